#pragma once

#include "platform/Menu.h"
#include "platform/Point.h"

/// A menu that comes up in place: in a menu field, which marks what was chosen last, or by itself.
class BPopUpMenu : public BMenu {
public:
    using BMenu::BMenu;

    /// Comes up at `where` on the screen and waits for a choice; marks nothing and sends no message.
    /// @return the item that was chosen; null without one, also when the window was closed meanwhile with all its
    /// views.
    BMenuItem* Go(BPoint where) const;
    /// Comes up at `where` on the screen, or so far to the left of it that it stays before the window, with the
    /// keyboard on the first item that can be chosen. Returns at once: a choice sends the item's message, and marks
    /// nothing. The menu itself is not needed any more then.
    void Open(BPoint where) const;
};
