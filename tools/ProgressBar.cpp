#include "tools/ProgressBar.h"

#include "foundation/PrintableText.h"

#include <algorithm>
#include <cmath>
#include <unistd.h>

ProgressBar::ProgressBar(FILE* terminal, Clock::duration delay)
    : terminal_(isatty(fileno(terminal)) != 0 ? terminal : nullptr), next_(Clock::now() + delay)
{}

void ProgressBar::show(const std::string& work, double part)
{
    if (terminal_ == nullptr || Clock::now() < next_)
        return;
    next_ = Clock::now() + std::chrono::milliseconds(100); // a terminal far away would be kept busy otherwise
    constexpr int kWidth = 20;
    const int done = static_cast<int>(std::lround(std::clamp(part, 0.0, 1.0) * kWidth));
    // To the line's front, and what is left of a longer line is erased.
    std::fprintf(terminal_, "\r%s  [%s%s] %3ld %%\033[K", printable(work.substr(work.find_last_of('/') + 1)).c_str(),
                 std::string(static_cast<std::size_t>(done), '#').c_str(),
                 std::string(static_cast<std::size_t>(kWidth - done), ' ').c_str(), std::lround(part * 100));
    std::fflush(terminal_);
    isShown_ = true;
}

void ProgressBar::clear()
{
    if (!isShown_)
        return;
    std::fputs("\r\033[K", terminal_);
    std::fflush(terminal_);
    isShown_ = false;
}
