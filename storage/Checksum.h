#pragma once

#include <cstdint>
#include <string_view>

constexpr std::uint64_t kChecksumOfNothing = 14695981039346656037U;

/// The 64-bit FNV-1a of `bytes`, or of what `before` is the checksum of with `bytes` behind it. It tells a damaged file
/// from a whole one; it is no guard against forgery.
inline std::uint64_t checksumOf(std::string_view bytes, std::uint64_t before = kChecksumOfNothing)
{
    for (const char c : bytes)
        before = (before ^ static_cast<unsigned char>(c)) * 1099511628211U;
    return before;
}
