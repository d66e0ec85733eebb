#include "engine/editor_lights.h"
#include "util/color.h"
#include "util/units.h"

#include <gtest/gtest.h>

#include <memory>
#include <string>

namespace {

constexpr std::int32_t kRed = packColor(255, 0, 0);
constexpr std::int32_t kGreen = packColor(0, 255, 0);
constexpr std::int32_t kBlue = packColor(0, 0, 255);

// One fixture with bulbs of 2 x 2 pixels on a white canvas of 20 x 6.
struct Desk {
    std::unique_ptr<ZephSimulation> document = std::make_unique<ZephSimulation>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    ZephDimmingCurve curve;
    QImage canvas{20, 6, QImage::Format_RGB32};
    ZephFixture& fixture;
    bool inColor = true;

    explicit Desk(std::int32_t type) : fixture(document->Fixtures[1]) {
        for (std::size_t i = 0; i < curve.size(); ++i)
            curve[i] = static_cast<std::uint8_t>(i);
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *masks);
        document->FixtureCount = 1;
        fixture.Fixture_Type = type;
        fixture.Channel_Type = kChannelNormal;
        fixture.BulbSize = 1;
        fixture.BulbShape = 1;
        fixture.ZOrder = 1;
        fixture.Max_Opacity = 100;
    }
    void addPoint(std::int32_t type, std::int32_t x, std::int32_t y) {
        fixture.DrawPoints[++fixture.PointCount] = {type, x * TwipsPerPixelX, y * TwipsPerPixelY};
    }
    ZephChannel& addChannel(std::int32_t color) {
        ZephChannel& channel = fixture.Channels[++fixture.ChannelCount];
        channel.Color = color;
        return channel;
    }
    void prepare() {
        canvas.fill(0xFFFFFFFFU);
        ZephRebuildStaticFixtureBulbs(*document, *masks, *bulbs);
    }
    EditorLightsContext context() const { return {*document, *bulbs, curve, inColor}; }

    // Row 3 of the canvas: '.' white, r g b, k black, '?' anything else.
    std::string drawn() {
        prepare();
        ZephDrawEditorLights(context(), 1, canvas);
        return row();
    }
    std::string row() const {
        std::string text;
        for (int x = 0; x < canvas.width(); ++x) {
            const QRgb pixel = canvas.pixel(x, 3);
            text += pixel == 0xFFFFFFFFU   ? '.'
                    : pixel == 0xFFFF0000U ? 'r'
                    : pixel == 0xFF00FF00U ? 'g'
                    : pixel == 0xFF0000FFU ? 'b'
                    : pixel == 0xFF000000U ? 'k'
                                           : '?';
        }
        return text;
    }
};

}  // namespace

TEST(EditorLights, StringsShowTheirChannelsInTurnOrASilhouetteOfTheFirst) {
    Desk desk(kFixtureStrings);
    desk.fixture.BulbSpacing = 2;  // a bulb every 4 pixels
    desk.addPoint(kPointMove, 2, 3);
    desk.addPoint(kPointLine, 18, 3);
    desk.addChannel(kRed);
    desk.addChannel(kGreen);
    EXPECT_EQ(desk.drawn(), ".rr..gg..rr..gg.....");
    desk.inColor = false;
    EXPECT_EQ(desk.drawn(), ".kk......kk.........");
    desk.inColor = true;
    desk.fixture.ChannelCount = 0;
    EXPECT_EQ(desk.drawn(), ".kk..kk..kk..kk.....");
}

TEST(EditorLights, MultiColorStepsWithTheWalkAndBeginsAnewAtAStroke) {
    Desk desk(kFixtureStrings);
    desk.addPoint(kPointMove, 1, 3);
    desk.addPoint(kPointLine, 11, 3);  // five bulbs
    desk.addPoint(kPointMove, 14, 3);
    desk.addPoint(kPointLine, 18, 3);
    ZephChannel& channel = desk.addChannel(0);
    channel.Sub_Type = kSpecialMultiColor;
    channel.Sub_Parm = 3;
    channel.Multi[1] = kRed;
    channel.Multi[2] = kGreen;
    channel.Multi[3] = kBlue;
    EXPECT_EQ(desk.drawn(), "rrggbbrrgg...rrgg...");
}

TEST(EditorLights, PointsAreCutAtTheEdgesAndPlaceHoldersAreNotShown) {
    Desk desk(kFixtureDmxPixels);
    desk.fixture.Channel_Type = kChannelRgb;
    desk.fixture.Sample = {0, 0, 0, 255};
    desk.addPoint(kPointBulb, 0, 3);
    desk.addPoint(kPointPlaceHolder, 5, 3);
    desk.addPoint(kPointBulb, 8, 3);
    desk.addPoint(kPointBulb, 20, 3);
    desk.addPoint(kPointBulb, 100'000'000, 3);
    EXPECT_EQ(desk.drawn(), "b......bb..........b");

    desk.prepare();
    ZephDrawLights(desk.context(), {.Fixture = 1, .Intensity = 100, .PixelNumber = 3}, desk.canvas);
    EXPECT_EQ(desk.row(), ".......bb...........");
    desk.prepare();
    ZephDrawLights(desk.context(), {.Fixture = 1, .Intensity = 100, .PixelNumber = 6}, desk.canvas);
    EXPECT_EQ(desk.row(), "b......bb..........b");  // there is no such point
}

TEST(EditorLights, LevelsClosedToEditingAreDimmedOrHidden) {
    Desk desk(kFixtureBulbs);
    desk.addPoint(kPointBulb, 8, 3);
    desk.addChannel(kRed);
    desk.document->Levels[1].Edit_Enabled = false;
    EXPECT_EQ(desk.drawn(), "....................");
    desk.document->Dimmed = 40;  // level 102
    EXPECT_EQ(desk.drawn(), ".......??...........");
    EXPECT_EQ(desk.canvas.pixel(8, 3), 0xFFFF9999U);  // 255 - 102
    desk.document->Dimmed = 4000;
    EXPECT_EQ(desk.drawn(), ".......rr...........");
    desk.fixture.ZOrder = 99;
    desk.document->Dimmed = 0;
    EXPECT_EQ(desk.drawn(), ".......rr...........");
}

TEST(EditorLights, AFloodNeverPassesItsTopOpacity) {
    Desk desk(kFixtureFlood);
    desk.fixture.BulbSize = 2;  // one ring, fully covered
    desk.fixture.Max_Opacity = 40;
    desk.addPoint(kPointBulb, 8, 3);
    desk.addChannel(kRed);
    desk.drawn();
    EXPECT_EQ(desk.canvas.pixel(8, 3), 0xFFFF9999U);
}

TEST(EditorLights, WrongNumbersFormatsAndSizesDrawNothing) {
    Desk desk(kFixtureBulbs);
    desk.addPoint(kPointBulb, 8, 3);
    desk.addChannel(kRed);
    desk.prepare();
    ZephDrawEditorLights(desk.context(), 0, desk.canvas);
    ZephDrawEditorLights(desk.context(), 2, desk.canvas);
    ZephDrawLights(desk.context(), {.Fixture = 1, .Channel = 17, .Intensity = 100}, desk.canvas);
    EXPECT_EQ(desk.row(), "....................");
    QImage gray(20, 6, QImage::Format_Grayscale8);
    gray.fill(7);
    ZephDrawEditorLights(desk.context(), 1, gray);
    EXPECT_EQ(gray.pixelColor(8, 3).red(), 7);
    desk.fixture.BulbSize = 40;
    EXPECT_EQ(desk.drawn(), "....................");
}
