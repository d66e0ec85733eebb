// The real window on a real event loop; only socket, clock and folder are the test's.
#pragma once

#include "shell/main_window.h"
#include "tests/shell/shell_rig.h"

#include <QAction>
#include <QLabel>
#include <QPushButton>
#include <QTest>

// The window's host; keeps what was told, and answers boxes itself unless they are to be seen.
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

    RecordingHost notes;
    bool seen = false;
};

struct WindowRig : testing::Test {
    void SetUp() override {
        rig.start();
        rig.startUp(window);
    }
    // Shows the window with the document in it.
    void open(ZephSimulation& document, const std::string& name) {
        file = rig.save(document, name);
        window.resize(1024, 700);
        window.show();
        ASSERT_TRUE(QTest::qWaitForWindowActive(&window));
        ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
    }
    template <typename Object>
    Object* find(const char* name) {
        auto* object = window.findChild<Object*>(name);
        if (object == nullptr) throw Failure(std::string("there is no ") + name);
        return object;
    }
    void key(Qt::Key pressed, Qt::KeyboardModifiers held = Qt::NoModifier) {
        QTest::keyClick(&window, pressed, held);
        QCoreApplication::processEvents();
    }
    template <typename Button>
    void click(const char* name) {
        QTest::mouseClick(find<Button>(name), Qt::LeftButton);
    }
    QString panel(int number) { return find<QLabel>(qPrintable(QString("StatusBar1Panel%1").arg(number)))->text(); }
    QColor canvasAt(int x, int y) { return find<QWidget>("picMain")->grab().toImage().pixelColor(x, y); }

    NotingHost host;
    ShellRig rig{host};
    frmZephMain window{rig.program, host};
    std::string file;
};
