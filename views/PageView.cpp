#include "views/PageView.h"

#include "platform/Box.h"
#include "platform/Button.h"
#include "platform/CheckBox.h"
#include "platform/TextControl.h"
#include "views/Look.h"

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
    auto* field = new BTextControl(frame, name, label, "", new BMessage(code));
    field->SetDivider(divider);
    field->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_LEFT);
    parent->AddChild(field);
    return field;
}

BTextControl* PageView::addNumber(BView* parent, BRect frame, const char* name, const char* label, uint32 code,
                                  float divider)
{
    BTextControl* field = addField(parent, frame, name, label, code, divider);
    field->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_RIGHT);
    return field;
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
