#pragma once

#include <optional>
#include <string_view>

/// Reads the decimal numbers of one file, all with the same decimal mark.
///
/// Where a comma is possible the first number with a mark settles whether it is '.' or ','. From then on the other one
/// makes a number unreadable, since it may as well separate thousands: "1.234" would be wrong by a factor of 1000.
class DecimalReader {
public:
    /// `commaAllowed` is false where commas separate the fields.
    explicit DecimalReader(bool commaAllowed) : mark_(commaAllowed ? kUnsettled : '.') {}

    /// @return nothing when `text` is not a number, or one beyond the range of double.
    std::optional<double> read(std::string_view text);
    /// '.' while it is unsettled.
    char mark() const { return mark_ == kUnsettled ? '.' : mark_; }

private:
    static constexpr char kUnsettled = '\0';

    char mark_;
};
