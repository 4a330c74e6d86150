#include "app/Rescue.h"

#include "app/PLWindow.h"
#include "foundation/DateText.h"
#include "foundation/Today.h"
#include "history/MemoryFile.h"
#include "platform/Message.h"
#include "portfolio/Wallet.h"
#include "storage/Checksum.h"

#include <algorithm>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <vector>

namespace {

using Clock = std::chrono::steady_clock;

constexpr uint32 kTick = 'RcTk';
constexpr const char* kFailed = "rescue failed";
constexpr std::uint64_t kNever = ~std::uint64_t{0}; // no change has that number
constexpr FileKind kKinds[] = {FileKind::kMarkets, FileKind::kWallet};

RescueNote::Kind noteKind(FileKind kind)
{
    return kind == FileKind::kMarkets ? RescueNote::kMarkets : RescueNote::kPortfolio;
}

/// "21/11/2026, 10:53"
std::string timeText(std::time_t time)
{
    std::tm local{};
    localtime_r(&time, &local);
    char text[64];
    std::strftime(text, sizeof text, "%d/%m/%Y, %H:%M", &local);
    return text;
}

std::string offerText(const RescueNote& note)
{
    std::string text = "Not saved on " + timeText(note.time) + ':';
    const char* separator = " ";
    for (const FileKind kind : kKinds) {
        const RescueNote::Part& part = note.parts[noteKind(kind)];
        if (!part.isCopied())
            continue;
        const char* what = kind == FileKind::kMarkets ? "market data" : "portfolio";
        const std::string name = std::filesystem::path(part.path).filename();
        text += separator + (name.empty() ? std::string("a new ") + what : what + (' ' + name));
        separator = ", ";
    }
    return text;
}

/// Those of all windows there are. Never destroyed, since `exit` may come by when all else is.
std::vector<Rescue*>& living()
{
    static auto* const all = new std::vector<Rescue*>;
    return *all;
}

/// The desktop that goes away ends the program by `exit`, and destroys no window.
void endAll()
{
    for (Rescue* rescue : living())
        rescue->end();
}

} // namespace

Rescue::Pace& Rescue::pace()
{
    static Pace pace;
    return pace;
}

Rescue::Rescue(PLWindow& window, DataFiles& files, const DataFolder& folder)
    : window_(window), files_(files), folder_(folder), copied_(window.changeSerial())
{
    [[maybe_unused]] static const int registered = std::atexit(endAll);
    living().push_back(this);
    const BMessage tick(kTick);
    runner_ =
        std::make_unique<BMessageRunner>(BMessenger(this), &tick, std::chrono::microseconds(pace().interval).count());
    for (const Copies& copies : RescueCopies::takeLeftBehind(folder))
        offer(copies);
}

Rescue::~Rescue()
{
    end();
    std::erase(living(), this);
}

void Rescue::end()
{
    runner_.reset(); // from here on nothing is shown any more
    update();
}

BLooper* Rescue::Looper() const
{
    return &window_;
}

void Rescue::MessageReceived(BMessage* message)
{
    if (message->what == kTick)
        update();
    else
        BHandler::MessageReceived(message);
}

void Rescue::tell(Notice notice)
{
    if (runner_ != nullptr)
        window_.showNotice(std::move(notice));
}

void Rescue::offer(const Copies& copies, const std::string& problem)
{
    const std::string text = offerText(copies->note());
    // The notice holds the copies, and so the lock, until it goes: nobody else offers them meanwhile.
    tell({"rescue " + copies->copyOf(RescueNote::kMarkets),
          problem.empty() ? text : text + ". " + problem,
          {{"Restore", [this, copies] { restore(copies); }}, {"Throw away", [copies] { copies->remove(); }}}});
}

std::string Rescue::pathOf(FileKind kind) const
{
    return std::string(files_.names().of(kind).path.bytes());
}

bool Rescue::isUnsaved(FileKind kind) const
{
    // An empty portfolio in the place of one that could not be loaded, or that a market file has thrown away, is no
    // work.
    const DataFiles::Remembered& file = files_.names().of(kind);
    const bool isNoWork = kind == FileKind::kWallet && (file.isAsked() || file.isEmptied) && files_.isWalletEmpty();
    return !isNoWork && window_.unsavedChanges(kind) > 0;
}

bool Rescue::canWriteWallet() const
{
    return std::ranges::none_of(window_.getWallet()->accounts(),
                                [](const Account* account) { return account->getCurrencyName().isUndefined(); });
}

RescueCopies::Source Rescue::source(FileKind kind) const
{
    RescueCopies::Source source{pathOf(kind), files_.names().of(kind).isAsked(), nullptr, false};
    if (!isUnsaved(kind))
        return source;
    if (kind == FileKind::kWallet && !canWriteWallet())
        source.isKept = own_ != nullptr && own_->note().parts[RescueNote::kPortfolio].isCopied();
    else if (kind == FileKind::kWallet)
        source.write = [this](FILE* out) { return window_.getWallet()->wrt(out, today()); };
    else if (own_ != nullptr && own_->note().parts[RescueNote::kMarkets].isCopied() &&
             market_.lock() == window_.history().now().catalogue)
        source.isKept = true; // It may be large, and the portfolio alone has changed.
    else
        source.write = [this](FILE* out) { return window_.catalogue().wrt(out, today()); };
    return source;
}

bool Rescue::write(const RescueCopies::Sources& sources)
{
    try {
        if (own_ == nullptr)
            own_ = std::make_shared<RescueCopies>(folder_);
        own_->write(sources);
    } catch (const std::runtime_error& error) {
        // Told once, and not whenever it fails again.
        if (failure_ != error.what())
            tell({kFailed, "There is no copy of what is not saved: " + (failure_ = error.what()), {}});
        return false;
    }
    if (!own_->note().hasCopies())
        own_.reset();
    if (!failure_.empty() && runner_ != nullptr)
        window_.dropNotice(kFailed);
    failure_.clear();
    return true;
}

void Rescue::update()
{
    giveBackWhatWasUndone();
    const std::uint64_t now = window_.changeSerial();
    if (now == copied_)
        return;
    if (!isUnsaved(FileKind::kMarkets) && !isUnsaved(FileKind::kWallet)) {
        letGo();
        copied_ = now;
        return;
    }
    const Clock::time_point start = Clock::now();
    if (write({source(FileKind::kMarkets), source(FileKind::kWallet)})) {
        copied_ = now;
        market_ = window_.history().now().catalogue;
    }
    // That must not cost the market data their copy.
    const bool isWalletLeftOut = isUnsaved(FileKind::kWallet) && !canWriteWallet();
    if (isWalletLeftOut && !isWalletLeftOut_)
        tell({kFailed, "There is no copy of the portfolio: an account has no currency", {}});
    isWalletLeftOut_ = isWalletLeftOut;
    const auto pause = std::max<Clock::duration>(pace().interval, pace().share * (Clock::now() - start));
    if (runner_ != nullptr)
        runner_->SetInterval(std::chrono::duration_cast<std::chrono::microseconds>(pause).count());
}

void Rescue::letGo()
{
    if (own_ == nullptr)
        return;
    if (std::ranges::any_of(isOnlyHere_, std::identity()))
        offer(own_);
    else
        own_->remove();
    forgetOwn();
}

void Rescue::forgetOwn()
{
    own_.reset();
    isOnlyHere_ = {};
    restoring_ = 0;
}

void Rescue::giveBackWhatWasUndone()
{
    if (own_ == nullptr || restoring_ == 0 || window_.history().isDone(restoring_))
        return;
    offer(own_);
    forgetOwn();
    own_ = std::exchange(left_, nullptr); // of what is here again
}

void Rescue::prepareSave(FileKind kind)
{
    if (isUnsaved(kind == FileKind::kMarkets ? FileKind::kWallet : FileKind::kMarkets))
        update();
}

void Rescue::noteSaved(FileKind kind)
{
    giveBackWhatWasUndone();
    if (own_ == nullptr)
        return;
    isOnlyHere_[noteKind(kind)] = false;
    // At once, and with what else has changed since: what is still copied must fit the file that has been written.
    copied_ = kNever;
    update();
}

void Rescue::restore(const Copies& copies)
{
    // What is here and not saved is left behind in turn, with the copies that were made until now.
    update();
    const std::uint64_t before = window_.changeSerial();
    const RescueNote& note = copies->note();
    const auto file = [&](FileKind kind) {
        const RescueNote::Part& part = note.parts[noteKind(kind)];
        DataFiles::Remembered name{part.path.c_str()};
        name.stamp = FileStamp::of(part.path.c_str());
        if (part.isCopied() && name.stamp && name.stamp->seconds > note.time)
            name.stamp = FileStamp{}; // it was written since: no file is in that state, so the next save asks
        if (part.isAsked)
            name.failure = part.path + " could not be loaded";
        return DataFiles::Restored{part.isCopied() ? copies->copyOf(noteKind(kind)) : part.path, name, part.isCopied()};
    };
    window_.nameStep("Restore");
    const DataFiles::Restoring done = files_.restore(file(FileKind::kMarkets), file(FileKind::kWallet));
    window_.noteStep();
    if (window_.changeSerial() != before) { // what was here is gone
        left_ = own_;
        forgetOwn();
    }
    if (!done.isComplete)
        return offer(copies, done.problem);
    // From here on the copies are this window's own: the next ones take their place.
    own_ = copies;
    copied_ = window_.changeSerial();
    restoring_ = window_.history().lastStep();
    market_ = window_.history().now().catalogue;
    for (const FileKind kind : kKinds)
        isOnlyHere_[noteKind(kind)] = note.parts[noteKind(kind)].isCopied();
    window_.SetMessage("Unsaved changes successfully restored...");
    if (!done.problem.empty())
        tell({"rescue", done.problem, {}});
}
