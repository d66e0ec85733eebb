#include "engine/rgb_bulbs.h"

#include <algorithm>
#include <cstdlib>

namespace {

constexpr std::int32_t kHitsCeiling = 999'999'999;  // an entry with more is never thrown out

std::int32_t sizeAndShape(const ZephFixture& fixture) noexcept {
    const std::int32_t shape = fixture.Fixture_Type == kFixtureFlood ? kFloodShapeKey : fixture.BulbShape;
    return 16 * fixture.BulbSize + shape;
}

// Entry of the colour, 0 = none.
std::int32_t findEntry(const ZephRGBBulbCache& cache, std::int32_t color, std::int32_t key) noexcept {
    for (std::size_t first = 1; first <= kRGBBulbCacheSize; first += 16) {
        std::int32_t any = 0;
        for (std::size_t i = first; i < first + 16; ++i) {
            any |= static_cast<std::int32_t>(cache.Color[i] == color) &
                   static_cast<std::int32_t>(cache.SizeAndShape[i] == key);
        }
        if (any == 0) continue;
        for (std::size_t i = first; i < first + 16; ++i) {
            if (cache.Color[i] == color && cache.SizeAndShape[i] == key && cache.Hits[i] > 0) {
                return static_cast<std::int32_t>(i);
            }
        }
    }
    return 0;
}

// The first entry with the fewest hits; 0 if all stand at the ceiling.
std::size_t leastUsed(const ZephRGBBulbCache& cache) noexcept {
    std::int32_t fewest = kHitsCeiling;
    for (std::size_t i = 1; i <= kRGBBulbCacheSize; ++i)
        fewest = std::min(fewest, cache.Hits[i]);
    if (fewest == kHitsCeiling) return 0;
    return static_cast<std::size_t>(std::find(cache.Hits.begin() + 1, cache.Hits.end(), fewest) - cache.Hits.begin());
}

}  // namespace

void RGBBulbPool::reserve(std::int32_t groups, std::int32_t floodGroups, std::int32_t maxFloodSize) {
    const auto hard = static_cast<std::size_t>(groups - floodGroups + kRGBBulbCacheSize + 1);
    const auto soft = floodGroups > 0 ? static_cast<std::size_t>(floodGroups + kRGBBulbCacheSize + 1) : 0;
    images_.assign(1 + hard + soft, {});
    holders_.assign(images_.size(), 0);
    freeHard_.clear();
    freeSoft_.clear();
    freeHard_.reserve(hard);
    freeSoft_.reserve(soft);
    firstSoft_ = static_cast<std::int32_t>(1 + hard);
    for (std::size_t handle = images_.size() - 1; handle >= 1; --handle) {
        if (handle > hard) {
            const auto side = static_cast<std::size_t>((2 * maxFloodSize + 7) / 8 * 8);
            images_[handle].Pixels.reserve(side * side);
            freeSoft_.push_back(static_cast<std::int32_t>(handle));
        } else {
            freeHard_.push_back(static_cast<std::int32_t>(handle));
        }
    }
}

std::int32_t RGBBulbPool::create(const BulbMask* mask, std::int32_t color) {
    std::vector<std::int32_t>& free = mask != nullptr && mask->Soft ? freeSoft_ : freeHard_;
    if (free.empty()) return 0;
    const std::int32_t handle = free.back();
    free.pop_back();
    makeBulbImage(mask, color, images_[static_cast<std::size_t>(handle)]);
    holders_[static_cast<std::size_t>(handle)] = 1;
    return handle;
}

void RGBBulbPool::hold(std::int32_t handle) noexcept {
    if (handle != 0) ++holders_[static_cast<std::size_t>(handle)];
}

void RGBBulbPool::release(std::int32_t handle) noexcept {
    if (handle == 0 || --holders_[static_cast<std::size_t>(handle)] > 0) return;
    (handle >= firstSoft_ ? freeSoft_ : freeHard_).push_back(handle);
}

bool RGBBulbRebuildNeeded(ZephRGBData& group) noexcept {
    std::int32_t drift = 0;
    for (std::size_t c = 1; c <= 3; ++c)
        drift += std::abs(group.Level[c] - group.LastLevel[c]);
    if (drift < kRGBRebuildDrift) return false;
    group.LastLevel = group.Level;
    return true;
}

void ZephUpdateRGBChannelBulb(const ZephFixture& fixture, std::int32_t color, const ZephMasks& masks,
                              ZephRGBBulbCache& cache, RGBBulbPool& pool, ZephRGBData& group) {
    const BulbMask* mask = maskOf(masks, fixture);
    if (mask == nullptr) return;  // sizes and shapes without a mask have no place in the cache either
    const std::int32_t key = sizeAndShape(fixture);
    if (const std::int32_t found = findEntry(cache, color, key); found != 0) {
        const auto entry = static_cast<std::size_t>(found);
        pool.hold(cache.Bulb[entry]);
        pool.release(group.Bulb);
        group.Bulb = cache.Bulb[entry];
        if (cache.Hits[entry] < kHitsCeiling) ++cache.Hits[entry];
        ++cache.RGBBulbCacheHits;
        return;
    }
    pool.release(group.Bulb);
    group.Bulb = pool.create(mask, color);
    ++cache.RGBBulbCacheMisses;
    const std::size_t entry = leastUsed(cache);
    if (entry == 0) return;
    pool.release(cache.Bulb[entry]);
    pool.hold(group.Bulb);
    cache.Color[entry] = color;
    cache.SizeAndShape[entry] = key;
    cache.Hits[entry] = 1;
    cache.Bulb[entry] = group.Bulb;
}
