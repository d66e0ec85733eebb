// A few bulbs of one colour on a background: what new fixtures will look like in their dialog.
#pragma once

#include <QColor>
#include <QWidget>

class SampleView : public QWidget {
public:
    explicit SampleView(QWidget* parent = nullptr);

    void setColors(const QColor& background, const QColor& bulbs);
    QSize sizeHint() const override;

protected:
    void paintEvent(QPaintEvent* event) override;

private:
    QColor background_;
    QColor bulbs_;
};
