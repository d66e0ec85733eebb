#include "engine/dialogs/compile_errors_dialog.h"
#include "tests/shell/window_rig.h"
#include "tests/support/fixtures.h"

#include <QApplication>
#include <QMenuBar>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QProgressBar>
#include <QTimer>

namespace {

using Strings = std::vector<std::string>;

const QColor kRedBulb(255, 0, 0);
const QColor kWhiteCanvas(255, 255, 255);

// The window and a display of one red bulb.
struct MainWindow : WindowRig {
    void SetUp() override {
        WindowRig::SetUp();
        ShellRig::buildDisplay(*display);
        file = rig.save(*display, "bulb.zee");
    }
    void openBulb() { open(*display, "bulb.zee"); }
    void enter() {
        openBulb();
        find<QAction>("mnuSimulationMode")->trigger();
        ASSERT_TRUE(rig.program.simulating());
    }
    void arrive(const std::string& bytes) {
        rig.socket.reads.push_back(bytes);
        rig.socket.dataArrival();
    }
    void expectEditor() {
        EXPECT_FALSE(rig.program.simulating());
        EXPECT_EQ(panel(2), "Select Fixture");
    }
    // Lets the timer run on a clock that moves on.
    void run(int ticks) {
        for (int tick = 0; tick < ticks; ++tick) {
            rig.clock.set(rig.clock.timeGetTime() + 10);
            QTest::qWait(12);
        }
    }

    std::unique_ptr<ZephSimulation> display = std::make_unique<ZephSimulation>();
};

}  // namespace

TEST_F(MainWindow, ShowsTheDisplayOfTheCommandLine) {
    const QString working = QDir::currentPath();
    QDir::setCurrent(rig.folder.path());
    rig.program.parms.FileToOpen = "bulb.zee";  // relative to the working folder
    window.start();
    QDir::setCurrent(working);
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -bulb.zee");
    EXPECT_EQ(panel(2), "Select Fixture");
    EXPECT_EQ(find<QWidget>("picMain")->size(), QSize(60, 30));
    EXPECT_EQ(canvasAt(20, 10), QColor(255, 0, 0));
    EXPECT_EQ(canvasAt(50, 25), QColor(255, 255, 255));
}

TEST_F(MainWindow, AQuietFileThatFailsClearsBothNames) {
    rig.program.parms.FileToOpen = "/nowhere/gone.zee";
    window.start();
    EXPECT_EQ(rig.program.simulation->FileName, "");
    EXPECT_EQ(rig.program.simulation->FilePath, "");
    EXPECT_FALSE(find<QAction>("mnuSimulationMode")->isEnabled());
}

TEST_F(MainWindow, SimulatesAndComesBackByEsc) {
    enter();
    const Strings& told = host.notes.panel2History;
    EXPECT_THAT(told, testing::Contains("Creating new simulation pointers..."));
    EXPECT_EQ(Strings(told.end() - 3, told.end()),
              (Strings{"Opening data connection...", "Setting Emulation Timer Attributes...",
                       "UDP Simulation active on 127.0.0.1 (30303)"}));
    EXPECT_EQ(panel(2), "UDP Simulation active on 127.0.0.1 (30303)");
    EXPECT_EQ(find<QTimer>("hrTimer1")->interval(), 9);
    EXPECT_FALSE(window.menuBar()->isVisible());
    EXPECT_FALSE(find<QWidget>("CoolBar1")->isVisible());
    EXPECT_TRUE(find<QProgressBar>("prbQueueLen")->isVisible());
    EXPECT_TRUE(find<QPushButton>("cmdStop")->isVisible());
    EXPECT_EQ(canvasAt(20, 10), kWhiteCanvas);
    arrive(bulbFrame("100"));
    run(110);
    EXPECT_EQ(canvasAt(20, 10), kRedBulb);
    EXPECT_TRUE(panel(3).startsWith("FPS:")) << panel(3).toStdString();

    key(Qt::Key_Escape);
    run(2);
    expectEditor();
    EXPECT_TRUE(window.menuBar()->isVisible());
    EXPECT_FALSE(find<QPushButton>("cmdStop")->isVisible());
    EXPECT_EQ(panel(3), "");
    EXPECT_EQ(window.size(), QSize(1024, 700));
    EXPECT_EQ(canvasAt(20, 10), kRedBulb);  // the editor shows every light
    EXPECT_EQ(rig.program.tables.RenderDataCount, 0);

    arrive(bulbFrame("100"));  // between two simulations: thrown away
    find<QAction>("mnuSimulationMode")->trigger();
    run(3);
    EXPECT_EQ(canvasAt(20, 10), kWhiteCanvas);
    EXPECT_EQ(std::ranges::count(rig.socket.calls, "bind 127.0.0.1 30303"), 1) << "the socket stays open";
}

TEST_F(MainWindow, ReturnsToTheEditorFromEachFailureToEnter) {
    openBulb();
    ZephSimulation& simulation = *rig.program.simulation;
    const std::pair<std::function<void()>, const char*> rows[] = {
        {[&] { simulation.Fixtures[1].ChannelCount = 0; }, "Qen Visualizer-Error|"},
        {[&] { rig.socket.taken = true; }, "Qen Visualizer-Port Error|"},
        {[&] { rig.clock.set(-1); }, "Qen Visualizer-Error:  Reboot Required|"},
        {[&] { rig.program.RenderEngine = kEngineOpenGL; }, ""},  // there is no context on this platform
    };
    for (const auto& [spoil, box] : rows) {
        host.notes.boxes.clear();
        spoil();
        find<QAction>("mnuSimulationMode")->trigger();
        EXPECT_FALSE(rig.program.simulating());
        // The refusal of a clock that runs backwards stays in view.
        EXPECT_EQ(panel(2), rig.clock.timeGetTime() < 0 ? "Can not enter simulation mode:  Time is running backwards."
                                                        : "Select Fixture");
        EXPECT_FALSE(find<QTimer>("hrTimer1")->isActive());
        EXPECT_TRUE(window.isVisible());
        EXPECT_THAT(host.notes.boxTexts(), testing::StartsWith(box));
        EXPECT_EQ(host.notes.boxes.size(), *box ? 1u : 0u) << box;
        simulation.Fixtures[1].ChannelCount = 1;
        rig.socket.taken = false;
        rig.clock.set(100'000);
        rig.program.RenderEngine = kEngineStandard;
    }
    EXPECT_THAT(host.notes.panel2History, testing::Contains("Creating Rendering Window"));
    find<QAction>("mnuSimulationMode")->trigger();
    EXPECT_TRUE(rig.program.simulating());
}

TEST_F(MainWindow, TakesAssembledRibbonsApartAgain) {
    openBulb();
    ZephSimulation& simulation = *rig.program.simulation;
    for (const int pixel : {1, 4}) {
        ZephFixture& ribbon = addFixture(simulation, kFixtureKesh, {{5, 5}});
        ribbon.Kesh.Base_Unit = 5;
        ribbon.Kesh.Physical_Pixel_Number = pixel;
    }
    find<QAction>("mnuSimulationMode")->trigger();
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 4);  // its own, two that are not drawn, and the child's
    key(Qt::Key_Escape);
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 1);

    simulation.Fixtures[3].Kesh.Physical_Pixel_Number = 1;  // two pieces on the same pixel
    find<QAction>("mnuSimulationMode")->trigger();
    expectEditor();
    EXPECT_EQ(host.notes.compileErrors.size(), 1U);
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 1);
}

TEST_F(MainWindow, AFileThatCannotBeOpenedLeavesAnEmptyWindow) {
    openBulb();
    EXPECT_FALSE(window.openFile(rig.folder.filePath("gone.zee"), false));
    EXPECT_FALSE(rig.program.simulation->SimulationOpen);
    EXPECT_TRUE(rig.program.picBackground.isNull());
    EXPECT_EQ(rig.program.simulation->FixtureCount, 0);
    EXPECT_THAT(host.notes.boxTexts(), testing::StartsWith("Qen Visualizer-Editor Load Error|"));
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -bulb.zee");  // the title keeps what it had
}

TEST_F(MainWindow, TheGaugeShowsWhatWaits) {
    enter();
    rig.program.receive.Stream.ZephStackBuffer.append("\x01" + std::string(1'600'000, '0'));  // no frame ends here
    arrive("0");
    EXPECT_EQ(find<QProgressBar>("prbQueueLen")->value(), 1'600'001);
    EXPECT_TRUE(find<QProgressBar>("prbQueueLen")->styleSheet().contains("#ffff00"));
}

TEST_F(MainWindow, StoppingAndClosingEndASimulationOnlyUnlessTheSettingSaysMore) {
    enter();
    click<QPushButton>("cmdStop");
    run(2);
    EXPECT_FALSE(rig.program.simulating());

    find<QAction>("mnuSimulationMode")->trigger();
    ASSERT_TRUE(rig.program.simulating());
    EXPECT_FALSE(window.close());
    run(2);
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_TRUE(window.isVisible());

    rig.program.settings.EndStopsSimulation = false;
    find<QAction>("mnuSimulationMode")->trigger();
    window.close();
    run(2);
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_FALSE(window.isVisible());
    EXPECT_EQ(rig.socket.State(), 0);
}

TEST_F(MainWindow, TellsOfADisplayWithoutChannels) {
    openBulb();
    host.seen = true;
    rig.program.simulation->Fixtures[1].ChannelCount = 0;
    QString told;
    QTimer::singleShot(50, &window, [&] {
        auto* box = qobject_cast<QMessageBox*>(QApplication::activeModalWidget());
        ASSERT_NE(box, nullptr);
        told = box->windowTitle() + "|" + box->text();
        box->button(QMessageBox::Ok)->click();
    });
    find<QAction>("mnuSimulationMode")->trigger();
    EXPECT_EQ(told, "Qen Visualizer-Error|There are no channels to simulate.");
    EXPECT_EQ(panel(2), "Select Fixture");
}

TEST(CompileErrors, SelectsItsTextOnFocusAndClosesByItsButton) {
    frmZephCompileErrors dialog;
    dialog.SetErrorMessage("first\r\nsecond");
    auto* txtError = dialog.findChild<QPlainTextEdit*>("txtError");
    auto* cmdOK = dialog.findChild<QPushButton*>("cmdOK");
    ASSERT_TRUE(txtError && cmdOK);
    EXPECT_TRUE(txtError->isReadOnly());
    EXPECT_EQ(txtError->toPlainText(), "first\nsecond");
    dialog.show();
    ASSERT_TRUE(QTest::qWaitForWindowActive(&dialog));
    txtError->setFocus();
    QTest::qWait(20);
    EXPECT_EQ(txtError->textCursor().selectedText().size(), 12);
    QTest::mouseClick(cmdOK, Qt::LeftButton);
    EXPECT_FALSE(dialog.isVisible());
}

int main(int argc, char** argv) {
    qputenv("QT_QPA_PLATFORM", "offscreen");
    QApplication application(argc, argv);
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
