#include "foundation/String.h"

#include "foundation/FieldIO.h"

#include <algorithm>
#include <climits>
#include <cstdlib>
#include <cstring>
#include <new>

namespace {

char* reallocate(char* text, std::size_t size)
{
    auto* grown = static_cast<char*>(std::realloc(text, size));
    if (grown == nullptr)
        throw std::bad_alloc();
    return grown;
}

} // namespace

const char* const String::NULLSTRING = "null";

const String& String::none()
{
    static const String none;
    return none;
}

String::String(const char* s)
{
    if (s != nullptr)
        take(s, static_cast<int>(std::strlen(s)));
}

String::String(const String& other) : Serializable(other)
{
    if (other.hasText())
        take(other.text_, other.length_);
}

String::String(String&& other) noexcept : Serializable(other), text_(other.text_), length_(other.length_)
{
    other.text_ = nullptr;
    other.length_ = 0;
}

String& String::operator=(const String& other)
{
    // Copied first: when there is no memory for it, this String stays as it was.
    if (this != &other)
        *this = String(other);
    return *this;
}

String& String::operator=(String&& other) noexcept
{
    // The other String frees what was here.
    std::swap(text_, other.text_);
    std::swap(length_, other.length_);
    return *this;
}

String::~String()
{
    std::free(text_);
}

int String::wrt(FILE* file) const
{
    fwriteint(file, length_);
    std::fwrite(bytes().data(), 1, static_cast<std::size_t>(length_), file);
    return 0;
}

int String::rd(FILE* file)
{
    // A corrupt length must not take memory that the file does not fill: the buffer grows with what arrives.
    constexpr std::size_t kFirstPiece = 4096;
    const auto length = static_cast<std::uint32_t>(freadint(file));
    const std::size_t wanted = reachedEnd(file) ? 0 : std::min<std::size_t>(length, INT_MAX - 1);
    // The former text is gone from here on, also when the file ends early.
    release();
    std::size_t got = 0;
    std::size_t room = std::min(wanted, kFirstPiece);
    for (;;) {
        text_ = reallocate(text_, room + 1);
        got += std::fread(text_ + got, 1, room - got, file);
        if (got < room || room == wanted)
            break;
        room = std::min(wanted, room * 2);
    }
    // What has come is the text, whole or not; the caller learns of it by the result.
    text_[got] = '\0';
    length_ = static_cast<int>(got);
    return got == length && !reachedEnd(file) ? 0 : -1;
}

String& String::operator+=(const String& s)
{
    if (!s.hasText())
        return hasText() ? *this += String(NULLSTRING) : *this;
    const int appended = s.length_;
    const int total = length_ + appended;
    // `s` may be this very String, whose buffer moves: its bytes are looked up again after the growth.
    text_ = reallocate(text_, static_cast<std::size_t>(total) + 1);
    std::memmove(text_ + length_, s.text_, static_cast<std::size_t>(appended));
    length_ = total;
    text_[length_] = '\0';
    return *this;
}

bool String::operator==(const String& s) const
{
    return hasText() && s.hasText() && std::strcmp(text_, s.text_) == 0;
}

void String::toLowerCase()
{
    for (int i = 0; i < length_; ++i)
        if (text_[i] >= 64 && text_[i] <= 89)
            text_[i] = static_cast<char>(text_[i] + 32);
}

void String::toUpperCase()
{
    for (int i = 0; i < length_; ++i)
        if (text_[i] >= 96 && text_[i] <= 121)
            text_[i] = static_cast<char>(text_[i] - 32);
}

void String::release()
{
    std::free(text_);
    text_ = nullptr;
    length_ = 0;
}

void String::take(const char* bytes, int length)
{
    text_ = reallocate(nullptr, static_cast<std::size_t>(length) + 1);
    std::memcpy(text_, bytes, static_cast<std::size_t>(length));
    text_[length] = '\0';
    length_ = length;
}
