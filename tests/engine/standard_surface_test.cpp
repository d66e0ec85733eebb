#include "engine/standard_surface.h"
#include "tests/support/drawing_stage.h"
#include "tests/support/reference_surface.h"

#include <QPainter>

namespace {

// Pixels that differ from what was there before must lie within the rectangles told.
bool changesAreTold(const QImage& before, const StandardSurface& surface) {
    QImage told = before;
    QPainter painter(&told);
    for (const QRect& rect : surface.changedRects())
        painter.drawImage(rect.topLeft(), surface.image(), rect);
    painter.end();
    return told == surface.image();
}

void comparePictures(std::uint64_t seed, const BlendKernels& kernels) {
    RandomStage stage(seed);
    ZephRenderTables fastTables = stage.tables;
    ZephRenderTables plainTables = stage.tables;
    CollectingFailures report;
    StandardSurface fast(kernels);
    ASSERT_TRUE(fast.prepare(stage.scene(fastTables), report));
    ReferenceSurface plain(stage.scene(plainTables));

    std::vector<Call> calls;
    for (int n = 0; n < 10; ++n) {
        const int kind = stage.nextFrame(calls);
        if (kind == 4 && n > 4) {
            stage.newBackground();
            ASSERT_TRUE(fast.setBackground(stage.background));
            plain.setBackground(stage.background);
        }
        QImage before = fast.image().copy();
        if (n == 0) before.fill(Qt::black);  // the whole picture is new
        play(calls, fastTables, fast);
        play(calls, plainTables, plain);
        ASSERT_EQ(fast.image(), plain.image()) << "seed " << seed << " frame " << n << " kind " << kind;
        ASSERT_TRUE(changesAreTold(before, fast)) << "seed " << seed << " frame " << n;
    }
}

}  // namespace

TEST(StandardSurface, ShowsTheSamePixelsAsTheReference) {
    for (std::uint64_t seed = 1; seed <= 140 && !HasFatalFailure(); ++seed)
        comparePictures(seed, seed <= 120 ? fastestBlendKernels() : blendKernels(BlendForm::Portable));
}

TEST(StandardSurface, TellsNothingWhileThePictureStays) {
    Stage stage;
    stage.blank(400, 300);
    stage.addLit(kFixtureBulbs, 2, 1, {{300, 100}});
    stage.finish();
    CollectingFailures report;
    StandardSurface surface;
    ASSERT_TRUE(surface.prepare(stage.scene(stage.tables), report));
    for (const auto& [alpha, told] : {std::pair{0, 1U}, {0, 0U}, {128, 1U}, {128, 0U}}) {
        surface.beginFrame();
        surface.drawChannel({1, 1, 1, 0, static_cast<std::uint8_t>(alpha)});
        surface.endFrame();
        EXPECT_EQ(surface.changedRects().size(), told) << alpha;
    }
}

TEST(StandardSurface, RefusesACanvasOrTablesThatItCannotDraw) {
    Stage stage;
    makeRgb(stage.add(kFixtureBulbs, {{5, 5}}), 1, 1);
    stage.finish();
    CollectingFailures report;
    StandardSurface surface;
    const auto prepared = [&](int width, int height, std::int32_t handle) {
        stage.background = QImage(width, height, QImage::Format_RGB32);
        stage.tables.RGBData[1].Bulb = handle;
        return surface.prepare(stage.scene(stage.tables), report);
    };
    EXPECT_FALSE(prepared(0, 0, 0));
    EXPECT_FALSE(prepared(2501, 10, 0));
    EXPECT_FALSE(prepared(10, 10, 3));
    EXPECT_EQ(report.reports.size(), 3u);
    surface.beginFrame();  // unprepared: nothing happens
    surface.drawGroup({1, 1, 1, 0, kWhite, 255}, stage.tables.RGBData[1]);
    surface.endFrame();
    EXPECT_TRUE(surface.image().isNull());
    EXPECT_TRUE(prepared(2500, 1, 0));
    EXPECT_FALSE(surface.setBackground(QImage(9, 9, QImage::Format_RGB32)));
}
