#include "exchange/TableText.h"

#include <charconv>
#include <cstdio>
#include <cstdlib>

namespace {

constexpr const char* kHexDigits = "0123456789ABCDEF";

template <class Number>
std::optional<Number> readWhole(std::string_view text)
{
    Number number;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

bool isControl(char c)
{
    return static_cast<unsigned char>(c) < ' ' || c == '\x7F';
}

/// The byte that "\xHH" at the beginning of `text` stands for; -1 for another text.
int readByteSign(std::string_view text)
{
    unsigned byte = 0;
    if (text.size() < 4 || text[1] != 'x')
        return -1;
    const char* end = text.data() + 4;
    const auto result = std::from_chars(text.data() + 2, end, byte, 16);
    return result.ec == std::errc() && result.ptr == end ? static_cast<int>(byte) : -1;
}

} // namespace

std::string numberText(float value)
{
    char text[32];
    std::snprintf(text, sizeof text, "%.9g", static_cast<double>(value));
    return text;
}

std::optional<float> readNumberText(std::string_view text)
{
    return readWhole<float>(text);
}

std::optional<int> readCountText(std::string_view text)
{
    return readWhole<int>(text);
}

std::string tableDate(const Date& date)
{
    char text[40];
    std::snprintf(text, sizeof text, "%04d-%02d-%02d", date.getYear(), date.getMonth(), date.getDay());
    return text;
}

std::optional<Date> readTableDate(std::string_view text)
{
    // A '-' in front of a part is its sign, and the one behind it ends it.
    int year;
    short month, day;
    const char* end = text.data() + text.size();
    auto part = std::from_chars(text.data(), end, year);
    if (part.ec != std::errc() || part.ptr == end || *part.ptr != '-')
        return std::nullopt;
    part = std::from_chars(part.ptr + 1, end, month);
    if (part.ec != std::errc() || part.ptr == end || *part.ptr != '-')
        return std::nullopt;
    part = std::from_chars(part.ptr + 1, end, day);
    if (part.ec != std::errc() || part.ptr != end)
        return std::nullopt;
    return Date(day, month, year);
}

std::size_t characterLength(std::string_view text)
{
    if (text.empty())
        return 0;
    const auto byte = [text](std::size_t i) { return static_cast<unsigned char>(text[i]); };
    const unsigned char lead = byte(0);
    if (lead < 0x80)
        return 1;
    const std::size_t length = lead >= 0xF0 ? 4 : lead >= 0xE0 ? 3 : 2;
    // 80..C1 and F5..FF begin no character.
    if (lead < 0xC2 || lead > 0xF4 || text.size() < length)
        return 0;
    for (std::size_t i = 1; i < length; ++i)
        if ((byte(i) & 0xC0) != 0x80)
            return 0;
    // Overlong forms, surrogates and what is beyond the last character.
    const bool isOdd = (lead == 0xE0 && byte(1) < 0xA0) || (lead == 0xED && byte(1) > 0x9F) ||
                       (lead == 0xF0 && byte(1) < 0x90) || (lead == 0xF4 && byte(1) > 0x8F);
    return isOdd ? 0 : length;
}

std::string escaped(std::string_view bytes)
{
    std::string text;
    for (std::size_t i = 0; i < bytes.size();) {
        const char c = bytes[i];
        const std::size_t length = characterLength(bytes.substr(i));
        if (c == '\\' || c == '\n') {
            text += c == '\n' ? "\\n" : "\\\\";
        } else if (length == 0 || isControl(c)) {
            const auto byte = static_cast<unsigned char>(c);
            text += {'\\', 'x', kHexDigits[byte >> 4], kHexDigits[byte & 0xF]};
        } else {
            text += bytes.substr(i, length);
            i += length - 1;
        }
        ++i;
    }
    return text;
}

std::string unescaped(std::string_view text)
{
    std::string bytes;
    while (!text.empty()) {
        std::size_t taken = 1;
        const char next = text.front() == '\\' && text.size() > 1 ? text[1] : '\0';
        const int byte = next == 'x' ? readByteSign(text) : -1;
        if (next == '\\' || next == 'n') {
            bytes += next == 'n' ? '\n' : '\\';
            taken = 2;
        } else if (byte >= 0) {
            bytes += static_cast<char>(byte);
            taken = 4;
        } else {
            bytes += text.front();
        }
        text.remove_prefix(taken);
    }
    return bytes;
}
