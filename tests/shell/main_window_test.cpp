#include "engine/dialogs/compile_errors_dialog.h"
#include "tests/shell/window_rig.h"

#include <QApplication>
#include <QMenuBar>
#include <QMessageBox>
#include <QPlainTextEdit>
#include <QProgressBar>

namespace {

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
    const QSize before(1024, 700);
    enter();
    EXPECT_EQ(panel(2), "UDP Simulation active on 127.0.0.1 (30303)");
    EXPECT_FALSE(window.menuBar()->isVisible());
    EXPECT_FALSE(find<QWidget>("CoolBar1")->isVisible());
    EXPECT_TRUE(find<QProgressBar>("prbQueueLen")->isVisible());
    EXPECT_TRUE(find<QPushButton>("cmdStop")->isVisible());
    EXPECT_EQ(canvasAt(20, 10), QColor(255, 255, 255));
    rig.socket.reads.push_back(bulbFrame("100"));
    rig.socket.dataArrival();
    run(110);
    EXPECT_EQ(canvasAt(20, 10), QColor(255, 0, 0));
    EXPECT_TRUE(panel(3).startsWith("FPS:")) << panel(3).toStdString();

    key(Qt::Key_Escape);
    run(2);
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_TRUE(window.menuBar()->isVisible());
    EXPECT_FALSE(find<QPushButton>("cmdStop")->isVisible());
    EXPECT_EQ(panel(2), "Select Fixture");
    EXPECT_EQ(panel(3), "");
    EXPECT_EQ(window.size(), before);
    EXPECT_EQ(canvasAt(20, 10), QColor(255, 0, 0));  // the editor shows every light
}

TEST_F(MainWindow, TheGaugeShowsWhatWaits) {
    enter();
    rig.program.receive.Stream.ZephStackBuffer.append("\x01" + std::string(1'600'000, '0'));  // no frame ends here
    rig.socket.reads.push_back("0");
    rig.socket.dataArrival();
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
