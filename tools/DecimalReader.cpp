#include "tools/DecimalReader.h"

#include <algorithm>
#include <charconv>
#include <string>

namespace {

std::optional<double> readWithPoint(std::string_view text)
{
    double number;
    const auto [end, error] = std::from_chars(text.data(), text.data() + text.size(), number);
    if (error != std::errc() || end != text.data() + text.size())
        return std::nullopt;
    return number;
}

} // namespace

std::optional<double> DecimalReader::read(std::string_view text)
{
    if (mark_ == '.')
        return readWithPoint(text);
    const std::size_t place = text.find_first_of(".,");
    std::string pointed(text);
    std::replace(pointed.begin(), pointed.end(), ',', '.');
    const std::optional<double> number = readWithPoint(pointed);
    if (!number || place == text.npos)
        return number;
    if (mark_ == kUnsettled)
        mark_ = text[place];
    return text[place] == mark_ ? number : std::nullopt;
}
