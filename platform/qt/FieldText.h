#pragma once

#include <cstddef>
#include <string>

/// The bytes that a field's text stands for. A field shows UTF-8, with line ends of its own, and of a long text only
/// the beginning; what it was given and still shows untouched comes back byte for byte, whatever it was.
///
/// A mark at the end of such a beginning tells how much more there is. It stands for the rest, which comes back in its
/// place as long as nobody touches the mark, whatever is typed around it.
class FieldText {
public:
    /// Of a text of more than `longest` bytes only about as many are shown.
    explicit FieldText(std::size_t longest) : longest_(longest) {}

    /// Takes what the field is to stand for; null is the empty text. @return what to put into the field.
    std::string take(const char* text);
    /// `shown` is what the field made of that.
    void noteShown(std::string shown);
    /// What to give away while the field shows `shown`; valid until the next call of these.
    const char* of(std::string shown) const;

private:
    std::size_t longest_;
    std::string given_;
    std::string shown_;
    std::size_t rest_ = 0; // where in `given_` that begins which is not shown
    std::string mark_;     // for the rest; empty when all is shown
    mutable std::string typed_;
};
