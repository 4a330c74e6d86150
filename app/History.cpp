#include "app/History.h"

#include "app/StepLabel.h"
#include "views/PageView.h"

#include <algorithm>
#include <cstdlib>

namespace {

constexpr FileKind kKinds[] = {FileKind::kMarkets, FileKind::kWallet};

std::size_t indexOf(FileKind kind)
{
    return static_cast<std::size_t>(kind);
}

/// Bytes that only `moment` holds, and not the one after it.
std::size_t bytesBeside(const Moment& moment, const Moment& next)
{
    return moment.catalogue->bytesBeside(*next.catalogue) + (moment.wallet == next.wallet ? 0 : moment.wallet->bytes());
}

} // namespace

History::History(Moment first, DataFiles::Names names) : names_(std::move(names))
{
    entries_.push_back({std::move(first), {}});
    for (const FileKind kind : kKinds)
        noteFile(kind, false);
}

std::string History::fileStepLabel(const std::string& command, const DataFiles::Names& names) const
{
    const FileKind kind = names.wallet == names_.wallet ? FileKind::kMarkets : FileKind::kWallet;
    const std::string name = PageView::fileName(names.of(kind).path);
    return name.empty() ? command : command + ' ' + name;
}

bool History::isSame(const Mark& mark, FileKind kind, const Moment& moment)
{
    if (kind == FileKind::kMarkets)
        return mark.catalogue == moment.catalogue;
    return mark.wallet == moment.wallet || mark.wallet->hasFileOf(*moment.wallet);
}

void History::note(Moment now, const DataFiles::Names& names, const std::string& command)
{
    const Moment& before = entries_[now_].moment;
    const bool isMarketStep = before.catalogue != now.catalogue;
    const bool isWalletStep = before.wallet != now.wallet && !before.wallet->hasWorkOf(*now.wallet);
    const bool isFileStep = !command.empty() && names != names_; // a load, or a new portfolio
    if (!isMarketStep && !isWalletStep && !isFileStep) {
        entries_[now_].moment = std::move(now);
        names_ = names; // a save gives a name, and an undo does not take it back
        return;
    }
    forgetUndone();
    const Entry& former = entries_.back();
    Entry entry{std::move(now), {}};
    entry.label = isFileStep ? fileStepLabel(command, names) : stepLabel(command, former.moment, entry.moment);
    entry.steps = former.steps;
    entry.steps[indexOf(FileKind::kMarkets)] += isMarketStep ? 1 : 0;
    entry.steps[indexOf(FileKind::kWallet)] += former.moment.wallet->hasFileOf(*entry.moment.wallet) ? 0 : 1;
    entry.bytes = bytesBeside(former.moment, entry.moment);
    entry.before = names_;
    entry.after = names;
    for (const FileKind kind : kKinds)
        entry.hasOtherFile[indexOf(kind)] = isFileStep && names.of(kind) != names_.of(kind);
    names_ = names;
    bytes_ += entry.bytes;
    entries_.push_back(std::move(entry));
    ++now_;
    entries_[now_].step = ++serial_;
    forgetOldest();
}

/// Before a new step: what was taken back can not be done again.
void History::forgetUndone()
{
    // What a file has may be among it. From there the way leads back to this moment and on from here; counted from the
    // mirrored place, it is as long.
    for (auto& [file, marks] : marks_) {
        const long here = entries_[now_].steps[indexOf(file.first)];
        for (Mark& mark : marks)
            if (mark.step > here)
                mark.step = 2 * here - mark.step;
    }
    for (std::size_t i = now_ + 1; i < entries_.size(); ++i)
        bytes_ -= entries_[i].bytes;
    entries_.resize(now_ + 1);
}

void History::forgetOldest()
{
    while (entries_.size() > 2 && (entries_.size() > kMostSteps + 1 || bytes_ > kMostBytes)) {
        entries_.pop_front();
        // The step that led to what is the oldest moment now is no more.
        bytes_ -= entries_.front().bytes;
        entries_.front().bytes = 0;
        --now_;
    }
}

void History::turn(const Entry& step, DataFiles::Names& from, const DataFiles::Names& to)
{
    for (const FileKind kind : kKinds)
        if (step.hasOtherFile[indexOf(kind)]) {
            from.of(kind) = names_.of(kind);
            names_.of(kind) = to.of(kind);
        }
    ++serial_;
}

const DataFiles::Names& History::undo()
{
    Entry& step = entries_[now_--];
    turn(step, step.after, step.before);
    return names_;
}

const DataFiles::Names& History::redo()
{
    Entry& step = entries_[++now_];
    turn(step, step.before, step.after);
    return names_;
}

bool History::isDone(std::uint64_t step) const
{
    const auto end = entries_.begin() + static_cast<std::ptrdiff_t>(now_) + 1;
    return step <= entries_.front().step || std::ranges::find(entries_.begin(), end, step, &Entry::step) != end;
}

std::string History::pathOf(FileKind kind) const
{
    return std::string(names_.of(kind).path.bytes());
}

void History::noteFile(FileKind kind, bool isSaved)
{
    // Only what is of that kind: a mark stays, and holds it.
    const bool isMarkets = kind == FileKind::kMarkets;
    Mark mark{entries_[now_].steps[indexOf(kind)], isMarkets ? now().catalogue : nullptr,
              isMarkets ? nullptr : now().wallet};
    std::vector<Mark>& marks = marks_[{kind, pathOf(kind)}];
    // A save leaves nothing of what the file had. After a load an undo may lead back to what the former one gave, as
    // long as that is remembered.
    std::erase_if(marks, [&](const Mark& former) {
        return isSaved || std::ranges::none_of(entries_, [&](const Entry& entry) {
                   return isMarkets ? entry.moment.catalogue == former.catalogue : entry.moment.wallet == former.wallet;
               });
    });
    marks.push_back(std::move(mark));
}

unsigned History::unsavedChanges(FileKind kind) const
{
    const long here = entries_[now_].steps[indexOf(kind)];
    const auto found = marks_.find({kind, pathOf(kind)});
    if (found == marks_.end()) {
        // What was restored, or could not be loaded, is not what the file has. The step that led to it counts, and
        // those behind it.
        std::size_t i = now_;
        while (i > 0 && !entries_[i].hasOtherFile[indexOf(kind)])
            --i;
        return static_cast<unsigned>(std::max(1L, here - entries_[i].steps[indexOf(kind)] + 1));
    }
    const std::vector<Mark>& marks = found->second;
    if (std::ranges::any_of(marks, [&](const Mark& mark) { return isSame(mark, kind, now()); }))
        return 0;
    return static_cast<unsigned>(std::max(1L, std::labs(here - marks.back().step)));
}
