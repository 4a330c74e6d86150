#pragma once

#include "foundation/Date.h"

#include <string>

/// The dates of a command line are DD/MM/YYYY, the form that the program shows and takes everywhere else; not the ISO
/// form that tables may have.
/// @return what is wrong with `text`; empty when it is a date.
std::string checkDateArgument(const std::string& text);

/// The date of a text that `checkDateArgument` has passed; today for an empty one.
Date dateArgument(const std::string& text);
