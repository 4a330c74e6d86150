#include "market/NameIndex.h"

#include "foundation/FoldedText.h"

#include <algorithm>
#include <array>
#include <tuple>

namespace {

constexpr std::size_t kRanks = 4;

bool isLetter(char c)
{
    return (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || static_cast<unsigned char>(c) >= 0x80;
}

bool hasWord(std::string_view name, std::string_view typed)
{
    for (std::size_t at = name.find(typed); at != name.npos; at = name.find(typed, at + 1)) {
        if (at == 0 || !isLetter(name[at - 1]))
            return true;
    }
    return false;
}

/// How well an entry fits; `kRanks` when it does not. All texts are folded.
std::size_t rank(std::string_view key, std::string_view name, std::string_view typed)
{
    if (key.starts_with(typed))
        return key.size() == typed.size() ? 0 : 1;
    if (hasWord(name, typed))
        return 2;
    return key.find(typed) != key.npos || name.find(typed) != name.npos ? 3 : kRanks;
}

} // namespace

NameIndex::NameIndex(std::vector<NamedEntry> entries)
{
    entries_.reserve(entries.size());
    for (NamedEntry& entry : entries)
        entries_.push_back({foldedText(entry.key), foldedText(entry.name), std::move(entry)});
    std::ranges::stable_sort(entries_, {}, [](const Folded& e) { return std::tie(e.key, e.name); });
    const auto isSame = [](const Folded& a, const Folded& b) { return a.entry == b.entry; };
    entries_.erase(std::unique(entries_.begin(), entries_.end(), isSame), entries_.end());
}

std::vector<const NamedEntry*> NameIndex::find(std::string_view typed, std::size_t most) const
{
    const std::string folded = foldedText(typed);
    std::array<std::vector<const NamedEntry*>, kRanks> byRank;
    for (const Folded& entry : entries_) {
        const std::size_t at = rank(entry.key, entry.name, folded);
        if (at < kRanks && byRank[at].size() < most)
            byRank[at].push_back(&entry.entry);
    }
    std::vector<const NamedEntry*> found;
    for (const auto& ranked : byRank)
        found.insert(found.end(), ranked.begin(),
                     ranked.begin() + static_cast<std::ptrdiff_t>(std::min(ranked.size(), most - found.size())));
    return found;
}
