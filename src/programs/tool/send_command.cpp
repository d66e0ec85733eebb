#include "programs/tool/send_command.h"

#include "link/capture_file.h"
#include "programs/tool/progress_line.h"
#include "programs/tool/sequencer_desk.h"
#include "programs/tool/stop_signal.h"
#include "util/failure.h"

#include <QHostInfo>
#include <QNetworkProxy>
#include <QTcpSocket>
#include <QUdpSocket>

#include <algorithm>
#include <cstdio>
#include <memory>
#include <utility>

namespace {

constexpr int kPatienceMs = 5000;  // for a connection, and for its orderly end

// The receiving end of one playback.
class Receiver {
public:
    virtual ~Receiver() = default;
    virtual void send(const std::string& bytes, StopSignal& stop) = 0;
};

QHostAddress addressOf(const std::string& host) {
    const QHostAddress address(QString::fromStdString(host));
    if (!address.isNull()) return address;
    const QHostInfo info = QHostInfo::fromName(QString::fromStdString(host));
    for (const QHostAddress& found : info.addresses()) {
        if (found.protocol() == QAbstractSocket::IPv4Protocol) return found;  // what simulations listen on
    }
    throw Failure("the host " + host + " is not known");
}

class UdpReceiver : public Receiver {
public:
    UdpReceiver(const std::string& host, std::int32_t port)
        : address_(addressOf(host)), port_(static_cast<quint16>(port)) {
        socket_.setProxy(QNetworkProxy::NoProxy);
    }

    void send(const std::string& bytes, StopSignal& stop) override {
        const qint64 length = static_cast<qint64>(bytes.size());
        while (socket_.writeDatagram(bytes.data(), length, address_, port_) != length) {
            if (socket_.error() != QAbstractSocket::TemporaryError) throw Failure(socket_.errorString().toStdString());
            // The system's send buffer is full; it empties by itself.
            if (stop.waitUntil(std::chrono::steady_clock::now() + std::chrono::milliseconds(1))) return;
        }
    }

private:
    QHostAddress address_;
    quint16 port_;
    QUdpSocket socket_;
};

class TcpReceiver : public Receiver {
public:
    TcpReceiver(const std::string& host, std::int32_t port) {
        socket_.setProxy(QNetworkProxy::NoProxy);
        socket_.connectToHost(addressOf(host), static_cast<quint16>(port));
        if (!socket_.waitForConnected(kPatienceMs)) throw Failure(socket_.errorString().toStdString());
        socket_.setSocketOption(QAbstractSocket::LowDelayOption, 1);  // a piece is due now, not with the next one
    }
    ~TcpReceiver() override {
        socket_.disconnectFromHost();
        if (socket_.state() != QAbstractSocket::UnconnectedState) socket_.waitForDisconnected(kPatienceMs);
    }

    void send(const std::string& bytes, StopSignal& stop) override {
        constexpr int turnMs = 50;
        socket_.write(bytes.data(), static_cast<qint64>(bytes.size()));
        while (socket_.bytesToWrite() > 0 && !stop.asked()) {
            if (socket_.waitForBytesWritten(turnMs)) continue;
            if (socket_.state() != QAbstractSocket::ConnectedState) throw Failure("the receiver closed the connection");
        }
    }

private:
    QTcpSocket socket_;
};

// Lets the time pass until a piece is due.
class Pause {
public:
    virtual ~Pause() = default;
    virtual bool until(std::chrono::steady_clock::time_point time) = 0;  // true: playing is to end
};

class PlainPause : public Pause {
public:
    explicit PlainPause(StopSignal& stop) : stop_(stop) {}
    bool until(std::chrono::steady_clock::time_point time) override { return stop_.waitUntil(time); }

private:
    StopSignal& stop_;
};

// Listens for orders while it waits; the last one stands.
class ListeningPause : public Pause {
public:
    ListeningPause(StopSignal& stop, SequencerDesk& desk) : stop_(stop), desk_(desk) {}

    bool until(std::chrono::steady_clock::time_point time) override {
        constexpr std::int64_t sliceMs = 20;  // a signal is answered within it
        for (;;) {
            const std::int64_t left =
                std::chrono::duration_cast<std::chrono::milliseconds>(time - std::chrono::steady_clock::now()).count();
            // The last millisecond is left to the exact wait.
            if (const auto order = desk_.order(static_cast<int>(std::clamp<std::int64_t>(left - 1, 0, sliceMs)))) {
                playOrdered = *order == SequencerCommand::Start;
                return true;
            }
            if (left <= sliceMs) return stop_.waitUntil(time);
            if (stop_.asked()) return true;
        }
    }

    bool playOrdered = false;

private:
    StopSignal& stop_;
    SequencerDesk& desk_;
};

// A capture on its way to a receiver.
struct Playback {
    const std::vector<CapturePiece>& pieces;
    double speed;
    bool loop;
    Receiver& receiver;
    StopSignal& stop;
    ProgressLine& progress;

    std::chrono::steady_clock::duration scaled(std::int32_t ms) const {
        return std::chrono::duration_cast<std::chrono::steady_clock::duration>(
            std::chrono::duration<double, std::milli>(ms / speed));
    }

    // Once from its beginning. False where the pause ended it.
    bool once(std::chrono::steady_clock::time_point start, Pause& pause) const {
        for (const CapturePiece& piece : pieces) {
            if (pause.until(start + scaled(piece.timeMs))) return false;
            receiver.send(piece.bytes, stop);
            progress.show("sent %.1f s of %.1f s", piece.timeMs / 1000.0, pieces.back().timeMs / 1000.0);
        }
        return true;
    }

    // To its end, or again and again.
    void run(Pause& pause) const {
        auto start = std::chrono::steady_clock::now();
        while (once(start, pause) && loop)
            start += scaled(std::max(pieces.back().timeMs, 1));
    }
};

void playOnRequest(const Playback& playback) {
    FileSettingsStore store(FileSettingsStore::userFile());
    SequencerDesk desk(store);
    ListeningPause pause(playback.stop, desk);
    constexpr std::chrono::seconds aWhile(3600);
    while (!playback.stop.asked()) {
        if (std::exchange(pause.playOrdered, false)) {
            playback.run(pause);
        } else {
            pause.until(std::chrono::steady_clock::now() + aWhile);
        }
    }
}

void send(const ToolOptions& options) {
    require(options.speed > 0, "the speed must be above 0");
    const Capture capture = loadCapture(options.file);
    if (capture.cutLine > 0) {
        std::fprintf(stderr, "%s, line %d: cut short, left out\n", options.file.c_str(), capture.cutLine);
    }
    if (capture.pieces.empty()) return;
    std::unique_ptr<Receiver> receiver;
    if (options.tcp) {
        receiver = std::make_unique<TcpReceiver>(options.host, options.port);
    } else {
        receiver = std::make_unique<UdpReceiver>(options.host, options.port);
    }
    StopSignal stop;
    ProgressLine progress;
    const Playback playback{capture.pieces, options.speed, options.loop, *receiver, stop, progress};
    if (options.onRequest) {
        playOnRequest(playback);
    } else {
        PlainPause pause(stop);
        playback.run(pause);
    }
}

}  // namespace

int runSend(const ToolOptions& options) {
    try {
        send(options);
        return 0;
    } catch (const Failure& failure) {
        std::fprintf(stderr, "zeph-tool send: %s\n", failure.what());
        return 1;
    }
}
