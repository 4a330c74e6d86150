#pragma once

#include <string>

class QEvent;
class QKeyEvent;

/// What `KeyDown` gets for a key: its control character, or its text in UTF-8; empty for keys that have neither.
std::string keyBytes(const QKeyEvent& event);

/// Whether Ctrl+Z or Ctrl+Shift+Z, which a field is asked about before anybody gets it, is none of the field's: there
/// is nothing typed that it could take back or bring back. The event is then left to the window's shortcuts.
bool isForWindow(QEvent& event, bool isModified, bool hasRedo);
