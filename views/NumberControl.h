#pragma once

#include "platform/TextControl.h"

/// A field for a number, with "." or "," as decimal mark. A text that is none shows by its colour until it is mended,
/// and so does one with a number and more; the number that it begins with counts then, or 0.
class NumberControl : public BTextControl {
public:
    using BTextControl::BTextControl;

    /// Shows enough digits for `getNumber` to give the same value.
    void setNumber(float value);
    /// A number that is too large counts as the largest one.
    float getNumber() const;

    void setInteger(int value);
    /// What stands behind the decimal mark is dropped, and a number out of range counts as the nearest one.
    int getInteger() const;
    short getShort() const;

    void TextModified() override;

private:
    void mark();
};
