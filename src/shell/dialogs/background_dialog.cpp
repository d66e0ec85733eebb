#include "shell/dialogs/background_dialog.h"

#include "editor/background.h"
#include "editor/picture_file.h"
#include "model/tables.h"
#include "shell/dialogs/change_size_dialog.h"
#include "shell/dialogs/dialog_parts.h"
#include "shell/dialogs/picture_preview.h"
#include "util/text.h"

#include <QComboBox>
#include <QSlider>

namespace {

constexpr int kPreviewDelayMs = 40;
constexpr int kFileNamePx = 230;
constexpr int kGridUnitPx = 10;
constexpr int kMostGridUnits = 20;

// A form whose sliders and lists take all of its width.
QFormLayout* wideForm() {
    QFormLayout* layout = labelledForm();
    layout->setFieldGrowthPolicy(QFormLayout::AllNonFixedFieldsGrow);
    return layout;
}

// A slider with its value beside it, in a column as wide as the widest one.
QHBoxLayout* sliderRow(QSlider* slider, QLabel* shown, const QString& widest) {
    shown->setMinimumWidth(shown->fontMetrics().horizontalAdvance(widest));
    shown->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    return rowOf({slider, shown});
}

}  // namespace

frmZephBackground::frmZephBackground(const ZephBackgroundDraft& draft, BackgroundDialogTerms terms, BackgroundDesk desk,
                                     QWidget* parent)
    : QDialog(parent), draft_(draft), atOpening_(draft.Background), terms_(std::move(terms)), desk_(std::move(desk)),
      picPreview_(new PicturePreview) {
    setObjectName("frmZephBackground");
    setWindowTitle(QString::fromStdString(boxTitle("-Background Properties")));
    setWindowFlag(Qt::WindowCloseButtonHint, terms_.AllowCancel);
    tmrPreview_.setObjectName("tmrPreview");
    tmrPreview_.setSingleShot(true);
    tmrPreview_.setInterval(kPreviewDelayMs);
    connect(&tmrPreview_, &QTimer::timeout, this, &frmZephBackground::MakePreview);

    QPushButton* cmdOK = pushButton("cmdOK", tr("OK"));
    QPushButton* cmdCancel = pushButton("cmdCancel", tr("Cancel"));
    if (!terms_.AllowCancel) cmdCancel->hide();
    connect(cmdOK, &QPushButton::clicked, this, &frmZephBackground::cmdOK_Click);
    connect(cmdCancel, &QPushButton::clicked, this, &frmZephBackground::reject);
    layOutBesidePicture(picPreview_, {pictureGroup(), sizeGroup(), gridGroup()}, closingRow(cmdOK, cmdCancel), *this);

    Image1_ = loadPicture(terms_.PictureFile);
    showPicture();
    ResizeSimulation(sizePixels(draft_.Background));
    sldIntensity_->setFocus();
}

QWidget* frmZephBackground::pictureGroup() {
    lblFileName_ = valueLabel("lblFileName");
    lblFileName_->setFixedWidth(kFileNamePx);
    lblImageSize_ = valueLabel("lblImageSize");
    QPushButton* cmdOpen = pushButton("cmdOpen", tr("&Select Picture..."));
    cmdNoBackground_ = pushButton("cmdNoBackground", tr("&No Background"));
    connect(cmdOpen, &QPushButton::clicked, this, &frmZephBackground::cmdOpen_Click);
    connect(cmdNoBackground_, &QPushButton::clicked, this, &frmZephBackground::cmdNoBackground_Click);
    sldIntensity_ = new QSlider(Qt::Horizontal);
    sldIntensity_->setObjectName("sldIntensity");
    sldIntensity_->setRange(0, 100);
    sldIntensity_->setPageStep(10);
    sldIntensity_->setValue(draft_.Background.PicIntensity);
    lblIntensity_ = valueLabel("lblIntensity");
    lblIntensity_->setText(QString::number(sldIntensity_->value()) + " %");
    connect(sldIntensity_, &QSlider::valueChanged, this, &frmZephBackground::sldIntensity_Change);

    auto* lblSlider = new QLabel(tr("&Intensity:"));
    lblSlider->setBuddy(sldIntensity_);
    QFormLayout* layout = wideForm();
    layout->addRow(tr("File:"), lblFileName_);
    layout->addRow(tr("Image Size:"), lblImageSize_);
    layout->addRow(rowOf({cmdOpen, cmdNoBackground_}));
    layout->addRow(lblSlider, sliderRow(sldIntensity_, lblIntensity_, "100 %"));
    return groupBox(tr("Picture"), layout);
}

QWidget* frmZephBackground::sizeGroup() {
    QLabel* lblEditorSize = valueLabel("lblEditorSize");
    lblEditorSize->setText(terms_.NewSimulation ? tr("(new)") : PicturePreview::sizeText(sizePixels(atOpening_)));
    lblNewSize_ = valueLabel("lblNewSize");
    QPushButton* cmdResize = pushButton("cmdResize", tr("&Change Size..."));
    connect(cmdResize, &QPushButton::clicked, this, &frmZephBackground::cmdResize_Click);
    QFormLayout* layout = labelledForm();
    layout->addRow(tr("Editor Size:"), lblEditorSize);
    layout->addRow(tr("New Size:"), lblNewSize_);
    layout->addRow(rowOf({cmdResize}));
    return groupBox(tr("Canvas, in pixels"), layout);
}

QWidget* frmZephBackground::gridGroup() {
    cmbGridLineOption_ = new QComboBox;
    cmbGridLineOption_->setObjectName("cmbGridLineOption");
    for (const std::string_view line : kGridLines)
        cmbGridLineOption_->addItem(QString::fromUtf8(line.data(), static_cast<qsizetype>(line.size())));
    cmbGridLineOption_->setCurrentIndex(draft_.GridLineOption);
    connect(cmbGridLineOption_, &QComboBox::currentIndexChanged, this, &frmZephBackground::CheckControls);
    sldGridLineDensity_ = new QSlider(Qt::Horizontal);
    sldGridLineDensity_->setObjectName("sldGridLineDensity");
    sldGridLineDensity_->setRange(1, kMostGridUnits);
    sldGridLineDensity_->setPageStep(2);
    sldGridLineDensity_->setValue(draft_.GridSpacing);
    lblGridLineDensity_ = valueLabel("lblGridLineDensity");
    const auto showDensity = [this](int units) { lblGridLineDensity_->setText(tr("%1 px").arg(units * kGridUnitPx)); };
    showDensity(sldGridLineDensity_->value());
    connect(sldGridLineDensity_, &QSlider::valueChanged, this, showDensity);
    cmdGridLineColor_ = new ColorButton(
        tr("Color of Grid Lines"),
        [this](std::int32_t color, const QString& title, QWidget* over) { return pickGridColor(color, title, over); },
        [] {});
    cmdGridLineColor_->setObjectName("cmdGridLineColor");
    cmdGridLineColor_->setColor(draft_.GridLineColor);
    auto* lblDensity = new QLabel(tr("S&pacing:"));
    lblDensity->setBuddy(sldGridLineDensity_);
    auto* lblLines = new QLabel(tr("&Lines:"));
    lblLines->setBuddy(cmbGridLineOption_);
    QFormLayout* layout = wideForm();
    layout->addRow(lblLines, rowOf({cmbGridLineOption_, cmdGridLineColor_}));
    layout->addRow(lblDensity, sliderRow(sldGridLineDensity_, lblGridLineDensity_, "200 px"));
    return groupBox(tr("Grid"), layout);
}

void frmZephBackground::CheckControls() {
    cmdNoBackground_->setEnabled(draft_.Background.BackgroundType == kBackgroundPicture);
    const bool grid = cmbGridLineOption_->currentIndex() > 0;
    sldGridLineDensity_->setEnabled(grid);
    lblGridLineDensity_->setEnabled(grid);
    cmdGridLineColor_->setEnabled(grid);
}

void frmZephBackground::showPicture() {
    const bool picture = draft_.Background.BackgroundType == kBackgroundPicture;
    const QString file = picture ? QString::fromStdString(draft_.Background.PicFileName) : QString();
    const QString name = QString::fromStdString(ZephNameFromFullPath(file.toStdString()));
    lblFileName_->setText(picture ? lblFileName_->fontMetrics().elidedText(name, Qt::ElideMiddle, kFileNamePx)
                                  : tr("none"));
    lblFileName_->setToolTip(file);
    lblImageSize_->setText(Image1_.isNull() ? tr("(none loaded)") : PicturePreview::sizeText(Image1_.size()));
    previewFailed_ = false;
    CheckControls();
    tmrPreview_.start();
}

void frmZephBackground::MakePreview() {
    picPreview_->showPicture(sizePixels(draft_.Background), Image1_.isNull() ? whitePicture() : Image1_,
                             sldIntensity_->value());
    if (!Image1_.isNull() || draft_.Background.BackgroundType != kBackgroundPicture || previewFailed_) return;
    previewFailed_ = true;  // one box, not one a tick
    desk_.host.messageBox(boxTitle("-Preview Load Error"),
                          "There was a problem with the preview picture load.  Please select another background.",
                          BoxIcon::Critical);
}

void frmZephBackground::ResizeSimulation(QSize size) {
    setSizePixels(size, draft_.Background);
    lblNewSize_->setText(PicturePreview::sizeText(size));
    tmrPreview_.start();
}

void frmZephBackground::reject() {
    if (terms_.AllowCancel) QDialog::reject();
}

void frmZephBackground::cmdOpen_Click() {
    const std::optional<PickedPicture> picked =
        ::cmdOpen_Click(desk_.pickPicture, terms_.PictureFolder, this, desk_.host);
    if (!picked) return;
    draft_.Background.BackgroundType = kBackgroundPicture;
    draft_.Background.PicFileName = picked->File.toStdString();
    draft_.PictureChosen = true;
    Image1_ = picked->Image1;
    showPicture();
    if (picked->TakeSize) ResizeSimulation(Image1_.size());
}

void frmZephBackground::cmdNoBackground_Click() {
    draft_.Background.BackgroundType = 0;
    draft_.Background.PicFileName.clear();
    draft_.PictureChosen = false;
    Image1_ = QImage();
    showPicture();
}

void frmZephBackground::cmdResize_Click() {
    frmZephChangeSize dialog(sizePixels(draft_.Background), desk_.host, this);
    dialog.exec();
    if (!dialog.Cancelled()) ResizeSimulation(dialog.newSize());
}

void frmZephBackground::sldIntensity_Change(int intensity) {
    lblIntensity_->setText(QString::number(intensity) + " %");
    draft_.Background.PicIntensity = intensity;
    // Not started anew by each step, or the preview would stand still for as long as the slider moves.
    if (!tmrPreview_.isActive()) tmrPreview_.start();
}

std::optional<std::int32_t> frmZephBackground::pickGridColor(std::int32_t color, const QString& title,
                                                             QWidget* over) try {
    return desk_.pickColor(color, title, over);
} catch (const std::exception&) {
    desk_.host.messageBox(boxTitle("-Error"), "Error Setting Color", BoxIcon::Critical);
    return std::nullopt;
}

void frmZephBackground::cmdOK_Click() {
    if (!ZephCheckBackground(draft_.Background, desk_.host)) return;
    draft_.GridLineOption = cmbGridLineOption_->currentIndex();
    draft_.GridSpacing = sldGridLineDensity_->value();
    draft_.GridLineColor = cmdGridLineColor_->color();
    accept();
}
