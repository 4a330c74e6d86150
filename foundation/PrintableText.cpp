#include "foundation/PrintableText.h"

#include <algorithm>
#include <cwchar>

namespace {

constexpr int kLongest = 60; // columns of a text; a damaged file can hold one of megabytes
constexpr std::size_t kLongestBytes = 240;

/// Takes one character off the front of `text`, which is not empty. @return its width, -1 when it is not printable.
int takeCharacter(std::string_view& text, std::string_view* character)
{
    std::mbstate_t state{};
    wchar_t code = 0;
    // In the state of a new text each time: UTF-8 has no shifts, and a broken character must not spoil the next one.
    const std::size_t length = std::mbrtowc(&code, text.data(), text.size(), &state);
    const bool isCharacter = length > 0 && length <= text.size(); // errors are larger than any size
    *character = text.substr(0, isCharacter ? length : 1);
    text.remove_prefix(character->size());
    return isCharacter ? wcwidth(code) : -1;
}

} // namespace

std::string printable(std::string_view bytes)
{
    std::string result;
    std::string_view character;
    for (int width = 0; !bytes.empty();) {
        const int taken = takeCharacter(bytes, &character);
        width += taken >= 0 ? taken : 1;
        if (width > kLongest || result.size() > kLongestBytes) // of characters without width there may be any number
            return result + "...";
        result += taken >= 0 ? character : "?";
    }
    return result;
}

int displayWidth(std::string_view text)
{
    int width = 0;
    std::string_view character;
    while (!text.empty())
        width += std::max(takeCharacter(text, &character), 0);
    return width;
}
