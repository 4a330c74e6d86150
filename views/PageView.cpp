#include "views/PageView.h"

#include "platform/Box.h"
#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/TextControl.h"
#include "views/DateControl.h"
#include "views/Look.h"
#include "views/NumberControl.h"

namespace {

/// A field of its class, in the look of all fields.
template <class Field>
Field* makeField(BView* parent, BRect frame, const char* name, const char* label, uint32 code, float divider,
                 alignment text)
{
    auto* field = new Field(frame, name, label, "", new BMessage(code));
    field->SetDivider(divider);
    field->SetAlignment(B_ALIGN_RIGHT, text);
    parent->AddChild(field);
    return field;
}

} // namespace

PageView::PageView(BRect frame, const char* name) : BView(frame, name, B_FOLLOW_ALL, B_WILL_DRAW)
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
    return makeField<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
}

BTextControl* PageView::addNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                  float divider)
{
    return makeField<BTextControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
}

DateControl* PageView::addDate(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                               float divider)
{
    return makeField<DateControl>(parent, frame, name, label, code, divider, B_ALIGN_LEFT);
}

NumberControl* PageView::addTypedNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                        float divider)
{
    return makeField<NumberControl>(parent, frame, name, label, code, divider, B_ALIGN_RIGHT);
}

BButton* PageView::addButton(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
{
    auto* button = new BButton(frame, name, label, new BMessage(code));
    parent->AddChild(button);
    return button;
}

BCheckBox* PageView::addCheckBox(BView* parent, BRect frame, const char* name, const char* label, uint32 code)
{
    auto* box = new BCheckBox(frame, name, label, new BMessage(code));
    parent->AddChild(box);
    return box;
}
