#include "editor/canvas_drawing.h"

#include <memory>

// Two bulbs of one place: the level decides which covers which, then the number.
TEST(CanvasDrawing, CoversByLevelThenByNumber) {
    const auto simulation = std::make_unique<ZephSimulation>();
    const auto masks = std::make_unique<ZephMasks>();
    const auto bulbs = std::make_unique<ZephStaticBulbs>();
    ZephDimmingCurve curve{};
    curve.fill(255);
    ZephSetUpMasks(
        curve, [](std::string_view) {}, *masks);
    simulation->FixtureCount = 2;
    for (const int number : {1, 2}) {
        ZephFixture& fixture = simulation->Fixtures[number];
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.Channel_Type = kChannelNormal;
        fixture.BulbSize = 3;
        fixture.BulbShape = 3;
        fixture.ChannelCount = 1;
        fixture.Channels[1].Color = number == 1 ? 255 : 255 * 65536;
        fixture.PointCount = 1;
        fixture.DrawPoints[1] = {kPointBulb, 10 * 15, 10 * 15};
        fixture.ZOrder = 4;
    }
    ZephRebuildStaticFixtureBulbs(*simulation, *masks, *bulbs);
    QImage background(20, 20, QImage::Format_RGB32);
    background.fill(Qt::gray);
    const QRgb gray = background.pixel(0, 0);
    QImage buffer;
    const ZephSettings settings;
    const EditorCanvas canvas{*simulation, settings, curve, *bulbs, background};
    ZephRedrawObjects(canvas, buffer);
    EXPECT_EQ(buffer.pixel(10, 10), qRgb(0, 0, 255));
    simulation->Fixtures[1].ZOrder = 16;
    ZephRedrawObjects(canvas, buffer);
    EXPECT_EQ(buffer.pixel(10, 10), qRgb(255, 0, 0));
    EXPECT_EQ(buffer.pixel(0, 0), gray);
    EXPECT_EQ(background.pixel(10, 10), gray);  // never drawn on
    background = QImage();
    ZephRedrawObjects(canvas, buffer);
    EXPECT_TRUE(buffer.isNull());
}
