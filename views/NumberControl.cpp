#include "views/NumberControl.h"

#include "foundation/NumberText.h"

#include <algorithm>
#include <limits>

namespace {

/// The nearest number that `Number` has.
template <class Number>
Number limited(double number)
{
    constexpr double kHighest = std::numeric_limits<Number>::max();
    constexpr double kLowest = std::numeric_limits<Number>::lowest();
    return static_cast<Number>(std::clamp(number, kLowest, kHighest));
}

} // namespace

void NumberControl::setNumber(float value)
{
    // A text that was marked as wrong is gone with this.
    SetText(exactText(value).c_str());
    mark();
}

float NumberControl::getNumber() const
{
    return limited<float>(readNumber(Text()));
}

void NumberControl::setInteger(int value)
{
    SetText(std::to_string(value).c_str());
    mark();
}

int NumberControl::getInteger() const
{
    return limited<int>(readCount(Text()));
}

short NumberControl::getShort() const
{
    return limited<short>(readCount(Text()));
}

void NumberControl::TextModified()
{
    mark();
}

void NumberControl::mark()
{
    const bool isWrong = *Text() != '\0' && !isNumber(Text());
    MarkAsInvalid(isWrong ? "This is no number, such as 1234.5 or 1234,5" : nullptr);
}
