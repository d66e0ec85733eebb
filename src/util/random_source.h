// Random numbers r, uniform in [0, 1). The same seed gives the same numbers on every machine.
#pragma once

#include <cstdint>

class RandomSource {
public:
    virtual ~RandomSource() = default;
    virtual double next() = 0;  // uniform in [0, 1)
};

// xoshiro256** 1.0 by David Blackman and Sebastiano Vigna (public domain), seeded through splitmix64; the upper 53
// bits make r.
class SeededRandom : public RandomSource {
public:
    explicit SeededRandom(std::uint64_t seed);
    double next() override;

private:
    std::uint64_t state_[4];
};

// A seed that differs from run to run.
std::uint64_t seedFromSystem();

// Int((high - low + 1) x r + low): a whole number in low..high.
std::int32_t ZephReturnRandomNumber(std::int32_t low, std::int32_t high, RandomSource& random);
