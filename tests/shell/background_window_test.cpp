#include "tests/shell/window_rig.h"

#include <QDialog>
#include <QLineEdit>
#include <QPointer>
#include <QRadioButton>
#include <QSlider>
#include <QTimer>

namespace {

struct BackgroundWindow : WindowRig {
    void SetUp() override {
        // A dialog that nobody works would hold the test for ever.
        guard.callOnTimeout([] {
            const QWidget* left = QApplication::activeModalWidget();
            if (left != nullptr) qFatal("left open: %s", qPrintable(left->windowTitle()));
        });
        guard.start(10'000);
        working.callOnTimeout([this] { workDialog(); });
        working.start(20);
        WindowRig::SetUp();
        show();
        QImage house(40, 20, QImage::Format_RGB32);
        house.fill(qRgb(200, 100, 50));
        house.save(folder.qPath("house.png"));
    }
    // A display of 60 x 30 pixels with one bulb at (20, 10).
    bool open(const std::string& picture, bool quiet = false, int widthPx = 60) {
        display->Background.BackgroundType = picture.empty() ? 0 : kBackgroundPicture;
        display->Background.PicFileName = picture;
        display->Background.EditorWidthTwips = widthPx * TwipsPerPixelX;
        return openFile(quiet);
    }
    // The modal dialogs that the next step opens, one after the other.
    void expectDialogs(std::vector<std::function<void(QDialog&)>> work) { waiting = std::move(work); }
    void workDialog() {
        auto* dialog = qobject_cast<QDialog*>(QApplication::activeModalWidget());
        if (waiting.empty() || dialog == nullptr || dialog == last) return;
        last = dialog;
        const auto work = waiting.front();
        waiting.erase(waiting.begin());
        work(*dialog);
    }
    void run(const char* command) { action(command)->trigger(); }
    static void press(QDialog& dialog, const char* button) {
        QTest::mouseClick(dialog.findChild<QPushButton*>(button), Qt::LeftButton);
    }
    static void type(QDialog& dialog, const char* field, const char* text) {
        dialog.findChild<QLineEdit*>(field)->setText(text);
    }
    // Through the size dialog, which keeps the proportions.
    static void resizeAndAccept(QDialog& dialog, const char* width) {
        QTimer::singleShot(0, &dialog, [width] {
            auto* size = qobject_cast<QDialog*>(QApplication::activeModalWidget());
            size->findChild<QLineEdit*>("txtNewWidth")->selectAll();
            QTest::keyClicks(size->findChild<QLineEdit*>("txtNewWidth"), width);
            press(*size, "cmdOK");
        });
        press(dialog, "cmdResize");
        press(dialog, "cmdOK");
    }
    std::vector<std::string> titles() const {
        std::vector<std::string> shown;
        for (const RecordingHost::Box& box : host.notes.boxes)
            shown.push_back(box.title.substr(kProgramName.size()));
        return shown;
    }

    QTimer guard;
    QTimer working;
    std::vector<std::function<void(QDialog&)>> waiting;
    QPointer<QDialog> last;  // forgets it once it is gone: the next one may lie at its place
};

using Titles = std::vector<std::string>;

}  // namespace

TEST_F(BackgroundWindow, ANewSimulationAsksFirstAndReplacesTheOldOne) {
    ASSERT_TRUE(open(""));
    document().SimulationDirty = true;
    run("mnuFileNew");
    EXPECT_EQ(host.notes.boxTexts(), "Qen Visualizer-Save?|This editor session has not been saved.  Are you sure you "
                                     "want to start a new one?");
    EXPECT_EQ(document().FixtureCount, 1);

    host.notes.answers = {BoxAnswer::Yes};
    expectDialogs({[&](QDialog& dialog) {
        const QWidget* band = window.findChild<QWidget*>("CoolBar1");
        EXPECT_GE(dialog.y(), band->mapToGlobal(QPoint(0, band->height())).y());
        auto* ok = dialog.findChild<QPushButton*>("OKButton");
        auto* width = dialog.findChild<QLineEdit*>("mskWidth");
        width->selectAll();
        QTest::keyClicks(width, "7-01234");
        EXPECT_EQ(width->text(), "7012");  // four digits
        EXPECT_FALSE(ok->isEnabled());
        type(dialog, "mskWidth", "70");
        type(dialog, "mskHeight", "50");
        EXPECT_TRUE(ok->isEnabled());
        dialog.findChild<QRadioButton*>("rdoBackgroundType(2)")->click();
        EXPECT_FALSE(ok->isEnabled());  // no file
        dialog.findChild<QRadioButton*>("rdoBackgroundType(0)")->click();
        QTest::keyClick(&dialog, Qt::Key_Return);
    }});
    run("mnuFileNew");
    EXPECT_EQ(document().FixtureCount, 0);
    EXPECT_FALSE(document().SimulationDirty);
    EXPECT_EQ(document().FileName, "");
    EXPECT_EQ(find<QWidget>("picMain")->size(), QSize(70, 50));
}

TEST_F(BackgroundWindow, WhatIsTooLargeGoesThroughTheBackgroundDialog) {
    expectDialogs({[](QDialog& dialog) {
        EXPECT_FALSE(dialog.findChild<QPushButton*>("cmdCancel")->isVisible());
        QTest::keyClick(&dialog, Qt::Key_Escape);
        EXPECT_TRUE(dialog.isVisible());
        resizeAndAccept(dialog, "2500");
    }});
    ASSERT_TRUE(open("", false, 2501));
    EXPECT_EQ(titles(), Titles{"-Maximum Size"});
    EXPECT_EQ(find<QWidget>("picMain")->width(), 2500);
    EXPECT_TRUE(document().SimulationDirty);
    ASSERT_TRUE(open("", false, 2500));
    EXPECT_EQ(titles(), Titles{"-Maximum Size"});

    const auto tooLarge = [](QDialog& dialog) {
        type(dialog, "mskWidth", "5000");
        type(dialog, "mskHeight", "100");
        press(dialog, "OKButton");
    };
    expectDialogs({tooLarge, [](QDialog& dialog) { dialog.reject(); }});
    run("mnuFileNew");
    EXPECT_EQ(titles(), (Titles{"-Maximum Size", "-Maximum Size"}));
    EXPECT_EQ(document().FileName, "bulb.zee");  // given up: the old display is whole
    EXPECT_EQ(document().FixtureCount, 1);
    expectDialogs({tooLarge, [](QDialog& dialog) {
                       EXPECT_EQ(dialog.findChild<QLabel*>("lblEditorSize")->text(), "(new)");
                       resizeAndAccept(dialog, "2500");
                   }});
    run("mnuFileNew");
    EXPECT_EQ(document().FileName, "");
    EXPECT_EQ(find<QWidget>("picMain")->size(), QSize(2500, 50));
}

TEST_F(BackgroundWindow, TheBackgroundDialogMovesPointsAndKeepsTheBandInStep) {
    ASSERT_TRUE(open(""));
    program.editor.ZephSelection.Object = 1;
    auto* band = window.findChild<QWidget*>("CoolBar1")->findChild<QSlider*>("sldIntensity");
    band->setValue(90);  // its timer is still to come
    expectDialogs({[&](QDialog& dialog) {
        auto* slider = dialog.findChild<QSlider*>("sldIntensity");
        EXPECT_EQ(slider->value(), 90);
        slider->setValue(50);
        resizeAndAccept(dialog, "120");
    }});
    run("mnuBackgroundProperties");
    EXPECT_EQ(band->value(), 50);
    EXPECT_EQ(document().Fixtures[1].DrawPoints[1],
              (ZephDrawPoint{kPointBulb, 40 * TwipsPerPixelX, 20 * TwipsPerPixelY}));
    EXPECT_EQ(canvasAt(40, 20), QColor(255, 0, 0));
    EXPECT_EQ(canvasAt(115, 55), QColor(127, 127, 127));
    EXPECT_EQ(program.editor.ZephSelection.Object, 0);
    EXPECT_EQ(panel(1), "Changed");
    QTest::qWait(800);
    EXPECT_EQ(document().Background.PicIntensity, 50);  // the band's timer has nothing left to say
    band->setValue(0);
    EXPECT_EQ(band->toolTip(), "0 %");
    EXPECT_EQ(document().Background.PicIntensity, 50) << "taken over once the slider rests";
    QTest::qWait(800);
    EXPECT_EQ(canvasAt(115, 55), QColor(0, 0, 0));
}

TEST_F(BackgroundWindow, APictureIsFoundBesideTheDisplayOrAskedForUnlessTheLoadIsQuiet) {
    const std::string house = folder.path("house.png");
    ASSERT_TRUE(open("/old/place/house.png"));
    EXPECT_TRUE(titles().empty());
    EXPECT_EQ(document().Background.PicFileName, house);
    EXPECT_FALSE(document().SimulationDirty);
    ASSERT_TRUE(open("/gone/other.png", true));
    EXPECT_EQ(titles(), Titles{"-Picture Load Error"});
    EXPECT_EQ(document().Background.PicFileName, "/gone/other.png");

    expectDialogs({[](QDialog& dialog) {
        EXPECT_EQ(dialog.windowTitle(), "Where is the picture \"other.png\"?");
        dialog.reject();
    }});
    ASSERT_TRUE(open("/gone/other.png"));
    EXPECT_EQ(document().Background.PicFileName, "/gone/other.png");
    EXPECT_FALSE(document().SimulationDirty);

    host.notes.boxes.clear();
    const auto choose = [&](const char* wanted) {
        return [path = folder.qPath(wanted)](QDialog& dialog) {
            auto* name = dialog.findChild<QLineEdit*>("fileNameEdit");
            name->setText(path);
            QTest::keyClick(name, Qt::Key_Return);
        };
    };
    expectDialogs({choose("bulb.zee"), choose("house.png")});
    ASSERT_TRUE(open("/gone/other.png"));
    EXPECT_EQ(titles(), (Titles{"-Picture Load Error", "-Picture Load Error"}));  // not found; then no picture
    EXPECT_EQ(document().Background.PicFileName, house);
    EXPECT_TRUE(document().SimulationDirty);
    EXPECT_EQ(canvasAt(55, 25), QColor(200, 100, 50));
}
