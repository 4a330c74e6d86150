#include "platform/qt/FieldText.h"

#include "platform/ShortText.h"

#include <utility>

std::string FieldText::take(const char* text)
{
    given_ = text != nullptr ? text : "";
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
    if (shown == shown_)
        return given_.c_str();
    typed_ = std::move(shown);
    const std::size_t mark = mark_.empty() ? std::string::npos : typed_.rfind(mark_);
    if (mark != std::string::npos)
        typed_.replace(mark, mark_.size(), given_, rest_);
    return typed_.c_str();
}
