#pragma once

#include <string>
#include <string_view>
#include <vector>

/// Text of tables that other programs wrote: which bytes it is in, and which words count as the same.

/// Takes one character off the front of `text`, which is not empty. @return its code point; `kBrokenCharacter`, with
/// one byte taken, for bytes that are not UTF-8.
char32_t takeCharacter(std::string_view& text);
constexpr char32_t kBrokenCharacter = ~char32_t{0};

bool isUtf8(std::string_view bytes);
/// The UTF-8 of what a Windows program wrote in the code page of Western Europe. Each byte is a character there; the
/// five that have none become control characters, as every browser has it.
std::string fromWindows1252(std::string_view bytes);

/// What `foldedText` leaves of a heading or word when blanks and marks do not matter either: "Date d'Opération" is
/// "datedoperation". Of a text without letters and digits, the text itself without blanks.
std::string wordKey(std::string_view utf8);

/// What stands between the plain blanks of `text`; refers to it.
std::vector<std::string_view> splitAtBlanks(std::string_view text);
/// `utf8` without blanks at its ends, no-break ones included.
std::string_view withoutBlanks(std::string_view utf8);
/// Whether it is a blank of any width, with a line break allowed at it or not.
bool isBlank(char32_t character);
