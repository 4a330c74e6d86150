#pragma once

#include "foundation/DateText.h"
#include "platform/TextControl.h"

/// A field for a date. A text that is none shows by its colour until it is mended. The keys Up and Down go a day on and
/// back, Page Up and Page Down a month; from an empty field they begin today. A calendar opens by its button or
/// Alt+Down.
///
/// A year of two digits that a person types is one within fifty years of today, from the first moment on; when the
/// field is left, or at Enter, it is written in full, with day, month and year in this order.
class DateControl : public BTextControl {
public:
    DateControl(BRect frame, const char* name, const char* label, const char* text, BMessage* message);

    void setDate(const Date& date);
    /// Undefined while the text is no date.
    Date getDate() const;

    void TextModified() override { mark(); }
    void TextFinished() override;
    void KeyDown(const char* bytes, int32 numBytes) override;

private:
    void mark();
    /// Shows `date` as if it had been typed, with Enter; does nothing for one that could not be typed.
    void enter(const Date& date);

    std::string shown_; // what was last put into the field; another text there was typed
};
