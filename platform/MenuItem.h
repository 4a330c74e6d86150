#pragma once

#include "platform/Invoker.h"

#include <string>

class BMenu;

/// One choice in a menu. Choosing it by hand marks it, where the menu does that, and sends its message.
class BMenuItem : public BInvoker {
public:
    /// Owns `message`, which may be null.
    BMenuItem(const char* label, BMessage* message) : BInvoker(message), label_(label) {}

    const char* Label() const { return label_.c_str(); }
    bool IsMarked() const { return marked_; }
    /// In a pop-up menu at most one item is marked. Sends no message.
    void SetMarked(bool marked);

private:
    friend class BMenu;

    std::string label_;
    bool marked_ = false;
    BMenu* menu_ = nullptr;
};
