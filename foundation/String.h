#pragma once

#include "foundation/Serializable.h"

#include <string_view>

/// The text of names, tickers and notes: any bytes, with a 32-bit length.
///
/// A String without text (never given one) differs from one with an empty text, though both have length 0 and count
/// as undefined: only the former compares unequal to everything, itself included.
class String final : public Serializable {
public:
    /// Stands in for a String without text where characters are asked for: "null".
    static const char* const NULLSTRING;

    /// One without text, for what gives a reference.
    static const String& none();

    String() = default;
    /// Copies `s` up to its terminating zero; null gives a String without text.
    String(const char* s);
    String(const String& other);
    String(String&& other) noexcept;
    String& operator=(const String& other);
    String& operator=(String&& other) noexcept;
    ~String();

    /// File: length (i32), then the bytes, no terminator.
    int wrt(FILE* file) const override;
    /// A negative length, or one that reaches past the end of the file, takes what is left of the file and returns -1.
    int rd(FILE* file) override;

    /// Appends the text of `s`; when `s` has none, "null" is appended, but only to a String that has text itself.
    String& operator+=(const String& s);

    /// Byte-wise up to the first zero byte; false when either side has no text.
    bool operator==(const String& s) const;
    bool operator!=(const String& s) const { return !(*this == s); }

    int getLength() const { return length_; }
    /// True for length 0: an empty text counts as undefined.
    bool isUndefined() const { return length_ == 0; }
    /// False only for a String that was never given a text, not even an empty one.
    bool hasText() const { return text_ != nullptr; }
    /// The text with a terminating zero, or `NULLSTRING` when there is none.
    const char* getCharacterArray() const { return text_ != nullptr ? text_ : NULLSTRING; }
    /// The character at `i`, 0 outside the text.
    char getCharAt(int i) const { return i >= 0 && i < length_ ? text_[i] : '\0'; }
    /// All bytes of the text, embedded zeros included; empty without text.
    std::string_view bytes() const { return {text_ != nullptr ? text_ : "", static_cast<std::size_t>(length_)}; }
    /// What comparisons look at: the bytes before the first zero.
    std::string_view comparedBytes() const { return {text_ != nullptr ? text_ : ""}; }

    /// Adds 32 to the codes 64..89. Intended: '@' becomes '`' and 'Z' stays.
    void toLowerCase();
    /// Subtracts 32 from the codes 96..121. Intended: '`' becomes '@' and 'z' stays, the mirror of `toLowerCase`.
    void toUpperCase();

private:
    void release();
    void take(const char* bytes, int length);

    char* text_ = nullptr; // length_ + 1 bytes from malloc, owned; null without text
    int length_ = 0;
};
