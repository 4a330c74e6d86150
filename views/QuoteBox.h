#pragma once

#include "foundation/Date.h"
#include "platform/Box.h"
#include "platform/SupportDefs.h"

#include <vector>

class DateControl;
class NumberControl;
class Quote;
class QuoteListView;

/// A list of quotes with the fields and buttons to add, change and remove them.
class QuoteBox final : public BBox {
public:
    /// What is sent by the list, by the fields, and by the buttons.
    struct Codes {
        uint32 selection;
        uint32 date;
        uint32 value;
        uint32 add;
        uint32 update;
        uint32 remove;
    };

    QuoteBox(BRect frame, const char* title, const Codes& codes);

    QuoteListView& list() const { return *list_; }
    /// Undefined while the text is no date.
    Date getDate() const;
    void setDate(const Date& date);
    float getValue() const;
    void setValue(float value);

    /// What is left free for more controls, in the box's coordinates.
    BRect freeArea() const { return freeArea_; }

private:
    QuoteListView* list_;
    DateControl* date_;
    NumberControl* value_;
    BRect freeArea_;
};
