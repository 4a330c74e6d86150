#include "exchange/TextForms.h"

#include "foundation/FoldedText.h"

#include <algorithm>
#include <array>
#include <cstddef>

namespace {

// What the code page has at 0x80 to 0x9F; elsewhere its bytes are the code points.
constexpr std::array<char32_t, 32> kWindows1252 = {
    0x20AC, 0x81,   0x201A, 0x0192, 0x201E, 0x2026, 0x2020, 0x2021, 0x02C6, 0x2030, 0x0160,
    0x2039, 0x0152, 0x8D,   0x017D, 0x8F,   0x90,   0x2018, 0x2019, 0x201C, 0x201D, 0x2022,
    0x2013, 0x2014, 0x02DC, 0x2122, 0x0161, 0x203A, 0x0153, 0x9D,   0x017E, 0x0178,
};

void append(std::string* text, char32_t c)
{
    const auto byte = [text](char32_t bits) { *text += static_cast<char>(static_cast<unsigned char>(bits)); };
    if (c < 0x80)
        return byte(c);
    if (c < 0x800) {
        byte(0xC0 | c >> 6);
    } else {
        if (c < 0x10000) {
            byte(0xE0 | c >> 12);
        } else {
            byte(0xF0 | c >> 18);
            byte(0x80 | (c >> 12 & 0x3F));
        }
        byte(0x80 | (c >> 6 & 0x3F));
    }
    byte(0x80 | (c & 0x3F));
}

bool isIn(char32_t c, char32_t first, char32_t last)
{
    return c >= first && c <= last;
}

/// Whether a character of a folded heading is passed over: marks of any kind.
bool isMark(char32_t c)
{
    if (c < 0x80)
        return !isIn(c, 'a', 'z') && !isIn(c, '0', '9');
    return isIn(c, 0x80, 0xBF) || isIn(c, 0x2000, 0x206F);
}

} // namespace

char32_t takeCharacter(std::string_view& text)
{
    const auto byte = [&](std::size_t i) { return i < text.size() ? static_cast<unsigned char>(text[i]) : 0U; };
    const char32_t first = byte(0);
    std::size_t length = 1;
    char32_t c = first;
    char32_t least = 0; // below it the same character has a shorter form
    if (first >= 0xF0) {
        length = 4;
        c = first & 0x07;
        least = first < 0xF8 ? 0x10000 : kBrokenCharacter;
    } else if (first >= 0xE0) {
        length = 3;
        c = first & 0x0F;
        least = 0x800;
    } else if (first >= 0x80) {
        length = 2;
        c = first & 0x1F;
        least = first >= 0xC0 ? 0x80 : kBrokenCharacter;
    }
    bool isWhole = true;
    for (std::size_t i = 1; i < length; ++i) {
        isWhole = isWhole && (byte(i) & 0xC0) == 0x80;
        c = c << 6 | (byte(i) & 0x3F);
    }
    const bool isCharacter = isWhole && c >= least && c <= 0x10FFFF && !isIn(c, 0xD800, 0xDFFF);
    text.remove_prefix(isCharacter ? length : 1);
    return isCharacter ? c : kBrokenCharacter;
}

bool isUtf8(std::string_view bytes)
{
    while (!bytes.empty())
        if (takeCharacter(bytes) == kBrokenCharacter)
            return false;
    return true;
}

std::string fromWindows1252(std::string_view bytes)
{
    std::string utf8;
    for (const char c : bytes) {
        const auto byte = static_cast<unsigned char>(c);
        append(&utf8, isIn(byte, 0x80, 0x9F) ? kWindows1252[byte - 0x80U] : byte);
    }
    return utf8;
}

std::string wordKey(std::string_view utf8)
{
    std::string key;
    const std::string folded = foldedText(utf8);
    for (std::string_view rest = folded; !rest.empty();) {
        const char* at = rest.data();
        const char32_t c = takeCharacter(rest);
        if (c != kBrokenCharacter && !isMark(c))
            key.append(at, rest.data());
    }
    return key.empty() ? std::string(withoutBlanks(utf8)) : key;
}

std::vector<std::string_view> splitAtBlanks(std::string_view text)
{
    std::vector<std::string_view> parts;
    for (std::size_t end = 0; !text.empty(); text.remove_prefix(std::min(end + 1, text.size()))) {
        end = std::min(text.find(' '), text.size());
        if (end > 0)
            parts.push_back(text.substr(0, end));
    }
    return parts;
}

bool isBlank(char32_t c)
{
    return c == ' ' || c == '\t' || c == 0xA0 || c == 0x1680 || isIn(c, 0x2000, 0x200B) || c == 0x202F || c == 0x205F ||
           c == 0x3000;
}

std::string_view withoutBlanks(std::string_view utf8)
{
    // Up to the end of the last character that is no blank, from the first one on.
    const char* first = nullptr;
    const char* end = nullptr;
    for (std::string_view rest = utf8; !rest.empty();) {
        const char* at = rest.data();
        if (isBlank(takeCharacter(rest)))
            continue;
        if (first == nullptr)
            first = at;
        end = rest.data();
    }
    return first != nullptr ? std::string_view(first, static_cast<std::size_t>(end - first)) : std::string_view();
}
