#include "tools/QuoteFetches.h"

#include "foundation/Today.h"
#include "tools/QuoteFolder.h"
#include "tools/SourceAnswer.h"

#include <algorithm>
#include <ostream>
#include <stdexcept>

QuoteFetches::QuoteFetches(const QuoteSource& source, const QuoteFolder& folder, std::chrono::milliseconds limit,
                           std::ostream& log)
    : source_(source), folder_(folder), limit_(limit), log_(log)
{}

bool QuoteFetches::ask(const std::string& ticker)
{
    if (isAsking(ticker))
        return true;
    if (!isTicker(ticker))
        return false;
    if (today() != day_)
        again_.clear();
    // From here on all in `again_` is of today.
    day_ = today();
    const auto asked = again_.find(ticker);
    const bool isEarly = asked != again_.end() && Clock::now() < asked->second;
    if (isEarly || again_.size() >= kMostAsked || folder_.reaches(ticker, day_))
        return false;
    if (Clock::now() < sourceAgain_) {
        tellOfSilence(ticker);
        return false;
    }
    again_[ticker] = Clock::time_point::max();
    waiting_.push_back(ticker);
    startWaiting();
    return isAsking(ticker);
}

bool QuoteFetches::isAsking(const std::string& ticker) const
{
    const auto isOfTicker = [&](const Fetch& fetch) { return fetch.run.names.front() == ticker; };
    return std::ranges::find(waiting_, ticker) != waiting_.end() || std::ranges::any_of(running_, isOfTicker);
}

void QuoteFetches::addWaiting(std::vector<pollfd>& all) const
{
    for (const Fetch& fetch : running_)
        fetch.program.addWaiting(all);
}

QuoteFetches::Clock::time_point QuoteFetches::nextLook() const
{
    auto next = Clock::time_point::max();
    for (const Fetch& fetch : running_)
        next = std::min(next, fetch.program.nextLook());
    return next;
}

void QuoteFetches::proceed()
{
    for (auto fetch = running_.begin(); fetch != running_.end();) {
        if (fetch->program.proceed()) {
            ++fetch;
            continue;
        }
        finish(*fetch);
        fetch = running_.erase(fetch);
    }
    startWaiting();
}

void QuoteFetches::startWaiting()
{
    while (!waiting_.empty() && running_.size() < kMostRunning) {
        const std::string ticker = std::move(waiting_.front());
        waiting_.pop_front();
        try {
            running_.emplace_back(source_.quotesOf({ticker}), limit_);
        } catch (const std::runtime_error& error) {
            tell(ticker, error.what());
        }
    }
}

void QuoteFetches::finish(const Fetch& fetch)
{
    const std::string& ticker = fetch.run.names.front();
    if (fetch.program.hasTimedOut()) {
        sourceAgain_ = Clock::now() + kSilence;
        // Whoever asks later for those whose turn has not come gets an answer then.
        for (const std::string& other : waiting_) {
            again_.erase(other);
            tellOfSilence(other);
        }
        waiting_.clear();
    }
    const SourceAnswer answer = answersOf(fetch.program, fetch.run, day_).at(ticker);
    try {
        if (!answer.closes.empty())
            folder_.add(ticker, answer.closes);
        if (!answer.reason.empty())
            tell(ticker, answer.reason);
        if (!answer.closes.empty())
            again_[ticker] = Clock::time_point::max();
    } catch (const std::runtime_error& error) {
        tell(ticker, error.what());
    }
}

void QuoteFetches::tell(const std::string& ticker, const std::string& reason)
{
    log_ << ticker << ": " << reason << std::endl;
    again_[ticker] = Clock::now() + kPause;
}

void QuoteFetches::tellOfSilence(const std::string& ticker)
{
    log_ << ticker << ": is not asked for: the source has been silent" << std::endl;
}
