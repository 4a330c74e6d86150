#include "app/MessageView.h"

#include <cstdlib>
#include <cstring>
#include <new>

MessageView::MessageView(BRect frame, const char* name, PLWindow* window)
    : BStringView(frame, name, "MessageView", B_FOLLOW_ALL, B_WILL_DRAW | B_FRAME_EVENTS), window_(window)
{
    SetFont(be_bold_font);
    SetFontSize(24); // kept as it is; nothing is drawn at this size, messages are at 14
    SetPenSize(3);
    SetLowColor(kPanelGrey);
}

MessageView::~MessageView()
{
    std::free(message_);
}

void MessageView::SetMessage(const char* text)
{
    if (text == nullptr) {
        std::free(message_);
        message_ = nullptr;
        return;
    }
    const std::size_t size = std::strlen(text) + 1;
    // A message of the same length goes into the place of the former one.
    if (message_ == nullptr || std::strlen(message_) + 1 != size) {
        void* moved = std::realloc(message_, size);
        if (moved == nullptr)
            throw std::bad_alloc();
        message_ = static_cast<char*>(moved);
    }
    std::memmove(message_, text, size); // `text` may be the message itself
    SetAccessibleName(message_);
    DrawMsg();
    Sync(); // the command may go on to block for a while
}

void MessageView::DrawMsg()
{
    FillRect(Bounds(), B_SOLID_LOW);
    BFont usual;
    GetFont(&usual);
    BFont font = usual;
    font.SetSize(14);
    SetFont(&font, B_FONT_SIZE);
    if (message_ != nullptr)
        DrawString(message_, {Bounds().left + 5, Bounds().bottom - 5});
    SetFont(&usual, B_FONT_SIZE);
}

void MessageView::Draw(BRect)
{
    DrawMsg();
}

void MessageView::FrameResized(float, float)
{
    Draw(Bounds());
}
