#pragma once

#include <array>
#include <cstdint>
#include <ctime>
#include <optional>
#include <string>

/// What has to be known about copies of unsaved work besides the work itself: which copies belong together, of when
/// they are, and where the user's files are that they would change. It is a small text file beside them; docs/FILES.md
/// has its layout.
struct RescueNote {
    /// A file's length and checksum.
    struct Fingerprint {
        std::uintmax_t size = 0;
        std::uint64_t sum = 0;

        bool operator==(const Fingerprint&) const = default;
    };
    struct Part {
        std::string path;        // the user's file; empty while it has no name
        bool isAsked = false;    // the next save asks for a name, whatever the path
        unsigned generation = 0; // in the name of its copy; 0 when there is none: there is nothing unsaved
        Fingerprint copy;

        bool isCopied() const { return generation > 0; }
    };
    enum Kind : std::size_t { kMarkets, kPortfolio, kKinds };

    std::time_t time = 0; // of the newest copy
    std::array<Part, kKinds> parts;

    bool hasCopies() const { return parts[kMarkets].isCopied() || parts[kPortfolio].isCopied(); }

    std::string text() const;
    /// @return nothing when `text` is not what `text()` gives, whole.
    static std::optional<RescueNote> read(const std::string& text);
};

/// Throws std::runtime_error with one line for the user when the file cannot be read.
RescueNote::Fingerprint fingerprintOf(const std::string& path);
