#include "app/RepeatGuard.h"

#include "platform/CheckBox.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/Message.h"
#include "platform/TextControl.h"
#include "views/PageView.h"

namespace {

bool isAddition(const BMessage& message)
{
    int32 byHand = 0;
    return message.FindInt32(PageView::kByHand, &byHand) == B_OK;
}

/// What all fields below `view` hold.
std::string fieldsOf(const BView& view)
{
    std::string held;
    if (const auto* text = dynamic_cast<const BTextControl*>(&view))
        held = text->Text();
    else if (const auto* box = dynamic_cast<const BCheckBox*>(&view))
        held = std::to_string(box->Value());
    else if (const auto* menu = dynamic_cast<const BMenuField*>(&view))
        held = std::to_string(menu->Menu()->IndexOf(menu->Menu()->FindMarked()));
    for (int32 i = 0; i < view.CountChildren(); ++i)
        held += '\n' + fieldsOf(*view.ChildAt(i));
    return held;
}

} // namespace

bool RepeatGuard::isRepeat(const BMessage& message, const BView& page)
{
    if (!isAddition(message) || message.what != code_)
        return false;
    bigtime_t longest;
    get_click_speed(&longest);
    if (Clock::now() - done_ >= std::chrono::microseconds(longest) || fieldsOf(page) != fields_)
        return false;
    done_ = Clock::now(); // a third one is no more meant than the second
    return true;
}

void RepeatGuard::noteRun(const BMessage& message, const BView& page)
{
    if (!isAddition(message))
        return;
    code_ = message.what;
    fields_ = fieldsOf(page);
    done_ = Clock::now();
}
