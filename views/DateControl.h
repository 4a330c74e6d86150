#pragma once

#include "foundation/Date.h"
#include "platform/TextControl.h"

/// A field for a date. A text that is none shows by its colour until it is mended.
class DateControl : public BTextControl {
public:
    using BTextControl::BTextControl;

    void setDate(const Date& date);
    /// Undefined while the text is no date.
    Date getDate() const;

    void TextModified() override;

private:
    void mark();
};
