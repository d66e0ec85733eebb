#include "shell/window_host.h"

#include "engine/dialogs/compile_errors_dialog.h"

#include <QApplication>
#include <QFileDialog>
#include <QMessageBox>

namespace {

QMessageBox::Icon boxIcon(BoxIcon icon) {
    switch (icon) {
    case BoxIcon::Critical:
        return QMessageBox::Critical;
    case BoxIcon::Question:
        return QMessageBox::Question;
    case BoxIcon::Warning:
        return QMessageBox::Warning;
    case BoxIcon::Information:
        return QMessageBox::Information;
    case BoxIcon::None:
        break;
    }
    return QMessageBox::NoIcon;
}

QMessageBox::StandardButtons boxButtons(BoxButtons buttons) {
    switch (buttons) {
    case BoxButtons::OkCancel:
        return QMessageBox::Ok | QMessageBox::Cancel;
    case BoxButtons::YesNo:
        return QMessageBox::Yes | QMessageBox::No;
    case BoxButtons::YesNoCancel:
        return QMessageBox::Yes | QMessageBox::No | QMessageBox::Cancel;
    case BoxButtons::Ok:
        break;
    }
    return QMessageBox::Ok;
}

BoxAnswer boxAnswer(int button) {
    switch (button) {
    case QMessageBox::Ok:
        return BoxAnswer::Ok;
    case QMessageBox::Yes:
        return BoxAnswer::Yes;
    case QMessageBox::No:
        return BoxAnswer::No;
    default:
        return BoxAnswer::Cancel;
    }
}

}  // namespace

QString toQString(std::string_view utf8) {
    return QString::fromUtf8(utf8.data(), static_cast<qsizetype>(utf8.size()));
}

QWidget* WindowHost::owner() const {
    QWidget* dialog = QApplication::activeModalWidget();
    return dialog != nullptr ? dialog : window_;
}

void WindowHost::attach(QWidget* window, PanelWriter panels) {
    window_ = window;
    panels_ = std::move(panels);
}

BoxAnswer WindowHost::messageBox(std::string_view title, std::string_view text, BoxIcon icon, BoxButtons buttons) {
    // An hourglass over a box that waits for a click would mislead.
    const bool wasBusy = busy_;
    setBusyPointer(false);
    QMessageBox box(boxIcon(icon), toQString(title), toQString(text).replace("\r\n", "\n"), boxButtons(buttons),
                    owner());
    box.setTextFormat(Qt::PlainText);
    // A hasty Enter must not lose what a warning is about.
    if (icon == BoxIcon::Warning) box.setDefaultButton(QMessageBox::No);
    const BoxAnswer answer = box.exec() == 0 && buttons == BoxButtons::Ok
                                 ? BoxAnswer::Ok
                                 : boxAnswer(box.standardButton(box.clickedButton()));
    setBusyPointer(wasBusy);
    return answer;
}

void WindowHost::setStatusPanel(int panel, std::string_view text) {
    if (panels_) panels_(panel, toQString(text));
}

void WindowHost::setBusyPointer(bool busy) {
    if (busy == busy_) return;
    busy_ = busy;
    if (busy) {
        QApplication::setOverrideCursor(Qt::WaitCursor);
    } else {
        QApplication::restoreOverrideCursor();
    }
}

void WindowHost::showCompileErrors(std::string_view text) {
    const bool wasBusy = busy_;
    setBusyPointer(false);
    frmZephCompileErrors dialog(window_);
    dialog.SetErrorMessage(toQString(text));
    dialog.exec();
    setBusyPointer(wasBusy);
}

QString WindowHost::askFile(const FileDialog& dialog, const QString& folder, bool save) {
    const QStringList filter = toQString(dialog.filter).split('|');
    QFileDialog box(owner(), toQString(dialog.title), folder, QString("%1 (%2)").arg(filter.value(0), filter.value(1)));
    box.setAcceptMode(save ? QFileDialog::AcceptSave : QFileDialog::AcceptOpen);
    box.setFileMode(save ? QFileDialog::AnyFile : QFileDialog::ExistingFile);
    box.setOption(QFileDialog::DontConfirmOverwrite);  // the name may still lack its extension
    return box.exec() == QDialog::Accepted ? box.selectedFiles().value(0) : QString();
}

void WindowHost::pumpEvents() {
    if (pumping_) return;
    pumping_ = true;
    QCoreApplication::processEvents();
    pumping_ = false;
}
