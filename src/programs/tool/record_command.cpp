#include "programs/tool/record_command.h"

#include "link/capture_file.h"
#include "link/communications.h"
#include "programs/tool/progress_line.h"
#include "programs/tool/stop_signal.h"
#include "util/failure.h"

#include <QNetworkProxy>
#include <QTcpServer>
#include <QTcpSocket>
#include <QUdpSocket>

#include <cstdio>
#include <functional>
#include <memory>

namespace {

constexpr int kTurnMs = 20;  // the longest that a stop waits

// Where a recording hears from. The program's own socket joins pieces that arrive together; a recording keeps them
// apart, so that playing it sends what was sent.
class Source {
public:
    virtual ~Source() = default;
    // Waits up to kTurnMs and hands over each piece that has arrived.
    virtual void read(const std::function<void(std::string_view)>& take) = 0;
};

[[noreturn]] void throwOpening(QAbstractSocket::SocketError error, const QString& words, std::int32_t port) {
    const std::string name = "port " + std::to_string(port);
    if (error == QAbstractSocket::AddressInUseError) throw Failure(name + " is already in use by another program");
    throw Failure(name + " cannot be opened: " + words.toStdString());
}

class UdpSource : public Source {
public:
    UdpSource(const std::string& address, std::int32_t port) : datagram_(65'536, '\0') {
        const QHostAddress local(QString::fromStdString(address));
        require(!local.isNull(), "the address is no IP address");
        socket_.setProxy(QNetworkProxy::NoProxy);
        if (!socket_.bind(local, static_cast<quint16>(port), QAbstractSocket::DontShareAddress)) {
            throwOpening(socket_.error(), socket_.errorString(), port);
        }
        socket_.setSocketOption(QAbstractSocket::ReceiveBufferSizeSocketOption, kReceiveBufferBytes);
    }

    void read(const std::function<void(std::string_view)>& take) override {
        socket_.waitForReadyRead(kTurnMs);
        while (socket_.hasPendingDatagrams()) {
            const qint64 length = socket_.readDatagram(datagram_.data(), static_cast<qint64>(datagram_.size()));
            if (length < 0) return;
            take(std::string_view(datagram_).substr(0, static_cast<std::size_t>(length)));
        }
    }

private:
    QUdpSocket socket_;
    std::string datagram_;
};

class TcpSource : public Source {
public:
    explicit TcpSource(std::int32_t port) {
        server_.setProxy(QNetworkProxy::NoProxy);
        if (!server_.listen(QHostAddress::AnyIPv4, static_cast<quint16>(port))) {
            throwOpening(server_.serverError(), server_.errorString(), port);
        }
    }

    void read(const std::function<void(std::string_view)>& take) override {
        server_.waitForNewConnection(client_ ? 0 : kTurnMs);
        while (QTcpSocket* const next = server_.nextPendingConnection()) {
            next->setParent(nullptr);
            client_.reset(next);  // the newest wins, as with the simulation
        }
        if (!client_) return;
        client_->waitForReadyRead(kTurnMs);
        const QByteArray bytes = client_->readAll();
        if (!bytes.isEmpty()) take({bytes.data(), static_cast<std::size_t>(bytes.size())});
        if (client_->state() == QAbstractSocket::UnconnectedState) client_.reset();
    }

private:
    QTcpServer server_;
    std::unique_ptr<QTcpSocket> client_;
};

void record(const ToolOptions& options) {
    using SteadyClock = std::chrono::steady_clock;
    StopSignal stop;  // before the sockets: threads that they start must not take the signal
    // The port first: a recording that cannot begin must not cost the capture that stands in its place.
    std::unique_ptr<Source> source;
    if (options.tcp) {
        source = std::make_unique<TcpSource>(options.port);
    } else {
        source = std::make_unique<UdpSource>(options.address, options.port);
    }
    CaptureWriter writer(options.out);
    ProgressLine progress;
    const SteadyClock::time_point start = SteadyClock::now();
    const auto elapsedMs = [start] {
        return std::chrono::duration_cast<std::chrono::milliseconds>(SteadyClock::now() - start).count();
    };
    const std::int64_t endMs = options.seconds ? std::int64_t{*options.seconds} * 1000 : INT32_MAX;
    std::size_t pieces = 0;
    while (elapsedMs() < endMs && !stop.asked()) {
        source->read([&](std::string_view bytes) {
            writer.piece(static_cast<std::int32_t>(elapsedMs()), bytes);
            ++pieces;
        });
        progress.show("recording: %.1f s, %zu pieces", static_cast<double>(elapsedMs()) / 1000, pieces);
    }
}

}  // namespace

int runRecord(const ToolOptions& options) {
    try {
        record(options);
        return 0;
    } catch (const Failure& failure) {
        std::fprintf(stderr, "zeph-tool record: %s\n", failure.what());
        return 1;
    }
}
