#include "views/PageView.h"

#include "foundation/NumberText.h"
#include "platform/Button.h"
#include "platform/StringView.h"
#include "views/FieldNotice.h"
#include "views/HeightSharing.h"
#include "views/Look.h"

#include <algorithm>
#include <cmath>
#include <cstring>

namespace {

constexpr const char* kNoFile = "No file";
constexpr const char* kBookingLabels[] = {PageView::kAddLabel, PageView::kUpdateLabel, "Split"};

/// A button whose command takes the numbers of its box.
class BookingButton final : public BButton {
public:
    using BButton::BButton;

    status_t Invoke(const BMessage* message) override
    {
        for (int32 i = 0; i < Parent()->CountChildren(); ++i) {
            auto* field = dynamic_cast<NumberControl*>(Parent()->ChildAt(i));
            if (field == nullptr || field->IsHidden() || field->fault() == nullptr)
                continue;
            field->MakeFocus();
            tellAboutField(*field, std::string(field->Label()) + ": " + shortened(field->Text(), kLongestTold) + ' ' +
                                       field->fault());
            return B_BAD_VALUE;
        }
        for (BView* view = Parent(); view != nullptr && isUpdating(); view = view->Parent()) {
            if (auto* page = dynamic_cast<PageView*>(view))
                page->AboutToUpdate();
        }
        return BButton::Invoke(message);
    }

private:
    bool isUpdating() const { return std::strcmp(Label(), PageView::kUpdateLabel) == 0; }

    static constexpr std::size_t kLongestTold = 60; // bytes
};

} // namespace

PageView::PageView(BRect frame, const char* name, uint32 flags)
    : BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_FRAME_EVENTS | flags)
{
    SetViewColor(look::kPanel);
}

PageView::~PageView() = default;

float PageView::shrinkTo(float height)
{
    AboutToShrink();
    if (heights_ == nullptr)
        heights_ = std::make_unique<HeightSharing>(*this, std::min(Bounds().Height(), look::kPageHeight));
    const float shown = std::max(height, heights_->least());
    ResizeTo(Bounds().Width(), shown);
    heights_->share(shown); // after the charts have followed the page
    Shrunk();
    return shown;
}

BButton* PageView::addButton(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
{
    const bool isBooking =
        std::ranges::any_of(kBookingLabels, [&](const char* l) { return std::strcmp(l, label) == 0; });
    auto* message = new BMessage(code);
    auto* button =
        isBooking ? new BookingButton(frame, name, label, message) : new BButton(frame, name, label, message);
    // `app/Shortcuts.cpp` finds the button that adds by the same label.
    if (std::strcmp(label, kAddLabel) == 0) {
        message->AddInt32(kByHand, 1);
        button->SetToolTip("Adds what the fields of this box say.  Ctrl+N, while the keyboard is in the box");
    }
    parent->AddChild(button);
    return button;
}

void PageView::addButtons(BView* parent, BRect area, const std::vector<ButtonPlan>& buttons)
{
    const auto count = static_cast<float>(buttons.size());
    // From the beginning of one button to that of the next: the last gap lies outside of the area.
    const float pitch = (area.Width() + look::kGap) / count;
    float left = area.left;
    for (const ButtonPlan& button : buttons) {
        const float right = left + pitch - look::kGap;
        addButton(parent, {std::round(left), area.top, std::round(right), area.bottom}, button.name, button.label,
                  button.code);
        // The next one begins where this one would end without rounding, so that the last ends at the edge.
        left += pitch;
    }
}

void PageView::addLoadAndSave(BView* page)
{
    constexpr float kWidth = 110;
    constexpr float kRight = look::kPageWidth - look::kMargin;
    addButtons(page, {kRight - 2 * kWidth - look::kGap, look::kMargin, kRight, look::kMargin + look::kButtonHeight},
               {{"btnLoadMarket", "Load", 'CBLd'}, {"btnSaveMarket", "Save", 'CBSv'}});
    addOpenFile(page, {look::kMargin, look::kMargin, kRight - 2 * kWidth - 3 * look::kGap,
                       look::kMargin + look::kButtonHeight});
    explain(*page, {{"btnLoadMarket", "Loads currencies, markets and companies from a file.  Ctrl+O"},
                    {"btnSaveMarket", "Saves all currencies, markets and companies to a file.  Ctrl+S"}});
}

void PageView::explain(BView& page, std::initializer_list<Tip> tips)
{
    for (const Tip& tip : tips)
        // A misspelt name would crash as soon as the page is made, and so in every test.
        page.FindView(tip.control)->SetToolTip(tip.text);
}

void PageView::addOpenFile(BView* page, BRect frame)
{
    auto* line = new BStringView(frame, "txtOpenFile", kNoFile);
    line->SetAlignment(B_ALIGN_RIGHT);
    page->AddChild(line);
}

std::string PageView::fileName(const String& path)
{
    constexpr std::size_t kLongest = 40; // bytes
    const std::string_view whole = path.bytes();
    return shortened(whole.substr(whole.rfind('/') + 1), kLongest); // all of it without a slash
}

void PageView::SetOpenFile(const String& path, unsigned changes)
{
    std::string text = path.isUndefined() ? kNoFile : fileName(path);
    if (changes > 0)
        text += " - " + countText(static_cast<int>(changes)) + (changes == 1 ? " change" : " changes") + " not saved";
    auto* line = static_cast<BStringView*>(FindView("txtOpenFile"));
    line->SetText(text.c_str());
    line->SetToolTip(wholeTextOf(path));
}
