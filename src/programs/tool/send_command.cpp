#include "programs/tool/send_command.h"

#include "link/capture_file.h"
#include "programs/tool/progress_line.h"
#include "programs/tool/stop_signal.h"
#include "util/failure.h"

#include <QHostInfo>
#include <QNetworkProxy>
#include <QTcpSocket>
#include <QUdpSocket>

#include <algorithm>
#include <cstdio>
#include <memory>

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

// Plays the capture once, or until the user stops it. Times count from start. Returns false when stopped.
bool play(const std::vector<CapturePiece>& pieces, double speed, std::chrono::steady_clock::time_point start,
          Receiver& receiver, StopSignal& stop, ProgressLine& progress) {
    for (const CapturePiece& piece : pieces) {
        const std::chrono::duration<double, std::milli> due(piece.timeMs / speed);
        if (stop.waitUntil(start + std::chrono::duration_cast<std::chrono::steady_clock::duration>(due))) return false;
        receiver.send(piece.bytes, stop);
        progress.show("sent %.1f s of %.1f s", piece.timeMs / 1000.0, pieces.back().timeMs / 1000.0);
    }
    return true;
}

void send(const ToolOptions& options) {
    require(options.speed > 0, "the speed must be above 0");
    const Capture capture = loadCapture(options.file);
    if (capture.cutLine > 0) {
        std::fprintf(stderr, "%s, line %d: cut short, left out\n", options.file.c_str(), capture.cutLine);
    }
    if (capture.pieces.empty()) return;
    StopSignal stop;  // before the sockets: threads that they start must not take the signal
    std::unique_ptr<Receiver> receiver;
    if (options.tcp) {
        receiver = std::make_unique<TcpReceiver>(options.host, options.port);
    } else {
        receiver = std::make_unique<UdpReceiver>(options.host, options.port);
    }
    ProgressLine progress;
    const std::chrono::duration<double, std::milli> length(std::max(capture.pieces.back().timeMs, 1) / options.speed);
    auto start = std::chrono::steady_clock::now();
    while (play(capture.pieces, options.speed, start, *receiver, stop, progress) && options.loop)
        start += std::chrono::duration_cast<std::chrono::steady_clock::duration>(length);
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
