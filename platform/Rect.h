#pragma once

#include "platform/Point.h"

/// A rectangle by its four sides. Unlike in the kits the sides lie between the pixels, and no pixel is counted twice:
/// one from 0 to 800 covers 800 pixels.
struct BRect {
    float left = 0;
    float top = 0;
    float right = -1; // the default rectangle is not valid
    float bottom = -1;

    BRect() = default;
    BRect(float l, float t, float r, float b) : left(l), top(t), right(r), bottom(b) {}

    float Width() const { return right - left; }
    float Height() const { return bottom - top; }

    /// Moves the sides inwards by `dx` and `dy`; outwards when negative.
    BRect InsetByCopy(float dx, float dy) const { return {left + dx, top + dy, right - dx, bottom - dy}; }
    BRect OffsetToCopy(float x, float y) const { return {x, y, x + Width(), y + Height()}; }
};
