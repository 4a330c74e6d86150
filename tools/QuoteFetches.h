#pragma once

#include "foundation/Date.h"
#include "tools/ChildProgram.h"
#include "tools/QuoteSource.h"

#include <deque>
#include <iosfwd>
#include <list>
#include <map>
#include <string>

class QuoteFolder;

/// Asks a source for what the tables of a folder do not have yet, beside a server that goes on meanwhile, and adds what
/// comes to them. Nothing here waits.
///
/// A ticker is asked for once a day, and not at all when its table has a close of the day. One that nothing came for is
/// asked for again after `kPause` at the earliest; when a time limit has run out, the source is asked for nothing at
/// all for `kSilence`. What went wrong is told on the log, and leaves the table as it is.
class QuoteFetches {
public:
    using Clock = ChildProgram::Clock;

    /// `source` and `folder` outlive this. `limit` is that of each run of the source.
    QuoteFetches(const QuoteSource& source, const QuoteFolder& folder, std::chrono::milliseconds limit,
                 std::ostream& log);

    /// @return whether the source is asked for the ticker now; `isAsking` tells when that is over.
    bool ask(const std::string& ticker);
    bool isAsking(const std::string& ticker) const;
    std::chrono::milliseconds limit() const { return limit_; }

    /// As those of a `ChildProgram`.
    void addWaiting(std::vector<pollfd>& all) const;
    Clock::time_point nextLook() const;
    void proceed();

private:
    static constexpr std::chrono::minutes kPause{15};
    static constexpr std::chrono::minutes kSilence{1};
    static constexpr std::size_t kMostRunning = 4;
    static constexpr std::size_t kMostAsked = 10'000; // tickers a day, whoever asks for them

    struct Fetch {
        Fetch(QuoteSource::Run aRun, std::chrono::milliseconds limit)
            : run(std::move(aRun)), program(run.arguments, limit)
        {}
        QuoteSource::Run run;
        ChildProgram program;
    };

    void startWaiting();
    void finish(const Fetch& fetch);
    void tell(const std::string& ticker, const std::string& reason);
    void tellOfSilence(const std::string& ticker);

    const QuoteSource& source_;
    const QuoteFolder& folder_;
    std::chrono::milliseconds limit_;
    std::ostream& log_;
    Date day_;                                       // on which those in `again_` were asked for
    std::map<std::string, Clock::time_point> again_; // when a ticker may be asked for again on that day
    Clock::time_point sourceAgain_;                  // the same of all
    std::deque<std::string> waiting_;                // tickers for which there is no room yet
    std::list<Fetch> running_;
};
