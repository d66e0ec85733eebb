#include "shell/viewport.h"

#include "util/rounding.h"

#include <QGridLayout>
#include <QLabel>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QWheelEvent>

namespace {

constexpr int kSmallChangePercent = 5;
constexpr int kSmallChangePixels = 20;

// Where the canvas begins along one axis. extent: of the canvas, room: of the viewport, both pixels.
int canvasStart(int extent, int room, int value, ScrollUnit unit) {
    if (extent <= room) return (room - extent) / 2;
    if (unit == ScrollUnit::Pixels) return -value;
    return -roundHalfEven((extent - room) * value / 100.0);
}

void setUpBar(QScrollBar& bar, int extent, int room, ScrollUnit unit) {
    const int excess = std::max(0, extent - room);
    const QSignalBlocker quiet(bar);
    if (unit == ScrollUnit::Pixels) {
        bar.setRange(0, excess);
        bar.setSingleStep(kSmallChangePixels);
        bar.setPageStep(std::max(1, room));
    } else {
        bar.setRange(0, 100);
        bar.setSingleStep(kSmallChangePercent);
        // The handle is as long, seen beside its track, as what is seen of the canvas.
        bar.setPageStep(excess == 0 ? 100 : std::max(kSmallChangePercent, 100 * room / excess));
    }
    bar.setVisible(excess > 0);
    bar.setEnabled(excess > 0);
    if (excess == 0) bar.setValue(0);
}

void stepBar(QScrollBar& bar, int delta) {
    if (!bar.isEnabled() || delta == 0) return;
    bar.setValue(bar.value() + (delta > 0 ? -bar.singleStep() : bar.singleStep()));
}

}  // namespace

CanvasViewport::CanvasViewport(QWidget* parent) : QWidget(parent) {
    picViewport_ = new QFrame(this);
    picViewport_->setObjectName("picViewport");
    picViewport_->setBackgroundRole(QPalette::Dark);
    picViewport_->setAutoFillBackground(true);
    picViewport_->installEventFilter(this);
    picMain_ = new PictureBox(picViewport_);
    picMain_->setObjectName("picMain");
    picMain_->setContextMenuPolicy(Qt::CustomContextMenu);
    hint_ = new QLabel(tr("To begin, start a new simulation or open one: File, New or Open"), picViewport_);
    hint_->setForegroundRole(QPalette::PlaceholderText);
    hint_->adjustSize();
    HScroll1_ = new QScrollBar(Qt::Horizontal, this);
    HScroll1_->setObjectName("HScroll1");
    VScroll1_ = new QScrollBar(Qt::Vertical, this);
    VScroll1_->setObjectName("VScroll1");
    connect(HScroll1_, &QScrollBar::valueChanged, this, &CanvasViewport::ScrollViewportHoriz);
    connect(VScroll1_, &QScrollBar::valueChanged, this, &CanvasViewport::ScrollViewportVert);

    auto* grid = new QGridLayout(this);
    grid->setContentsMargins(0, 0, 0, 0);
    grid->setSpacing(0);
    grid->addWidget(picViewport_, 0, 0);
    grid->addWidget(VScroll1_, 0, 1);
    grid->addWidget(HScroll1_, 1, 0);
    grid->setRowStretch(0, 1);
    grid->setColumnStretch(0, 1);
    setBorder(true);
    layOut();
}

void CanvasViewport::setScrollUnit(ScrollUnit unit) {
    unit_ = unit;
    layOut();
    scrollToOrigin();
}

void CanvasViewport::setBorder(bool shown) {
    picViewport_->setFrameShape(shown ? QFrame::StyledPanel : QFrame::NoFrame);
    layOut();
}

void CanvasViewport::scrollToOrigin() {
    HScroll1_->setValue(0);
    VScroll1_->setValue(0);
    ScrollViewportHoriz();
    ScrollViewportVert();
}

void CanvasViewport::layOut() {
    const QRect room = picViewport_->contentsRect();
    setUpBar(*HScroll1_, picMain_->width(), room.width(), unit_);
    setUpBar(*VScroll1_, picMain_->height(), room.height(), unit_);
    ScrollViewportHoriz();
    ScrollViewportVert();
    hint_->setVisible(picMain_->isHidden());
    hint_->move(room.center() - hint_->rect().center());
}

void CanvasViewport::ScrollViewportHoriz() {
    const QRect room = picViewport_->contentsRect();
    picMain_->move(room.left() + canvasStart(picMain_->width(), room.width(), HScroll1_->value(), unit_),
                   picMain_->y());
}

void CanvasViewport::ScrollViewportVert() {
    const QRect room = picViewport_->contentsRect();
    picMain_->move(picMain_->x(),
                   room.top() + canvasStart(picMain_->height(), room.height(), VScroll1_->value(), unit_));
}

void CanvasViewport::wheel(QWheelEvent& event) {
    const bool sideways = event.modifiers().testFlag(Qt::ShiftModifier);
    stepBar(*HScroll1_, sideways ? event.angleDelta().y() : event.angleDelta().x());
    if (!sideways) stepBar(*VScroll1_, event.angleDelta().y());
    event.accept();
}

bool CanvasViewport::eventFilter(QObject* watched, QEvent* event) {
    if (event->type() == QEvent::Resize) layOut();
    if (event->type() == QEvent::Wheel) {
        wheel(*static_cast<QWheelEvent*>(event));
        return true;
    }
    return QWidget::eventFilter(watched, event);
}
