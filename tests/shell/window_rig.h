// The real window on a real event loop, without the machine: a list for a socket, a clock set by hand, a folder that
// goes with the test.
#pragma once

#include "model/editor_writer.h"
#include "shell/main_window.h"
#include "shell/startup.h"
#include "tests/shell/controls.h"
#include "tests/support/fixtures.h"
#include "tests/support/list_socket.h"
#include "tests/support/loading.h"
#include "tests/support/map_settings_store.h"
#include "util/units.h"

#include <QAction>
#include <QApplication>
#include <QLabel>
#include <QPushButton>

// The window's host; keeps what was told, and answers boxes itself unless they are to be seen. A file dialog gives the
// next of a list, and is cancelled after the last.
class NotingHost : public WindowHost {
public:
    BoxAnswer messageBox(std::string_view title, std::string_view text, BoxIcon icon, BoxButtons buttons) override {
        return seen ? WindowHost::messageBox(title, text, icon, buttons) : notes.messageBox(title, text, icon, buttons);
    }
    void setStatusPanel(int panel, std::string_view text) override {
        notes.setStatusPanel(panel, text);
        WindowHost::setStatusPanel(panel, text);
    }
    void showCompileErrors(std::string_view text) override { notes.showCompileErrors(text); }
    QString askFile(const FileDialog& dialog, const QString&, bool) override {
        asked.append(QString::fromUtf8(dialog.title.data()));
        return chosen.isEmpty() ? QString() : chosen.takeFirst();
    }

    RecordingHost notes;
    QStringList chosen;
    QStringList asked;
    bool seen = false;
};

struct WindowRig : testing::Test, Controls {
    void SetUp() override {
        QImage white(1, 1, QImage::Format_RGB32);
        white.fill(Qt::white);
        white.save(folder.qPath("blank.gif"), "PNG");  // pictures are known by their content
        store.set("Advanced Render Engine", "False");  // no OpenGL on the platform of these tests
        EXPECT_TRUE(ZephReadSettingsAtStart(program));
        ZephStartUp([](std::string_view) {}, window, program);
        buildDisplay();
    }
    // A canvas of 60 x 30 pixels with one red bulb of radius 4 at (20, 10), on Qen unit 1, circuit 1.
    void buildDisplay() {
        display->Background = {0, "", 100, 60 * TwipsPerPixelX, 30 * TwipsPerPixelY};
        display->FixtureCount = 1;
        ZephFixture& fixture = display->Fixtures[1];
        InitializeFixture(ZephSettings{}, fixture);
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.Name = "Bulb";
        fixture.BulbSize = 4;
        fixture.BulbShape = 3;
        addChannel(fixture, 1, 1, 255);
        addPoint(fixture, kPointBulb, {20, 10});
    }
    void show() {
        window.resize(1024, 700);
        window.show();
        ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
    }
    // The display as an editor file in the window.
    bool openFile(bool quiet = false) {
        display->FilePath = folder.path();
        display->FileName = "bulb.zee";
        EXPECT_TRUE(ZephSaveVisualizerXML("1/1/2026 0:00:00 AM", program.files, *display));
        return window.openFile(QString::fromStdString(file), quiet);
    }
    void open() {
        show();
        ASSERT_TRUE(openFile());
    }
    QWidget& shown() override { return window; }
    QAction* action(const char* name) { return find<QAction>(name); }
    bool visible(const char* name) { return find<QWidget>(name)->isVisible(); }
    void key(Qt::Key pressed, Qt::KeyboardModifiers held = Qt::NoModifier) {
        QTest::keyClick(&window, pressed, held);
        QCoreApplication::processEvents();
    }
    QString panel(int number) { return find<QLabel>(qPrintable(QString("StatusBar1Panel%1").arg(number)))->text(); }
    QColor canvasAt(int x, int y) { return find<QWidget>("picMain")->grab().toImage().pixelColor(x, y); }
    ZephSimulation& document() { return *program.simulation; }

    NotingHost host;
    MapSettingsStore store;
    Folder folder;
    ManualClock clock{100'000};
    ListSocket socket;
    Program program{
        {host, clock, socket, store, [] { return std::vector<ZephAdapter>{}; }, folder.path(), folder.path(), 1}, {}};
    frmZephMain window{program, host};
    std::unique_ptr<ZephSimulation> display = std::make_unique<ZephSimulation>();
    std::string file = folder.path("bulb.zee");
};
