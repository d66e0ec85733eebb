#include "programs/tool/frame_sink.h"

#include "util/failure.h"

#include <QDir>
#include <QFileInfo>
#include <QProcess>
#include <QStandardPaths>

#include <cstdio>
#include <unistd.h>

namespace {

class FolderSink : public FrameSink {
public:
    explicit FolderSink(const QString& folder) : folder_(folder) {
        if (!QDir().mkpath(folder)) throw Failure("the folder " + folder.toStdString() + " cannot be made");
    }

    void add(const QImage& frame) override {
        const QString file = folder_.filePath(QString("frame%1.png").arg(++count_, 5, 10, QChar('0')));
        if (!frame.save(file)) throw Failure("the picture " + file.toStdString() + " cannot be written");
    }

    void finish() override {}

private:
    QDir folder_;
    int count_ = 0;
};

// Feeds raw pictures to ffmpeg.
class FilmSink : public FrameSink {
public:
    FilmSink(const QString& file, QSize size, std::int32_t fps) : file_(file) {
        const QString program = QStandardPaths::findExecutable("ffmpeg");
        if (program.isEmpty()) {
            throw Failure("there is no ffmpeg here to make " + file.toStdString() +
                          "; name a folder (with / at its end) to get numbered pictures instead");
        }
        QStringList arguments{"-y",
                              "-loglevel",
                              "error",
                              "-f",
                              "rawvideo",
                              "-pix_fmt",
                              "bgr0",
                              "-s",
                              QString("%1x%2").arg(size.width()).arg(size.height()),
                              "-r",
                              QString::number(fps),
                              "-i",
                              "-"};
        if (file.endsWith(".gif", Qt::CaseInsensitive)) {
            arguments << "-vf"
                      << "split[a][b];[a]palettegen=stats_mode=diff[p];[b][p]paletteuse=dither=bayer";
        } else {
            // Most players want even sides and this pixel format.
            arguments << "-vf"
                      << "pad=ceil(iw/2)*2:ceil(ih/2)*2"
                      << "-pix_fmt"
                      << "yuv420p";
        }
        process_.setProcessChannelMode(QProcess::ForwardedErrorChannel);
        process_.setStandardOutputFile(QProcess::nullDevice());
        process_.start(program, arguments << file);
        if (!process_.waitForStarted()) throw Failure("ffmpeg does not start");
    }

    ~FilmSink() override {
        if (process_.state() != QProcess::NotRunning) process_.kill();
        process_.waitForFinished();
    }

    void add(const QImage& frame) override {
        for (int y = 0; y < frame.height(); ++y) {
            process_.write(reinterpret_cast<const char*>(frame.constScanLine(y)), qint64{frame.width()} * 4);
        }
        while (process_.bytesToWrite() > 0) {
            if (!process_.waitForBytesWritten(-1)) throw Failure("ffmpeg could not make " + file_.toStdString());
        }
    }

    void finish() override {
        process_.closeWriteChannel();
        process_.waitForFinished(-1);
        if (process_.exitStatus() != QProcess::NormalExit || process_.exitCode() != 0) {
            throw Failure("ffmpeg could not make " + file_.toStdString());
        }
    }

private:
    QString file_;
    QProcess process_;
};

}  // namespace

std::unique_ptr<FrameSink> openFrameSink(const std::string& out, QSize size, std::int32_t fps) {
    const QString path = QString::fromLocal8Bit(out.c_str());
    if (path.endsWith('/') || QFileInfo(path).isDir()) return std::make_unique<FolderSink>(path);
    return std::make_unique<FilmSink>(path, size, fps);
}

ProgressBar::ProgressBar(std::int64_t whole) : whole_(whole), terminal_(isatty(STDERR_FILENO) != 0) {}

ProgressBar::~ProgressBar() {
    if (terminal_ && shown_ >= 0) std::fputc('\n', stderr);
}

void ProgressBar::show(std::int64_t done) {
    constexpr int kWidth = 40;
    const std::int64_t percent = whole_ > 0 ? done * 100 / whole_ : 100;
    if (!terminal_ || percent == shown_) return;
    shown_ = percent;
    const int filled = static_cast<int>(percent * kWidth / 100);
    std::fprintf(stderr, "\r[%.*s%*s] %3d %%", filled, "########################################", kWidth - filled, "",
                 static_cast<int>(percent));
}
