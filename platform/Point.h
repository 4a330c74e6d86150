#pragma once

/// A place in a view: x grows to the right, y downwards, in pixels of a screen of ordinary resolution.
struct BPoint {
    float x = 0;
    float y = 0;

    BPoint() = default;
    BPoint(float px, float py) : x(px), y(py) {}

    bool operator==(const BPoint& p) const { return x == p.x && y == p.y; }
    BPoint operator+(const BPoint& p) const { return {x + p.x, y + p.y}; }
    BPoint operator-(const BPoint& p) const { return {x - p.x, y - p.y}; }
};
