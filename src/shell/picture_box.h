// picMain: the canvas on the screen. Shows an image that somebody else owns and repaints what it is told has changed.
#pragma once

#include <QImage>
#include <QWidget>

#include <span>

class PictureBox : public QWidget {
public:
    explicit PictureBox(QWidget* parent = nullptr);

    // The image must keep its place until another one is shown; a null image shows nothing.
    void showImage(const QImage& image);
    // Parts of the image that have changed, in pixels.
    void showChanged(std::span<const QRect> parts);

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    const QImage* image_ = nullptr;
};
