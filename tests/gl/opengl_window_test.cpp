// The window of the OpenGL engine, opened for real, drawn on and used.
#include "engine/dialogs/opengl_window.h"
#include "engine/opengl_surface.h"
#include "tests/support/drawing_stage.h"

#include <QApplication>
#include <QPushButton>
#include <QScreen>
#include <QTest>
#include <QWindow>

namespace {

struct OpenGLWindow : testing::Test {
    GLWindowActions actions() {
        return {[this] { ++stops; }, [this] { ++plays; }, [this] { ++halts; },
                [this](std::int32_t width, std::int32_t height, double ratio) {
                    surface.setViewport(width, height, ratio);
                }};
    }

    // A canvas of 300 x 200 with a red square of 20 x 20 in the middle, on blue, and another one to the right of it.
    void SetUp() override {
        stage.blank(300, 200, qRgb(0, 0, 120));
        stage.addLit(kFixtureBulbs, 10, 3, {{150, 100}, {350, 100}}, packColor(255, 0, 0));
        stage.finish();
        ASSERT_TRUE(ZephCreateRenderWindow(stage.background.size(), failures, window));
        window.move(100, 80);
        ASSERT_TRUE(QTest::qWaitForWindowExposed(&window));
        ASSERT_TRUE(surface.ZephGLStartup(stage.glScene(stage.background), window.target(), failures));
        window.resizeDrawing();
    }
    void TearDown() override {
        EXPECT_TRUE(failures.reports.empty());
        surface.release();
    }

    void drawFrame(std::uint8_t alpha) {
        Call call;
        call.channel = ChannelDraw{1, 1, 1, 0, alpha};
        play({call}, stage.tables, surface);
    }
    // What stands on the screen at a place of the drawing.
    QRgb screenAt(int x, int y) {
        QTest::qWait(50);
        const QPoint place = window.findChild<QWidget*>("drawing")->mapToGlobal(QPoint(x, y));
        return QGuiApplication::primaryScreen()->grabWindow(0, place.x(), place.y(), 1, 1).toImage().pixel(0, 0);
    }
    void click(const char* name) { QTest::mouseClick(window.findChild<QPushButton*>(name), Qt::LeftButton); }

    int stops = 0;
    int plays = 0;
    int halts = 0;
    Stage stage;
    CollectingFailures failures;
    OpenGLSurface surface;
    frmZephOpenGL window{actions()};
};

}  // namespace

TEST_F(OpenGLWindow, ShowsTheLightsOnTheScreenAndGrowsRoundTheDrawing) {
    drawFrame(255);
    EXPECT_EQ(screenAt(141, 91), qRgb(255, 0, 0));
    EXPECT_EQ(screenAt(138, 100), qRgb(0, 0, 120));
    drawFrame(0);
    EXPECT_EQ(screenAt(150, 100), qRgb(0, 0, 120));
    window.resize(window.width() + 80, window.height() + 40);
    QTest::qWait(50);
    drawFrame(255);  // the driver learns of the new size by this one
    drawFrame(255);
    EXPECT_EQ(screenAt(150, 100), qRgb(255, 0, 0));
    EXPECT_EQ(screenAt(341, 91), qRgb(255, 0, 0)) << "more room, not larger bulbs";
    EXPECT_EQ(screenAt(5, 5), qRgb(0, 0, 120));
    EXPECT_EQ(screenAt(350, 220), qRgb(0, 0, 0));
}

TEST_F(OpenGLWindow, TellsTheSequencerAndAsksToStopByButtonKeyAndClosing) {
    QTest::mouseClick(window.findChild<QPushButton*>("cmdStop"), Qt::RightButton);
    click("cmdSEPlay");
    click("cmdSEPlay");
    click("cmdSEStop");
    EXPECT_EQ(std::tuple(plays, halts, stops), std::tuple(2, 1, 0));
    click("cmdStop");
    EXPECT_EQ(stops, 1);
    EXPECT_FALSE(window.isVisible());
    drawFrame(255);  // a frame before the next tick has nowhere to go, and does no harm
    EXPECT_EQ(window.notedPlace(), QPoint(100, 80));

    window.show();
    QTest::keyClick(&window, Qt::Key_A);
    EXPECT_TRUE(window.isVisible());
    QTest::keyClick(window.windowHandle(), Qt::Key_Escape);
    EXPECT_EQ(stops, 2);
    EXPECT_FALSE(window.isVisible());

    window.show();
    window.move(0, 0);
    window.close();
    EXPECT_EQ(stops, 3);
    EXPECT_EQ(window.notedPlace(), std::nullopt);
}
