#include "shell/dialogs/picture_picker.h"

#include "editor/background_change.h"
#include "editor/picture_file.h"

#include <QFileDialog>

QString pickPicture(const QString& title, const QString& folder, QWidget* over) {
    // Under "All Files" stand the pictures whose names have a longer ending.
    return QFileDialog::getOpenFileName(
        over, title, folder,
        QObject::tr("Bitmap Files (bmp,gif,tif,png,jpg) (*.bmp *.gif *.tif *.png *.jpg);;All Files (*)"));
}

std::optional<PickedPicture> cmdOpen_Click(const PicturePicker& pick, const QString& folder, QWidget* over,
                                           Host& host) {
    const QString file = pick(QObject::tr("Load File"), folder, over);
    if (file.isEmpty()) return std::nullopt;
    QImage picture;
    {
        const BusyPointer busy(host);
        picture = loadPicture(file.toStdString());
    }
    if (picture.isNull()) {
        tellBadPicture(host);
        return std::nullopt;
    }
    const bool takeSize =
        host.messageBox(boxTitle("-Set Simulation Size"),
                        "Would you like to set the simulation size to the size of the background image?",
                        BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes;
    return PickedPicture{file, std::move(picture), takeSize};
}
