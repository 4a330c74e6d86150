#pragma once

#include <string>
#include <string_view>
#include <vector>

/// Something that a person asks for by a short name, or by words of a long one.
struct NamedEntry {
    std::string key;   ///< a ticker, a symbol, the name of a market
    std::string name;  ///< may be empty
    std::string place; ///< what stands beside them and is not searched, such as a company's market; may be empty

    bool operator==(const NamedEntry&) const = default;
};

/// Finds entries by what a person has typed of them, whatever its case and accents.
///
/// It has copies of the texts and refers to nothing: when the catalogue changes, another index is made.
class NameIndex {
public:
    NameIndex() = default;
    explicit NameIndex(std::vector<NamedEntry> entries);

    /// At most `most` entries: first those of exactly that key, then those whose key begins so, then those with such a
    /// beginning of a word in the name, then those that have it anywhere in key or name; each by key, then by name. All
    /// of them for an empty text. They are valid as long as the index.
    std::vector<const NamedEntry*> find(std::string_view typed, std::size_t most) const;

private:
    struct Folded {
        std::string key;
        std::string name;
        NamedEntry entry;
    };
    std::vector<Folded> entries_; // by key, then by name
};
