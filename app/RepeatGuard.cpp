#include "app/RepeatGuard.h"

#include "platform/Button.h"
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

/// The box of the button below `view` that adds by that code; null when there is none.
const BView* boxOf(uint32 code, const BView& view)
{
    const auto* button = dynamic_cast<const BButton*>(&view);
    if (button != nullptr && button->Message() != nullptr && button->Message()->what == code)
        return view.Parent();
    for (int32 i = 0; i < view.CountChildren(); ++i) {
        if (const BView* box = boxOf(code, *view.ChildAt(i)))
            return box;
    }
    return nullptr;
}

/// What all fields below `view` hold that a person can change: the others follow what was added.
std::string fieldsOf(const BView& view)
{
    std::string held;
    if (const auto* text = dynamic_cast<const BTextControl*>(&view))
        held = text->IsEditable() ? text->Text() : "";
    else if (const auto* box = dynamic_cast<const BCheckBox*>(&view))
        held = std::to_string(box->Value());
    else if (const auto* menu = dynamic_cast<const BMenuField*>(&view))
        held = std::to_string(menu->Menu()->IndexOf(menu->Menu()->FindMarked()));
    for (int32 i = 0; i < view.CountChildren(); ++i)
        held += '\n' + fieldsOf(*view.ChildAt(i));
    return held;
}

/// Those of the box that the addition is of: the rest of the page shows what was added, and changes with it.
std::string addedFrom(uint32 code, const BView& page)
{
    const BView* box = boxOf(code, page);
    return fieldsOf(box != nullptr ? *box : page);
}

} // namespace

bool RepeatGuard::isRepeat(const BMessage& message, const BView& page)
{
    if (!isAddition(message) || message.what != code_)
        return false;
    bigtime_t longest;
    get_click_speed(&longest);
    if (Clock::now() - done_ >= std::chrono::microseconds(longest) || addedFrom(code_, page) != fields_)
        return false;
    done_ = Clock::now(); // a third one is no more meant than the second
    return true;
}

void RepeatGuard::noteRun(const BMessage& message, const BView& page)
{
    if (!isAddition(message))
        return;
    code_ = message.what;
    fields_ = addedFrom(code_, page);
    done_ = Clock::now();
}
