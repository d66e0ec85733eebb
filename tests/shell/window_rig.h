// The real window on a real event loop; only socket, clock and folder are the test's.
#pragma once

#include "shell/main_window.h"
#include "tests/shell/shell_rig.h"

#include <QAction>
#include <QLabel>
#include <QPushButton>
#include <QTest>

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

    WindowHost host;
    ShellRig rig{host};
    frmZephMain window{rig.program, host};
    std::string file;
};
