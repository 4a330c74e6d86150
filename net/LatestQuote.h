#pragma once

#include <string_view>

/// Cuts the price out of a latest-quote page: out of the first cell "<td nowrap><b>", where it stands as a whole
/// number, followed perhaps by a fraction as in "112 <sup>3</sup>/<sub>8</sub>". Without a denominator, or with 0 for
/// one, there is no fraction; what is no number counts as 0.
/// @return 0; -1, leaving `*price` alone, when there is no such cell or the page ends with it.
int parseLatestQuotePage(std::string_view page, float* price);
