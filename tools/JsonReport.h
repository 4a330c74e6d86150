#pragma once

#include <cstdio>

class Valuation;

/// Writes the valuation as one JSON object with a line end, for scripts. A failure is left to the file's own error
/// mark.
void writeJsonReport(const Valuation& valuation, FILE* out);
