#include "platform/ShortText.h"

std::size_t wholeCharacters(std::string_view text, std::size_t length)
{
    if (length >= text.size())
        return text.size();
    constexpr std::size_t kLongestCharacter = 4;
    const auto isInside = [&](std::size_t i) { return (static_cast<unsigned char>(text[i]) & 0xC0) == 0x80; };
    // The bytes of a character behind its first one begin with the bits 10: back to a first one, at most the length of
    // a character.
    std::size_t end = length;
    while (end > 0 && length - end < kLongestCharacter && isInside(end))
        --end;
    return isInside(end) ? length : end; // in bytes that are no UTF-8 there are no characters to keep whole
}

std::string shortened(std::string_view text, std::size_t longest)
{
    if (text.size() <= longest)
        return std::string(text);
    return std::string(text.substr(0, wholeCharacters(text, longest))) + kEllipsis;
}
