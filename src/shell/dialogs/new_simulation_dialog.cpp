#include "shell/dialogs/new_simulation_dialog.h"

#include "editor/background.h"
#include "shell/dialogs/dialog_parts.h"
#include "shell/dialogs/number_field.h"
#include "shell/dialogs/picture_preview.h"
#include "util/text.h"
#include "util/units.h"

#include <QButtonGroup>
#include <QRadioButton>

namespace {

constexpr int kPreviewDelayMs = 40;
constexpr int kFileNamePx = 230;
constexpr int kMaskDigits = 4;
constexpr int kBackgroundBlank = 0;

}  // namespace

frmZephNewSimulation::frmZephNewSimulation(const QString& pictureFolder, Host& host, PicturePicker pick,
                                           QWidget* parent)
    : QDialog(parent), pictureFolder_(pictureFolder), host_(host), pick_(std::move(pick)),
      picPreview_(new PicturePreview), mskWidth_(new NumberField("mskWidth", kMaskDigits)),
      mskHeight_(new NumberField("mskHeight", kMaskDigits)), OKButton_(pushButton("OKButton", tr("OK"))) {
    setObjectName("frmZephNewSimulation");
    setWindowTitle(QString::fromStdString(boxTitle("-New Simulation")));
    tmrPreview_.setObjectName("tmrPreview");
    tmrPreview_.setSingleShot(true);
    tmrPreview_.setInterval(kPreviewDelayMs);
    connect(&tmrPreview_, &QTimer::timeout, this, &frmZephNewSimulation::MakePreview);

    QPushButton* CancelButton = pushButton("CancelButton", tr("Cancel"));
    connect(OKButton_, &QPushButton::clicked, this, &frmZephNewSimulation::OKButton_Click);
    connect(CancelButton, &QPushButton::clicked, this, &QDialog::reject);
    layOutBesidePicture(picPreview_, {backgroundGroup(), sizeGroup()}, closingRow(OKButton_, CancelButton), *this);
    mskWidth_->setFocus();
    mskWidth_->selectAll();
    CheckEnable();
}

QWidget* frmZephNewSimulation::backgroundGroup() {
    rdoBackgroundType_ = new QButtonGroup(this);
    auto* column = new QVBoxLayout;
    for (const auto& [type, text] :
         {std::pair{kBackgroundBlank, tr("&Blank, white")}, std::pair{int{kBackgroundPicture}, tr("A &picture")}}) {
        auto* choice = new QRadioButton(text);
        choice->setObjectName(QString("rdoBackgroundType(%1)").arg(type));
        rdoBackgroundType_->addButton(choice, type);
        column->addWidget(choice);
    }
    rdoBackgroundType_->button(kBackgroundBlank)->setChecked(true);
    connect(rdoBackgroundType_, &QButtonGroup::idToggled, this, [this](int type, bool on) {
        if (on) rdoBackgroundType_Click(type);
    });
    lblFileName_ = valueLabel("lblFileName", tr("none"));
    lblFileName_->setFixedWidth(kFileNamePx);
    lblImageSize_ = valueLabel("lblImageSize", tr("(none loaded)"));
    QPushButton* cmdOpen = pushButton("cmdOpen", tr("&Select Picture..."));
    connect(cmdOpen, &QPushButton::clicked, this, &frmZephNewSimulation::cmdOpen_Click);
    QFormLayout* picture = labelledForm();
    picture->addRow(tr("File:"), lblFileName_);
    picture->addRow(tr("Image Size:"), lblImageSize_);
    picture->addRow(cmdOpen);
    column->addLayout(picture);
    return groupBox(tr("Background"), column);
}

QWidget* frmZephNewSimulation::sizeGroup() {
    QFormLayout* form = labelledForm();
    form->addRow(tr("&Width:"), mskWidth_);
    form->addRow(tr("&Height:"), mskHeight_);
    for (NumberField* field : {mskWidth_, mskHeight_}) {
        field->setText("0");
        connect(field, &QLineEdit::textChanged, this, &frmZephNewSimulation::CheckEnable);
    }
    auto* hint = new QLabel(tr("At most %1 each way").arg(kMaxCanvasPixels));
    hint->setForegroundRole(QPalette::PlaceholderText);
    form->addRow(hint);
    return groupBox(tr("Canvas, in pixels"), form);
}

void frmZephNewSimulation::rdoBackgroundType_Click(int type) {
    choice_.BackgroundType = type;
    CheckEnable();
}

void frmZephNewSimulation::cmdOpen_Click() {
    const std::optional<PickedPicture> picked = ::cmdOpen_Click(pick_, pictureFolder_, this, host_);
    if (!picked) return;
    choice_.BackgroundFileName = picked->File.toStdString();
    Image1_ = picked->Image1;
    const QString name = QString::fromStdString(ZephNameFromFullPath(choice_.BackgroundFileName));
    lblFileName_->setText(lblFileName_->fontMetrics().elidedText(name, Qt::ElideMiddle, kFileNamePx));
    lblFileName_->setToolTip(picked->File);
    lblImageSize_->setText(PicturePreview::sizeText(Image1_.size()));
    rdoBackgroundType_->button(kBackgroundPicture)->setChecked(true);
    if (picked->TakeSize) {
        const QSize size = withinMask(Image1_.size());
        mskWidth_->setText(QString::number(size.width()));
        mskHeight_->setText(QString::number(size.height()));
    }
    CheckEnable();
}

void frmZephNewSimulation::CheckEnable() {
    choice_.WidthPixels = maskPixels(mskWidth_->text().toStdString());
    choice_.HeightPixels = maskPixels(mskHeight_->text().toStdString());
    OKButton_->setEnabled(ZephNewSimulationComplete(choice_));
    tmrPreview_.start();
}

void frmZephNewSimulation::MakePreview() {
    // Until a size is set, the picture shows in its own proportions, and a blank one not at all.
    QSize canvas(choice_.WidthPixels, choice_.HeightPixels);
    QImage source = choice_.BackgroundType == kBackgroundPicture ? Image1_ : QImage();
    if (choice_.BackgroundType != kBackgroundPicture && !canvas.isEmpty()) source = whitePicture();
    if (canvas.isEmpty()) canvas = source.size();
    picPreview_->showPicture(canvas, source, 100);
}

void frmZephNewSimulation::OKButton_Click() {
    choice_.WidthTwips = choice_.WidthPixels * TwipsPerPixelX;
    choice_.HeightTwips = choice_.HeightPixels * TwipsPerPixelY;
    accept();
}
