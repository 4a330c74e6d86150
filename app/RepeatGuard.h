#pragma once

#include "platform/MessageRunner.h"

#include <chrono>
#include <string>

class BMessage;
class BView;

/// Tells a second click of a double click, on a button that adds, from a second addition: it comes within the time of a
/// double click after the first was done, and nothing was changed in the fields of the button's box.
class RepeatGuard {
public:
    /// Whether `message` is such a repetition, which is to do nothing. It may be any message.
    bool isRepeat(const BMessage& message, const BView& page);
    /// The command of that message was run.
    void noteRun(const BMessage& message, const BView& page);
    /// What was added is gone again: the next addition is meant.
    void forget() { code_ = 0; }

private:
    using Clock = std::chrono::steady_clock;

    std::uint32_t code_ = 0; // of the last addition, 0 when there is none
    std::string fields_;     // what they held behind it
    Clock::time_point done_;
};
