#include "shell/dialogs/change_size_dialog.h"

#include "editor/background_change.h"
#include "shell/dialogs/dialog_parts.h"
#include "shell/dialogs/number_field.h"

#include <QCheckBox>

namespace {

constexpr int kMostDigits = 6;  // more than any canvas has, and its product with the proportions is still a number

}  // namespace

frmZephChangeSize::frmZephChangeSize(QSize size, Host& host, QWidget* parent)
    : QDialog(parent), atOpening_(size), newSize_(size), host_(host),
      txtNewWidth_(new NumberField("txtNewWidth", kMostDigits)),
      txtNewHeight_(new NumberField("txtNewHeight", kMostDigits)),
      chkAspect_(new QCheckBox(tr("Keep the &proportions"))) {
    setObjectName("frmZephChangeSize");
    setWindowTitle(QString::fromStdString(boxTitle("-Change Size")));
    chkAspect_->setObjectName("chkAspect");
    chkAspect_->setChecked(true);
    txtNewWidth_->setText(QString::number(size.width()));
    txtNewHeight_->setText(QString::number(size.height()));
    connect(txtNewWidth_, &QLineEdit::textEdited, this,
            [this] { followProportions(*txtNewWidth_, atOpening_.width(), atOpening_.height(), *txtNewHeight_); });
    connect(txtNewHeight_, &QLineEdit::textEdited, this,
            [this] { followProportions(*txtNewHeight_, atOpening_.height(), atOpening_.width(), *txtNewWidth_); });

    QFormLayout* form = labelledForm();
    form->addRow(tr("New &width:"), txtNewWidth_);
    form->addRow(tr("New &height:"), txtNewHeight_);
    form->addRow(QString(), chkAspect_);
    auto* hint =
        new QLabel(tr("Pixels, 1 to %1 each. The drawing keeps its place on the picture;\nbulbs keep their size.")
                       .arg(kMaxCanvasPixels));
    hint->setForegroundRole(QPalette::PlaceholderText);
    QPushButton* cmdOK = pushButton("cmdOK", tr("OK"));
    QPushButton* cmdCancel = pushButton("cmdCancel", tr("Cancel"));
    connect(cmdOK, &QPushButton::clicked, this, &frmZephChangeSize::cmdOK_Click);
    connect(cmdCancel, &QPushButton::clicked, this, &QDialog::reject);
    auto* column = new QVBoxLayout(this);
    column->setContentsMargins(kDialogGapPx, kDialogGapPx, kDialogGapPx, kDialogGapPx);
    column->setSpacing(kDialogGapPx);
    column->addLayout(form);
    column->addWidget(hint);
    column->addLayout(closingRow(cmdOK, cmdCancel));
    column->setSizeConstraint(QLayout::SetFixedSize);
    txtNewWidth_->setFocus();
    txtNewWidth_->selectAll();
}

void frmZephChangeSize::followProportions(const NumberField& typed, int typedSide, int otherSide, NumberField& other) {
    if (!chkAspect_->isChecked()) return;
    bool number = false;
    const int side = typed.text().toInt(&number);
    other.setText(number ? QString::number(proportionalSide(side, otherSide, typedSide)) : QString());
}

void frmZephChangeSize::cmdOK_Click() {
    const std::optional<QSize> size =
        ZephCheckNewSize(txtNewWidth_->text().toStdString(), txtNewHeight_->text().toStdString(), host_);
    if (size) {
        newSize_ = *size;
        accept();
        return;
    }
    txtNewWidth_->setFocus();
    txtNewWidth_->selectAll();
}
