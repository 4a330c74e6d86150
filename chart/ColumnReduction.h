#pragma once

#include "chart/ChartScale.h"

#include <span>
#include <vector>

/// The pixels of a line or outline through `points`, without those that cannot be seen: of neighbours that fall into
/// one column of pixels, only the first, the lowest, the highest and the last stay, each at its exact place.
/// A line whose points ascend in x keeps at most four for each column.
std::vector<BPoint> reduceByColumn(std::span<const ChartPoint> points, const ChartScale& scale);
