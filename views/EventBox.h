#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "platform/Box.h"

class BMenuField;
class BTextControl;
class BTextView;
class CompanyEventListView;
class DateControl;
class NumberControl;

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
    Date getDate() const;
    void setDate(const Date& date);
    String getTitle() const;
    void setTitle(const String& title);
    String getText() const;
    void setText(const String& text);
    short getNumerator() const;
    void setNumerator(short numerator);
    short getDivider() const;
    void setDivider(short divider);

private:
    BMenuField* makeMenu(BRect frame);
    void makeFields(BRect area);

    CompanyEventListView* list_;
    BMenuField* menu_ = nullptr;
    DateControl* date_ = nullptr;
    NumberControl* numerator_ = nullptr;
    NumberControl* divider_ = nullptr;
    BTextControl* title_ = nullptr;
    BView* textLabel_ = nullptr;
    BTextView* text_ = nullptr;
    short type_ = 0;
};
