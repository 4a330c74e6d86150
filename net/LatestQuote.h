#pragma once

#include "net/FetchEnd.h"
#include "net/Wait.h"

#include <string_view>

class Company;
class Date;
class String;

/// Cuts the price out of a latest-quote page: out of the first cell "<td nowrap><b>", where it stands as a whole
/// number, followed perhaps by a fraction as in "112 <sup>3</sup>/<sub>8</sub>". Without a denominator, or with 0 for
/// one, there is no fraction; what is no number counts as 0.
///
/// A page that ends before it is certain whether a fraction follows may hold a price cut in half. It has one only when
/// a closing tag comes behind the whole number, and no number behind that.
/// @return 0; -1, leaving `*price` alone, when there is no such cell, when the page ends in a number of it or right
/// behind one, and when the price is infinite, negative or "nan".
int parseLatestQuotePage(std::string_view page, float* price);

/// Whether `parseLatestQuotePage` gives the same for every page that begins so.
bool isLatestQuoteCertain(std::string_view beginning);

/// What `Company::getInternetLastQuote` does, and how it ended. `stop` ends its waits.
FetchEnd fetchLatestQuote(const Company& company, const String& host, const String& path, const StopCheck& stop,
                          float* value, Date* date);
