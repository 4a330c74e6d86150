#include "sample/Noise.h"

std::uint64_t Noise::nextBits()
{
    state_ += 0x9E3779B97F4A7C15ULL;
    std::uint64_t bits = state_;
    bits = (bits ^ bits >> 30) * 0xBF58476D1CE4E5B9ULL;
    bits = (bits ^ bits >> 27) * 0x94D049BB133111EBULL;
    return bits ^ bits >> 31;
}

double Noise::next()
{
    // A uniform number between 0 and 1 has the variance 1/12, so the sum of twelve has the variance 1.
    constexpr int kTerms = 12;
    constexpr double kScale = 1.0 / 4294967296.0; // 2^-32
    double sum = -kTerms / 2.0;
    for (int i = 0; i < kTerms; ++i)
        sum += static_cast<double>(nextBits() >> 32) * kScale;
    return sum;
}
