#pragma once

#include "storage/Descriptor.h"
#include "tools/QuoteSource.h"

#include <chrono>
#include <string>

/// Asks a source for the latest quote of every company and the latest rate of every currency of a market file, adds
/// them to it as an import does, and prints the figures that an import prints. What does not come, or cannot be used,
/// is told on standard error with its reason.
///
/// Throws std::runtime_error when nothing at all has come, when the file cannot be read or written, and when there is
/// something to read at `stop`; the file is as it was then.
/// @param limit of the source for each quote and rate.
void updateMarket(const std::string& path, const QuoteSource& source, std::chrono::milliseconds limit,
                  const Descriptor& stop);
