#include "engine/rgb_bulbs.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"
#include "util/color.h"
#include "util/random_source.h"

namespace {

// Groups of one fixture.
struct Groups {
    ZephFixture fixture;
    ZephRGBBulbCache cache;
    RGBBulbPool pool;

    Groups() {
        InitializeFixture({}, fixture);
        fixture.Fixture_Type = kFixtureBulbs;
        pool.reserve(4, 1, 64);
    }
    void update(std::int32_t color, ZephRGBData& group) {
        ZephUpdateRGBChannelBulb(fixture, color, masks(), cache, pool, group);
    }
};

}  // namespace

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
    ZephRGBData holder;
    groups.update(1000, holder);
    for (std::int32_t color = 2001; color <= 2400; ++color)
        groups.update(color, other);
    EXPECT_EQ(groups.cache.find(1000, 2, 1), 0);
    EXPECT_EQ(groups.pool.image(holder.Bulb).Color, opaquePixel(1000));

    groups.fixture.BulbSize = 17;  // no mask, no image
    ZephRGBData none;
    groups.update(kWhite, none);
    EXPECT_EQ(none.Bulb, 0);
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
