#pragma once

#include "storage/Descriptor.h"

#include <chrono>
#include <cstddef>
#include <optional>
#include <poll.h>
#include <string>
#include <string_view>
#include <sys/types.h>
#include <vector>

/// A program that is run for what it prints, without a shell, and watched by `poll`. Nothing here waits.
///
/// It reads nothing, has none of our descriptors, and is the first of a process group of its own: when its time is
/// over, when it prints more than `kMostOutput`, when it ends, and when this object goes, the whole group is killed.
class ChildProgram {
public:
    using Clock = std::chrono::steady_clock;

    static constexpr std::size_t kMostOutput = std::size_t{1} << 20; // bytes; a century of days

    /// @param arguments the first is the program, which is searched as a shell does; there is one at least.
    /// @param limit from now on.
    ChildProgram(const std::vector<std::string>& arguments, std::chrono::milliseconds limit);
    ~ChildProgram();
    ChildProgram(const ChildProgram&) = delete;
    ChildProgram& operator=(const ChildProgram&) = delete;

    /// Adds what is to be waited for before the next `proceed`, which is to come by `nextLook` at the latest.
    void addWaiting(std::vector<pollfd>& all) const;
    Clock::time_point nextLook() const;

    /// Goes on with what has come. @return false when the program has ended, in one way or another.
    bool proceed();

    /// What it has printed, up to its end or until it was killed.
    const std::string& output() const { return output_; }
    /// Why it did not end well, in words for a person; empty when it has.
    const std::string& failure() const { return failure_; }
    bool hasTimedOut() const { return hasTimedOut_; }

private:
    void start(const std::vector<std::string>& arguments);
    bool reap();
    void takeStatus(int status);
    int killAll();

    std::string name_;
    std::chrono::milliseconds limit_;
    Clock::time_point deadline_;
    pid_t process_ = 0; // 0 when there is none any more
    std::optional<Descriptor> printed_;
    std::optional<Descriptor> complained_; // its standard error
    std::string output_;
    std::string complaint_; // the beginning of it
    std::string failure_;
    bool hasTimedOut_ = false;
};

/// What a program has said, as one line for a person: printable, and cut where nobody would read on.
std::string toldBy(std::string_view text);
