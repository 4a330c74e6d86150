#pragma once

#include <string>
#include <string_view>
#include <unordered_map>
#include <unordered_set>

/// Gives names of which no two are the same.
class UniqueNames {
public:
    /// @param separator what stands between a name and its number.
    explicit UniqueNames(std::string separator) : separator_(std::move(separator)) {}

    /// `wanted` for the first that wants it; for a further one `wanted` with the first free number from 2 on behind it,
    /// of which `longest` bytes are left at most.
    const std::string& take(const std::string& wanted, std::size_t longest = std::string::npos)
    {
        const auto first = taken_.insert(wanted);
        if (first.second)
            return *first.first;
        unsigned& number = next_.try_emplace(wanted, 1).first->second;
        for (;;) {
            const std::string ending = separator_ + std::to_string(++number);
            const std::size_t room = longest > ending.size() ? longest - ending.size() : 0;
            const auto further = taken_.insert(wanted.substr(0, room) + ending);
            if (further.second)
                return *further.first;
        }
    }

private:
    std::string separator_;
    std::unordered_set<std::string> taken_;
    std::unordered_map<std::string, unsigned> next_; // the number given last, by name
};

/// `bytes` as one line of UTF-8 that somebody can type: what is no text becomes a blank, and there is no blank at an
/// end, nor two together. "unnamed" when nothing is left.
std::string cleanName(std::string_view bytes);
