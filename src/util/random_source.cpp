#include "util/random_source.h"

#include "util/rounding.h"

#include <bit>
#include <random>

SeededRandom::SeededRandom(std::uint64_t seed) {
    for (std::uint64_t& word : state_) {
        seed += 0x9E3779B97F4A7C15u;
        std::uint64_t mixed = seed;
        mixed = (mixed ^ (mixed >> 30)) * 0xBF58476D1CE4E5B9u;
        mixed = (mixed ^ (mixed >> 27)) * 0x94D049BB133111EBu;
        word = mixed ^ (mixed >> 31);
    }
}

double SeededRandom::next() {
    const std::uint64_t result = std::rotl(state_[1] * 5, 7) * 9;
    const std::uint64_t shifted = state_[1] << 17;
    state_[2] ^= state_[0];
    state_[3] ^= state_[1];
    state_[1] ^= state_[2];
    state_[0] ^= state_[3];
    state_[2] ^= shifted;
    state_[3] = std::rotl(state_[3], 45);
    return static_cast<double>(result >> 11) * 0x1.0p-53;
}

std::uint64_t seedFromSystem() {
    std::random_device device;
    return (static_cast<std::uint64_t>(device()) << 32) | device();
}

std::int32_t ZephReturnRandomNumber(std::int32_t low, std::int32_t high, RandomSource& random) {
    return floorToInt((high - low + 1) * random.next() + low);
}
