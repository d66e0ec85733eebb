// picPreview: a background as it will look, in the middle of a dark field.
#pragma once

#include <QImage>
#include <QWidget>

class PicturePreview : public QWidget {
public:
    explicit PicturePreview(QWidget* parent = nullptr);

    // A null picture leaves the field empty.
    void showPicture(const QSize& canvas, const QImage& Image1, int intensity);
    // How the size of a canvas or a picture is written: width + " x " + height.
    static QString sizeText(const QSize& size);

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QImage stretched_;  // at its own brightness, in the pixels of the screen
    QSize canvas_;
    qint64 source_ = 0;  // of the picture that stretched_ was made of
    QImage shown_;
};
