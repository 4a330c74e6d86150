#pragma once

#include "foundation/NumberText.h"
#include "platform/TextControl.h"

#include <algorithm>
#include <limits>
#include <string>

/// A field for a number, with "." or "," as decimal mark. A text that is none shows by its colour until it is mended,
/// and so does one with a number and more; the number that it begins with counts then, or 0.
class NumberControl : public BTextControl {
public:
    using BTextControl::BTextControl;

    /// Shows enough digits for `getNumber` to give the same value.
    void setNumber(float value) { show(exactText(value)); }
    /// A number that is too large counts as the largest one.
    float getNumber() const { return limited<float>(readNumber(Text())); }

    void setInteger(int value) { show(std::to_string(value)); }
    /// What stands behind the decimal mark is dropped, and a number out of range counts as the nearest one.
    int getInteger() const { return limited<int>(readCount(Text())); }
    short getShort() const { return limited<short>(readCount(Text())); }

    void TextModified() override { mark(); }

private:
    /// The nearest number that `Number` has.
    template <class Number>
    static Number limited(double number)
    {
        constexpr double kHighest = std::numeric_limits<Number>::max();
        constexpr double kLowest = std::numeric_limits<Number>::lowest();
        return static_cast<Number>(std::clamp(number, kLowest, kHighest));
    }
    void show(const std::string& text);
    void mark();
};
