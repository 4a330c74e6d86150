#pragma once

#include <string>

class QKeyEvent;

/// What `KeyDown` gets for a key: its control character, or its text in UTF-8; empty for keys that have neither.
std::string keyBytes(const QKeyEvent& event);
