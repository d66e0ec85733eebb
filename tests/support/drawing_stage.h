// Displays for tests of drawing surfaces: small ones, and random ones with everything that a file may hold, together
// with the calls of their frames.
#pragma once

#include "engine/opengl_surface.h"
#include "engine/standard_surface.h"
#include "tests/support/compiled_display.h"
#include "tests/support/masks.h"
#include "util/color.h"
#include "util/random_source.h"

#include <array>
#include <optional>

// A display with the images of its bulbs, on a picture; each surface that draws it takes a copy of the tables.
struct Stage : CompiledDisplay {
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    QImage background;

    // A fixture of plain look with one channel, or three circuits, on a unit of its own.
    ZephFixture& addLit(std::int32_t type, std::int32_t size, std::int32_t shape, std::initializer_list<Place> places,
                        std::int32_t color = kWhite) {
        ZephFixture& fixture = add(type, places);
        fixture.BulbSize = size;
        fixture.BulbShape = shape;
        addChannel(fixture, simulation->FixtureCount, 1, color);
        return fixture;
    }

    void finish() {
        build();
        ZephRebuildStaticFixtureBulbs(*simulation, masks(), *bulbs);
    }
    void blank(int width, int height, QRgb color = qRgb(0, 0, 0)) {
        background = QImage(width, height, QImage::Format_RGB32);
        background.fill(color);
    }

    GLScene glScene(const QImage& picture, std::int32_t intensity = 100) const {
        return {*simulation,        tables, *states, curve, masks().GLShapes, picture, intensity, background.width(),
                background.height()};
    }
    SurfaceScene scene(const ZephRenderTables& used) const {
        return {*simulation, used, *states, masks(), *bulbs, background};
    }
};

struct Call {
    std::optional<ChannelDraw> channel;
    std::optional<GroupDraw> group;
    std::vector<std::uint8_t> lit;
    std::vector<std::int32_t> list;
    std::array<std::int32_t, 4> levels{};
};

inline void play(const std::vector<Call>& calls, ZephRenderTables& tables, LightSurface& surface) {
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
    // everyShape: every size, shape and fixture type, odd ones too; otherwise squares that are no floods, of which
    // every way of drawing covers the same pixels.
    explicit RandomStage(std::uint64_t seed, bool everyShape = true) : everyShape_(everyShape), random_(seed) {
        blank(pick(1, 3) == 1 ? 97 : 420, pick(20, 170));
        newBackground();
        for (int n = pick(1, 25); n > 0; --n)
            addRandomFixture();
        finish();
    }

    // The calls of one frame in the order of the render cycle; share is how many of a hundred channels are lit.
    std::vector<Call> frame(int share) {
        std::vector<Call> calls;
        for (std::int32_t level = 1; level <= kLevels; ++level) {
            for (const ZephRenderSlot& slot : tables.Slots) {
                const bool plain = !slot.isRGB() && slot.KeshMagic == 0;
                if (slot.Level == level && plain && pick(1, 100) <= share) calls.push_back(channelCall(slot));
            }
            for (const ZephRenderSlot& slot : tables.Slots) {
                if (slot.Level == level && slot.isRGB() && slot.Channel == 1 && pick(1, 100) <= share) {
                    calls.push_back(groupCall(slot));
                }
            }
        }
        return calls;
    }

    // Makes the calls of the next frame out of those of the last one. Returns how: 1 the same, 2 in another order, 3
    // half of them twice, 4 to 6 others, 7 and 8 two in three at other strengths.
    int nextFrame(std::vector<Call>& calls) {
        constexpr std::array kShares{100, 5, 40, 0, 90};
        const std::int32_t kind = pick(1, 8);
        if (kind > 1 && kind < 7) calls = frame(kShares[static_cast<std::size_t>(pick(0, 4))]);
        for (std::size_t i = calls.size(); kind == 2 && i > 1; --i)
            std::swap(calls[i - 1], calls[static_cast<std::size_t>(pick(0, static_cast<int>(i) - 1))]);
        const std::vector<Call> half(calls.begin(), calls.begin() + std::ssize(calls) / 2);
        if (kind == 3) calls.insert(calls.end(), half.begin(), half.end());
        for (Call& call : calls) {
            if (kind < 7 || pick(1, 3) == 1) continue;
            const auto alpha = static_cast<std::uint8_t>(pick(1, 255));
            if (call.channel) call.channel->Alpha = alpha;
            if (call.group && call.group->Alpha != 0) call.group->Alpha = alpha;
        }
        return kind;
    }

    std::int32_t pick(std::int32_t low, std::int32_t high) { return ZephReturnRandomNumber(low, high, random_); }
    void newBackground() {
        for (int place = 0; place < background.width() * background.height(); ++place) {
            const QPoint at(place % background.width(), place / background.width());
            background.setPixel(at, 0xFF000000U | static_cast<unsigned>(pick(0, kWhite)));
        }
    }

private:
    void addRandomFixture() {
        const std::int32_t drawn = pick(1, 5);
        const std::int32_t type = drawn == kFixtureFlood && !everyShape_ ? kFixtureBulbs : drawn;
        const bool rgb = type >= kFixtureKesh || pick(1, 3) == 1;
        ZephFixture& fixture = add(type, {});
        const std::int32_t unit = simulation->FixtureCount;
        fixture.BulbSize = type == kFixtureFlood ? pick(-1, 66) : pick(1, 3) == 1 ? pick(-1, 17) : pick(1, 4);
        fixture.BulbShape = pick(0, 60) == 0 ? 99 : everyShape_ ? pick(0, 12) : 3;
        fixture.ZOrder = pick(1, 4);
        fixture.BulbSpacing = pick(0, 4);
        fixture.Kesh.Base_Unit = fixture.DMX.Universe = unit;
        if (type < kFixtureKesh && rgb) makeRgb(fixture, unit, 1);
        if (!rgb) addRandomChannels(fixture, unit);
        for (int points = pick(1, 30); points > 0; --points) {
            const std::int32_t kind = type == kFixtureStrings ? (pick(1, 5) == 1 ? kPointMove : kPointLine)
                                      : pick(1, 8) == 1       ? kPointPlaceHolder
                                                              : kPointBulb;
            const std::int32_t reach = type != kFixtureStrings && pick(1, 20) == 1 ? 140'000'000 : 70;
            addPoint(fixture, kind,
                     {pick(-reach, background.width() + reach / 2), pick(-reach, background.height() + reach / 2)});
        }
    }

    void addRandomChannels(ZephFixture& fixture, std::int32_t unit) {
        for (int count = fixture.Fixture_Type == kFixtureStrings ? pick(1, 5) : 1; count > 0; --count) {
            ZephChannel& channel = addChannel(fixture, unit, count, pick(0, kWhite));
            channel.Sub_Type = pick(0, 2);
            channel.Sub_Parm = pick(-1, 7);
            for (std::int32_t& color : channel.Multi)
                color = pick(0, kWhite);
        }
    }

    Call channelCall(const ZephRenderSlot& slot) {
        Call call;
        call.channel = ChannelDraw{slot.Level, slot.Fixture, slot.Channel, 0, randomAlpha()};
        if (simulation->Fixtures[slot.Fixture].Channels[slot.Channel].Sub_Type == kSpecialStrobes) {
            const std::int32_t bulbCount = bulbLocations((*states)[slot.Fixture], slot.Channel)->Count;
            call.lit.resize(static_cast<std::size_t>(bulbCount + 1));
            for (std::uint8_t& bulb : call.lit)
                bulb = static_cast<std::uint8_t>(pick(0, 1));
        }
        return call;
    }

    Call groupCall(const ZephRenderSlot& slot) {
        Call call;
        const std::int32_t type = simulation->Fixtures[slot.Fixture].Fixture_Type;
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

    bool everyShape_;
    SeededRandom random_;
};
