#include "platform/qt/FieldText.h"

#include "platform/ShortText.h"

#include <utility>

std::string FieldText::take(const char* text)
{
    given_ = text != nullptr ? text : "";
    // All is shown, unless what follows finds the text too long.
    mark_.clear();
    rest_ = given_.size();
    if (given_.size() <= longest_)
        return given_;
    rest_ = wholeCharacters(given_, longest_);
    mark_ = kEllipsis + (" [" + std::to_string(given_.size() - rest_)) + " more bytes]";
    return given_.substr(0, rest_) + mark_;
}

void FieldText::noteShown(std::string shown)
{
    shown_ = std::move(shown);
}

const char* FieldText::of(std::string shown) const
{
    // Nobody has touched the field: its own line ends and what it made of bytes that are no UTF-8 do not count.
    if (shown == shown_)
        return given_.c_str();
    typed_ = std::move(shown);
    // The last one is ours: what a person types in front may look like it. Without the mark in its full length the rest
    // has been deleted with it.
    const std::size_t mark = mark_.empty() ? std::string::npos : typed_.rfind(mark_);
    if (mark != std::string::npos)
        typed_.replace(mark, mark_.size(), given_, rest_);
    return typed_.c_str();
}
