#include "foundation/FoldedText.h"

namespace {

// By code point from U+00C0 and U+0100 on. A dot is no letter, and a star one that two letters stand for.
constexpr std::string_view kLatin1 = "aaaaaa*ceeeeiiiidnooooo.ouuuuy**aaaaaa*ceeeeiiiidnooooo.ouuuuy*y";
constexpr std::string_view kLatinA = "aaaaaaccccccccddddeeeeeeeeeegggggggghhhhiiiiiiiiii**jjkkkllllllllll"
                                     "nnnnnnnnnoooooo**rrrrrrssssssssttttttuuuuuuuuuuuuwwyyyzzzzzzs";
static_assert(kLatin1.size() == 64 && kLatinA.size() == 128);

const char* twoLetters(unsigned code)
{
    switch (code) {
    case 0xDF:
        return "ss";
    case 0xDE:
    case 0xFE:
        return "th";
    case 0x132:
    case 0x133:
        return "ij";
    case 0x152:
    case 0x153:
        return "oe";
    default:
        return "ae";
    }
}

/// What stands for the character `code` of two bytes; nothing when it stays.
std::string_view letterOf(unsigned code)
{
    const bool isLatin1 = code >= 0xC0 && code < 0x100;
    if (!isLatin1 && (code < 0x100 || code >= 0x180))
        return {};
    const std::string_view letter = isLatin1 ? kLatin1.substr(code - 0xC0, 1) : kLatinA.substr(code - 0x100, 1);
    if (letter == ".")
        return {};
    return letter == "*" ? twoLetters(code) : letter;
}

/// The small letter of a Greek or Cyrillic one.
unsigned smallLetter(unsigned code)
{
    if ((code >= 0x391 && code <= 0x3A9) || (code >= 0x410 && code <= 0x42F))
        return code + 0x20;
    return code >= 0x400 && code <= 0x40F ? code + 0x50 : code;
}

} // namespace

std::string foldedText(std::string_view text)
{
    std::string folded;
    folded.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        const auto byte = static_cast<unsigned char>(text[i]);
        const bool isPair = byte >= 0xC3 && byte < 0xE0 && i + 1 < text.size();
        const unsigned next = isPair ? static_cast<unsigned char>(text[i + 1]) : 0;
        if ((next & 0xC0U) != 0x80U) {
            folded += byte >= 'A' && byte <= 'Z' ? static_cast<char>(byte + ('a' - 'A')) : text[i];
            continue;
        }
        ++i; // both bytes are one character
        const unsigned code = (byte & 0x1FU) << 6U | (next & 0x3FU);
        if (code >= 0x300 && code < 0x370)
            continue; // an accent by itself, behind its letter
        if (const std::string_view letter = letterOf(code); !letter.empty()) {
            folded += letter;
            continue;
        }
        const unsigned small = smallLetter(code);
        folded += static_cast<char>(0xC0U | small >> 6U);
        folded += static_cast<char>(0x80U | (small & 0x3FU));
    }
    return folded;
}
