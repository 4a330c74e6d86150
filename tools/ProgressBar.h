#pragma once

#include <chrono>
#include <cstdio>
#include <string>

/// A bar on a terminal for work that takes over a second: "prices.csv.gz  [#########           ]  45 %". It stands on
/// the last line, is drawn over, and taken away in the end. Where the stream is no terminal there is none.
class ProgressBar {
public:
    using Clock = std::chrono::steady_clock;

    explicit ProgressBar(FILE* terminal, Clock::duration delay = std::chrono::seconds(1));
    ~ProgressBar() { clear(); }
    ProgressBar(const ProgressBar&) = delete;
    ProgressBar& operator=(const ProgressBar&) = delete;

    /// @param part of the work that is done, from 0 to 1.
    void show(const std::string& work, double part);
    /// Takes the bar away, so that something else can be told on the terminal.
    void clear();

private:
    FILE* terminal_; // null for none
    Clock::time_point next_;
    bool isShown_ = false;
};
