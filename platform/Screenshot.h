#pragma once

#include "platform/SupportDefs.h"

class BWindow;

/// Writes what the window shows as a PNG, at the resolution of its screen.
status_t save_screenshot(const BWindow& window, const char* path);
/// Handles what waits in the queues, until nothing does.
void handle_pending_messages();
