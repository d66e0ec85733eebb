#include "shell/command_icons.h"
#include "tests/shell/window_rig.h"

#include <QApplication>
#include <QCheckBox>
#include <QMenu>
#include <QMenuBar>
#include <QScrollBar>
#include <QSlider>
#include <QTableWidget>
#include <QToolButton>

namespace {

// The first pixel that covers what lies behind it; not valid where nothing was drawn.
QColor firstInk(const QImage& drawn) {
    for (int y = 0; y < drawn.height(); ++y) {
        for (int x = 0; x < drawn.width(); ++x) {
            if (drawn.pixelColor(x, y).alpha() == 255) return drawn.pixelColor(x, y);
        }
    }
    return QColor();
}

// The window with a document of three fixtures: "Bulb" alone on level 1, "Left" and "Right" of the prop "Pair", on a
// canvas of 60 x 30 pixels or larger.
struct WindowCommands : WindowRig {
    void open(int widthPixels = 60, int heightPixels = 30) {
        const auto display = std::make_unique<ZephSimulation>();
        ShellRig::buildDisplay(*display);
        display->Background.EditorWidthTwips = widthPixels * TwipsPerPixelX;
        display->Background.EditorHeightTwips = heightPixels * TwipsPerPixelY;
        display->PropCount = 1;
        display->Props[1].Name = "Pair";
        for (const char* name : {"Left", "Right"}) {
            ZephFixture& fixture = display->Fixtures[++display->FixtureCount];
            fixture = display->Fixtures[1];
            fixture.Name = name;
            ZephAddFixtureToProp(display->FixtureCount, 1, *display);
        }
        display->Fixtures[3].ZOrder = 16;
        WindowRig::open(*display, "pair.zee");
    }
    QTableWidget* list() { return find<QTableWidget>("flgObjectSelect"); }
    QPoint rowCentre(int row) { return list()->visualItemRect(list()->item(row, 0)).center(); }
    void clickRow(int row) { QTest::mouseClick(list()->viewport(), Qt::LeftButton, {}, rowCentre(row)); }
    QStringList rows() {
        QStringList texts;
        for (int row = 0; row < list()->rowCount(); ++row)
            texts.append(list()->item(row, 0)->text());
        return texts;
    }
    bool pressed(const char* button) { return find<QToolButton>(button)->isChecked(); }
};

}  // namespace

TEST_F(WindowCommands, EveryCommandHasItsActionPictureAndTip) {
    open();
    for (const CommandRow& row : kCommandTable) {
        if (row.id == Command::None) continue;
        if (row.kind == CommandKind::Menu) {
            EXPECT_NE(window.findChild<QMenu*>(toQString(row.name)), nullptr) << row.name;
            continue;
        }
        auto* action = find<QAction>(std::string(row.name).c_str());
        EXPECT_TRUE(firstInk(action->icon().pixmap(20).toImage()).isValid()) << row.name;
        EXPECT_FALSE(action->toolTip().isEmpty()) << row.name;
        EXPECT_EQ(action->shortcut().isEmpty(), row.shortcut.empty()) << row.name;
        if (!row.pop.empty()) {
            EXPECT_NE(window.findChild<QAction*>(toQString(row.pop)), nullptr) << row.pop;
        }
        if (!row.built) {
            EXPECT_FALSE(action->isEnabled()) << row.name;
        }
    }
    for (const QToolButton* button : window.findChildren<QToolButton*>()) {
        if (button->objectName().startsWith("qt_")) continue;  // what unfolds a bar that is too long
        EXPECT_FALSE(button->toolTip().isEmpty()) << button->objectName().toStdString();
    }
}

TEST_F(WindowCommands, PicturesTakeTheirInkFromThePalette) {
    const auto ink = [](QIcon::Mode mode) {
        return firstInk(commandIcon("draw-bulbs").pixmap(48, 48, mode).toImage());
    };
    const QPalette before = QApplication::palette();
    QPalette blue;
    blue.setColor(QPalette::ButtonText, QColor(0, 0, 255));
    blue.setColor(QPalette::Disabled, QPalette::ButtonText, QColor(0, 128, 0));
    QApplication::setPalette(blue);
    EXPECT_EQ(ink(QIcon::Normal), QColor(0, 0, 255));
    EXPECT_EQ(ink(QIcon::Disabled), QColor(0, 128, 0));
    QApplication::setPalette(before);
}

TEST_F(WindowCommands, WithoutADocumentOnlyFilesAndHelpCanBeReached) {
    window.show();
    QStringList enabled;
    for (const CommandRow& row : kCommandTable) {
        if (row.id == Command::None || row.kind == CommandKind::Menu) continue;
        if (find<QAction>(std::string(row.name).c_str())->isEnabled()) enabled.append(toQString(row.name));
    }
    EXPECT_EQ(enabled, (QStringList{"mnuFileNew", "mnuFileLoad", "mnuFileOptions", "mnuFileExit", "mnuHelpAbout"}));
    EXPECT_FALSE(find<QToolButton>("chkCmdFixtureOrProp(1)")->isEnabled());
    EXPECT_FALSE(find<QMenu>("mnuDebug")->menuAction()->isVisible());
    key(Qt::Key_F2);
    EXPECT_EQ(rig.program.editor.ZephUIState, kStateSelectFixture);
}

TEST_F(WindowCommands, KeysAndButtonsChangeTheMode) {
    open();
    EXPECT_EQ(rows(), (QStringList{"Bulb", "Left", "Right"}));
    EXPECT_TRUE(pressed("DrawToolBar(3)"));
    EXPECT_FALSE(find<QCheckBox>("chkSimplePropMode")->isVisible());
    key(Qt::Key_F2);
    EXPECT_EQ(panel(2), "Select Prop");
    EXPECT_TRUE(pressed("DrawToolBar(2)"));
    EXPECT_FALSE(pressed("DrawToolBar(3)"));
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(1)"));
    EXPECT_FALSE(pressed("chkCmdFixtureOrProp(0)"));
    EXPECT_EQ(rows(), (QStringList{"Pair", "Bulb"}));  // the key of a whole prop keeps its capitals
    QTest::mouseClick(find<QCheckBox>("chkSimplePropMode"), Qt::LeftButton, {}, QPoint(8, 8));
    EXPECT_EQ(rows(), (QStringList{"Bulb", "Pair\n(Left)", "Pair\n(Right)"}));

    click<QToolButton>("chkCmdFixtureOrProp(1)");
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(1)"));  // stays pressed
    click<QToolButton>("DrawToolBar(3)");
    EXPECT_EQ(panel(2), "Select Fixture");
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(0)"));
    click<QToolButton>("DrawToolBar(3)");
    EXPECT_TRUE(pressed("DrawToolBar(3)"));
}

TEST_F(WindowCommands, TheListAndTabSelect) {
    open();
    clickRow(2);
    EXPECT_EQ(panel(2), "Fixture Selected:Right - Layer:16");
    EXPECT_EQ(find<QAction>("mnuMoveForward")->toolTip(), "Move Forward");
    EXPECT_EQ(find<QAction>("mnuMoveBackward")->toolTip(), "Move Backward (to level:15)");
    key(Qt::Key_Tab);
    EXPECT_EQ(panel(2), "Fixture Selected:Bulb - Layer:1");
    key(Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_EQ(panel(2), "Fixture Selected:Right - Layer:16");
    QTest::mouseClick(list()->viewport(), Qt::RightButton, {}, rowCentre(1));
    QTest::mousePress(list()->viewport(), Qt::LeftButton, {}, rowCentre(0));
    QTest::mouseMove(list()->viewport(), rowCentre(1));
    QTest::mouseRelease(list()->viewport(), Qt::LeftButton, {}, rowCentre(1));
    EXPECT_EQ(list()->selectedItems(), QList<QTableWidgetItem*>{list()->item(2, 0)});
    key(Qt::Key_F2);
    EXPECT_EQ(rig.program.editor.ZephSelection.Object, 0);
    EXPECT_EQ(find<QAction>("mnuObjectProperties")->text(), "Prop Properties");

    clickRow(0);
    ASSERT_TRUE(window.openFile(QString::fromStdString(file), false));
    EXPECT_EQ(rig.program.editor.ZephSelection.Object, 0);  // another document, another selection
    EXPECT_EQ(panel(2), "Select Fixture");
}

TEST_F(WindowCommands, ASimulationHidesTheEditorAndFreezesItsKeys) {
    open();
    clickRow(0);
    key(Qt::Key_F5);
    ASSERT_TRUE(rig.program.simulating());
    for (const char* hidden : {"CoolBar1", "flgObjectSelect", "chkCmdFixtureOrProp(0)", "chkCmdFixtureOrProp(1)"})
        EXPECT_FALSE(find<QWidget>(hidden)->isVisible()) << hidden;
    for (const char* shown : {"cmdStop", "cmdSEPlay", "cmdSEStop", "prbQueueLen"})
        EXPECT_TRUE(find<QWidget>(shown)->isVisible()) << shown;
    EXPECT_FALSE(window.menuBar()->isVisible());
    key(Qt::Key_F2);
    key(Qt::Key_F5);
    EXPECT_TRUE(rig.program.simulating());
    key(Qt::Key_Escape);
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_TRUE(find<QWidget>("flgObjectSelect")->isVisible());
    EXPECT_TRUE(pressed("DrawToolBar(3)"));
}

TEST_F(WindowCommands, ScrollsInPerCentAndInASimulationInPixels) {
    open(2000, 1500);
    auto* bar = find<QScrollBar>("HScroll1");
    auto* canvas = find<QWidget>("picMain");
    auto* viewport = find<QFrame>("picViewport");
    ASSERT_TRUE(bar->isVisible());
    EXPECT_EQ(bar->maximum(), 100);
    const int left = viewport->contentsRect().left();
    EXPECT_EQ(canvas->x(), left);
    bar->setValue(100);
    EXPECT_EQ(canvas->x() + canvas->width(), left + viewport->contentsRect().width());
    key(Qt::Key_F5);
    EXPECT_EQ(canvas->x(), 0);
    EXPECT_EQ(bar->maximum(), 2000 - viewport->width());
    bar->setValue(7);
    EXPECT_EQ(canvas->x(), -7);
    key(Qt::Key_Escape);
    EXPECT_EQ(bar->maximum(), 100);
    EXPECT_EQ(window.size(), QSize(1024, 700));

    open();  // a small canvas stands in the middle without bars
    EXPECT_FALSE(find<QScrollBar>("HScroll1")->isVisible());
    EXPECT_FALSE(find<QScrollBar>("VScroll1")->isVisible());
    const QRect room = find<QFrame>("picViewport")->contentsRect();
    EXPECT_LE(std::abs(find<QWidget>("picMain")->geometry().center().x() - room.center().x()), 1);
}

TEST_F(WindowCommands, TheBrightnessIsTakenOverOnceTheSliderRests) {
    open();
    auto* slider = find<QSlider>("sldIntensity");
    ASSERT_TRUE(slider->isEnabled());
    EXPECT_EQ(panel(1), "");
    slider->setValue(0);
    EXPECT_EQ(slider->toolTip(), "0 %");
    EXPECT_EQ(panel(1), "Changed");
    EXPECT_TRUE(rig.program.simulation->SimulationDirty);
    EXPECT_EQ(rig.program.simulation->Background.PicIntensity, 100);
    QTest::qWait(800);
    EXPECT_EQ(rig.program.simulation->Background.PicIntensity, 0);
    EXPECT_EQ(canvasAt(55, 25), QColor(0, 0, 0));
}

TEST_F(WindowCommands, TheRecentFileOpensAgain) {
    open();
    EXPECT_TRUE(find<QMenu>("mnuFileRecent")->menuAction()->isVisible());
    auto* recent = find<QAction>("mnuRecentFiles(0)");
    EXPECT_TRUE(recent->text().startsWith("&1 ")) << recent->text().toStdString();
    EXPECT_FALSE(find<QAction>("mnuRecentFiles(1)")->isVisible());
    rig.program.simulation->Fixtures[1].Name = "Gone";
    recent->trigger();
    EXPECT_EQ(rig.program.simulation->Fixtures[1].Name, "Bulb");
}

TEST_F(WindowCommands, TheContextMenuComesByMouseAndKey) {
    open();
    auto* menu = find<QMenu>("popContextMenu");
    key(Qt::Key_Menu);
    EXPECT_TRUE(menu->isVisible());
    menu->close();
    auto* canvas = find<QWidget>("picMain");
    QContextMenuEvent asked(QContextMenuEvent::Mouse, QPoint(5, 5), canvas->mapToGlobal(QPoint(5, 5)));
    QCoreApplication::sendEvent(canvas, &asked);
    EXPECT_TRUE(menu->isVisible());
    EXPECT_EQ(find<QAction>("popCut")->text(), "Cu&t\tCtrl+X");
    menu->close();
}
