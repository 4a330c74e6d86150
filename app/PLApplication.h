#pragma once

#include "platform/Application.h"

/// The program: opens the main window.
class PLApplication final : public BApplication {
public:
    PLApplication();

    void MessageReceived(BMessage* message) override;
};
