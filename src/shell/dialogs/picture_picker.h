// Choosing a background's picture, for every dialog that offers it: the file dialog, reading the file, and the question
// whether the canvas takes the picture's size.
#pragma once

#include "util/host.h"

#include <QImage>
#include <QString>

#include <functional>
#include <optional>

class QWidget;

// Asks for a picture's file and begins in the folder; "" for none.
using PicturePicker = std::function<QString(const QString& title, const QString& folder, QWidget* over)>;

// The platform's dialog.
QString pickPicture(const QString& title, const QString& folder, QWidget* over);

struct PickedPicture {
    QString File;
    QImage Image1;          // in its own size
    bool TakeSize = false;  // the canvas is to be as large
};

// Nothing where no file was chosen, or, after a message, where it is no picture.
std::optional<PickedPicture> cmdOpen_Click(const PicturePicker& pick, const QString& folder, QWidget* over, Host& host);
