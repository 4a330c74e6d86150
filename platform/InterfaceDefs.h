#pragma once

#include "platform/SupportDefs.h"

/// How a view follows its parent when that changes its size.
enum : uint32 {
    B_FOLLOW_LEFT = 1,
    B_FOLLOW_RIGHT = 2,
    B_FOLLOW_TOP = 4,
    B_FOLLOW_BOTTOM = 8,
    B_FOLLOW_ALL = B_FOLLOW_LEFT | B_FOLLOW_RIGHT | B_FOLLOW_TOP | B_FOLLOW_BOTTOM,
    B_FOLLOW_ALL_SIDES = B_FOLLOW_ALL,
};

/// What a view takes part in.
enum view_flags : uint32 {
    B_WILL_DRAW = 1,    ///< its `Draw` is called
    B_FRAME_EVENTS = 2, ///< its `FrameResized` is called
    B_NAVIGABLE = 4,    ///< the Tab key reaches it
    B_FULL_UPDATE_ON_RESIZE = 8,
};

enum button_width { B_WIDTH_AS_USUAL };
enum alignment { B_ALIGN_LEFT, B_ALIGN_RIGHT, B_ALIGN_CENTER };

/// Keys that are held while another one is pressed.
enum : uint32 { B_SHIFT_KEY = 1, B_COMMAND_KEY = 2, B_CONTROL_KEY = 4 };

/// Those that are held now.
uint32 modifiers();

/// `*speed` becomes the longest time between the two clicks of a double click, as the desktop has it. @return `B_OK`
status_t get_click_speed(bigtime_t* speed);

constexpr int32 B_CONTROL_OFF = 0;
constexpr int32 B_CONTROL_ON = 1;

/// Keys as `KeyDown` gets them that have no text of their own: one control character.
constexpr char B_LEFT_ARROW = 0x1c;
constexpr char B_RIGHT_ARROW = 0x1d;
constexpr char B_UP_ARROW = 0x1e;
constexpr char B_DOWN_ARROW = 0x1f;
constexpr char B_HOME = 0x01;
constexpr char B_END = 0x04;
constexpr char B_PAGE_UP = 0x0b;
constexpr char B_PAGE_DOWN = 0x0c;
constexpr char B_ESCAPE = 0x1b;
constexpr char B_ENTER = 0x0a;
constexpr char B_DELETE = 0x7f;
constexpr uint32 B_F1_KEY = 0x02;     ///< for shortcuts; unlike in the kits they have it beside the letters
constexpr char B_FUNCTION_KEY = 0x10; ///< lists get it for F2 only
