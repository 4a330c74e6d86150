#pragma once

#include <cstdio>

class Valuation;

/// Writes the valuation as tables for a person at a terminal. A failure is left to the file's own error mark.
void writeTableReport(const Valuation& valuation, FILE* out);
