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
    entries_.push_back({std::move(first), {}, {}, {}, 0, 0});
    for (const FileKind kind : kKinds)
        noteFile(kind);
}

std::string History::fileStepLabel(const std::string& command, const DataFiles::Names& names) const
{
    const FileKind kind = names.wallet == names_.wallet ? FileKind::kMarkets : FileKind::kWallet;
    const std::string name = PageView::fileName(names.of(kind).path);
    return name.empty() ? command : command + ' ' + name;
}

bool History::isSame(FileKind kind, const Moment& a, const Moment& b) const
{
    if (kind == FileKind::kMarkets)
        return a.catalogue == b.catalogue;
    return a.wallet == b.wallet || a.wallet->hasWorkOf(*b.wallet);
}

void History::note(Moment now, const DataFiles::Names& names, const std::string& command)
{
    const bool isMarketStep = !isSame(FileKind::kMarkets, entries_[now_].moment, now);
    const bool isWalletStep = !isSame(FileKind::kWallet, entries_[now_].moment, now);
    const bool isFileStep = !command.empty() && names != names_; // a load, or a new portfolio
    if (!isMarketStep && !isWalletStep && !isFileStep) {
        entries_[now_].moment = std::move(now);
        names_ = names; // a save gives a name, and an undo does not take it back
        return;
    }
    forgetUndone();
    const Entry& former = entries_.back();
    Entry entry{std::move(now), {}, {}, former.steps, 0, 0};
    entry.label = isFileStep ? fileStepLabel(command, names) : stepLabel(command, former.moment, entry.moment);
    entry.steps[indexOf(FileKind::kMarkets)] += isMarketStep ? 1 : 0;
    entry.steps[indexOf(FileKind::kWallet)] += isWalletStep ? 1 : 0;
    entry.bytes = bytesBeside(former.moment, entry.moment);
    if (isFileStep)
        entry.files = {names_, names};
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
    for (auto& [file, mark] : marks_) {
        const long here = entries_[now_].steps[indexOf(file.first)];
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

std::optional<DataFiles::Names> History::undo()
{
    const Entry& step = entries_[now_--];
    ++serial_;
    if (!step.files)
        return std::nullopt;
    return names_ = step.files->first;
}

std::optional<DataFiles::Names> History::redo()
{
    const Entry& step = entries_[++now_];
    ++serial_;
    if (!step.files)
        return std::nullopt;
    return names_ = step.files->second;
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

void History::noteFile(FileKind kind)
{
    // Only what is of that kind: a mark stays, and holds it.
    const bool isMarkets = kind == FileKind::kMarkets;
    marks_[{kind, pathOf(kind)}] = {entries_[now_].steps[indexOf(kind)], isMarkets ? now().catalogue : nullptr,
                                    isMarkets ? nullptr : now().wallet};
}

unsigned History::unsavedChanges(FileKind kind) const
{
    const long here = entries_[now_].steps[indexOf(kind)];
    const auto found = marks_.find({kind, pathOf(kind)});
    if (found == marks_.end()) {
        // What was restored, or could not be loaded, is not what the file has. The step that led to it counts, and
        // those behind it.
        std::size_t i = now_;
        while (i > 0 && !entries_[i].files)
            --i;
        return static_cast<unsigned>(std::max(1L, here - entries_[i].steps[indexOf(kind)] + 1));
    }
    const Mark& mark = found->second;
    Moment saved;
    saved.catalogue = mark.catalogue;
    saved.wallet = mark.wallet;
    if (isSame(kind, saved, now()))
        return 0;
    return static_cast<unsigned>(std::max(1L, std::labs(here - mark.step)));
}
