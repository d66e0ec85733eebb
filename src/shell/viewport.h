// picViewport with picMain in it and its scroll bars. In the editor HScroll1 and VScroll1 run in per cent, in a
// simulation in pixels of what picMain exceeds the viewport by. A canvas smaller than the viewport stands in its
// middle.
#pragma once

#include "shell/picture_box.h"

#include <QFrame>

class QLabel;
class QScrollBar;

enum class ScrollUnit { Percent, Pixels };

class CanvasViewport : public QWidget {
public:
    explicit CanvasViewport(QWidget* parent);

    PictureBox& picMain() { return *picMain_; }
    QFrame& picViewport() { return *picViewport_; }
    void setScrollUnit(ScrollUnit unit);
    void setBorder(bool shown);
    void scrollToOrigin();
    // To be called once picMain has another size.
    void layOut();

protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

private:
    void ScrollViewportHoriz();
    void ScrollViewportVert();
    void wheel(QWheelEvent& event);

    QFrame* picViewport_ = nullptr;
    PictureBox* picMain_ = nullptr;
    QLabel* hint_ = nullptr;  // in place of a canvas
    QScrollBar* HScroll1_ = nullptr;
    QScrollBar* VScroll1_ = nullptr;
    ScrollUnit unit_ = ScrollUnit::Percent;
};
