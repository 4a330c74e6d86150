#pragma once

#include "storage/DataFolder.h"
#include "storage/RescueNote.h"
#include "storage/Writing.h"

#include <array>
#include <ctime>
#include <memory>
#include <string>
#include <vector>

/// Copies of one window's unsaved work, in the data folder's "Backups/Unsaved": whole files of the two kinds, below
/// "Companies" and "PortoFolios", and a note of what belongs together.
///
/// They are named after the time at which the window first had something unsaved: "2026-11-21 10.53.04 (3)" is a copy
/// of its third generation, "2026-11-21 10.53.04.note" the note. A generation is written in this order: copies, each
/// under a name of its own; the note, which from then on names them; then the copies that it does not name are removed.
/// So whenever the program or the machine stops, the note that is there fits the copies that it names, and what no note
/// names counts for nothing. AtomicFile gives every file its name only when it is whole.
///
/// Who holds such an object has locked "2026-11-21 10.53.04.lock". The kernel takes the lock from a program that ends,
/// however it does, so an unlocked one belongs to a program that is gone, and whoever locks it first has taken its
/// copies over.
class RescueCopies {
public:
    /// What is to be known of a kind of file, and what is to be done about it.
    struct Source {
        std::string path;     // as in the note
        bool isAsked = false; // as in the note
        FileWriter write;     // makes a new copy; where it is empty, there is to be none
        bool isKept = false;  // or, if this is set, the one that is there stays
    };
    using Sources = std::array<Source, RescueNote::kKinds>;

    /// Takes over what programs have left that are gone, newest first. What is damaged is left where it is; an
    /// unfinished first generation, which has no note, is removed.
    static std::vector<std::shared_ptr<RescueCopies>> takeLeftBehind(const DataFolder& folder);

    /// Makes room for a window that has no copies yet. Throws std::runtime_error with one line for the user when there
    /// can be none.
    explicit RescueCopies(const DataFolder& folder);
    /// Leaves the copies to whoever takes them over.
    ~RescueCopies();
    RescueCopies(const RescueCopies&) = delete;
    RescueCopies& operator=(const RescueCopies&) = delete;

    /// Of the last generation; without copies when there is none.
    const RescueNote& note() const { return note_; }
    /// Where the copy of that kind is.
    std::string copyOf(RescueNote::Kind kind) const;

    /// Writes the next generation, or removes all when there is nothing to copy. Throws std::runtime_error with one
    /// line for the user when that fails: the last generation then stands.
    void write(const Sources& sources, std::time_t now = std::time(nullptr));
    void remove();

private:
    RescueCopies(const std::string& folder, const std::string& name, int lock);

    /// Reads the note. @return false when it or what it names is damaged.
    bool recall();
    RescueNote::Part copied(RescueNote::Kind kind, unsigned generation, const FileWriter& write) const;
    void removeUnnamed() const;
    std::string file(const char* ending) const { return folder_ + '/' + name_ + ending; }
    std::string file(RescueNote::Kind kind, unsigned generation) const;

    std::string folder_; // "Unsaved"
    std::string name_;   // what all the files' names begin with
    int lock_ = -1;      // the descriptor of the locked file
    RescueNote note_;
};
