#include "shell/dialogs/about_dialog.h"

#include "util/host.h"

#include <QCloseEvent>
#include <QCoreApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QPainter>
#include <QPainterPath>
#include <QPushButton>
#include <QVBoxLayout>

#include <array>

namespace {

constexpr QSize kPictureSize(520, 220);

// A garland in front of the night, with the program's name: drawn, so that it is sharp at any scale.
class NightPicture : public QWidget {
public:
    explicit NightPicture(QWidget* parent) : QWidget(parent) { setFixedSize(kPictureSize); }

protected:
    void paintEvent(QPaintEvent*) override {
        QPainter painter(this);
        painter.setRenderHint(QPainter::Antialiasing);
        paintSky(painter);
        paintGarland(painter);
        paintName(painter);
    }

private:
    void paintSky(QPainter& painter) const {
        QLinearGradient sky(0, 0, 0, height());
        sky.setColorAt(0, QColor(8, 11, 30));
        sky.setColorAt(1, QColor(38, 42, 84));
        painter.fillRect(rect(), sky);
        painter.setPen(Qt::NoPen);
        for (int star = 0; star < 60; ++star) {
            // Scattered by a rule, so that it is the same sky at every start.
            const QPointF place(star * 197 % width(), star * 83 % (height() * 2 / 3));
            painter.setBrush(QColor(255, 255, 255, 40 + star * 37 % 120));
            painter.drawEllipse(place, 0.8, 0.8);
        }
    }

    void paintGarland(QPainter& painter) const {
        QPainterPath wire(QPointF(-10, 30));
        wire.cubicTo(QPointF(120, 110), QPointF(200, 100), QPointF(width() / 2.0, 40));
        wire.cubicTo(QPointF(320, 100), QPointF(420, 110), QPointF(width() + 10.0, 24));
        painter.setPen(QPen(QColor(20, 46, 40), 2.5));
        painter.setBrush(Qt::NoBrush);
        painter.drawPath(wire);
        painter.setPen(Qt::NoPen);
        constexpr std::array kColors{0xFF5A4A, 0x54D66A, 0x58A6FF, 0xFFC94A, 0xC678FF};
        constexpr int kBulbs = 23;
        for (int bulb = 0; bulb < kBulbs; ++bulb) {
            const QPointF place = wire.pointAtPercent((bulb + 0.5) / kBulbs);
            const QColor color(QRgb(kColors[static_cast<std::size_t>(bulb) % kColors.size()]));
            QRadialGradient glow(place, 22);
            QColor soft = color;
            soft.setAlpha(120);
            glow.setColorAt(0, soft);
            soft.setAlpha(0);
            glow.setColorAt(1, soft);
            painter.setBrush(glow);
            painter.drawEllipse(place, 22, 22);
            painter.setBrush(color.lighter(130));
            painter.drawEllipse(place, 4.5, 4.5);
        }
    }

    void paintName(QPainter& painter) const {
        QFont font = painter.font();
        font.setPixelSize(38);
        font.setWeight(QFont::Light);
        painter.setFont(font);
        painter.setPen(QColor(246, 240, 226));
        painter.drawText(QRect(32, 118, width() - 64, 52), Qt::AlignLeft | Qt::AlignVCenter,
                         QString::fromUtf8(kProgramName.data(), static_cast<qsizetype>(kProgramName.size())));
        font.setPixelSize(14);
        font.setWeight(QFont::Normal);
        painter.setFont(font);
        painter.setPen(QColor(190, 194, 214));
        painter.drawText(QRect(34, 170, width() - 68, 24), Qt::AlignLeft | Qt::AlignVCenter,
                         QStringLiteral("Version " ZEPH_VERSION));
    }
};

}  // namespace

frmZephAbout::frmZephAbout(Purpose purpose, QWidget* parent)
    : QDialog(parent, purpose == Purpose::Splash ? Qt::SplashScreen : Qt::Dialog), purpose_(purpose),
      lblStatus_(new QLabel(this)), cmdOK_(new QPushButton(tr("OK"), this)) {
    setObjectName("frmZephAbout");
    lblStatus_->setObjectName("lblStatus");
    cmdOK_->setObjectName("cmdOK");
    cmdOK_->setDefault(true);
    connect(cmdOK_, &QPushButton::clicked, this, &QDialog::accept);

    auto* const column = new QVBoxLayout(this);
    column->setContentsMargins(0, 0, 0, 0);
    column->setSpacing(0);
    column->addWidget(new NightPicture(this));
    auto* const foot = new QHBoxLayout;
    foot->setContentsMargins(16, 10, 16, 10);
    foot->addWidget(lblStatus_, 1);
    foot->addWidget(cmdOK_);
    column->addLayout(foot);
    layout()->setSizeConstraint(QLayout::SetFixedSize);

    if (purpose == Purpose::Splash) {
        cmdOK_->hide();
        setWindowModality(Qt::NonModal);
    } else {
        setWindowTitle(QString::fromStdString("About " + std::string(kProgramName)));
        lblStatus_->setText(tr("Plans a light display and previews it under its live channel stream."));
        lblStatus_->setWordWrap(true);
    }
}

void frmZephAbout::StartupMessage(std::string_view text) {
    lblStatus_->setText(QString::fromUtf8(text.data(), static_cast<qsizetype>(text.size())));
    // Only what paints: a start is not to be interrupted by clicks.
    lblStatus_->repaint();
    QCoreApplication::processEvents(QEventLoop::ExcludeUserInputEvents);
}

void frmZephAbout::closeEvent(QCloseEvent* event) {
    if (purpose_ == Purpose::Splash) {
        event->ignore();
    } else {
        QDialog::closeEvent(event);
    }
}

void frmZephAbout::keyPressEvent(QKeyEvent* event) {
    if (purpose_ == Purpose::Splash) return;  // Esc would hide it
    QDialog::keyPressEvent(event);
}
