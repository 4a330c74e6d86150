#pragma once

#include <QString>

/// A label as Qt wants it, which takes a single & for the mark of a shortcut.
inline QString labelText(const char* label)
{
    return QString::fromUtf8(label != nullptr ? label : "").replace('&', "&&");
}
