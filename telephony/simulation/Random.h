#pragma once

#include <cstdint>
#include <random>

namespace kelvo::simulation {

/// A repeatable source of chance: the same seed gives the same numbers with every compiler, as long as the mathematics
/// library is one. (The engine's sequence is fixed by the language; the distributions are not, so they are written out
/// here. The last bit of a logarithm or a cosine is the library's choice.)
class Random {
public:
    explicit Random(std::uint64_t seed) : _engine(seed) {}

    /// From 0 up to, not including, 1.
    double uniform();
    double between(double low, double high);
    /// From `low` to `high`, both included.
    int between(int low, int high);
    bool chance(double probability) { return uniform() < probability; }
    /// Standard normal: mean 0, deviation 1.
    double normal();
    /// Exponentially distributed with this mean: the time to the next of many independent events.
    double exponential(double mean);
    /// A generator of its own: what it is used for does not shift the numbers drawn here afterwards.
    Random split() { return Random(_engine()); }

private:
    std::mt19937_64 _engine;
};

}  // namespace kelvo::simulation
