#pragma once

#include <QSocketNotifier>

#include <functional>

/// Calls a function from the event loop when the desktop or a person ends the program from outside: by SIGTERM,
/// SIGHUP or SIGINT. There is one, for the process.
///
/// A signal may come in the middle of anything, so its handler only writes a byte into a pipe. What was told to ignore
/// a signal, as by `nohup`, goes on to do so. The handlers stay when this is gone: the program is ending then, and
/// another signal must not cut that short.
class EndSignals {
public:
    explicit EndSignals(std::function<void()> end);
    EndSignals(const EndSignals&) = delete;
    EndSignals& operator=(const EndSignals&) = delete;

private:
    QSocketNotifier notifier_;
};
