#include "engine/rgb_bulbs.h"

#include <algorithm>
#include <bit>
#include <cstdlib>

namespace {

constexpr std::int32_t kHitsCeiling = 999'999'999;  // an entry with as many is never thrown out

std::size_t chainOf(std::int32_t color, std::int32_t size, std::int32_t shape) noexcept {
    const std::uint32_t mixed = (static_cast<std::uint32_t>(color) ^ static_cast<std::uint32_t>(size) << 24 ^
                                 static_cast<std::uint32_t>(shape) << 28) *
                                2654435761U;  // 2^32 over the golden ratio: spreads neighbours
    return mixed >> 24;
}

}  // namespace

std::int32_t ZephRGBBulbCache::find(std::int32_t color, std::int32_t size, std::int32_t shape) const noexcept {
    std::int32_t entry = chains_[chainOf(color, size, shape)];
    while (entry != 0) {
        const ZephRGBBulbCacheEntry& held = (*this)[entry];
        if (held.Color == color && held.BulbSize == size && held.BulbShape == shape) break;
        entry = held.Chained;
    }
    return entry;
}

std::int32_t ZephRGBBulbCache::leastUsed() noexcept {
    if (lowest_[0] == 0 && lowest_[1] == 0) collectLowest();
    if (lowest_[0] != 0) return 1 + std::countr_zero(lowest_[0]);
    if (lowest_[1] != 0) return 65 + std::countr_zero(lowest_[1]);
    return 0;
}

void ZephRGBBulbCache::collectLowest() noexcept {
    lowestHits_ = kHitsCeiling;
    for (std::size_t n = 1; n <= kRGBBulbCacheSize; ++n)
        lowestHits_ = std::min(lowestHits_, entries_[n].Hits);
    if (lowestHits_ == kHitsCeiling) return;
    for (std::size_t n = 1; n <= kRGBBulbCacheSize; ++n) {
        if (entries_[n].Hits == lowestHits_) lowest_[(n - 1) / 64] |= std::uint64_t{1} << (n - 1) % 64;
    }
}

void ZephRGBBulbCache::countHit(std::int32_t entry) noexcept {
    const auto n = static_cast<std::size_t>(entry);
    if (entries_[n].Hits < kHitsCeiling) ++entries_[n].Hits;
    lowest_[(n - 1) / 64] &= ~(std::uint64_t{1} << (n - 1) % 64);
}

std::int32_t ZephRGBBulbCache::replace(std::int32_t entry, std::int32_t color, std::int32_t size, std::int32_t shape,
                                       std::int32_t bulb) noexcept {
    const auto n = static_cast<std::size_t>(entry);
    ZephRGBBulbCacheEntry& held = entries_[n];
    if (held.Hits > 0) {
        std::int32_t* link = &chains_[chainOf(held.Color, held.BulbSize, held.BulbShape)];
        while (*link != entry)
            link = &entries_[static_cast<std::size_t>(*link)].Chained;
        *link = held.Chained;
    }
    const std::int32_t before = held.Bulb;
    std::int32_t& chain = chains_[chainOf(color, size, shape)];
    held = {size, shape, color, 1, bulb, chain};
    chain = entry;

    // With one hit it stands lowest, unless empty entries do.
    const std::uint64_t bit = std::uint64_t{1} << (n - 1) % 64;
    if (lowestHits_ > 1) {
        lowest_ = {};
        lowestHits_ = 1;
    }
    if (lowestHits_ == 1) {
        lowest_[(n - 1) / 64] |= bit;
    } else {
        lowest_[(n - 1) / 64] &= ~bit;
    }
    return before;
}

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
    const std::int32_t shape = shapeDrawn(fixture);
    if (const std::int32_t entry = cache.find(color, fixture.BulbSize, shape); entry != 0) {
        pool.hold(cache[entry].Bulb);
        pool.release(group.Bulb);
        group.Bulb = cache[entry].Bulb;
        cache.countHit(entry);
        ++cache.RGBBulbCacheHits;
        return;
    }
    pool.release(group.Bulb);
    group.Bulb = pool.create(mask, color);
    ++cache.RGBBulbCacheMisses;
    if (const std::int32_t entry = cache.leastUsed(); entry != 0) {
        pool.hold(group.Bulb);
        pool.release(cache.replace(entry, color, fixture.BulbSize, shape, group.Bulb));
    }
}
