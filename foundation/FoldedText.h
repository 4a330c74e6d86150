#pragma once

#include <string>
#include <string_view>

/// `text`, UTF-8, as a search compares it: in small letters and without accents, so that "Crédit" and "CREDIT" are the
/// same. Latin letters lose their accents, "ß" is "ss" and "æ" is "ae"; Greek and Cyrillic ones become small. All other
/// bytes stay as they are, also those that are no UTF-8.
std::string foldedText(std::string_view text);
