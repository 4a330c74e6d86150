#pragma once

#include <cstdio>

class Valuation;

// Both leave a failure to the file's own error mark.

/// Writes the valuation as tables for a person at a terminal.
void writeTableReport(const Valuation& valuation, FILE* out);
/// Writes the valuation as one JSON object with a line end, for scripts.
void writeJsonReport(const Valuation& valuation, FILE* out);
