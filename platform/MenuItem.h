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
    /// A pop-up menu that comes up by itself shows one that is not enabled grey, and it cannot be chosen there. A menu
    /// field does not look at this.
    void SetEnabled(bool enabled) { enabled_ = enabled; }
    bool IsEnabled() const { return enabled_; }

private:
    friend class BMenu;

    std::string label_;
    bool marked_ = false;
    bool enabled_ = true;
    BMenu* menu_ = nullptr;
};

/// A line between the items of a pop-up menu that comes up by itself.
class BSeparatorItem final : public BMenuItem {
public:
    BSeparatorItem() : BMenuItem("", nullptr) { SetEnabled(false); }
};
