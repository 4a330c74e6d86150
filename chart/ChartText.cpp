#include "chart/ChartText.h"

#include <cmath>

namespace {

constexpr const char* kEllipsis = "\xE2\x80\xA6";

/// The end of the last whole character within the first `length` bytes.
std::size_t wholeCharacters(const std::string& text, std::size_t length)
{
    while (length > 0 && length < text.size() && (static_cast<unsigned char>(text[length]) & 0xC0) == 0x80)
        --length;
    return length;
}

} // namespace

ChartText textAt(const std::string& text, const ChartFont& font, float left, float top)
{
    left = std::floor(left); // letters are sharp on whole pixels
    top = std::floor(top);
    return {text,
            font.size,
            {left, std::round(top + font.ascent)},
            {left, top, left + font.width(text), top + std::ceil(font.height())}};
}

std::string fitText(const std::string& text, const ChartFont& font, float width)
{
    if (text.empty() || font.width(text) <= width)
        return text;
    const auto shortened = [&](std::size_t length) {
        return text.substr(0, wholeCharacters(text, length)) + kEllipsis;
    };
    std::size_t fitting = 0;
    for (std::size_t tooLong = text.size(); tooLong - fitting > 1;) {
        const std::size_t middle = fitting + (tooLong - fitting) / 2;
        (font.width(shortened(middle)) <= width ? fitting : tooLong) = middle;
    }
    return wholeCharacters(text, fitting) > 0 ? shortened(fitting) : std::string();
}
