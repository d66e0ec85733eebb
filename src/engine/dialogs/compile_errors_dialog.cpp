#include "engine/dialogs/compile_errors_dialog.h"

#include "util/host.h"

#include <QEvent>
#include <QHBoxLayout>
#include <QPlainTextEdit>
#include <QPushButton>
#include <QVBoxLayout>

frmZephCompileErrors::frmZephCompileErrors(QWidget* parent) : QDialog(parent), txtError_(new QPlainTextEdit(this)) {
    setObjectName("frmZephCompileErrors");
    setWindowTitle(QString::fromStdString(boxTitle("-Errors")));
    resize(720, 360);
    setSizeGripEnabled(true);

    txtError_->setObjectName("txtError");
    txtError_->setReadOnly(true);
    txtError_->installEventFilter(this);
    auto* cmdOK = new QPushButton(tr("OK"), this);
    cmdOK->setObjectName("cmdOK");
    cmdOK->setDefault(true);
    connect(cmdOK, &QPushButton::clicked, this, &QDialog::accept);

    auto* buttons = new QHBoxLayout;
    buttons->addStretch();
    buttons->addWidget(cmdOK);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(12, 12, 12, 12);
    layout->setSpacing(10);
    layout->addWidget(txtError_);
    layout->addLayout(buttons);
    cmdOK->setFocus();
}

void frmZephCompileErrors::SetErrorMessage(const QString& text) {
    txtError_->setPlainText(QString(text).replace("\r\n", "\n"));
}

// All of it is selected when the text gets the focus, so that one key copies it into a mail.
bool frmZephCompileErrors::eventFilter(QObject* watched, QEvent* event) {
    if (watched == txtError_ && event->type() == QEvent::FocusIn) {
        const bool done = QDialog::eventFilter(watched, event);
        QMetaObject::invokeMethod(txtError_, &QPlainTextEdit::selectAll, Qt::QueuedConnection);
        return done;
    }
    return QDialog::eventFilter(watched, event);
}
