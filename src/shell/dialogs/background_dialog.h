// The background of a display: its picture, the size of the canvas, the brightness, and the lines of the grid. The
// dialog works on a draft; whoever opened it takes the draft when it was accepted.
#pragma once

#include "editor/background_change.h"
#include "shell/dialogs/color_button.h"
#include "shell/dialogs/picture_picker.h"

#include <QDialog>
#include <QTimer>

class PicturePreview;
class QComboBox;
class QLabel;
class QSlider;

// How the dialog is opened.
struct BackgroundDialogTerms {
    bool AllowCancel = true;
    bool NewSimulation = false;  // there is no canvas yet whose size could be told
    std::string PictureFile;     // where the picture of the draft lies; "" = it has none
    QString PictureFolder;       // where the file dialog begins
};

// What the dialog asks of whoever opens it.
struct BackgroundDesk {
    Host& host;
    PicturePicker pickPicture = ::pickPicture;
    ColorPicker pickColor = ::pickColor;
};

class frmZephBackground : public QDialog {
public:
    frmZephBackground(const ZephBackgroundDraft& draft, BackgroundDialogTerms terms, BackgroundDesk desk,
                      QWidget* parent = nullptr);

    bool AllowCancel() const { return terms_.AllowCancel; }
    bool Cancelled() const { return result() != Accepted; }
    // The background is another one than at opening, or its picture was chosen again.
    bool SimInfoChanged() const { return draft_.PictureChosen || draft_.Background != atOpening_; }
    // The draft as it was edited; good once the dialog was accepted.
    const ZephBackgroundDraft& draft() const { return draft_; }

    void CheckControls();
    void MakePreview();
    void ResizeSimulation(QSize size);

    // Where it may not be cancelled, neither Esc nor the window's own button close it.
    void reject() override;

private:
    void cmdOpen_Click();
    void cmdNoBackground_Click();
    void cmdResize_Click();
    void sldIntensity_Change(int intensity);
    void cmdOK_Click();
    std::optional<std::int32_t> pickGridColor(std::int32_t color, const QString& title, QWidget* over);
    void showPicture();

    QWidget* pictureGroup();
    QWidget* sizeGroup();
    QWidget* gridGroup();

    ZephBackgroundDraft draft_;
    const ZephBackground atOpening_;
    const BackgroundDialogTerms terms_;
    BackgroundDesk desk_;
    QImage Image1_;               // the picture in its own size; null = none loaded
    bool previewFailed_ = false;  // and that was told
    QTimer tmrPreview_;

    PicturePreview* picPreview_;
    QLabel* lblFileName_ = nullptr;
    QLabel* lblImageSize_ = nullptr;
    QPushButton* cmdNoBackground_ = nullptr;
    QLabel* lblNewSize_ = nullptr;
    QSlider* sldIntensity_ = nullptr;
    QLabel* lblIntensity_ = nullptr;
    QComboBox* cmbGridLineOption_ = nullptr;
    QSlider* sldGridLineDensity_ = nullptr;
    QLabel* lblGridLineDensity_ = nullptr;
    ColorButton* cmdGridLineColor_ = nullptr;
};
