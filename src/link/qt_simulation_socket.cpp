#include "link/qt_simulation_socket.h"

#include "link/socket_reader.h"

#include <QCoreApplication>

namespace {

// As the platform's socket control counts: 0 closed, 1 open.
constexpr std::int32_t kStateClosed = 0;
constexpr std::int32_t kStateOpen = 1;

std::uint16_t portNumber(std::int32_t port) {
    require(port >= 0 && port <= 65'535, "the port is not 0 to 65535");
    return static_cast<std::uint16_t>(port);
}

}  // namespace

QtSimulationSocket::QtSimulationSocket() = default;
QtSimulationSocket::~QtSimulationSocket() = default;

void QtSimulationSocket::Listen(std::int32_t localPort) {
    open(std::make_unique<TcpReader>(events(), portNumber(localPort)));
}

void QtSimulationSocket::Bind(std::int32_t localPort, const std::string& localIP) {
    const QHostAddress address(QString::fromStdString(localIP));
    require(!address.isNull(), "the local address is no IP address");
    open(std::make_unique<UdpReader>(events(), address, portNumber(localPort)));
}

void QtSimulationSocket::open(std::unique_ptr<SocketReader> reader) {
    require(!open_, "the socket is open");
    reader->open();
    QCoreApplication::removePostedEvents(&receiver_);  // of the reader before, which ends here
    reader_ = std::move(reader);
    open_ = true;
}

SocketReader::Events QtSimulationSocket::events() {
    return {&receiver_,
            [this] {
                if (dataArrival) dataArrival();
            },
            [this](std::int64_t requestID) {
                if (connectionRequest) connectionRequest(requestID);
            }};
}

void QtSimulationSocket::Accept(std::int64_t requestID) {
    require(open_, "the socket is closed");
    reader_->accept(requestID);
}

void QtSimulationSocket::Close() {
    if (!open_) return;
    reader_->stop();
    open_ = false;
}

std::int32_t QtSimulationSocket::State() const {
    return open_ ? kStateOpen : kStateClosed;
}

std::int32_t QtSimulationSocket::LocalPort() const {
    return open_ ? reader_->localPort() : 0;
}

bool QtSimulationSocket::GetData(std::string& text) {
    text.clear();
    if (reader_) reader_->queue().take(text);
    return reader_ != nullptr;
}

ReceiveBufferAnswer QtSimulationSocket::SetReceiveBuffer(int bytes) {
    require(open_, "the socket is closed");
    return reader_->setReceiveBuffer(bytes);
}
