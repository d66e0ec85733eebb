// Finds a 32-bit key in a sorted array. Channels are numbered through, so keys come in runs without a gap, and only the
// first key of each run is searched for: 1,024 ribbons have 160,000 keys in 1,024 runs. The heads lie in blocks of 16,
// one cache line each, as a static search tree: a look-up reads one line a level, three for 1,024 heads, and then what
// its run says.
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
    // Keys that follow each other without a gap.
    struct Run {
        std::int32_t lastKey = 0;
        std::int32_t shift = 0;  // from a key to its position, modulo 2^32
    };

    // The answer of the run with the highest head that is not above the key; run0 may lie in the padding behind.
    std::int32_t positionIn(std::int32_t run0, std::int32_t key) const noexcept;
    void findManyVector(std::span<const std::int32_t> keys, std::int32_t* positions) const noexcept;

    std::int32_t lowest_ = 0;  // key
    std::vector<Run> runs_;
    std::vector<Block> blocks_;  // level 0 holds the heads of the runs, each level above the first key of each block
    std::vector<Level> levels_;  // lowest level first
};
