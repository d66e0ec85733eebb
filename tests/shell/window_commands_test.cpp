#include "shell/command_icons.h"
#include "tests/shell/window_rig.h"

#include <QCheckBox>
#include <QMenu>
#include <QScrollBar>
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

// The window and a display of three fixtures: "Bulb" alone on level 1, "Left" and "Right" of the prop "Pair".
struct WindowCommands : WindowRig {
    void SetUp() override {
        WindowRig::SetUp();
        display->PropCount = 1;
        display->Props[1].Name = "Pair";
        for (const char* name : {"Left", "Right"}) {
            ZephFixture& fixture = display->Fixtures[++display->FixtureCount];
            fixture = display->Fixtures[1];
            fixture.Name = name;
            ZephAddFixtureToProp(display->FixtureCount, 1, *display);
        }
        display->Fixtures[3].ZOrder = 16;
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
        const QAction* made = action(std::string(row.name).c_str());
        EXPECT_TRUE(firstInk(made->icon().pixmap(20).toImage()).isValid()) << row.name;
        EXPECT_FALSE(made->toolTip().isEmpty()) << row.name;
        EXPECT_EQ(made->shortcut().isEmpty(), row.shortcut.empty()) << row.name;
        EXPECT_TRUE(row.pop.empty() || window.findChild<QAction*>(toQString(row.pop)) != nullptr) << row.pop;
        EXPECT_TRUE(row.built || !made->isEnabled()) << row.name;
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

TEST_F(WindowCommands, KeysAndButtonsChangeTheMode) {
    show();
    key(Qt::Key_F2);
    EXPECT_EQ(program.editor.ZephUIState, kStateSelectFixture) << "not without a document";
    open();
    EXPECT_EQ(rows(), (QStringList{"Bulb", "Left", "Right"}));
    EXPECT_FALSE(visible("chkSimplePropMode"));
    key(Qt::Key_F2);
    EXPECT_EQ(panel(2), "Select Prop");
    EXPECT_TRUE(pressed("DrawToolBar(2)"));
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(1)"));
    EXPECT_EQ(rows(), (QStringList{"Pair", "Bulb"}));  // the key of a whole prop keeps its capitals
    QTest::mouseClick(find<QCheckBox>("chkSimplePropMode"), Qt::LeftButton, {}, QPoint(8, 8));
    EXPECT_EQ(rows(), (QStringList{"Bulb", "Pair\n(Left)", "Pair\n(Right)"}));

    click("chkCmdFixtureOrProp(1)");
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(1)"));  // stays pressed
    click("DrawToolBar(3)");
    EXPECT_EQ(panel(2), "Select Fixture");
    EXPECT_TRUE(pressed("chkCmdFixtureOrProp(0)"));
}

TEST_F(WindowCommands, TheListAndTabSelect) {
    open();
    clickRow(2);
    EXPECT_EQ(action("mnuMoveBackward")->toolTip(), "Move Backward (to level:15)");
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
    EXPECT_EQ(action("mnuObjectProperties")->text(), "Prop Properties");
    clickRow(0);
    ASSERT_TRUE(openFile());
    EXPECT_EQ(program.editor.ZephSelection.Object, 0);  // another document, another selection
}

TEST_F(WindowCommands, ScrollsInPerCentAndInASimulationInPixels) {
    display->Background.EditorWidthTwips = 2000 * TwipsPerPixelX;
    display->Background.EditorHeightTwips = 1500 * TwipsPerPixelY;
    open();
    auto* bar = find<QScrollBar>("HScroll1");
    auto* canvas = find<QWidget>("picMain");
    auto* viewport = find<QFrame>("picViewport");
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

    buildDisplay();  // a small canvas stands in the middle without bars
    ASSERT_TRUE(openFile());
    EXPECT_FALSE(visible("HScroll1") || visible("VScroll1"));
    EXPECT_LE(std::abs(canvas->geometry().center().x() - viewport->contentsRect().center().x()), 1);
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
    EXPECT_EQ(action("popCut")->text(), "Cu&t\tCtrl+X");
    menu->close();
}
