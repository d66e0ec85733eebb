#include "engine/standard_surface.h"
#include "tests/support/hand_tables.h"
#include "tests/support/reference_surface.h"
#include "util/color.h"
#include "util/random_source.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <memory>
#include <optional>
#include <vector>

namespace {

class SilentReport : public FailureReport {
public:
    void ErrReport(std::string_view, std::string_view, int) override { ++count; }
    int count = 0;
};

const ZephMasks& masks() {
    static const std::unique_ptr<ZephMasks> made = [] {
        auto all = std::make_unique<ZephMasks>();
        ZephDimmingCurve curve;
        for (std::size_t i = 0; i < curve.size(); ++i)
            curve[i] = static_cast<std::uint8_t>(i);
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *all);
        return all;
    }();
    return *made;
}

QImage noisyPicture(int width, int height, SeededRandom& random) {
    QImage picture(width, height, QImage::Format_RGB32);
    for (int y = 0; y < height; ++y) {
        for (int x = 0; x < width; ++x)
            picture.setPixel(x, y, 0xFF000000U | static_cast<unsigned>(ZephReturnRandomNumber(0, kWhite, random)));
    }
    return picture;
}

// A document with everything that a surface needs, and a table copy for each surface that draws it.
struct Stage {
    std::unique_ptr<ZephSimulation> document = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    ZephRenderTables tables;
    QImage background;

    ZephFixture& add(std::int32_t type, std::int32_t channelType, std::int32_t size, std::int32_t shape) {
        ZephFixture& fixture = document->Fixtures[++document->FixtureCount];
        fixture.Fixture_Type = type;
        fixture.Channel_Type = channelType;
        fixture.BulbSize = size;
        fixture.BulbShape = shape;
        fixture.ChannelCount = channelType == kChannelRgb ? 3 : 1;
        fixture.ZOrder = 1;
        return fixture;
    }

    static void addPoint(ZephFixture& fixture, std::int32_t type, std::int32_t xPixels, std::int32_t yPixels) {
        fixture.DrawPoints[++fixture.PointCount] = {type, xPixels * TwipsPerPixelX, yPixels * TwipsPerPixelY};
    }

    void finish() {
        buildHandTables(*document, tables, *states);
        ZephRebuildStaticFixtureBulbs(*document, masks(), *bulbs);
    }

    SurfaceScene scene(const ZephRenderTables& used) const {
        return {*document, used, *states, masks(), *bulbs, background};
    }
};

struct Call {
    std::optional<ChannelDraw> channel;
    std::optional<GroupDraw> group;
    std::vector<std::uint8_t> lit;
    std::vector<std::int32_t> list;
    std::array<std::int32_t, 4> levels{};
};

void play(const std::vector<Call>& calls, ZephRenderTables& tables, LightSurface& surface) {
    surface.beginFrame();
    for (const Call& call : calls) {
        if (call.channel) {
            ChannelDraw draw = *call.channel;
            draw.BulbLit = call.lit.empty() ? nullptr : call.lit.data();
            surface.drawChannel(draw);
        } else {
            GroupDraw draw = *call.group;
            if (draw.BulbCount > 0) draw.Bulbs = call.list.data();
            ZephRGBData& group = tables.RGBData[static_cast<std::size_t>(draw.RGBIndex)];
            group.Level = call.levels;
            surface.drawGroup(draw, group);
        }
    }
    surface.endFrame();
}

class RandomStage : public Stage {
public:
    explicit RandomStage(std::uint64_t seed) : random_(seed) {
        background = noisyPicture(pick(1, 3) == 1 ? 97 : 260, pick(20, 170), random_);
        for (int n = pick(1, 25); n > 0; --n)
            addRandomFixture();
        finish();
    }

    // The calls of one frame in the order of the render cycle; share is how many of a hundred channels are lit.
    std::vector<Call> frame(int share) {
        std::vector<Call> calls;
        for (std::int32_t level = 1; level <= kLevels; ++level) {
            for (const ZephRenderSlot& slot : tables.Slots) {
                if (slot.Level == level && !slot.isRGB() && pick(1, 100) <= share) calls.push_back(channelCall(slot));
            }
            for (const ZephRenderSlot& slot : tables.Slots) {
                if (slot.Level == level && slot.isRGB() && slot.Channel == 1 && pick(1, 100) <= share) {
                    calls.push_back(groupCall(slot));
                }
            }
        }
        return calls;
    }

    std::int32_t pick(std::int32_t low, std::int32_t high) { return ZephReturnRandomNumber(low, high, random_); }
    SeededRandom& random() { return random_; }

private:
    void addRandomFixture() {
        const std::int32_t type = pick(1, 5);
        const bool rgb = type >= kFixtureKesh || pick(1, 3) == 1;
        const std::int32_t size = type == kFixtureFlood ? pick(0, 66) : pick(1, 3) == 1 ? pick(0, 17) : pick(1, 4);
        ZephFixture& fixture = add(type, rgb ? kChannelRgb : kChannelNormal, size, pick(0, 60) == 0 ? 99 : pick(1, 11));
        fixture.ZOrder = pick(1, 4);
        fixture.BulbSpacing = pick(0, 4);
        if (type == kFixtureStrings && !rgb) fixture.ChannelCount = pick(1, 5);
        for (std::int32_t c = 1; c <= fixture.ChannelCount; ++c) {
            fixture.Channels[c].Color = pick(0, kWhite);
            if (!rgb) fixture.Channels[c].Sub_Type = pick(0, 2);
            fixture.Channels[c].Sub_Parm = pick(-1, 7);
            for (std::int32_t k = 1; k <= kMaxMultiColors; ++k)
                fixture.Channels[c].Multi[k] = pick(0, kWhite);
        }
        for (int points = pick(1, 30); points > 0; --points) {
            const std::int32_t kind = type == kFixtureStrings ? (pick(1, 5) == 1 ? kPointMove : kPointLine)
                                      : pick(1, 8) == 1       ? kPointPlaceHolder
                                                              : kPointBulb;
            const bool far = type != kFixtureStrings && pick(1, 20) == 1;
            const std::int32_t reach = far ? 140'000'000 : 70;
            addPoint(fixture, kind, pick(-reach, background.width() + reach / 2),
                     pick(-reach, background.height() + reach / 2));
        }
    }

    Call channelCall(const ZephRenderSlot& slot) {
        Call call;
        call.channel = ChannelDraw{slot.Level, slot.Fixture, slot.Channel, 0, randomAlpha()};
        if (document->Fixtures[slot.Fixture].Channels[slot.Channel].Sub_Type == kSpecialStrobes) {
            const ZephFixtureState& state = (*states)[slot.Fixture];
            call.lit.resize(
                static_cast<std::size_t>(state.BulbLocations[static_cast<std::size_t>(slot.Channel)].Count + 1));
            for (std::uint8_t& bulb : call.lit)
                bulb = static_cast<std::uint8_t>(pick(0, 1));
        }
        return call;
    }

    Call groupCall(const ZephRenderSlot& slot) {
        Call call;
        const std::int32_t type = document->Fixtures[slot.Fixture].Fixture_Type;
        call.group = GroupDraw{slot.Level, slot.Fixture, slot.RGBIndex, slot.Triplet, pick(1, kWhite), randomAlpha()};
        for (std::size_t c = 1; c <= 3; ++c)
            call.levels[c] = pick(0, 40);
        if (type == kFixtureDmxPixels) call.list = {slot.Triplet - 1000};
        if (type == kFixtureKesh) {
            for (int n = pick(1, 6); n > 0; --n)
                call.list.push_back(pick(-1, 32));
        }
        call.group->BulbCount = static_cast<std::int32_t>(call.list.size());
        return call;
    }

    std::uint8_t randomAlpha() {
        const std::int32_t kind = pick(1, 4);
        return static_cast<std::uint8_t>(kind == 1 ? 255 : kind == 2 ? pick(0, 2) : pick(0, 255));
    }

    SeededRandom random_;
};

// Pixels that differ from what was there before must lie within the rectangles told.
bool changesAreTold(const QImage& before, const StandardSurface& surface) {
    const QImage& after = surface.image();
    for (int y = 0; y < after.height(); ++y) {
        for (int x = 0; x < after.width(); ++x) {
            if (before.pixel(x, y) == after.pixel(x, y)) continue;
            const auto holds = [&](const QRect& rect) { return rect.contains(x, y); };
            if (std::none_of(surface.changedRects().begin(), surface.changedRects().end(), holds)) return false;
        }
    }
    return true;
}

void comparePictures(std::uint64_t seed, const BlendKernels& kernels) {
    RandomStage stage(seed);
    ZephRenderTables fastTables = stage.tables;
    ZephRenderTables plainTables = stage.tables;
    SilentReport report;
    StandardSurface fast(kernels);
    ASSERT_TRUE(fast.prepare(stage.scene(fastTables), report));
    ReferenceSurface plain(stage.scene(plainTables));

    std::vector<Call> calls;
    for (int n = 0; n < 10; ++n) {
        constexpr std::array kShares{100, 5, 40, 0, 90};
        const std::int32_t kind = stage.pick(1, 6);
        if (kind > 1) calls = stage.frame(kShares[static_cast<std::size_t>(stage.pick(0, 4))]);
        if (kind == 2 && calls.size() > 1) std::reverse(calls.begin(), calls.end());
        if (kind == 3) calls.insert(calls.end(), calls.begin(), calls.begin() + std::ssize(calls) / 2);
        if (kind == 4 && n > 4) {
            stage.background = noisyPicture(stage.background.width(), stage.background.height(), stage.random());
            ASSERT_TRUE(fast.setBackground(stage.background));
            plain.setBackground(stage.background);
        }
        const QImage before = fast.image().copy();
        play(calls, fastTables, fast);
        play(calls, plainTables, plain);
        ASSERT_EQ(fast.image(), plain.image()) << "seed " << seed << " frame " << n << " kind " << kind;
        ASSERT_TRUE(changesAreTold(before, fast)) << "seed " << seed << " frame " << n;
    }
}

}  // namespace

TEST(StandardSurface, ShowsTheSamePixelsAsTheReference) {
    for (std::uint64_t seed = 1; seed <= 120; ++seed) {
        comparePictures(seed, fastestBlendKernels());
        if (HasFatalFailure()) return;
    }
    for (std::uint64_t seed = 121; seed <= 140; ++seed) {
        comparePictures(seed, blendKernels(BlendForm::Portable));
        if (HasFatalFailure()) return;
    }
}

TEST(StandardSurface, TellsNothingWhileThePictureStaysAndOnlyTheBulbThatMoved) {
    Stage stage;
    stage.background = QImage(400, 300, QImage::Format_RGB32);
    stage.background.fill(0xFF102030U);
    for (const std::int32_t x : {20, 300}) {
        ZephFixture& fixture = stage.add(kFixtureBulbs, kChannelNormal, 2, 1);
        fixture.Channels[1].Color = packColor(255, 0, 0);
        Stage::addPoint(fixture, kPointBulb, x, 100);
    }
    stage.finish();
    SilentReport report;
    StandardSurface surface;
    ASSERT_TRUE(surface.prepare(stage.scene(stage.tables), report));
    const auto frame = [&](std::uint8_t first, std::uint8_t second) {
        surface.beginFrame();
        surface.drawChannel({1, 1, 1, 0, first});
        surface.drawChannel({1, 2, 1, 0, second});
        surface.endFrame();
        return std::vector<QRect>(surface.changedRects().begin(), surface.changedRects().end());
    };
    EXPECT_EQ(frame(0, 0), std::vector<QRect>{QRect(0, 0, 400, 300)});  // the picture is new
    EXPECT_EQ(frame(0, 0).size(), 0U);
    EXPECT_GT(frame(255, 128).size(), 0U);
    EXPECT_EQ(frame(255, 128).size(), 0U);
    EXPECT_EQ(surface.image().pixel(20, 100), 0xFFFF0000U);
    EXPECT_EQ(surface.image().pixel(300, 100), 0xFF881018U);  // (16 x 127 + 255 x 128) / 255 = 135.97, 15.9, 23.9
    frame(0, 0);
    EXPECT_EQ(surface.image(), stage.background);
}

TEST(StandardSurface, RefusesACanvasOrTablesThatItCannotDraw) {
    Stage stage;
    ZephFixture& fixture = stage.add(kFixtureBulbs, kChannelRgb, 2, 1);
    Stage::addPoint(fixture, kPointBulb, 5, 5);
    stage.finish();
    SilentReport report;
    StandardSurface surface;
    const auto prepared = [&](int width, int height, std::int32_t handle) {
        stage.background = QImage(width, height, QImage::Format_RGB32);
        stage.tables.RGBData[1].Bulb = handle;
        return surface.prepare(stage.scene(stage.tables), report);
    };
    EXPECT_FALSE(prepared(0, 0, 0));
    EXPECT_FALSE(prepared(2501, 10, 0));
    EXPECT_FALSE(prepared(10, 10, 3));
    EXPECT_EQ(report.count, 3);
    surface.beginFrame();  // unprepared: nothing happens
    surface.drawGroup({1, 1, 1, 0, kWhite, 255}, stage.tables.RGBData[1]);
    surface.endFrame();
    EXPECT_TRUE(surface.image().isNull());
    EXPECT_TRUE(prepared(2500, 1, 0));
    EXPECT_FALSE(surface.setBackground(QImage(9, 9, QImage::Format_RGB32)));
}
