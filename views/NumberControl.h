#pragma once

#include "foundation/NumberText.h"
#include "platform/TextControl.h"

#include <algorithm>
#include <limits>
#include <string>

/// A field for a number, with "." or "," as decimal mark. A text that is none shows by its colour until it is mended,
/// and so does one with a number and more; the number that it begins with counts then, or 0.
///
/// When a person leaves the field, or presses Enter, the number is written as it was understood. Where the mark may
/// have been meant to part thousands, and where a whole number is too large, a notice says how it was read.
class NumberControl : public BTextControl {
public:
    static constexpr int kLargestShort = std::numeric_limits<short>::max();

    using BTextControl::BTextControl;

    /// From here on it is for whole numbers up to `largest`, and others are marked.
    void askForCount(int largest = std::numeric_limits<int>::max());

    /// Shows enough digits for `getNumber` to give the same value.
    void setNumber(float value) { show(exactText(value)); }
    /// A number that is too large counts as the largest one.
    float getNumber() const { return limited<float>(readNumber(Text())); }

    void setInteger(int value) { show(std::to_string(value)); }
    /// What stands behind the decimal mark is dropped, and a number out of range counts as the nearest one.
    int getInteger() const { return limited<int>(readCount(Text())); }
    short getShort() const { return limited<short>(readCount(Text())); }

    /// What is wrong with the text, as it goes on from it: "is no number". Null when it is what the field is for, and
    /// when the field is empty.
    const char* fault() const;

    void TextModified() override { mark(); }
    void TextFinished() override;

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

    int largestCount_ = 0; // 0: it need not be whole
    std::string shown_;    // what was last put into the field; another text there was typed
};
