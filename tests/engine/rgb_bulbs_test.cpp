#include "engine/rgb_bulbs.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"
#include "util/color.h"
#include "util/random_source.h"

TEST(RGBBulbRebuildNeeded, AsksForADriftOfThirtyInAll) {
    ZephRGBData group;
    const auto needed = [&](std::array<std::int32_t, 4> levels) {
        group.Level = levels;
        return RGBBulbRebuildNeeded(group);
    };
    EXPECT_FALSE(needed({0, 10, 10, 9}));
    EXPECT_TRUE(needed({0, 10, 10, 10}));
    EXPECT_FALSE(needed({0, 10, 10, 10}));  // the levels are those of the image now
    EXPECT_FALSE(needed({0, 24, 0, 5}));    // 14 + 10 + 5
}

TEST(RGBBulbCache, SharesAnImageAndKeepsTheOneThatIsStillHeld) {
    ZephFixture fixture;
    InitializeFixture({}, fixture);
    fixture.Fixture_Type = kFixtureBulbs;
    ZephRGBBulbCache cache;
    RGBBulbPool pool;
    pool.reserve(4, 1, 64);
    const auto update = [&](std::int32_t color, ZephRGBData& group) {
        ZephUpdateRGBChannelBulb(fixture, color, masks(), cache, pool, group);
    };
    ZephRGBData first;
    ZephRGBData second;
    update(packColor(255, 0, 0), first);
    update(packColor(255, 0, 0), second);
    EXPECT_EQ(first.Bulb, second.Bulb);
    EXPECT_EQ(cache.RGBBulbCacheHits, 1);

    // The red one has two hits and stays. An image that is thrown out lives on with the group that shows it.
    ZephRGBData other;
    ZephRGBData holder;
    update(1000, holder);
    for (std::int32_t color = 2001; color <= 2400; ++color)
        update(color, other);
    EXPECT_NE(cache.find(packColor(255, 0, 0), 2, 1), 0);
    EXPECT_EQ(cache.find(1000, 2, 1), 0);
    EXPECT_EQ(pool.image(holder.Bulb).Color, opaquePixel(1000));
}

TEST(RGBBulbCache, ThrowsOutTheFirstWithTheFewestHits) {
    // Beside it the plain rule: a scan of all 128 entries.
    struct Entry {
        std::int32_t color = -1;
        std::int32_t hits = 0;
    };
    std::vector<Entry> plain(128);
    ZephRGBBulbCache cache;
    SeededRandom random(5);
    for (int round = 0; round < 20000; ++round) {
        // Few colours at times, so that hits grow; many at others.
        const std::int32_t color = ZephReturnRandomNumber(0, round / 2000 % 2 == 0 ? 149 : 3999, random);
        const auto found =
            std::ranges::find_if(plain, [&](const Entry& at) { return at.hits > 0 && at.color == color; });
        const auto lowest = std::ranges::min_element(plain, {}, &Entry::hits);
        const std::int32_t entry = cache.find(color, 3, 4);
        if (found != plain.end()) {
            ASSERT_EQ(entry, found - plain.begin() + 1);
            ++found->hits;
            cache.countHit(entry);
        } else {
            ASSERT_EQ(entry, 0);
            ASSERT_EQ(cache.leastUsed(), lowest - plain.begin() + 1) << "round " << round;
            *lowest = {color, 1};
            cache.replace(cache.leastUsed(), color, 3, 4, 7);
        }
    }
    EXPECT_EQ(cache.find(1, 4, 3), 0);
}
