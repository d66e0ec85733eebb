#include "shell/dialogs/background_dialog.h"
#include "shell/dialogs/change_size_dialog.h"
#include "tests/shell/controls.h"
#include "tests/support/folder.h"
#include "tests/support/recording_host.h"
#include "util/units.h"

#include <QApplication>
#include <QCheckBox>
#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QSlider>
#include <QTimer>

namespace {

// A dialog on a draft, worked with clicks and keys; the pictures to be chosen lie in a folder of the test.
struct BackgroundDialogs : testing::Test, Controls {
    BackgroundDialogs() {
        QImage house(40, 20, QImage::Format_RGB32);
        house.fill(qRgb(200, 100, 50));
        house.save(folder.qPath("house.png"));
        folder.write("bad.png", "no picture");
        draft.Background = {0, "", 100, 80 * TwipsPerPixelX, 60 * TwipsPerPixelY};
    }
    void open(BackgroundDialogTerms terms = {}) {
        background =
            std::make_unique<frmZephBackground>(draft, std::move(terms), BackgroundDesk{host, pickPicture, pickColor});
        background->show();
    }
    QWidget& shown() override { return *background; }
    QString label(const char* name) { return find<QLabel>(name)->text(); }
    QColor previewed() {
        QTest::qWait(100);  // tmrPreview
        const QImage preview = find<QWidget>("picPreview")->grab().toImage();
        return preview.pixelColor(preview.width() / 2, preview.height() / 2);
    }
    // Works the size dialog from inside its own event loop.
    void resize(const std::function<void(frmZephChangeSize&)>& work) {
        QTimer::singleShot(0, [work] {
            auto* size = dynamic_cast<frmZephChangeSize*>(QApplication::activeModalWidget());
            ASSERT_NE(size, nullptr);
            work(*size);
            if (size->isVisible()) size->reject();
        });
        click("cmdResize");
    }

    Folder folder;
    RecordingHost host;
    QString toPick;
    PicturePicker pickPicture = [this](const QString&, const QString&, QWidget*) { return toPick; };
    ColorPicker pickColor = [](std::int32_t, const QString&, QWidget*) { return 0x112233; };
    ZephBackgroundDraft draft;
    std::unique_ptr<frmZephBackground> background;
};

void typeInto(QDialog& dialog, const char* field, const QString& text) {
    auto* box = dialog.findChild<QLineEdit*>(field);
    box->selectAll();
    if (text.isEmpty()) QTest::keyClick(box, Qt::Key_Delete);
    QTest::keyClicks(box, text);
}

}  // namespace

TEST_F(BackgroundDialogs, APictureIsChosenShownAndTakenAway) {
    open();
    EXPECT_FALSE(find<QPushButton>("cmdNoBackground")->isEnabled());
    EXPECT_EQ(previewed(), QColor(255, 255, 255));

    toPick = folder.qPath("bad.png");
    click("cmdOpen");
    EXPECT_EQ(host.boxTexts(),
              "Qen Visualizer-Picture Load Error|There was a problem loading this background picture.  "
              "Please select another.");
    EXPECT_EQ(label("lblFileName"), "none");

    toPick = folder.qPath("house.png");
    host.answers = {BoxAnswer::No, BoxAnswer::Yes};
    click("cmdOpen");
    EXPECT_THAT(host.boxTexts(), testing::EndsWith("\nQen Visualizer-Set Simulation Size|Would you like to set the "
                                                   "simulation size to the size of the background image?"));
    EXPECT_EQ(label("lblImageSize"), "40 x 20");
    EXPECT_EQ(label("lblNewSize"), "80 x 60");
    EXPECT_EQ(previewed(), QColor(200, 100, 50));
    click("cmdOpen");
    EXPECT_EQ(label("lblNewSize"), "40 x 20");
    EXPECT_EQ(label("lblEditorSize"), "80 x 60");
    click("cmdOK");
    EXPECT_FALSE(background->Cancelled());
    EXPECT_EQ(background->draft().Background, (ZephBackground{kBackgroundPicture, folder.path("house.png"), 100,
                                                              40 * TwipsPerPixelX, 20 * TwipsPerPixelY}));

    draft = {background->draft().Background};
    open({true, false, folder.path("house.png"), {}});
    EXPECT_FALSE(background->SimInfoChanged());
    host.answers = {BoxAnswer::No};
    click("cmdOpen");  // the same file, which may have been retouched
    EXPECT_EQ(background->draft().Background, draft.Background);
    EXPECT_TRUE(background->SimInfoChanged());
    click("cmdNoBackground");
    EXPECT_EQ(label("lblFileName"), "none");
    click("cmdCancel");
    EXPECT_TRUE(background->Cancelled());
}

TEST_F(BackgroundDialogs, AMissingPictureIsToldOnceAndTheGridIsOnlyOptions) {
    draft.Background.BackgroundType = kBackgroundPicture;
    draft.Background.PicFileName = "/gone/old.png";
    open({true, false, "/gone/old.png", {}});
    previewed();
    QTest::keyClick(find<QSlider>("sldIntensity"), Qt::Key_Home);
    EXPECT_EQ(label("lblIntensity"), "0 %");
    EXPECT_EQ(previewed(), QColor(0, 0, 0));
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Preview Load Error|There was a problem with the preview picture load.  "
                               "Please select another background.");
    EXPECT_EQ(label("lblFileName"), "old.png");
    QTest::keyClick(find<QSlider>("sldIntensity"), Qt::Key_End);

    EXPECT_FALSE(find<QSlider>("sldGridLineDensity")->isEnabled());
    find<QComboBox>("cmbGridLineOption")->setCurrentIndex(3);
    find<QSlider>("sldGridLineDensity")->setValue(20);
    EXPECT_EQ(label("lblGridLineDensity"), "200 px");
    click("cmdGridLineColor");
    click("cmdOK");
    EXPECT_FALSE(background->SimInfoChanged());
    EXPECT_EQ(background->draft(), (ZephBackgroundDraft{draft.Background, false, 3, 20, 0x112233}));
}

TEST_F(BackgroundDialogs, TheSizeDialogKeepsProportionsAndLimits) {
    open();
    resize([&](frmZephChangeSize& size) {
        auto* width = size.findChild<QLineEdit*>("txtNewWidth");
        auto* height = size.findChild<QLineEdit*>("txtNewHeight");
        typeInto(size, "txtNewWidth", "1x2-2");
        EXPECT_EQ(width->text(), "122");
        EXPECT_EQ(height->text(), "92");  // 91.5
        typeInto(size, "txtNewHeight", "");
        EXPECT_EQ(width->text(), "");
        QTest::mouseClick(size.findChild<QPushButton*>("cmdOK"), Qt::LeftButton);
        EXPECT_TRUE(size.isVisible());
        EXPECT_EQ(host.boxes.size(), 1U);
        size.findChild<QCheckBox*>("chkAspect")->click();
        typeInto(size, "txtNewWidth", "2500");
        EXPECT_EQ(height->text(), "");  // as it was
        typeInto(size, "txtNewHeight", "1876");
        QTest::keyClick(&size, Qt::Key_Return);
    });
    EXPECT_EQ(label("lblNewSize"), "2500 x 1876");
}
