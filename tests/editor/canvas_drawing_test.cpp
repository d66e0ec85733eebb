#include "editor/canvas_drawing.h"
#include "tests/support/fixtures.h"
#include "tests/support/masks.h"

// Two bulbs of one place: the level decides which covers which, then the number.
TEST(CanvasDrawing, CoversByLevelThenByNumber) {
    const auto simulation = std::make_unique<ZephSimulation>();
    const auto bulbs = std::make_unique<ZephStaticBulbs>();
    const ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    for (const std::int32_t color : {255, 255 * 65536}) {
        ZephFixture& fixture = addFixture(*simulation, kFixtureBulbs, {{10, 10}});
        fixture.ZOrder = 4;
        addChannel(fixture, 1, 1, color);
    }
    ZephRebuildStaticFixtureBulbs(*simulation, masks(), *bulbs);
    QImage background(20, 20, QImage::Format_RGB32);
    background.fill(Qt::gray);
    QImage buffer;
    const ZephSettings settings;
    const EditorCanvas canvas{*simulation, settings, curve, *bulbs, background};
    ZephRedrawObjects(canvas, buffer);
    EXPECT_EQ(buffer.pixel(10, 10), qRgb(0, 0, 255));
    simulation->Fixtures[1].ZOrder = 16;
    ZephRedrawObjects(canvas, buffer);
    EXPECT_EQ(buffer.pixel(10, 10), qRgb(255, 0, 0));
    EXPECT_EQ(background.pixel(10, 10), buffer.pixel(0, 0));  // never drawn on
    background = QImage();
    ZephRedrawObjects(canvas, buffer);
    EXPECT_TRUE(buffer.isNull());
}
