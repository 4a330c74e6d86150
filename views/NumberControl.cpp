#include "views/NumberControl.h"

#include "foundation/NumberText.h"

#include <algorithm>
#include <limits>

namespace {

/// The number that `text` begins with, brought into the range of `Number`.
template <class Number>
Number readAs(const char* text)
{
    constexpr double kHighest = std::numeric_limits<Number>::max();
    constexpr double kLowest = std::numeric_limits<Number>::lowest();
    return static_cast<Number>(std::clamp(readNumber(text), kLowest, kHighest));
}

} // namespace

void NumberControl::setNumber(float value)
{
    SetText(exactText(value).c_str());
    mark();
}

float NumberControl::getNumber() const
{
    return readAs<float>(Text());
}

void NumberControl::setInteger(int value)
{
    SetText(std::to_string(value).c_str());
    mark();
}

int NumberControl::getInteger() const
{
    return readAs<int>(Text());
}

short NumberControl::getShort() const
{
    return readAs<short>(Text());
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
