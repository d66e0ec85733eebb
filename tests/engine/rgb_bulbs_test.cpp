#include "engine/rgb_bulbs.h"
#include "util/color.h"

#include <gtest/gtest.h>

#include <memory>
#include <vector>

namespace {

// Groups of one fixture, on masks made once.
struct Groups {
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    ZephFixture fixture;
    ZephRGBBulbCache cache;
    RGBBulbPool pool;

    Groups() {
        ZephSetUpMasks(
            ZephDimmingCurve{}, [](std::string_view) {}, *masks);
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.BulbSize = 2;
        fixture.BulbShape = 1;
        pool.reserve(4, 1, 64);
    }
    void update(std::int32_t color, ZephRGBData& group) {
        ZephUpdateRGBChannelBulb(fixture, color, *masks, cache, pool, group);
    }
};

}  // namespace

TEST(RGBBulbRebuildNeeded, AsksForADriftOfThirtyInAll) {
    ZephRGBData group;
    group.Level = {0, 10, 10, 9};
    EXPECT_FALSE(RGBBulbRebuildNeeded(group));
    group.Level = {0, 10, 10, 10};
    EXPECT_TRUE(RGBBulbRebuildNeeded(group));
    EXPECT_FALSE(RGBBulbRebuildNeeded(group));  // the levels are those of the image now
    group.Level = {0, 24, 0, 5};                // 14 + 10 + 5
    EXPECT_FALSE(RGBBulbRebuildNeeded(group));
}

TEST(RGBBulbCache, SharesAnImageAndKeepsTheOneThatIsStillHeld) {
    Groups groups;
    ZephRGBData first;
    ZephRGBData second;
    groups.update(packColor(255, 0, 0), first);
    groups.update(packColor(255, 0, 0), second);
    EXPECT_EQ(first.Bulb, second.Bulb);
    EXPECT_EQ(groups.cache.RGBBulbCacheHits, 1);
    EXPECT_EQ(groups.cache.RGBBulbCacheMisses, 1);

    // The red one has two hits. 127 colours fill the cache; each one more throws out the newest, never red.
    ZephRGBData other;
    for (std::int32_t color = 1; color <= 400; ++color)
        groups.update(color, other);
    EXPECT_NE(groups.cache.find(packColor(255, 0, 0), 2, 1), 0);
    EXPECT_EQ(groups.cache.find(1, 2, 1), 0);
    EXPECT_EQ(groups.pool.image(second.Bulb).Color, 0xFFFF0000U);

    // An image that was thrown out lives on with the group that shows it.
    ZephRGBData holder = {};
    groups.update(1000, holder);
    for (std::int32_t color = 2001; color <= 2400; ++color)
        groups.update(color, other);
    EXPECT_EQ(groups.cache.find(1000, 2, 1), 0);
    EXPECT_EQ(groups.pool.image(holder.Bulb).Color, opaquePixel(1000));
}

TEST(RGBBulbCache, ThrowsOutTheFirstWithTheFewestHits) {
    // Beside it the plain rule: a scan of all 128 entries.
    struct Entry {
        std::int32_t color = -1;
        std::int32_t hits = 0;
    };
    std::vector<Entry> plain(128);
    ZephRGBBulbCache cache;
    std::uint32_t state = 5;
    for (int round = 0; round < 20000; ++round) {
        state = state * 1664525 + 1013904223;  // Numerical Recipes' generator
        // Few colours at times, so that hits grow; many at others.
        const auto color = static_cast<std::int32_t>((state >> 8) % (round / 2000 % 2 == 0 ? 150U : 4000U));
        std::size_t lowest = 0;
        std::size_t found = plain.size();
        for (std::size_t i = 0; i < plain.size(); ++i) {
            if (plain[i].hits > 0 && plain[i].color == color) found = i;
            if (plain[i].hits < plain[lowest].hits) lowest = i;
        }
        const std::int32_t entry = cache.find(color, 3, 4);
        if (found < plain.size()) {
            ASSERT_EQ(entry, static_cast<std::int32_t>(found) + 1);
            ++plain[found].hits;
            cache.countHit(entry);
        } else {
            ASSERT_EQ(entry, 0);
            ASSERT_EQ(cache.leastUsed(), static_cast<std::int32_t>(lowest) + 1) << "round " << round;
            plain[lowest] = {color, 1};
            cache.replace(cache.leastUsed(), color, 3, 4, 7);
        }
    }
    EXPECT_EQ(cache.find(1, 4, 3), 0);
}

TEST(RGBBulbs, SizesWithoutAMaskGetNoImage) {
    Groups groups;
    groups.fixture.BulbSize = 17;
    ZephRGBData group;
    groups.update(kWhite, group);
    EXPECT_EQ(group.Bulb, 0);
    EXPECT_EQ(groups.cache.RGBBulbCacheMisses, 0);
}
