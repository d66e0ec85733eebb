// Finds a 32-bit key in a sorted array. The keys are copied into blocks of 16, one cache line each, as a static search
// tree: a look-up reads one line a level, five for 160,000 keys, where bisection reads seventeen.
#pragma once

#include <array>
#include <cstdint>
#include <span>
#include <vector>

class KeySearch {
public:
    // sorted: ascending, without repeats. The position that find gives counts from 1.
    void build(std::span<const std::int32_t> sorted);
    void clear();

    // Position of the key, from 1; 0 = absent.
    std::int32_t find(std::int32_t key) const noexcept;

    // The same for many keys at once; their look-ups overlap, so each costs a fraction. positions as long as keys.
    void findMany(std::span<const std::int32_t> keys, std::int32_t* positions) const noexcept;

    // The form without vector instructions: what other processors run, and what the fast form is tested against.
    std::int32_t findPortable(std::int32_t key) const noexcept;

private:
    static constexpr std::int32_t kBlock = 16;
    struct alignas(64) Block {
        std::array<std::int32_t, kBlock> keys;
    };

    struct Level {
        std::int32_t first = 0;  // index of its first block
        std::int32_t last = 0;   // of its last block, counted from the first
    };

    void findManyVector(std::span<const std::int32_t> keys, std::int32_t* positions) const noexcept;

    std::int32_t count_ = 0;
    std::vector<Block> blocks_;  // level 0 holds the keys, each level above the first key of each block
    std::vector<Level> levels_;  // lowest level first
};
