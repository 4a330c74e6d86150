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

/// Text on white that is of less weight than other text.
constexpr rgb_color kFaintGrey = {110, 110, 110, 255};

/// What a shape is drawn with.
enum pattern { B_SOLID_HIGH, B_SOLID_LOW };

enum drawing_mode {
    B_OP_COPY,  ///< colours cover what is there; their alpha does not count
    B_OP_ALPHA, ///< alpha 255 covers, 0 leaves all as it is
};
