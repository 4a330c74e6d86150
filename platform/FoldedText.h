#pragma once

#include <string>
#include <string_view>

/// `text`, UTF-8, as it is compared and searched where capitals and accents do not count: "Élan" and "ELAN" give
/// "elan".
std::string foldedText(std::string_view text);
