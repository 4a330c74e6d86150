#pragma once

#include "platform/Menu.h"

/// A menu that comes up in place and marks what was chosen last.
class BPopUpMenu : public BMenu {
public:
    using BMenu::BMenu;
};
