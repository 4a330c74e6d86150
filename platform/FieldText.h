#pragma once

#include <string>
#include <utility>

/// The bytes that a field's text stands for. A field shows UTF-8, with line ends of its own; what it was given and
/// still shows untouched comes back byte for byte, whatever it was.
class FieldText {
public:
    /// `text` was put into the field, which then showed `shown`.
    void set(const char* text, std::string shown)
    {
        given_ = text != nullptr ? text : "";
        shown_ = std::move(shown);
    }
    /// What to give away while the field shows `shown`; valid until the next call of either.
    const char* of(std::string shown) const
    {
        if (shown == shown_)
            return given_.c_str();
        typed_ = std::move(shown);
        return typed_.c_str();
    }

private:
    std::string given_;
    std::string shown_;
    mutable std::string typed_;
};
