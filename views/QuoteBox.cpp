#include "views/QuoteBox.h"

#include "views/Look.h"
#include "views/PageView.h"

using namespace look;

QuoteBox::QuoteBox(BRect frame, const char* title, const Codes& codes) : BBox(frame, "")
{
    SetLabel(title);
    const float right = frame.Width() - kBoxSide;
    const float bottom = frame.Height() - kBoxSide;
    // The list stands at the left, fields and buttons at the right; what is below these is left free.
    constexpr float kListWidth = 82 + 96 + kScrollBar;
    list_ = new QuoteListView("lstQuotes");
    list_->addTo(this, {kBoxSide, kBoxTop, kBoxSide + kListWidth, bottom}, title);
    list_->SetSelectionMessage(new BMessage(codes.selection));
    list_->setHint("A value for each day will stand here. Select a row above; then type date and value, and press Add. "
                   "\"Import...\" brings a table.");

    constexpr float kLeft = kBoxSide + kListWidth + kMargin;
    constexpr float kDivider = 44;
    float top = kBoxTop;
    date_ =
        PageView::addDate(this, {kLeft, top, right, top + kFieldHeight}, "txtQuoteDate", "Date", codes.date, kDivider);
    top += kRow;
    value_ = PageView::addTypedNumber(this, {kLeft, top, right, top + kFieldHeight}, "txtQuoteValue", "Value",
                                      codes.value, kDivider);
    // Fields and buttons are told apart by a wider gap.
    top += kRow + kGap;
    PageView::addButtons(this, {kLeft, top, right, top + kButtonHeight},
                         {{"btnAddQuote", "Add", codes.add},
                          {"btnUpdateQuote", "Update", codes.update},
                          {"btnRemoveQuote", "Remove", codes.remove}});
    freeArea_ = {kLeft, top + kButtonHeight + kMargin, right, bottom};
}
