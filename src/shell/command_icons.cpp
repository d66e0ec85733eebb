#include "shell/command_icons.h"

#include "shell/window_host.h"

#include <QApplication>
#include <QFile>
#include <QIconEngine>
#include <QPainter>
#include <QPalette>
#include <QPixmapCache>
#include <QSvgRenderer>

// Outside every namespace, as the macro asks: pictures inside a static library are dropped unless they are named.
static void initIconResource() {
    Q_INIT_RESOURCE(icons);
}

namespace {

constexpr int kField = 24;            // the drawings' own field
constexpr double kBarFrom = 20.0;     // of the field: where the bar of a colour begins
constexpr double kShrunkField = 0.8;  // of a drawing above such a bar

QByteArray readDrawing(std::string_view name) {
    initIconResource();
    QFile file(QString(":/icons/%1.svg").arg(QString::fromUtf8(name.data(), static_cast<qsizetype>(name.size()))));
    if (!file.open(QIODevice::ReadOnly)) {
        qWarning("There is no picture named %s", qPrintable(file.fileName()));
        return {};
    }
    return file.readAll();
}

class DrawingEngine : public QIconEngine {
public:
    DrawingEngine(std::string_view name, const QColor& bar)
        : name_(toQString(name)), drawing_(readDrawing(name)), bar_(bar) {}

    void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode, QIcon::State) override {
        if (drawing_.isEmpty()) return;
        const QColor ink = inkOf(mode);
        QByteArray inked = drawing_;
        inked.replace("currentColor", ink.name().toLatin1());
        QSvgRenderer renderer(inked);
        QRectF field(rect);
        if (bar_.isValid()) {
            field.setSize(field.size() * kShrunkField);
            field.moveLeft(field.left() + rect.width() * (1 - kShrunkField) / 2);
        }
        renderer.render(painter, field);
        if (bar_.isValid()) paintBar(*painter, rect, mode == QIcon::Disabled, ink);
    }

    // The bars repaint often and the vector files are text: each picture is drawn once per size and ink.
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override {
        const QString key = QString("%1 %2 %3 %4x%5 %6")
                                .arg(name_, inkOf(mode).name(), bar_.isValid() ? bar_.name() : QString())
                                .arg(size.width())
                                .arg(size.height())
                                .arg(mode);
        QPixmap drawn;
        if (QPixmapCache::find(key, &drawn)) return drawn;
        drawn = QPixmap(size);
        drawn.fill(Qt::transparent);
        QPainter painter(&drawn);
        paint(&painter, QRect(QPoint(), size), mode, state);
        painter.end();
        QPixmapCache::insert(key, drawn);
        return drawn;
    }

    QIconEngine* clone() const override { return new DrawingEngine(*this); }

private:
    static QColor inkOf(QIcon::Mode mode) {
        return QApplication::palette().color(mode == QIcon::Disabled ? QPalette::Disabled : QPalette::Active,
                                             mode == QIcon::Selected ? QPalette::HighlightedText
                                                                     : QPalette::ButtonText);
    }

    void paintBar(QPainter& painter, const QRect& rect, bool disabled, const QColor& ink) const {
        const double unit = rect.height() / static_cast<double>(kField);
        const QRectF bar(rect.left() + unit, rect.top() + kBarFrom * unit, rect.width() - 2 * unit,
                         (kField - kBarFrom) * unit);
        painter.setRenderHint(QPainter::Antialiasing);
        painter.setOpacity(disabled ? 0.45 : 1.0);
        painter.setPen(QPen(ink, unit));  // a colour like the ground's would not be seen without a border
        painter.setBrush(bar_);
        painter.drawRoundedRect(bar.adjusted(unit / 2, unit / 2, -unit / 2, -unit / 2), unit, unit);
        painter.setOpacity(1.0);
    }

    QString name_;
    QByteArray drawing_;
    QColor bar_;  // not valid = none
};

}  // namespace

QIcon commandIcon(std::string_view name) {
    return QIcon(new DrawingEngine(name, QColor()));
}

QIcon colorIcon(std::string_view name, const QColor& color) {
    return QIcon(new DrawingEngine(name, color));
}

QCursor pencilPointer(double devicePixelRatio) {
    QPixmap pencil(QSize(kField, kField) * devicePixelRatio);
    pencil.fill(Qt::transparent);
    QPainter painter(&pencil);
    QSvgRenderer(readDrawing("pointer-pencil")).render(&painter, QRectF(QPointF(), QSizeF(pencil.size())));
    painter.end();
    pencil.setDevicePixelRatio(devicePixelRatio);
    return QCursor(pencil, 2, 21);
}
