#pragma once

#include "app/DataFiles.h"
#include "app/FileKind.h"
#include "history/CatalogueImage.h"
#include "history/WalletImage.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"

#include <array>
#include <cstdint>
#include <deque>
#include <map>
#include <memory>
#include <optional>
#include <string>
#include <utility>
#include <vector>

/// The model and what the lists show of it, at one moment.
struct Moment {
    std::shared_ptr<const CatalogueImage> catalogue;
    std::shared_ptr<const WalletImage> wallet;
    CompanyView::Places companyPage;
    CurrencyView::Places currencyPage;
    std::pair<ListPlaces, ListPlaces> portfolioPage;
    ListPlaces operations;
};

/// The moments between the user's steps, from the oldest that is remembered to the newest that was taken back: what
/// undo and redo go along. It also counts what is not in the files.
///
/// A step is a change of the model but for what a valuation makes up, or of the files that are remembered by a command
/// that has a name. The moment now is always up to date: what is no step replaces it. A new step forgets those that
/// were taken back.
class History {
public:
    /// How much is remembered, whichever is less; the last step in any case.
    static constexpr std::size_t kMostSteps = 1000;
    static constexpr std::size_t kMostBytes = std::size_t{256} << 20;

    History(Moment first, DataFiles::Names names);

    /// Takes note of what is there after a command; `command` is its name, empty for one that is no step by itself.
    void note(Moment now, const DataFiles::Names& names, const std::string& command);

    bool canUndo() const { return now_ > 0; }
    bool canRedo() const { return now_ + 1 < entries_.size(); }
    /// What the step is, to be told: "Remove company ALP".
    const std::string& undoLabel() const { return entries_[now_].label; }
    const std::string& redoLabel() const { return entries_[now_ + 1].label; }
    /// Go back or on by one step. The moment to be restored is `now()` then.
    /// @return the files to be remembered from now on.
    const DataFiles::Names& undo();
    const DataFiles::Names& redo();
    const Moment& now() const { return entries_[now_].moment; }

    /// What is there now is what the remembered file of that kind has: it was loaded, or saved.
    void noteFile(FileKind kind, bool isSaved);
    /// The steps between what the remembered file has and what is there; 0 when they are the same.
    unsigned unsavedChanges(FileKind kind) const;
    /// Another number after every step, undo and redo.
    std::uint64_t serial() const { return serial_; }
    /// The step that led to what is there now: a number that no other step has or had. 0 before the first.
    std::uint64_t lastStep() const { return entries_[now_].step; }
    /// Whether what is there now came about with that step, which may be forgotten by now: it was not taken back.
    bool isDone(std::uint64_t step) const;

private:
    using Counts = std::array<long, 2>; // by kind
    /// A moment, and the step that led to it.
    struct Entry {
        Moment moment;
        std::string label;
        // Of the kinds whose files the step changed: those that come back with an undo, and with a redo.
        std::array<bool, 2> hasOtherFile{};
        DataFiles::Names before = {};
        DataFiles::Names after = {};
        Counts steps{};         // that changed what is of that kind
        std::uint64_t step = 0; // its number
        std::size_t bytes = 0;  // in the moment before, and not in this one
    };
    /// What a file has; what it is not about is null.
    struct Mark {
        long step;
        std::shared_ptr<const CatalogueImage> catalogue;
        std::shared_ptr<const WalletImage> wallet;
    };

    static bool isSame(const Mark& mark, FileKind kind, const Moment& moment);
    std::string fileStepLabel(const std::string& command, const DataFiles::Names& names) const;
    /// Remembers the files `to` of the kinds that the step changed, and keeps the present ones in `from` for the way
    /// back. Those of the other kind stay: a save may have named them since.
    void turn(const Entry& step, DataFiles::Names& from, const DataFiles::Names& to);
    void forgetUndone();
    void forgetOldest();
    std::string pathOf(FileKind kind) const;

    std::deque<Entry> entries_;
    std::size_t now_ = 0;
    DataFiles::Names names_;
    // By path, empty for no file yet: what each load of it gave, or what was saved to it.
    std::map<std::pair<FileKind, std::string>, std::vector<Mark>> marks_;
    std::size_t bytes_ = 0; // that the steps hold besides what is there now
    std::uint64_t serial_ = 0;
};
