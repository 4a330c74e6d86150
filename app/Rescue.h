#pragma once

#include "app/DataFiles.h"
#include "app/FileKind.h"
#include "app/Notice.h"
#include "platform/Handler.h"
#include "platform/MessageRunner.h"
#include "storage/RescueCopies.h"

#include <array>
#include <chrono>
#include <cstdint>
#include <map>
#include <memory>
#include <string>

class PLWindow;
struct CatalogueImage;

/// Keeps a copy of what is not saved, and offers what other windows have left of theirs.
///
/// A copy is made at intervals, when the window goes, and when the program ends from outside, if there are changes
/// since the last one. It is written at once, in the window's own thread, so a large one comes so seldom that all of
/// them take less than a hundredth of the time. The user's files are left alone, and nothing is loaded by itself: a
/// notice offers it. What is restored takes the place of all that is here, as one step; the window then goes on with
/// its copies.
class Rescue final : public BHandler {
public:
    /// When the next copy comes after one.
    struct Pace {
        std::chrono::milliseconds interval{60000};
        int share = 100; ///< and so many times as long as that one took
    };
    /// That of the windows to come, until a test sets another one.
    static Pace& pace();

    /// Both outlive this. Offers what windows have left whose programs are gone.
    Rescue(PLWindow& window, DataFiles& files, const DataFolder& folder);
    /// Makes a last copy, which stays.
    ~Rescue() override;

    BLooper* Looper() const override;
    void MessageReceived(BMessage* message) override;

    /// The file of that kind is about to be written. What is not saved of the other one gets a copy that fits it, since
    /// the program may be killed before `noteSaved`.
    void prepareSave(FileKind kind);
    /// What is here of that kind was just saved: no copy of it is needed.
    void noteSaved(FileKind kind);
    /// Makes the last copy. Nothing is shown from here on.
    void end();

private:
    using Copies = std::shared_ptr<RescueCopies>;

    /// Brings the copies up to date.
    void update();
    void tell(Notice notice);
    /// @param problem why they were not restored when that was tried.
    void offer(const Copies& copies, const std::string& problem = "");
    void restore(const Copies& copies);
    /// Of the remembered file; empty while it has no name.
    std::string pathOf(FileKind kind) const;
    bool isUnsaved(FileKind kind) const;
    /// Not while an account has no currency.
    bool canWriteWallet() const;
    RescueCopies::Source source(FileKind kind) const;
    /// Writes the next generation of this window's copies, or tells why not. @return whether it did.
    bool write(const RescueCopies::Sources& sources);
    /// Nothing is left to be copied: the copies go. What was restored and is neither here nor in a file is offered
    /// again.
    void letGo();
    /// Offers what was restored again when that was taken back: what is here now is other work, with copies of its own.
    void giveBackWhatWasUndone();
    void forgetOwn();

    PLWindow& window_;
    DataFiles& files_;
    DataFolder folder_;
    std::unique_ptr<BMessageRunner> runner_;
    Copies own_;                                 // null while there is nothing to copy
    Copies left_;                                // of what was here before a restore, for when that is taken back
    std::uint64_t copied_ = 0;                   // the change that they are of
    std::weak_ptr<const CatalogueImage> market_; // the market data that they have
    std::uint64_t restoring_ = 0;                // the step that has restored them; 0 when they began here
    std::array<bool, RescueNote::kKinds> isOnlyHere_{}; // they were restored, and never saved since
    bool isWalletLeftOut_ = false;                      // it cannot be written
    std::string failure_;                               // that was told last
};
