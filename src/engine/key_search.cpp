#include "engine/key_search.h"

#include <algorithm>
#include <limits>

#if defined(__x86_64__)
#include <immintrin.h>
#endif

namespace {

// Fills the end of the last block of a level. A real key may have the same value: it then stands before the padding
// and is found first.
constexpr std::int32_t kPadding = std::numeric_limits<std::int32_t>::max();

#if defined(__x86_64__)
// How many keys of a block are not above the key. target: the caller made sure that the processor has AVX2.
__attribute__((target("avx2,popcnt"))) inline std::int32_t notAbove(const std::int32_t* block, __m256i key) {
    const __m256i low = _mm256_load_si256(reinterpret_cast<const __m256i*>(block));
    const __m256i high = _mm256_load_si256(reinterpret_cast<const __m256i*>(block + 8));
    const __m256i above = _mm256_packs_epi32(_mm256_cmpgt_epi32(low, key), _mm256_cmpgt_epi32(high, key));
    return 16 - _mm_popcnt_u32(static_cast<unsigned>(_mm256_movemask_epi8(above))) / 2;
}
#endif

}  // namespace

void KeySearch::clear() {
    runs_.clear();
    blocks_.clear();
    levels_.clear();
}

void KeySearch::build(std::span<const std::int32_t> sorted) {
    clear();
    if (sorted.empty()) return;
    lowest_ = sorted.front();
    std::vector<std::int32_t> level;
    for (std::size_t i = 0; i < sorted.size(); ++i) {
        if (i == 0 || std::int64_t{sorted[i]} != std::int64_t{sorted[i - 1]} + 1) {
            level.push_back(sorted[i]);
            runs_.push_back({0, static_cast<std::int32_t>(static_cast<std::uint32_t>(i + 1) -
                                                          static_cast<std::uint32_t>(sorted[i]))});
        }
        runs_.back().lastKey = sorted[i];
    }
    for (;;) {
        const std::size_t levelBlocks = (level.size() + kBlock - 1) / kBlock;
        levels_.push_back({static_cast<std::int32_t>(blocks_.size()), static_cast<std::int32_t>(levelBlocks) - 1});
        level.resize(levelBlocks * kBlock, kPadding);
        std::vector<std::int32_t> heads;
        for (std::size_t b = 0; b < levelBlocks; ++b) {
            Block block;
            std::copy_n(level.begin() + static_cast<std::ptrdiff_t>(b) * kBlock, kBlock, block.keys.begin());
            blocks_.push_back(block);
            heads.push_back(block.keys[0]);
        }
        if (levelBlocks == 1) break;
        level = std::move(heads);
    }
}

inline std::int32_t KeySearch::positionIn(std::int32_t run0, std::int32_t key) const noexcept {
    const Run& run = runs_[std::min(static_cast<std::size_t>(run0), runs_.size() - 1)];
    const std::uint32_t position = static_cast<std::uint32_t>(key) + static_cast<std::uint32_t>(run.shift);
    return lowest_ <= key && key <= run.lastKey ? static_cast<std::int32_t>(position) : 0;
}

std::int32_t KeySearch::findPortable(std::int32_t key) const noexcept {
    if (runs_.empty()) return 0;
    std::int32_t index = 0;
    for (std::size_t level = levels_.size(); level-- > 0;) {
        // The highest key possible is not above the padding either, and would lead past the end of the level.
        const std::int32_t inLevel = std::min(index, levels_[level].last);
        const Block& block = blocks_[static_cast<std::size_t>(levels_[level].first + inLevel)];
        std::int32_t atMost = 0;
        for (const std::int32_t head : block.keys)
            atMost += head <= key ? 1 : 0;
        index = inLevel * kBlock + std::max(atMost - 1, 0);
    }
    return positionIn(index, key);
}

#if defined(__x86_64__)

__attribute__((target("avx2,popcnt"))) void KeySearch::findManyVector(std::span<const std::int32_t> keys,
                                                                      std::int32_t* positions) const noexcept {
    constexpr std::size_t kLanes = 8;
    const Block* const blocks = blocks_.data();
    std::size_t done = 0;
    while (done < keys.size()) {
        const std::size_t lanes = std::min(kLanes, keys.size() - done);
        std::int32_t index[kLanes] = {};
        for (std::size_t level = levels_.size(); level-- > 0;) {
            const Block* const first = blocks + levels_[level].first;
            const std::int32_t last = levels_[level].last;
            for (std::size_t lane = 0; lane < lanes; ++lane) {
                const std::int32_t inLevel = std::min(index[lane], last);
                const std::int32_t atMost = notAbove(first[inLevel].keys.data(), _mm256_set1_epi32(keys[done + lane]));
                index[lane] = inLevel * kBlock + (atMost > 0 ? atMost - 1 : 0);
            }
        }
        for (std::size_t lane = 0; lane < lanes; ++lane)
            positions[done + lane] = positionIn(index[lane], keys[done + lane]);
        done += lanes;
    }
}

void KeySearch::findMany(std::span<const std::int32_t> keys, std::int32_t* positions) const noexcept {
    if (runs_.empty()) {
        std::fill_n(positions, keys.size(), 0);
    } else if (__builtin_cpu_supports("avx2")) {
        findManyVector(keys, positions);
    } else {
        for (std::size_t i = 0; i < keys.size(); ++i)
            positions[i] = findPortable(keys[i]);
    }
}

#else

void KeySearch::findMany(std::span<const std::int32_t> keys, std::int32_t* positions) const noexcept {
    for (std::size_t i = 0; i < keys.size(); ++i)
        positions[i] = findPortable(keys[i]);
}

#endif

std::int32_t KeySearch::find(std::int32_t key) const noexcept {
    std::int32_t position = 0;
    findMany({&key, 1}, &position);
    return position;
}
