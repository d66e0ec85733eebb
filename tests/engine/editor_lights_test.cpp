#include "engine/editor_lights.h"

#include <memory>

namespace {

constexpr QRgb kWhitePixel = qRgb(255, 255, 255);

// A white canvas of 40 x 20 pixels and one square red bulb of radius 2 at (10, 10), level 1.
struct Bench {
    Bench() {
        for (std::size_t i = 0; i < curve.size(); ++i)
            curve[i] = static_cast<std::uint8_t>(i);
        ZephSetUpMasks(
            curve, [](std::string_view) {}, *masks);
        simulation->FixtureCount = 1;
        ZephFixture& first = fixture();
        first.Fixture_Type = kFixtureBulbs;
        first.Channel_Type = kChannelNormal;
        first.ZOrder = 1;
        first.BulbSize = 2;
        first.BulbShape = 3;
        first.Max_Opacity = 100;
        first.ChannelCount = 1;
        first.Channels[1].Color = 255;
        first.PointCount = 2;
        first.DrawPoints[1] = {kPointBulb, 10 * 15, 10 * 15};
        first.DrawPoints[2] = {kPointBulb, 30 * 15, 10 * 15};
        canvas.fill(Qt::white);
    }
    ZephFixture& fixture() { return simulation->Fixtures[1]; }
    QRgb drawnAt(int x, int y, int pixelNumber = 0) {
        canvas.fill(Qt::white);
        ZephRebuildStaticFixtureBulbs(*simulation, *masks, *bulbs);
        const EditorLights lights{*simulation, settings, curve, *bulbs};
        if (pixelNumber > 0) {
            ZephDrawLights(lights, 1, 1, 100, false, pixelNumber, canvas);
        } else {
            ZephDrawEditorLights(lights, 1, canvas);
        }
        return canvas.pixel(x, y);
    }

    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    ZephSettings settings;
    ZephDimmingCurve curve{};
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();
    QImage canvas{40, 20, QImage::Format_RGB32};
};

}  // namespace

TEST(EditorLights, ShowColourSilhouetteOrNothing) {
    struct Row {
        const char* name;
        bool editInColor;
        bool levelOpen;
        std::int32_t dimmed;
        QRgb expected;
    };
    // Dimmed 50 is level 127 of 255: a red bulb leaves 128 of the white behind it, a black one too.
    for (const Row& row :
         {Row{"colour", true, true, 50, qRgb(255, 0, 0)}, Row{"colour, dimmed", true, false, 50, qRgb(255, 128, 128)},
          Row{"colour, hidden", true, false, 0, kWhitePixel}, Row{"open beats hidden", true, true, 0, qRgb(255, 0, 0)},
          Row{"silhouette", false, true, 0, qRgb(0, 0, 0)},
          Row{"silhouette, dimmed", false, false, 50, qRgb(128, 128, 128)},
          Row{"silhouette, hidden", false, false, 0, kWhitePixel}}) {
        Bench bench;
        bench.settings.EditInColor = row.editInColor;
        bench.simulation->Levels[1].Edit_Enabled = row.levelOpen;
        bench.simulation->Dimmed = row.dimmed;
        EXPECT_EQ(bench.drawnAt(10, 10), row.expected) << row.name;
        EXPECT_EQ(bench.drawnAt(20, 10), kWhitePixel) << row.name;  // no bulb hangs here
    }
}

TEST(EditorLights, AFixtureWithoutChannelsIsASilhouette) {
    Bench bench;
    bench.fixture().ChannelCount = 0;
    EXPECT_EQ(bench.drawnAt(10, 10), qRgb(0, 0, 0));
}

TEST(EditorLights, AnRgbFixtureShowsItsSampleColour) {
    Bench bench;
    bench.fixture().Channel_Type = kChannelRgb;
    bench.fixture().ChannelCount = 3;
    bench.fixture().Sample = {0, 10, 200, 30};
    EXPECT_EQ(bench.drawnAt(10, 10), qRgb(10, 200, 30));
    bench.fixture().Fixture_Type = kFixtureKesh;  // never fills its channels
    bench.fixture().ChannelCount = 0;
    EXPECT_EQ(bench.drawnAt(30, 10), qRgb(10, 200, 30));
}

TEST(EditorLights, ASingleFlashedPixelStandsAlone) {
    Bench bench;
    EXPECT_EQ(bench.drawnAt(10, 10, 2), kWhitePixel);
    EXPECT_EQ(bench.drawnAt(30, 10, 2), qRgb(255, 0, 0));
    EXPECT_EQ(bench.drawnAt(10, 10, 3), qRgb(255, 0, 0));  // no such point: all of them
}

TEST(EditorLights, AFloodStopsAtItsOpacity) {
    Bench bench;
    bench.fixture().Fixture_Type = kFixtureFlood;
    bench.fixture().BulbSize = 9;
    const QRgb full = bench.drawnAt(10, 10);
    bench.fixture().Max_Opacity = 20;
    const QRgb capped = bench.drawnAt(10, 10);
    EXPECT_LT(qGreen(full), 30);
    EXPECT_GT(qGreen(capped), 190);  // level 51: at least four fifths of the white shine through
}

TEST(EditorLights, BulbsOfAStringTakeTurns) {
    Bench bench;
    ZephFixture& string = bench.fixture();
    string.Fixture_Type = kFixtureStrings;
    string.BulbSpacing = 6;  // a pitch of 10
    string.DrawPoints[1] = {kPointMove, 5 * 15, 10 * 15};
    string.DrawPoints[2] = {kPointLine, 39 * 15, 10 * 15};
    string.ChannelCount = 2;
    string.Channels[2].Color = 255 * 256;
    EXPECT_EQ(bench.drawnAt(5, 10), qRgb(255, 0, 0));
    EXPECT_EQ(bench.drawnAt(15, 10), qRgb(0, 255, 0));
    EXPECT_EQ(bench.drawnAt(25, 10), qRgb(255, 0, 0));
}
