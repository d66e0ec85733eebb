// A new display: what it is drawn on, and how large the canvas is.
#pragma once

#include "editor/new_simulation.h"
#include "shell/dialogs/picture_picker.h"

#include <QDialog>
#include <QTimer>

class NumberField;
class PicturePreview;
class QButtonGroup;
class QLabel;
class QPushButton;

class frmZephNewSimulation : public QDialog {
public:
    // pictureFolder: where the file dialog begins.
    frmZephNewSimulation(const QString& pictureFolder, Host& host, PicturePicker pick = ::pickPicture,
                         QWidget* parent = nullptr);

    bool Cancelled() const { return result() != Accepted; }
    // What was entered; good once the dialog was accepted.
    const ZephNewSimulationChoice& choice() const { return choice_; }

    void MakePreview();

private:
    void rdoBackgroundType_Click(int type);
    void cmdOpen_Click();
    void CheckEnable();
    void OKButton_Click();
    QWidget* backgroundGroup();
    QWidget* sizeGroup();

    ZephNewSimulationChoice choice_;
    const QString pictureFolder_;
    Host& host_;
    PicturePicker pick_;
    QImage Image1_;
    QTimer tmrPreview_;

    PicturePreview* picPreview_;
    QButtonGroup* rdoBackgroundType_ = nullptr;
    QLabel* lblFileName_ = nullptr;
    QLabel* lblImageSize_ = nullptr;
    NumberField* mskWidth_;
    NumberField* mskHeight_;
    QPushButton* OKButton_;
};
