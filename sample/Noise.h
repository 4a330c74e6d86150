#pragma once

#include <cstdint>

/// Random numbers that are the same for a seed on every machine: integers, and sums and products of doubles, none of
/// the library's distributions.
///
/// Source: the SplitMix64 generator of Steele, Lea and Flood, Fast Splittable Pseudorandom Number Generators, 2014.
class Noise {
public:
    explicit Noise(std::uint64_t seed) : state_(seed) {}

    /// Near to normal, with mean 0 and standard deviation 1, within -6 to 6.
    double next();

private:
    std::uint64_t nextBits();

    std::uint64_t state_;
};
