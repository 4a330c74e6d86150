#include "chart/ChartDrag.h"

#include "chart/ChartZoom.h"

#include <cmath>

ChartDrag::ChartDrag(Kind kind, BPoint where, const ChartScale& scale, const ChartRange& shown)
    : kind_(kind), scale_(scale), shown_(shown), from_(where.x), to_(where.x)
{}

void ChartDrag::moveTo(BPoint where, ChartZoom& zoom)
{
    to_ = where.x;
    if (kind_ != Kind::kPan)
        return;
    // From where it began, not from where it came to: else what the bounds have held back would be lost on the way
    // back.
    const double begin = shown_.min - (scale_.x(to_) - scale_.x(from_));
    zoom.pan(begin - zoom.shown().min);
}

std::optional<ChartRange> ChartDrag::selection() const
{
    constexpr float kLeast = 4; // pixels
    if (kind_ != Kind::kSelect || std::abs(to_ - from_) < kLeast)
        return std::nullopt;
    const auto within = [this](float pixel) { return std::clamp(scale_.x(pixel), shown_.min, shown_.max); };
    return ChartRange{within(std::min(from_, to_)), within(std::max(from_, to_))};
}
