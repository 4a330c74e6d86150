#pragma once

#include "foundation/DateText.h"
#include "platform/TextControl.h"

/// A field for a date. A text that is none shows by its colour until it is mended. The keys Up and Down go a day on and
/// back, Page Up and Page Down a month; from an empty field they begin today.
class DateControl : public BTextControl {
public:
    using BTextControl::BTextControl;

    void setDate(const Date& date);
    /// Undefined while the text is no date.
    Date getDate() const { return readDate(Text()); }

    void TextModified() override { mark(); }
    void KeyDown(const char* bytes, int32 numBytes) override;

private:
    void mark();
    /// Shows `date` as if it had been typed, with Enter; does nothing for one that could not be typed.
    void enter(const Date& date);
};
