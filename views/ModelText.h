#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "platform/ShortText.h"

#include <optional>
#include <string>

/// How much of a text is shown in a list, a chart or a line, in bytes.
constexpr std::size_t kLongestShown = 512;

/// A text of the model, to be shown in a list, a chart or a line; empty for a String without text. Of a longer one, as
/// a damaged file can hold of megabytes, some hundred characters are shown.
inline std::string textOf(const String& text)
{
    return shortened(text.bytes(), kLongestShown);
}

/// What a date is sorted by; nothing for one that is no day.
inline std::optional<double> dayOrder(const Date& day)
{
    return !day.isValid() ? std::nullopt : std::optional<double>(day - Date(1, 1, 1));
}

/// The text, whole, for what gives it back: fields and menus, which show as much of it as they can.
inline const char* wholeTextOf(const String& text)
{
    return text.hasText() ? text.getCharacterArray() : "";
}
