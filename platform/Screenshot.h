#pragma once

#include "platform/Rect.h"
#include "platform/SupportDefs.h"

class BView;
class BWindow;

/// Writes what the window shows within `part`, which is in its own coordinates, as a PNG at the resolution of its
/// screen, with the menu that is up over it.
status_t save_screenshot(const BWindow& window, BRect part, const char* path);
/// Writes what `view` has drawn as a PNG, without what it draws over that: all of it or, when that fails, nothing.
status_t save_picture(BView& view, const char* path);
/// Leaves the menu that is up without a choice.
void close_menu();
/// Handles what waits in the queues, until nothing does.
void handle_pending_messages();
