#pragma once

#include "platform/Menu.h"
#include "platform/Point.h"

/// A menu that comes up in place and marks what was chosen last.
class BPopUpMenu : public BMenu {
public:
    using BMenu::BMenu;

    /// Comes up at `where` on the screen and waits for a choice. @return the item that was chosen; null without one.
    BMenuItem* Go(BPoint where) const;
};
