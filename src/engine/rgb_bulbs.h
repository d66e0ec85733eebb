// The coloured images of RGB groups in simulation: a cache of 128 colours in front of the masks. An image lives as long
// as a group or the cache holds it. All storage is reserved before the first frame; nothing here allocates after.
#pragma once

#include "engine/bulb_images.h"
#include "engine/render_table.h"

#include <array>
#include <cstdint>
#include <vector>

inline constexpr int kRGBBulbCacheSize = 128;
inline constexpr std::int32_t kRGBRebuildDrift = 30;

struct ZephRGBBulbCacheEntry {
    std::int32_t BulbSize = 0;
    std::int32_t BulbShape = 0;  // 12 = a flood
    std::int32_t Color = 0;
    std::int32_t Hits = 0;     // 0 = empty
    std::int32_t Bulb = 0;     // handle
    std::int32_t Chained = 0;  // next entry of the same chain, 0 = the last
};

// 128 colours, found through chains by colour, size and shape. What goes is the entry with the fewest hits, the first
// of equals; a set of the entries that stand lowest spares the search for it.
class ZephRGBBulbCache {
public:
    // 1..128, 0 = not there.
    std::int32_t find(std::int32_t color, std::int32_t size, std::int32_t shape) const noexcept;
    std::int32_t leastUsed() noexcept;  // 1..128, 0 = every entry stands at the highest count

    void countHit(std::int32_t entry) noexcept;
    // Puts an image in the entry's place, with one hit. Gives the handle that stood there.
    std::int32_t replace(std::int32_t entry, std::int32_t color, std::int32_t size, std::int32_t shape,
                         std::int32_t bulb) noexcept;
    const ZephRGBBulbCacheEntry& operator[](std::int32_t entry) const noexcept {
        return entries_[static_cast<std::size_t>(entry)];
    }

    std::int64_t RGBBulbCacheHits = 0;  // only counted
    std::int64_t RGBBulbCacheMisses = 0;

private:
    void collectLowest() noexcept;

    std::array<ZephRGBBulbCacheEntry, kRGBBulbCacheSize + 1> entries_{};         // 1..
    std::array<std::int32_t, 256> chains_{};                                     // first entry of each
    std::array<std::uint64_t, 2> lowest_{~std::uint64_t{0}, ~std::uint64_t{0}};  // bit n - 1: entry n has lowestHits_
    std::int32_t lowestHits_ = 0;
};

// The images behind the handles 1.. that stand in ZephRGBData::Bulb and in the cache.
class RGBBulbPool {
public:
    // Room for every image that can be alive at once: one a group, and the cache full. groups: all RGB groups;
    // floodGroups of them are floods, none larger than maxFloodSize.
    void reserve(std::int32_t groups, std::int32_t floodGroups, std::int32_t maxFloodSize);

    // handle from create.
    const BulbImage& image(std::int32_t handle) const noexcept { return images_[static_cast<std::size_t>(handle)]; }

    // A new image, held once. 0 if the reserved room is used up.
    std::int32_t create(const BulbMask* mask, std::int32_t color);
    void hold(std::int32_t handle) noexcept;     // 0 is ignored
    void release(std::int32_t handle) noexcept;  // 0 is ignored; the last holder frees the image

private:
    std::vector<BulbImage> images_;  // [0] not used
    std::vector<std::int32_t> holders_;
    std::vector<std::int32_t> freeHard_;
    std::vector<std::int32_t> freeSoft_;
    std::int32_t firstSoft_ = 0;
};

// Whether the levels have moved so far (30 in all) since the image was made that it must be made anew; then the present
// levels are noted as those of the image. So call it once for each draw, before asking for a missing image.
bool RGBBulbRebuildNeeded(ZephRGBData& group) noexcept;

// Gives the group the image of a colour on the fixture's mask, from the cache where it is there. On a miss the entry
// with the fewest hits goes, the first of equals. Hits are never aged: a colour that was popular once stays.
void ZephUpdateRGBChannelBulb(const ZephFixture& fixture, std::int32_t color, const ZephMasks& masks,
                              ZephRGBBulbCache& cache, RGBBulbPool& pool, ZephRGBData& group);
