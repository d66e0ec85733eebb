// The OpenGL surface beside the standard one: what both must show alike, on the driver of the machine or in software.
#include "engine/gl_offscreen.h"
#include "engine/opengl_surface.h"
#include "tests/support/drawing_stage.h"

#include <cstdlib>

namespace {

int farthest(QRgb a, QRgb b) {
    return std::max({std::abs(qRed(a) - qRed(b)), std::abs(qGreen(a) - qGreen(b)), std::abs(qBlue(a) - qBlue(b))});
}

// A surface on a picture, started with the stage; 100 per cent of the stage's background.
struct GLRig {
    explicit GLRig(const Stage& stage) : target(stage.background.width(), stage.background.height()) {
        start(stage, stage.background);
    }
    void start(const Stage& stage, const QImage& picture, std::int32_t intensity = 100) {
        EXPECT_TRUE(surface.ZephGLStartup(stage.glScene(picture, intensity), target, failures));
        EXPECT_TRUE(failures.reports.empty()) << failures.reports.front().description;
    }
    QImage frame(const std::vector<Call>& calls, const ZephRenderTables& tables) {
        ZephRenderTables used = tables;
        play(calls, used, surface);
        return target.image();
    }

    CollectingFailures failures;
    GLOffscreen target;
    OpenGLSurface surface;
};

// Single bulbs of one fixture on black.
struct DarkStage : Stage {
    DarkStage(int width, int height, std::int32_t size, std::int32_t shape, std::initializer_list<Place> places) {
        blank(width, height);
        addLit(kFixtureBulbs, size, shape, places);
        finish();
    }
};

Call lit(std::uint8_t alpha) {
    Call call;
    call.channel = ChannelDraw{1, 1, 1, 0, alpha};
    return call;
}

// Full: lights are on or off, and nothing is left to rounding. Otherwise none covers less than a quarter, or the
// fractions that the standard surface cuts off would add up under dozens of layers: one level a layer, of which three
// quarters at most live through the next one, are four in all, and one for rounding.
void setOpacity(bool full, std::vector<Call>& calls) {
    for (Call& call : calls) {
        std::uint8_t& alpha = call.channel ? call.channel->Alpha : call.group->Alpha;
        alpha = full ? (alpha < 128 ? 0 : 255) : std::max<std::uint8_t>(alpha, 64);
    }
}

void compareSquares(std::uint64_t seed, bool full) {
    RandomStage stage(seed, false);
    ZephRenderTables standardTables = stage.tables;
    CollectingFailures failures;
    StandardSurface standard;
    ASSERT_TRUE(standard.prepare(stage.scene(standardTables), failures));
    GLRig gl(stage);

    std::vector<Call> calls;
    for (int n = 0; n < 8; ++n) {
        const int kind = stage.nextFrame(calls);
        setOpacity(full, calls);
        // The standard surface keeps an image while colours drift a little; here each is to be made anew.
        for (ZephRGBData& group : standardTables.RGBData)
            group.LastLevel[1] = -kRGBRebuildDrift;
        play(calls, standardTables, standard);
        const QImage drawn = gl.frame(calls, stage.tables);
        ASSERT_EQ(drawn.size(), standard.image().size());
        for (int place = 0; place < drawn.width() * drawn.height(); ++place) {
            const QPoint at(place % drawn.width(), place / drawn.width());
            ASSERT_LE(farthest(drawn.pixel(at), standard.image().pixel(at)), full ? 0 : 5)
                << "seed " << seed << " frame " << n << " kind " << kind << " at " << at.x() << "," << at.y();
        }
    }
}

}  // namespace

// Squares cover the same pixels in both, so every pixel tells of position, colour, order and opacity.
TEST(OpenGLSurface, ShowsTheSamePixelsAsTheStandardSurface) {
    for (std::uint64_t seed = 1; seed <= 120 && !HasFatalFailure(); ++seed)
        compareSquares(seed, seed <= 60);
}

// The two cut shapes out of pixels by different rules; they may differ along the outline, by no more than one pixel. At
// half strength, triangles that overlap would show.
TEST(OpenGLSurface, FillsTheShapesOfTheMasksOnce) {
    for (std::int32_t shape = 1; shape <= kBulbShapes; ++shape) {
        for (std::int32_t size = 1; size <= kMaxBulbSize; ++size) {
            // The second one lies where 16 bits would turn over to 5.
            const DarkStage stage(60, 60, size, shape, {{30, 30}, {65'541, 5}});
            const QImage drawn = GLRig(stage).frame({lit(128)}, stage.tables);
            const BulbMask& mask = masks().ZephBulbMasks[size][shape];
            const auto covered = [&](int x, int y) {
                const int column = x - (30 - size);
                const int row = y - (30 - size);
                const bool inside = column >= 0 && row >= 0 && column < 2 * size && row < 2 * size;
                return inside && mask.Coverage[static_cast<std::size_t>(row * 2 * size + column)] != 0;
            };
            for (int place = 0; place < 58 * 58; ++place) {
                const int x = 1 + place % 58;
                const int y = 1 + place / 58;
                int around = 0;
                for (int next = 0; next < 9; ++next)
                    around += covered(x + next % 3 - 1, y + next / 3 - 1) ? 1 : 0;
                const int red = qRed(drawn.pixel(x, y));
                // Arms of the smallest stars are thinner than a pixel.
                const bool wrong = (around == 9 && size > 2 && red == 0) || (around == 0 && red > 0);
                ASSERT_FALSE(wrong || red > 129) << shape << " of " << size << " at " << x << "," << y;
            }
        }
    }
}

TEST(OpenGLSurface, DrawsFloodsAsDiscsUpToTheirOpacity) {
    DarkStage stage(140, 140, 64, 3, {{70, 70}});
    ZephFixture& flood = stage.simulation->Fixtures[1];
    flood.Fixture_Type = kFixtureFlood;
    flood.Channels[1].Color = packColor(200, 100, 0);
    flood.Max_Opacity = 50;
    GLRig gl(stage);
    const auto at = [&](std::uint8_t alpha, int x, int y) { return gl.frame({lit(alpha)}, stage.tables).pixel(x, y); };
    // 51 lies above 50 and so becomes 50 per cent, 127 of 255; 50 does not.
    EXPECT_LE(farthest(at(51, 70, 70), qRgb(100, 50, 0)), 1);
    EXPECT_LE(farthest(at(50, 70, 70), qRgb(39, 20, 0)), 1);
    // As bright at the rim as in the middle, and nothing in the corner of its box.
    EXPECT_LE(farthest(at(255, 70, 10), qRgb(100, 50, 0)), 1);
    EXPECT_EQ(at(255, 10, 10), qRgb(0, 0, 0));
    flood.Max_Opacity = 0;
    EXPECT_EQ(at(255, 70, 70), qRgb(0, 0, 0));
}

TEST(OpenGLSurface, LaysThePictureOverBlack) {
    using Row = std::tuple<bool, std::int32_t, QRgb>;  // with a picture, intensity, expected
    DarkStage stage(40, 30, 2, 3, {});
    GLRig gl(stage);
    QImage small(4, 3, QImage::Format_RGB32);  // stretched to the drawing
    small.fill(qRgb(200, 100, 40));
    for (const auto& [picture, intensity, expected] :
         {Row{true, 100, qRgb(200, 100, 40)}, Row{true, 50, qRgb(100, 50, 20)}, Row{true, 0, qRgb(0, 0, 0)},
          Row{false, 60, qRgb(153, 153, 153)}}) {
        gl.start(stage, picture ? small : QImage(), intensity);
        const QImage drawn = gl.frame({}, stage.tables);
        for (const QPoint& place : {QPoint(0, 0), QPoint(39, 0), QPoint(0, 29), QPoint(20, 15)})
            EXPECT_LE(farthest(drawn.pixel(place), expected), 1) << picture << " at " << intensity;
    }
    // The upper left corner of the picture is that of the drawing.
    stage.background.setPixel(1, 2, qRgb(255, 0, 0));
    EXPECT_EQ(GLRig(stage).frame({}, stage.tables), stage.background);
}

TEST(OpenGLSurface, TellsWhyItCannotStart) {
    struct DeadTarget : GLTarget {
        bool isSeen() const override { return true; }
        bool makeCurrent() override { return works; }
        GLProcedure resolve(const char*) override { return nullptr; }
        void swapBuffers() override { FAIL(); }
        bool works = false;
    } target;
    DarkStage stage(60, 60, 2, 3, {{30, 30}});
    CollectingFailures failures;
    OpenGLSurface surface;
    const auto start = [&](std::int32_t width) {
        stage.blank(width, 60);
        return surface.ZephGLStartup(stage.glScene(stage.background), target, failures);
    };
    EXPECT_FALSE(start(60));
    target.works = true;
    EXPECT_FALSE(start(60));
    EXPECT_FALSE(start(0));
    EXPECT_FALSE(start(kMaxCanvasPixels + 1));
    ASSERT_EQ(failures.reports.size(), 4U);
    EXPECT_EQ(failures.reports[0].procedure, "Zeph.modZephRenderOPenGL.ZephGLStartup");
    EXPECT_EQ(failures.reports[1].description, "OpenGL lacks glActiveTexture");
    play({lit(255)}, stage.tables, surface);  // draws nothing, and does not crash
}
