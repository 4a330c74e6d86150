#pragma once

#include <string>

struct Moment;

/// What a step is called: the command, "Change" without one, and what it was about, told from what differs between the
/// moments before and after it: "Remove company ALP".
std::string stepLabel(const std::string& command, const Moment& before, const Moment& after);
