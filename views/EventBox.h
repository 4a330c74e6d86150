#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "platform/Box.h"
#include "platform/TextView.h"
#include "views/DateControl.h"
#include "views/MarketDataLists.h"
#include "views/ModelText.h"
#include "views/NumberControl.h"
#include "views/PageView.h"

class BMenuField;

/// A company's events with the fields and buttons to add, change and remove them. Of the fields, those of the chosen
/// kind show.
class EventBox final : public BBox {
public:
    explicit EventBox(BRect frame);

    CompanyEventListView& list() const { return *list_; }

    /// 1 split, 2 note.
    short getType() const { return type_; }
    void setType(short type);
    /// Undefined while the text is no date.
    Date getDate() const { return date_->getDate(); }
    void setDate(const Date& date) { date_->setDate(date); }
    String getTitle() const { return title_->Text(); }
    void setTitle(const String& title) { PageView::showText(*title_, title); }
    String getText() const { return text_->Text(); }
    void setText(const String& text) { text_->SetText(wholeTextOf(text)); }
    short getNumerator() const { return numerator_->getShort(); }
    void setNumerator(short numerator) { numerator_->setInteger(numerator); }
    short getDivider() const { return divider_->getShort(); }
    void setDivider(short divider) { divider_->setInteger(divider); }

private:
    BMenuField* makeMenu(BRect frame);
    void makeFields(BRect area);

    CompanyEventListView* list_;
    BMenuField* menu_ = nullptr;
    DateControl* date_ = nullptr;
    NumberControl* numerator_ = nullptr;
    NumberControl* divider_ = nullptr;
    BView* apply_ = nullptr;
    BTextControl* title_ = nullptr;
    BView* textLabel_ = nullptr;
    BTextView* text_ = nullptr;
    short type_ = 0;
};
