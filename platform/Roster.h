#pragma once

class BMessage;
class BMessenger;
struct entry_ref;

/// The desktop's other programs.
class BRoster {
public:
    /// Opens `file` with the program that the desktop has for its kind, which outlives this one. Whether that starts
    /// shows only after a while, unlike in the kits: `failed`, owned from now on, is sent to `target` if it does not.
    void Launch(const entry_ref* file, const BMessenger& target, BMessage* failed) const;
};

extern const BRoster* const be_roster;
