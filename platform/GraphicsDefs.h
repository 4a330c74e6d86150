#pragma once

#include "platform/SupportDefs.h"

#include <cstdint>

struct rgb_color {
    std::uint8_t red = 0;
    std::uint8_t green = 0;
    std::uint8_t blue = 0;
    std::uint8_t alpha = 0; // looked at only when a view draws with B_OP_ALPHA

    bool operator==(const rgb_color&) const = default;
};

/// Leaves what lies beneath a view visible.
constexpr rgb_color B_TRANSPARENT_COLOR = {119, 116, 119, 0};

/// The ground of windows and of what stands in them.
constexpr rgb_color kPanelGrey = {216, 216, 216, 255};

// What is written has a contrast of 4.5 to 1 at least to each ground that it can stand on.

/// Text that is of less weight than other text.
constexpr rgb_color kFaintGrey = {88, 88, 88, 255};
/// Text that warns.
constexpr rgb_color kWarningRed = {176, 32, 16, 255};
constexpr rgb_color kBoxTitle = {40, 60, 90, 255};

// Grounds: of every other row of a list, of what is selected with and without the keyboard, of a field that nobody can
// type in, of one with a mistake, of a tool tip.
constexpr rgb_color kSecondRow = {244, 246, 249, 255};
constexpr rgb_color kSelection = {38, 94, 158, 255};
constexpr rgb_color kPaleSelection = {208, 220, 234, 255};
constexpr rgb_color kReadOnlyField = {236, 236, 236, 255};
constexpr rgb_color kWrongField = {255, 214, 209, 255};
constexpr rgb_color kToolTipGround = {255, 253, 231, 255};

/// What a shape is drawn with.
enum pattern { B_SOLID_HIGH, B_SOLID_LOW };

enum drawing_mode {
    B_OP_COPY,  ///< colours cover what is there; their alpha does not count
    B_OP_ALPHA, ///< alpha 255 covers, 0 leaves all as it is
};
