#pragma once

#include <chrono>
#include <functional>

/// Asked some ten times a second while a connection waits: true ends the wait. An empty one lets it wait.
using StopCheck = std::function<bool()>;

// Results of a wait that has come to nothing, beside 0 and -1.
constexpr int kTimedOut = 8; ///< the deadline has passed
constexpr int kStopped = 9;  ///< `StopCheck` has ended it

/// Waits in slices, between which `stop` is asked. `waitUntil` waits up to the time that it is given, and gives 0 when
/// nothing has come by then.
/// @return what `waitUntil` has given when it was not 0; `kTimedOut` or `kStopped`.
int waitInSlices(std::chrono::steady_clock::time_point deadline, const StopCheck& stop,
                 const std::function<int(std::chrono::steady_clock::time_point until)>& waitUntil);

/// What `poll` gives for the descriptor; 0 at once when the time has passed.
int pollUntil(int descriptor, short events, std::chrono::steady_clock::time_point until);

/// Waits until `poll` has one of `events` to tell of the descriptor. A signal does not end the wait.
/// @return 0; -1 when it cannot be waited for, `kTimedOut` or `kStopped`.
int waitFor(int descriptor, short events, std::chrono::steady_clock::time_point deadline, const StopCheck& stop);
