#include "engine/editor_lights.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"
#include "util/color.h"

#include <map>

namespace {

constexpr std::int32_t kRed = packColor(255, 0, 0);
constexpr std::int32_t kGreen = packColor(0, 255, 0);

// One fixture with bulbs of 2 x 2 pixels on a white canvas of 20 x 6.
struct Desk {
    std::unique_ptr<ZephSimulation> document = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    QImage canvas{20, 6, QImage::Format_RGB32};
    ZephFixture& fixture;
    bool inColor = true;

    Desk(std::int32_t type, std::initializer_list<Place> places) : fixture(addFixture(*document, type, places)) {
        fixture.BulbSize = 1;
        fixture.BulbSpacing = 0;
        fixture.Max_Opacity = 100;
    }
    ZephChannel& light(std::int32_t color) { return addChannel(fixture, 1, 1, color); }
    void prepare() {
        canvas.fill(0xFFFFFFFFU);
        ZephRebuildStaticFixtureBulbs(*document, masks(), *bulbs);
    }
    EditorLightsContext context() const { return {*document, *bulbs, curve, inColor}; }

    // Row 3 of the canvas: '.' white, r g b, k black, '?' anything else.
    inline static const std::map<QRgb, char> kNamed{
        {0xFFFFFFFFU, '.'}, {0xFFFF0000U, 'r'}, {0xFF00FF00U, 'g'}, {0xFF0000FFU, 'b'}, {0xFF000000U, 'k'}};
    std::string drawn(std::int32_t fixtureNumber = 1) {
        prepare();
        ZephDrawEditorLights(context(), fixtureNumber, canvas);
        return row();
    }
    std::string row() const {
        std::string text;
        for (int x = 0; x < canvas.width(); ++x) {
            const auto known = kNamed.find(canvas.pixel(x, 3));
            text += known == kNamed.end() ? '?' : known->second;
        }
        return text;
    }
};

}  // namespace

TEST(EditorLights, StringsShowTheirChannelsInTurnOrASilhouetteOfTheFirst) {
    Desk desk(kFixtureStrings, {{2, 3}, {18, 3}});
    desk.fixture.BulbSpacing = 2;  // a bulb every 4 pixels
    desk.light(kRed);
    desk.light(kGreen);
    EXPECT_EQ(desk.drawn(), ".rr..gg..rr..gg.....");
    desk.inColor = false;
    EXPECT_EQ(desk.drawn(), ".kk......kk.........");
    desk.inColor = true;
    desk.fixture.ChannelCount = 0;
    EXPECT_EQ(desk.drawn(), ".kk..kk..kk..kk.....");
}

TEST(EditorLights, PointsAreCutAtTheEdgesAndPlaceHoldersAreNotShown) {
    Desk desk(kFixtureDmxPixels, {{0, 3}, {5, 3}, {8, 3}, {20, 3}, {100'000'000, 3}});
    desk.fixture.DrawPoints[2].Type = kPointPlaceHolder;
    desk.fixture.Sample = {0, 0, 0, 255};
    EXPECT_EQ(desk.drawn(), "b......bb..........b");
    EXPECT_EQ(desk.canvas.pixel(0, 4), 0xFFFFFFFFU) << "what is cut at the right does not come in again at the left";
    const auto point = [&](std::int32_t number) {
        desk.prepare();
        ZephDrawLights(desk.context(), {.Fixture = 1, .Intensity = 100, .PixelNumber = number}, desk.canvas);
        return desk.row();
    };
    EXPECT_EQ(point(3), ".......bb...........");
    EXPECT_EQ(point(6), "b......bb..........b");  // there is no such point

    Desk high(kFixtureBulbs, {{8, -1}, {8, 0}, {8, 6}, {8, 7}});
    high.light(kRed);
    high.drawn();
    for (const auto& [y, red] : {std::pair{0, true}, {1, false}, {4, false}, {5, true}})
        EXPECT_EQ(high.canvas.pixel(8, y), red ? 0xFFFF0000U : 0xFFFFFFFFU) << y;
}

TEST(EditorLights, ClosedLevelsAreDimmedOrHiddenAndFloodsNeverPassTheirTopOpacity) {
    Desk desk(kFixtureBulbs, {{8, 3}});
    desk.light(kRed);
    desk.document->Levels[1].Edit_Enabled = false;
    EXPECT_EQ(desk.drawn(), "....................");
    desk.document->Dimmed = 40;  // level 102
    desk.drawn();
    EXPECT_EQ(desk.canvas.pixel(8, 3), 0xFFFF9999U);  // 255 - 102
    desk.document->Dimmed = 4000;
    EXPECT_EQ(desk.drawn(), ".......rr...........");
    desk.fixture.ZOrder = 99;
    desk.document->Dimmed = 0;
    EXPECT_EQ(desk.drawn(), ".......rr...........");

    Desk flood(kFixtureFlood, {{8, 3}});
    flood.fixture.BulbSize = 2;  // one ring, fully covered
    flood.fixture.Max_Opacity = 40;
    flood.light(kRed);
    flood.drawn();
    EXPECT_EQ(flood.canvas.pixel(8, 3), 0xFFFF9999U);
}
