#include "views/PageView.h"

#include "foundation/NumberText.h"
#include "platform/Box.h"
#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/StringView.h"
#include "platform/TextControl.h"
#include "views/DateControl.h"
#include "views/Look.h"
#include "views/ModelText.h"
#include "views/NumberControl.h"

#include <cmath>
#include <cstring>

PageView::PageView(BRect frame, const char* name) : BView(frame, name, B_FOLLOW_ALL, B_WILL_DRAW | B_FRAME_EVENTS)
{
    SetViewColor(look::kPanel);
}

BBox* PageView::addBox(BView* parent, BRect frame, const char* label)
{
    auto* box = new BBox(frame, "");
    box->SetLabel(label);
    parent->AddChild(box);
    return box;
}

BTextControl* PageView::addField(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                 float divider)
{
    return addFieldOf<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
}

BTextControl* PageView::addNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                  float divider)
{
    return addFieldOf<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
}

DateControl* PageView::addDate(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                               float divider)
{
    return addFieldOf<DateControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
}

NumberControl* PageView::addTypedNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                        float divider)
{
    return addFieldOf<NumberControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
}

BButton* PageView::addButton(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
{
    auto* button = new BButton(frame, name, label, new BMessage(code));
    if (std::strcmp(label, kAddLabel) == 0)
        button->SetToolTip("Adds what the fields of this box say.  Ctrl+N, while the keyboard is in the box");
    parent->AddChild(button);
    return button;
}

void PageView::addButtons(BView* parent, BRect area, const std::vector<ButtonPlan>& buttons)
{
    const auto count = static_cast<float>(buttons.size());
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
        page.FindView(tip.control)->SetToolTip(tip.text);
}

void PageView::addOpenFile(BView* page, BRect frame)
{
    auto* line = new BStringView(frame, "txtOpenFile", "");
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
    std::string text = path.isUndefined() ? "No file" : fileName(path);
    if (changes > 0)
        text += " - " + countText(static_cast<int>(changes)) + (changes == 1 ? " change" : " changes") + " not saved";
    auto* line = static_cast<BStringView*>(FindView("txtOpenFile"));
    line->SetText(text.c_str());
    line->SetToolTip(wholeTextOf(path));
}

BCheckBox* PageView::addCheckBox(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
{
    auto* box = new BCheckBox(frame, name, label, new BMessage(code));
    parent->AddChild(box);
    return box;
}

void PageView::showText(BTextControl& field, const String& text)
{
    field.SetText(wholeTextOf(text));
}
