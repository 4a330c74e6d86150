#include "exchange/TableText.h"

#include "exchange/TextForms.h"

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

std::string escaped(std::string_view bytes)
{
    std::string text;
    while (!bytes.empty()) {
        const std::string_view rest = bytes;
        const char32_t c = takeCharacter(bytes);
        if (c == '\\' || c == '\n') {
            text += c == '\n' ? "\\n" : "\\\\";
        } else if (c == kBrokenCharacter || c < ' ' || c == '\x7F') {
            const auto byte = static_cast<unsigned char>(rest.front());
            text += {'\\', 'x', kHexDigits[byte >> 4], kHexDigits[byte & 0xF]};
        } else {
            text += rest.substr(0, rest.size() - bytes.size());
        }
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
