// The OpenGL surface beside the standard one: what both must show alike, on the driver of the machine or in software.
#include "engine/gl_offscreen.h"
#include "engine/opengl_surface.h"
#include "tests/support/drawing_stage.h"
#include "tests/support/recording_host.h"

#include <gtest/gtest.h>

#include <cstdlib>

namespace {

int farthest(QRgb a, QRgb b) {
    return std::max({std::abs(qRed(a) - qRed(b)), std::abs(qGreen(a) - qGreen(b)), std::abs(qBlue(a) - qBlue(b))});
}

ZephDimmingCurve identity() {
    return ZephCreateDummyDimmingCurve();
}

// A surface on a picture, started with the stage; 100 per cent of the stage's background.
struct GLRig {
    explicit GLRig(const Stage& stage, std::int32_t intensity = 100)
        : target(stage.background.width(), stage.background.height()) {
        start(stage, stage.background, intensity);
    }
    void start(const Stage& stage, const QImage& picture, std::int32_t intensity) {
        EXPECT_TRUE(surface.ZephGLStartup({*stage.document, stage.tables, *stage.states, curve, masks().GLShapes,
                                           picture, intensity, stage.background.width(), stage.background.height()},
                                          target, failures));
        EXPECT_TRUE(failures.reports.empty()) << failures.reports.front().description;
    }
    QImage frame(const std::vector<Call>& calls, const ZephRenderTables& tables) {
        ZephRenderTables used = tables;
        play(calls, used, surface);
        return target.image();
    }

    ZephDimmingCurve curve = identity();
    CollectingFailures failures;
    GLOffscreen target;
    OpenGLSurface surface;
};

Stage darkStage(int width = 60, int height = 60) {
    Stage stage;
    stage.background = QImage(width, height, QImage::Format_RGB32);
    stage.background.fill(Qt::black);
    return stage;
}

Call lit(std::int32_t fixture, std::uint8_t alpha, std::int32_t channel = 1) {
    Call call;
    call.channel = ChannelDraw{1, fixture, channel, 0, alpha};
    return call;
}

enum class Opacity { Full, Quarter };

// Full: lights are on or off, and nothing is left to rounding. Quarter: no light covers less than that, or the
// fractions that the standard surface cuts off would add up under dozens of layers.
void setOpacity(Opacity opacity, std::vector<Call>& calls) {
    for (Call& call : calls) {
        std::uint8_t& alpha = call.channel ? call.channel->Alpha : call.group->Alpha;
        alpha = opacity == Opacity::Full ? (alpha < 128 ? 0 : 255) : std::max<std::uint8_t>(alpha, 64);
    }
}

void compareSquares(std::uint64_t seed, Opacity opacity, int tolerance) {
    RandomStage stage(seed, false);
    ZephRenderTables standardTables = stage.tables;
    CollectingFailures failures;
    StandardSurface standard;
    ASSERT_TRUE(standard.prepare(stage.scene(standardTables), failures));
    GLRig gl(stage);

    std::vector<Call> calls;
    for (int n = 0; n < 8; ++n) {
        constexpr std::array kShares{100, 5, 40, 0, 90};
        const std::int32_t kind = stage.pick(1, 6);
        if (kind > 1) calls = stage.frame(kShares[static_cast<std::size_t>(stage.pick(0, 4))]);
        if (kind == 2 && calls.size() > 1) std::reverse(calls.begin(), calls.end());
        for (std::size_t i = calls.size(); kind == 5 && i > 1; --i)
            std::swap(calls[i - 1], calls[static_cast<std::size_t>(stage.pick(0, static_cast<int>(i) - 1))]);
        if (kind == 3) calls.insert(calls.end(), calls.begin(), calls.begin() + std::ssize(calls) / 2);
        setOpacity(opacity, calls);
        // The standard surface keeps an image while colours drift a little; here each is to be made anew.
        for (ZephRGBData& group : standardTables.RGBData)
            group.LastLevel[1] = -kRGBRebuildDrift;
        play(calls, standardTables, standard);
        const QImage drawn = gl.frame(calls, stage.tables);
        ASSERT_EQ(drawn.size(), standard.image().size());
        for (int y = 0; y < drawn.height(); ++y) {
            for (int x = 0; x < drawn.width(); ++x) {
                ASSERT_LE(farthest(drawn.pixel(x, y), standard.image().pixel(x, y)), tolerance)
                    << "seed " << seed << " frame " << n << " kind " << kind << " at " << x << "," << y;
            }
        }
    }
}

}  // namespace

// Squares cover the same pixels in both, so every pixel tells of position, colour, order and opacity.
TEST(OpenGLSurface, ShowsTheSamePixelsAsTheStandardSurface) {
    for (std::uint64_t seed = 1; seed <= 60; ++seed) {
        compareSquares(seed, Opacity::Full, 0);
        if (HasFatalFailure()) return;
    }
    // One level a layer is cut off, of which three quarters at most live through the next layer: four in all, and one
    // for rounding.
    for (std::uint64_t seed = 61; seed <= 120; ++seed) {
        compareSquares(seed, Opacity::Quarter, 5);
        if (HasFatalFailure()) return;
    }
}

// The two cut shapes out of pixels by different rules; they may differ along the outline, by no more than one pixel.
TEST(OpenGLSurface, FillsTheShapesOfTheMasks) {
    for (std::int32_t shape = 1; shape <= kBulbShapes; ++shape) {
        for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
            Stage stage = darkStage();
            ZephFixture& fixture = stage.add(kFixtureBulbs, kChannelNormal, size, shape);
            fixture.Channels[1].Color = kWhite;
            Stage::addPoint(fixture, kPointBulb, 30, 30);
            stage.finish();
            GLRig gl(stage);
            const QImage drawn = gl.frame({lit(1, 255)}, stage.tables);
            const BulbMask& mask = masks().ZephBulbMasks[size][shape];
            const auto covered = [&](int x, int y) {
                const int column = x - (30 - size);
                const int row = y - (30 - size);
                const bool inside = column >= 0 && row >= 0 && column < 2 * size && row < 2 * size;
                return inside && mask.Coverage[static_cast<std::size_t>(row * 2 * size + column)] != 0;
            };
            for (int y = 1; y < 59; ++y) {
                for (int x = 1; x < 59; ++x) {
                    int around = 0;
                    for (int dy = -1; dy <= 1; ++dy) {
                        for (int dx = -1; dx <= 1; ++dx)
                            around += covered(x + dx, y + dy) ? 1 : 0;
                    }
                    const bool white = qRed(drawn.pixel(x, y)) > 127;
                    if (around == 9 && size > 2) {  // arms of the smallest stars are thinner than a pixel

                        EXPECT_TRUE(white) << shape << " of " << size << " at " << x << "," << y;
                    }
                    if (around == 0) {
                        EXPECT_FALSE(white) << shape << " of " << size << " at " << x << "," << y;
                    }
                }
            }
        }
    }
}

TEST(OpenGLSurface, DrawsFloodsAsDiscsUpToTheirOpacity) {
    Stage stage = darkStage(140, 140);
    ZephFixture& flood = stage.add(kFixtureFlood, kChannelNormal, 64, 3);
    flood.Channels[1].Color = packColor(200, 100, 0);
    flood.Max_Opacity = 50;
    Stage::addPoint(flood, kPointBulb, 70, 70);
    stage.finish();
    GLRig gl(stage);

    const auto at = [&](std::uint8_t alpha, int x, int y) {
        return gl.frame({lit(1, alpha)}, stage.tables).pixel(x, y);
    };
    // 51 lies above 50 and so becomes 50 per cent, 127 of 255; 50 does not.
    EXPECT_LE(farthest(at(255, 70, 70), qRgb(100, 50, 0)), 1);
    EXPECT_LE(farthest(at(51, 70, 70), qRgb(100, 50, 0)), 1);
    EXPECT_LE(farthest(at(50, 70, 70), qRgb(39, 20, 0)), 1);
    // As bright at the rim as in the middle, and nothing in the corner of its box.
    EXPECT_LE(farthest(at(255, 70, 10), qRgb(100, 50, 0)), 1);
    EXPECT_EQ(at(255, 10, 10), qRgb(0, 0, 0));

    stage.document->Fixtures[1].Max_Opacity = 0;
    EXPECT_EQ(at(255, 70, 70), qRgb(0, 0, 0));
}

TEST(OpenGLSurface, FillsTheArmsOfStarsAlone) {
    Stage stage = darkStage();
    ZephFixture& star = stage.add(kFixtureBulbs, kChannelNormal, 16, 7);
    star.Channels[1].Color = kWhite;
    Stage::addPoint(star, kPointBulb, 30, 30);
    stage.finish();
    GLRig gl(stage);
    const QImage drawn = gl.frame({lit(1, 128)}, stage.tables);
    // A four-pointed star: light along its arms, none between them, none twice.
    for (const QPoint& arm : {QPoint(29, 20), QPoint(40, 29), QPoint(29, 40), QPoint(20, 29), QPoint(29, 29)})
        EXPECT_NEAR(qRed(drawn.pixel(arm)), 128, 1) << arm.x() << "," << arm.y();
    for (const QPoint& gap : {QPoint(20, 20), QPoint(40, 20), QPoint(40, 40), QPoint(20, 40)})
        EXPECT_EQ(qRed(drawn.pixel(gap)), 0) << gap.x() << "," << gap.y();
}

TEST(OpenGLSurface, LaysThePictureOverBlack) {
    struct Row {
        bool picture;
        std::int32_t intensity;
        QRgb expected;
    };
    const Row rows[] = {{true, 100, qRgb(200, 100, 40)},   {true, 50, qRgb(100, 50, 20)},    {true, 0, qRgb(0, 0, 0)},
                        {false, 100, qRgb(255, 255, 255)}, {false, 60, qRgb(153, 153, 153)}, {false, 0, qRgb(0, 0, 0)}};
    for (const Row& row : rows) {
        Stage stage = darkStage(40, 30);
        stage.finish();
        GLRig gl(stage);
        QImage small(4, 3, QImage::Format_RGB32);  // stretched to the drawing
        small.fill(qRgb(200, 100, 40));
        gl.start(stage, row.picture ? small : QImage(), row.intensity);
        const QImage drawn = gl.frame({}, stage.tables);
        for (const QPoint& place : {QPoint(0, 0), QPoint(39, 0), QPoint(0, 29), QPoint(20, 15)})
            EXPECT_LE(farthest(drawn.pixel(place), row.expected), 1) << row.picture << " at " << row.intensity;
    }
    // The upper left corner of the picture is that of the drawing.
    Stage stage = darkStage(40, 30);
    stage.background.setPixel(1, 2, qRgb(255, 0, 0));
    stage.finish();
    EXPECT_EQ(GLRig(stage).frame({}, stage.tables), stage.background);
}

// A wider window shows more room to the right and below, not larger bulbs.
TEST(OpenGLSurface, KeepsOneUnitOnePixelInAWindowOfAnotherSize) {
    Stage stage = darkStage(40, 40);
    ZephFixture& bulb = stage.add(kFixtureBulbs, kChannelNormal, 2, 3);
    bulb.Channels[1].Color = kWhite;
    Stage::addPoint(bulb, kPointBulb, 10, 10);
    Stage::addPoint(bulb, kPointBulb, 50, 10);
    stage.finish();
    GLOffscreen target(60, 40);
    OpenGLSurface surface;
    CollectingFailures failures;
    const ZephDimmingCurve curve = identity();
    ASSERT_TRUE(surface.ZephGLStartup(
        {*stage.document, stage.tables, *stage.states, curve, masks().GLShapes, stage.background, 100, 40, 40}, target,
        failures));
    surface.setViewport(60, 40, 1.0);
    play({lit(1, 255)}, stage.tables, surface);
    const QImage drawn = target.image();
    EXPECT_EQ(drawn.pixel(8, 8), qRgb(255, 255, 255));
    EXPECT_EQ(drawn.pixel(7, 8), qRgb(0, 0, 0));
    EXPECT_EQ(drawn.pixel(51, 11), qRgb(255, 255, 255));
    EXPECT_EQ(drawn.pixel(52, 11), qRgb(0, 0, 0));
}

TEST(OpenGLSurface, TellsWhyItCannotStart) {
    struct DeadTarget : GLTarget {
        bool isSeen() const override { return true; }
        bool makeCurrent() override { return works; }
        GLProcedure resolve(const char*) override { return nullptr; }
        void swapBuffers() override { FAIL(); }
        bool works = false;
    } target;
    Stage stage = darkStage();
    stage.finish();
    const ZephDimmingCurve curve = identity();
    CollectingFailures failures;
    OpenGLSurface surface;
    const auto start = [&](std::int32_t width) {
        return surface.ZephGLStartup(
            {*stage.document, stage.tables, *stage.states, curve, masks().GLShapes, stage.background, 100, width, 60},
            target, failures);
    };
    EXPECT_FALSE(start(60));
    target.works = true;
    EXPECT_FALSE(start(60));
    EXPECT_FALSE(start(0));
    EXPECT_FALSE(start(kMaxCanvasPixels + 1));
    ASSERT_EQ(failures.reports.size(), 4U);
    EXPECT_EQ(failures.reports[0].procedure, "Zeph.modZephRenderOPenGL.ZephGLStartup");
    EXPECT_EQ(failures.reports[1].description, "OpenGL lacks glActiveTexture");
    play({lit(1, 255)}, stage.tables, surface);  // draws nothing, and does not crash
}

TEST(OpenGLSurface, CoversBulbsThatHangOutOfThePictureOnce) {
    for (const std::int32_t size : {1, 5, 16}) {
        Stage stage = darkStage(40, 30);
        ZephFixture& bulb = stage.add(kFixtureBulbs, kChannelNormal, size, 3);
        bulb.Channels[1].Color = kWhite;
        const std::pair<int, int> places[] = {{20, 1}, {1, 15}, {39, 15}, {20, 29}, {0, 0}, {40, 30}};
        for (const auto& [x, y] : places) {
            bulb.PointCount = 0;
            Stage::addPoint(bulb, kPointBulb, x, y);
            stage.finish();
            const QImage drawn = GLRig(stage).frame({lit(1, 64)}, stage.tables);
            for (int column = 0; column < 40; ++column) {
                for (int row = 0; row < 30; ++row) {
                    const bool inside = column >= x - size && column < x + size && row >= y - size && row < y + size;
                    EXPECT_EQ(qRed(drawn.pixel(column, row)), inside ? 64 : 0)
                        << size << " " << x << "," << y << ": " << column << "," << row;
                }
            }
        }
    }
}
