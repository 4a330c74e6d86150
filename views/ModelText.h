#pragma once

#include "foundation/String.h"

#include <string>

/// A text of the model, to be shown; empty for a String without text.
inline std::string textOf(const String& text)
{
    return std::string(text.bytes());
}
