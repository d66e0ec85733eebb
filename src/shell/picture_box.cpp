#include "shell/picture_box.h"

#include <QPaintEvent>
#include <QPainter>

PictureBox::PictureBox(QWidget* parent) : QWidget(parent) {
    setAttribute(Qt::WA_OpaquePaintEvent);
    resize(0, 0);
    hide();  // until there is something to show
}

void PictureBox::showImage(const QImage& image) {
    image_ = &image;
    if (size() != image.size()) setFixedSize(image.size());
    setVisible(!image.isNull());
    update();
}

void PictureBox::showChanged(std::span<const QRect> parts) {
    for (const QRect& part : parts)
        update(part);
}

void PictureBox::paintEvent(QPaintEvent* event) {
    if (image_ == nullptr || image_->isNull()) return;
    QPainter painter(this);
    for (const QRect& part : event->region())
        painter.drawImage(part, *image_, part);
}
