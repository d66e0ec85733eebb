#include "engine/dialogs/compile_errors_dialog.h"
#include "tests/shell/window_rig.h"

#include <QMenuBar>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTimer>

namespace {

using Strings = std::vector<std::string>;

const QColor kRedBulb(255, 0, 0);
const QColor kWhiteCanvas(255, 255, 255);

// A frame with one plain command for unit 1, circuit 1, at once to 100 per cent.
const std::string kBulbFrame = "\x01"
                               "001"   // one payload
                               "0036"  // 7 + 29 characters
                               "0000"  // light command, plain
                               "00001001001"
                               "00000000"
                               "100100\x04";

// The window and a display of one red bulb.
struct MainWindow : WindowRig {
    void simulate() { action("mnuSimulationMode")->trigger(); }
    void enter() {
        open();
        editing = window.size();
        simulate();
        ASSERT_TRUE(program.simulating());
    }
    void arrive(const std::string& bytes) {
        socket.reads.push_back(bytes);
        socket.dataArrival();
    }
    void expectEditor() {
        run(2);
        EXPECT_FALSE(program.simulating());
        EXPECT_EQ(panel(2), "Select Fixture");
    }
    // Lets the timer run on a clock that moves on.
    void run(int ticks) {
        for (int tick = 0; tick < ticks; ++tick) {
            clock.set(clock.timeGetTime() + 10);
            QTest::qWait(12);
        }
    }
    QSize editing;  // the window's size before the simulation
};

}  // namespace

TEST_F(MainWindow, ShowsTheDisplayOfTheCommandLineOrNone) {
    program.parms.FileToOpen = "/nowhere/gone.zee";
    window.start();
    EXPECT_EQ(document().FileName, "");
    EXPECT_FALSE(action("mnuSimulationMode")->isEnabled());

    open();
    const QString working = QDir::currentPath();
    QDir::setCurrent(folder.qPath());
    program.parms.FileToOpen = "bulb.zee";  // relative to the working folder
    window.start();
    QDir::setCurrent(working);
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -bulb.zee");
    EXPECT_EQ(panel(2), "Select Fixture");
    EXPECT_EQ(find<QWidget>("picMain")->size(), QSize(60, 30));
    EXPECT_EQ(canvasAt(20, 10), kRedBulb);
    EXPECT_EQ(canvasAt(50, 25), kWhiteCanvas);

    EXPECT_FALSE(window.openFile(folder.qPath("gone.zee"), false));
    EXPECT_FALSE(document().SimulationOpen);
    EXPECT_EQ(document().FixtureCount, 0);
    EXPECT_TRUE(program.picBackground.isNull());
    EXPECT_THAT(host.notes.boxTexts(), testing::StartsWith("Qen Visualizer-Editor Load Error|"));
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -bulb.zee");  // the title keeps what it had
}

TEST_F(MainWindow, SimulatesAndComesBackByEsc) {
    enter();
    const Strings& told = host.notes.panel2History;
    EXPECT_THAT(told, testing::Contains("Creating new simulation pointers..."));
    EXPECT_EQ(Strings(told.end() - 3, told.end()),
              (Strings{"Opening data connection...", "Setting Emulation Timer Attributes...",
                       "UDP Simulation active on 127.0.0.1 (30303)"}));
    EXPECT_EQ(find<QTimer>("hrTimer1")->interval(), 9);
    EXPECT_EQ(canvasAt(20, 10), kWhiteCanvas);
    for (const char* hidden : {"CoolBar1", "flgObjectSelect", "chkCmdFixtureOrProp(0)", "chkCmdFixtureOrProp(1)"})
        EXPECT_FALSE(visible(hidden)) << hidden;
    for (const char* shown : {"cmdStop", "cmdSEPlay", "cmdSEStop", "prbQueueLen"})
        EXPECT_TRUE(visible(shown)) << shown;
    EXPECT_FALSE(window.menuBar()->isVisible());
    key(Qt::Key_F2);  // the editor's keys are frozen
    key(Qt::Key_F5);
    ASSERT_TRUE(program.simulating());
    arrive(kBulbFrame);
    run(110);
    EXPECT_EQ(canvasAt(20, 10), kRedBulb);
    EXPECT_TRUE(panel(3).startsWith("FPS:")) << panel(3).toStdString();

    key(Qt::Key_Escape);
    expectEditor();
    EXPECT_TRUE(visible("flgObjectSelect") && window.menuBar()->isVisible());
    EXPECT_EQ(panel(3), "");
    EXPECT_EQ(window.size(), editing);
    EXPECT_EQ(canvasAt(20, 10), kRedBulb);  // the editor shows every light
    EXPECT_EQ(program.tables.RenderDataCount, 0);

    arrive(kBulbFrame);  // between two simulations: thrown away
    simulate();
    run(3);
    EXPECT_EQ(canvasAt(20, 10), kWhiteCanvas);
    EXPECT_EQ(std::ranges::count(socket.calls, "bind 127.0.0.1 30303"), 1) << "the socket stays open";

    program.receive.Stream.ZephStackBuffer.append("\x01" + std::string(1'600'000, '0'));  // no frame ends here
    arrive("0");
    EXPECT_EQ(find<QProgressBar>("prbQueueLen")->value(), 1'600'001);
    EXPECT_TRUE(find<QProgressBar>("prbQueueLen")->styleSheet().contains("#ffff00"));
    key(Qt::Key_Escape);
    EXPECT_TRUE(program.receive.Stream.ZephStackBuffer.empty());
}

TEST_F(MainWindow, ReturnsToTheEditorFromEachFailureToEnter) {
    open();
    const std::pair<std::function<void()>, const char*> rows[] = {
        {[&] { document().Fixtures[1].ChannelCount = 0; }, "Qen Visualizer-Error|"},
        {[&] { socket.taken = true; }, "Qen Visualizer-Port Error|"},
        {[&] { clock.set(-1); }, "Qen Visualizer-Error:  Reboot Required|"},
        {[&] { program.RenderEngine = kEngineOpenGL; }, ""},  // there is no context on this platform
    };
    for (const auto& [spoil, box] : rows) {
        host.notes.boxes.clear();
        spoil();
        simulate();
        EXPECT_FALSE(program.simulating());
        // The refusal of a clock that runs backwards stays in view.
        EXPECT_EQ(panel(2), clock.timeGetTime() < 0 ? "Can not enter simulation mode:  Time is running backwards."
                                                    : "Select Fixture");
        EXPECT_FALSE(find<QTimer>("hrTimer1")->isActive());
        EXPECT_TRUE(window.isVisible());
        EXPECT_THAT(host.notes.boxTexts(), testing::StartsWith(box));
        EXPECT_EQ(host.notes.boxes.size(), *box ? 1u : 0u) << box;
        document().Fixtures[1].ChannelCount = 1;
        socket.taken = false;
        clock.set(100'000);
        program.RenderEngine = kEngineStandard;
    }
    EXPECT_THAT(host.notes.panel2History, testing::Contains("Creating Rendering Window"));
    simulate();
    EXPECT_TRUE(program.simulating());
}

TEST_F(MainWindow, TakesAssembledRibbonsApartAgain) {
    for (const int pixel : {1, 4}) {
        ZephFixture& ribbon = addFixture(*display, kFixtureKesh, {{5, 5}});
        ribbon.Kesh.Base_Unit = 5;
        ribbon.Kesh.Physical_Pixel_Number = pixel;
    }
    enter();
    EXPECT_EQ(document().Fixtures[2].PointCount, 4);  // its own, two that are not drawn, and the child's
    key(Qt::Key_Escape);
    EXPECT_EQ(document().Fixtures[2].PointCount, 1);

    document().Fixtures[3].Kesh.Physical_Pixel_Number = 1;  // two pieces on the same pixel
    simulate();
    expectEditor();
    EXPECT_EQ(host.notes.compileErrors.size(), 1U);
    EXPECT_EQ(document().Fixtures[2].PointCount, 1);
}

TEST_F(MainWindow, StoppingAndClosingEndASimulationOnlyUnlessTheSettingSaysMore) {
    enter();
    click("cmdStop");
    expectEditor();

    simulate();
    ASSERT_TRUE(program.simulating());
    EXPECT_FALSE(window.close());
    expectEditor();
    EXPECT_TRUE(window.isVisible());

    program.settings.EndStopsSimulation = false;
    simulate();
    window.close();
    run(2);
    EXPECT_FALSE(program.simulating());
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(socket.State(), 0);
}

TEST_F(MainWindow, TellsOfADisplayWithoutChannels) {
    open();
    host.seen = true;
    document().Fixtures[1].ChannelCount = 0;
    QString told;
    QTimer::singleShot(50, &window, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        told = box->windowTitle() + "|" + box->text();
        QTest::mouseClick(box->button(QMessageBox::Ok), Qt::LeftButton);
    });
    simulate();
    EXPECT_EQ(told, "Qen Visualizer-Error|There are no channels to simulate.");
    EXPECT_EQ(panel(2), "Select Fixture");
}

TEST(CompileErrors, SelectsItsTextOnFocusAndClosesByItsButton) {
    frmZephCompileErrors dialog;
    dialog.SetErrorMessage("first\r\nsecond");
    auto* txtError = dialog.findChild<QPlainTextEdit*>("txtError");
    EXPECT_EQ(txtError->toPlainText(), "first\nsecond");
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&dialog));
    txtError->setFocus();
    QTest::qWait(20);
    EXPECT_EQ(txtError->textCursor().selectedText().size(), 12);
    QTest::mouseClick(dialog.findChild<QPushButton*>("cmdOK"), Qt::LeftButton);
    EXPECT_FALSE(dialog.isVisible());
}

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication application(argc, argv);
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
