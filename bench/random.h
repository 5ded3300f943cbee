#pragma once

#include <algorithm>
#include <cmath>
#include <cstdint>
#include <vector>

/// Numbers that look random and are the same everywhere, unlike the distributions of the standard
/// library: the same seed makes the same catalogue on every machine.
class Random
{
public:
    explicit Random(std::uint64_t seed) : mState(seed) {}

    std::uint64_t next()
    {
        std::uint64_t z = mState += 0x9E3779B97F4A7C15u;
        z = (z ^ (z >> 30)) * 0xBF58476D1CE4E5B9u;
        z = (z ^ (z >> 27)) * 0x94D049BB133111EBu;
        return z ^ (z >> 31);
    }

    double fraction() { return double(next() >> 11) * 0x1p-53; } // from 0 to below 1
    bool chance(double share) { return fraction() < share; }
    int between(int low, int high) { return low + int(fraction() * (high - low + 1)); }

private:
    std::uint64_t mState;
};

/// Picks places of a list as often as Zipf's law has it: the first ones often, the many others
/// seldom. The head is made flatter, or the first artist would own a tenth of a collection.
class Zipf
{
public:
    Zipf(std::size_t size, double head, double exponent)
    {
        double sum = 0;
        for (std::size_t i = 0; i < size; ++i)
            mSums.push_back(sum += std::pow(double(i) + 1 + head, -exponent));
    }

    std::size_t pick(Random &random) const
    {
        const double at = random.fraction() * mSums.back();
        const auto found = std::upper_bound(mSums.begin(), mSums.end(), at);
        return std::min(std::size_t(found - mSums.begin()), mSums.size() - 1);
    }

private:
    std::vector<double> mSums;
};
