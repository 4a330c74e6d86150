#include "chart/ChartText.h"

#include "platform/ShortText.h"

#include <cmath>

ChartText textAt(const std::string& text, const ChartFont& font, float left, float top)
{
    left = std::floor(left); // letters are sharp on whole pixels
    top = std::floor(top);
    return {text,
            font.size,
            {left, std::round(top + font.ascent)},
            {left, top, left + font.width(text), top + std::ceil(font.height())}};
}

std::string fitText(const std::string& text, const TextWidth& widthOf, float width)
{
    if (text.empty() || widthOf(text) <= width)
        return text;
    const auto cut = [&](std::size_t length) { return text.substr(0, wholeCharacters(text, length)) + kEllipsis; };
    // The width grows with the length, so halving finds the cut: `fitting` bytes fit, `tooLong` do not.
    std::size_t fitting = 0;
    for (std::size_t tooLong = text.size(); tooLong - fitting > 1;) {
        const std::size_t middle = fitting + (tooLong - fitting) / 2;
        (widthOf(cut(middle)) <= width ? fitting : tooLong) = middle;
    }
    return wholeCharacters(text, fitting) > 0 ? cut(fitting) : std::string();
}
