#pragma once

#include "foundation/Date.h"
#include "tools/QuotePages.h"
#include "tools/QuoteSource.h"

#include <map>
#include <string>

class ChildProgram;

/// What a source has told of one name.
struct SourceAnswer {
    Closes closes;
    std::string currency; // of the last of the lines; empty when they tell none
    std::string reason;   // why there is no close, or why not each line was taken; else empty
};

/// The answers in what a run has printed, one for each of its names. A last line without its end is left out.
///
/// A line is "date,close" or "date,close,currency", with the name in front where the run tells names. The date is
/// YYYY-MM-DD and no later than tomorrow, since elsewhere a day begins earlier; the close is a positive number with a
/// decimal point. A first line of headings is passed over. Any other line is a reason.
std::map<std::string, SourceAnswer> readAnswer(const std::string& output, const QuoteSource::Run& run,
                                               const Date& today);
/// The answers of a run that has ended. Of one that failed the lines before its end count where they tell names; else
/// nothing of it does.
std::map<std::string, SourceAnswer> answersOf(const ChildProgram& program, const QuoteSource::Run& run,
                                              const Date& today);
