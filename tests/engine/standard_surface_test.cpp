#include "engine/standard_surface.h"
#include "tests/support/drawing_stage.h"
#include "tests/support/recording_host.h"
#include "tests/support/reference_surface.h"

#include <QPainter>

#include <algorithm>

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
        constexpr std::array kShares{100, 5, 40, 0, 90};
        const std::int32_t kind = stage.pick(1, 8);
        if (kind >= 7) stage.fade(calls);
        if (kind > 1 && kind < 7) calls = stage.frame(kShares[static_cast<std::size_t>(stage.pick(0, 4))]);
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
    for (std::uint64_t seed = 1; seed <= 140 && !HasFatalFailure(); ++seed)
        comparePictures(seed, seed <= 120 ? fastestBlendKernels() : blendKernels(BlendForm::Portable));
}

TEST(StandardSurface, TellsNothingWhileThePictureStays) {
    Stage stage;
    stage.blank(400, 300, qRgb(16, 32, 48));
    stage.addLit(kFixtureBulbs, 2, 1, {{300, 100}}, packColor(255, 0, 0));
    stage.finish();
    CollectingFailures report;
    StandardSurface surface;
    ASSERT_TRUE(surface.prepare(stage.scene(stage.tables), report));
    const auto frame = [&](std::uint8_t alpha) {
        surface.beginFrame();
        surface.drawChannel({1, 1, 1, 0, alpha});
        surface.endFrame();
        return std::vector<QRect>(surface.changedRects().begin(), surface.changedRects().end());
    };
    EXPECT_EQ(frame(0), std::vector<QRect>{QRect(0, 0, 400, 300)});  // the picture is new
    EXPECT_EQ(frame(0).size(), 0U);
    EXPECT_EQ(frame(128).size(), 1U);
    EXPECT_EQ(frame(128).size(), 0U);
    EXPECT_EQ(surface.image().pixel(300, 100), 0xFF881018U);  // (16 x 127 + 255 x 128) / 255 = 135.97, 15.9, 23.9
    frame(0);
    EXPECT_EQ(surface.image(), stage.background);
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
