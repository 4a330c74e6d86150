#include "views/EventBox.h"

#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "platform/Button.h"
#include "platform/Label.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/PopUpMenu.h"
#include "views/Look.h"

using namespace look;

namespace {

constexpr float kDivider = 38; // room for the labels at the left

void setVisible(BView& view, bool isVisible)
{
    if (isVisible)
        view.Show();
    else
        view.Hide();
}

} // namespace

EventBox::EventBox(BRect frame) : BBox(frame, "")
{
    SetLabel("Events");
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    constexpr float kListEnd = kBoxTop + kHeadingHeight + 4 * kListRow + 2;
    list_ = new CompanyEventListView("lstCompanyEvents");
    list_->addTo(this, {kBoxSide, kBoxTop, right, kListEnd}, "Events");
    list_->SetSelectionMessage(new BMessage('CEse'));
    list_->setHint(
        "Splits and notes of the company that is selected will stand here. Fill in the fields, and press Add.");

    // Four rows of the list; what is below it is left to the fields.
    const float top = kListEnd + kMargin;
    const float buttonTop = bottom - kButtonHeight;
    makeFields({kBoxSide, top, right, buttonTop - kMargin});
    PageView::addButtons(this, {kBoxSide, buttonTop, right, bottom},
                         {{"btnAddCompanyEvent", "Add", 'CBEa'},
                          {"btnUpdateCompanyEvent", "Update", 'CBEu'},
                          {"btnRemoveCompanyEvent", "Remove", 'CBEr'}});
    PageView::explain(*this, {{"companyEventType", "An event by itself changes neither quotes nor holdings"},
                              {"btnApplySplit", "Shows what the selected split does to quotes, purchases and sales "
                                                "before its day, and does it"}});
    // What a new event starts with. `type_` is set by the last call, which also hides the fields of the other kind.
    setNumerator(1);
    setDivider(2);
    setType(SplitCompanyEvent::kType);
}

BMenuField* EventBox::makeMenu(BRect frame)
{
    auto* kinds = new BPopUpMenu("companyEventType");
    kinds->AddItem(new BMenuItem("Split", new BMessage('CMSp')));
    kinds->AddItem(new BMenuItem("Note", new BMessage('CMNo')));
    auto* field = new BMenuField(frame, "companyEventType", "Kind", kinds);
    field->SetDivider(kDivider);
    field->SetAlignment(B_ALIGN_RIGHT);
    AddChild(field);
    return field;
}

void EventBox::makeFields(BRect area)
{
    const float middle = area.left + 136;
    float top = area.top;
    menu_ = makeMenu({area.left, top, middle, top + kFieldHeight});
    date_ = PageView::addDate(this, {middle, top, area.right, top + kFieldHeight}, "txtCompanyEventDate", "Date",
                              'CTEd', kDivider + kMargin);
    top += kRow;
    // The two kinds take turns in the same place.
    constexpr float kNumberWidth = 80;
    const float second = area.left + kDivider + kNumberWidth;
    numerator_ = PageView::addTypedNumber(this, {area.left, top, second, top + kFieldHeight}, "txtEventSplitRangeNum",
                                          "Split", 'CTQv', kDivider);
    divider_ = PageView::addTypedNumber(this, {second, top, second + 24 + kNumberWidth, top + kFieldHeight},
                                        "txtEventSplitRangeDenum", "to", 'CTQv', 24);
    apply_ =
        PageView::addButton(this, {second + 24 + kNumberWidth + kGap, top - 1, area.right, top - 1 + kButtonHeight},
                            "btnApplySplit", "Apply...", 'CBAs');
    numerator_->askForCount(NumberControl::kLargestShort);
    divider_->askForCount(NumberControl::kLargestShort);
    title_ = PageView::addField(this, {area.left, top, area.right, top + kFieldHeight}, "txtCompanyEventTitle", "Title",
                                'CTEt', kDivider);
    top += kRow;
    text_ = new BTextView({area.left + kDivider, top, area.right, area.bottom}, "txtCompanyEventText",
                          B_FOLLOW_LEFT | B_FOLLOW_TOP);
    text_->SetAccessibleName("Text");
    AddChild(text_);
    // It hides with the note's text, so it is kept.
    textLabel_ = new BLabel({area.left, top, area.left + kDivider - kGap, top + kFieldHeight}, "Text", *text_);
    AddChild(textLabel_);
}

void EventBox::setType(short type)
{
    const bool isNote = type == NoteCompanyEvent::kType;
    // Any code but that of a note counts as a split. After this, mark, type and visible fields agree.
    type_ = isNote ? NoteCompanyEvent::kType : SplitCompanyEvent::kType;
    menu_->Menu()->ItemAt(isNote ? 1 : 0)->SetMarked(true);
    for (BView* view : {static_cast<BView*>(title_), textLabel_, static_cast<BView*>(text_)})
        setVisible(*view, isNote);
    for (BView* view : {static_cast<BView*>(numerator_), static_cast<BView*>(divider_), static_cast<BView*>(apply_)})
        setVisible(*view, !isNote);
}
