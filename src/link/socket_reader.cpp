#include "link/socket_reader.h"

#include <array>
#include <cerrno>
#include <vector>

#ifdef Q_OS_WIN
#include <winsock2.h>
#else
#include <poll.h>
#include <sys/socket.h>
#endif

namespace {

[[noreturn]] void throwOpening(QAbstractSocket::SocketError error, const QString& words) {
    if (error == QAbstractSocket::AddressInUseError) throw PortTaken(words.toStdString());
    throw Failure(words.toStdString());
}

ReceiveBufferAnswer setReceiveBufferOf(qintptr handle, int bytes) {
    ReceiveBufferAnswer answer;
#ifdef Q_OS_WIN
    const SOCKET socket = static_cast<SOCKET>(handle);
    int length = sizeof answer.grantedBytes;
    const bool failed =
        ::setsockopt(socket, SOL_SOCKET, SO_RCVBUF, reinterpret_cast<const char*>(&bytes), sizeof bytes) != 0 ||
        ::getsockopt(socket, SOL_SOCKET, SO_RCVBUF, reinterpret_cast<char*>(&answer.grantedBytes), &length) != 0;
    if (failed) answer.systemError = WSAGetLastError();
#else
    const int socket = static_cast<int>(handle);
    socklen_t length = sizeof answer.grantedBytes;
    if (::setsockopt(socket, SOL_SOCKET, SO_RCVBUF, &bytes, sizeof bytes) != 0 ||
        ::getsockopt(socket, SOL_SOCKET, SO_RCVBUF, &answer.grantedBytes, &length) != 0) {
        answer.systemError = errno;
    }
#endif
    return answer;
}

// For a client, which may have gone by now and then has no buffer to tune.
ReceiveBufferAnswer tune(const QTcpSocket& client, int bytes) {
    return client.socketDescriptor() == -1 ? ReceiveBufferAnswer{}
                                           : setReceiveBufferOf(client.socketDescriptor(), bytes);
}

#ifdef Q_OS_LINUX

// Takes several datagrams with each call of the system: at 50,000 a second, one call a datagram would cost more than
// all that is done with them.
class DatagramBatch {
public:
    DatagramBatch() : space_(kDatagrams * kLongest) {
        for (std::size_t i = 0; i < kDatagrams; ++i) {
            pieces_[i] = {space_.data() + i * kLongest, kLongest};
            messages_[i].msg_hdr.msg_iov = &pieces_[i];
            messages_[i].msg_hdr.msg_iovlen = 1;
        }
    }

    // Hands over every datagram that waits. Returns false where the read failed.
    template <typename Take>
    bool drain(int handle, Take take) {
        for (;;) {
            const int count = ::recvmmsg(handle, messages_.data(), kDatagrams, MSG_DONTWAIT, nullptr);
            if (count < 0) return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
            for (int i = 0; i < count; ++i) {
                const std::size_t n = static_cast<std::size_t>(i);
                take(std::string_view(space_.data() + n * kLongest, messages_[n].msg_len));
            }
            if (count < static_cast<int>(kDatagrams)) return true;
        }
    }

private:
    static constexpr std::size_t kDatagrams = 32;
    static constexpr std::size_t kLongest = 65'536;

    std::vector<char> space_;
    std::array<iovec, kDatagrams> pieces_{};
    std::array<mmsghdr, kDatagrams> messages_{};
};

#endif

}  // namespace

void SocketReader::open() {
    std::future<std::int32_t> opened = opened_.get_future();
    start(QThread::TimeCriticalPriority);
    localPort_ = opened.get();
}

void SocketReader::stop() {
    stopping_ = true;
    wait();
}

void SocketReader::run() {
    // The socket is made on this thread, which never runs an event loop: Qt's own notifiers stay out of the way.
    try {
        opened_.set_value(openSocket());
    } catch (...) {
        opened_.set_exception(std::current_exception());
        return;
    }
    serve();
}

void SocketReader::arrived(std::string_view bytes) {
    if (bytes.empty()) return;
    queue_.put(bytes);
    if (told_.exchange(true)) return;
    QMetaObject::invokeMethod(
        events_.receiver,
        [this] {
            told_ = false;  // before the owner reads: what comes in meanwhile is told again
            events_.dataArrival();
        },
        Qt::QueuedConnection);
}

void SocketReader::requested(std::int64_t requestID) {
    QMetaObject::invokeMethod(
        events_.receiver, [this, requestID] { events_.connectionRequest(requestID); }, Qt::QueuedConnection);
}

std::int32_t UdpReader::openSocket() {
    auto socket = std::make_unique<QUdpSocket>();
    // Not shared: two receivers on one port would each get a part of the stream.
    if (!socket->bind(address_, port_, QAbstractSocket::DontShareAddress)) {
        throwOpening(socket->error(), socket->errorString());
    }
    socket_ = std::move(socket);
    return socket_->localPort();
}

void UdpReader::serve() {
#ifdef Q_OS_LINUX
    DatagramBatch batch;
    pollfd waiting{static_cast<int>(socket_->socketDescriptor()), POLLIN, 0};
    while (!stopping()) {
        if (::poll(&waiting, 1, kTurnMs) <= 0) continue;
        // A read that fails (a network that went down, say) is no error of the program; it must not spin either.
        if (!batch.drain(waiting.fd, [this](std::string_view bytes) { arrived(bytes); })) msleep(kTurnMs);
    }
    batch.drain(waiting.fd, [this](std::string_view bytes) { arrived(bytes); });
#else
    std::vector<char> datagram(65'536);
    while (!stopping()) {
        socket_->waitForReadyRead(kTurnMs);
        while (socket_->hasPendingDatagrams()) {
            const qint64 length = socket_->readDatagram(datagram.data(), static_cast<qint64>(datagram.size()));
            if (length < 0) break;
            arrived({datagram.data(), static_cast<std::size_t>(length)});
        }
    }
#endif
    socket_.reset();
}

ReceiveBufferAnswer UdpReader::setReceiveBuffer(int bytes) {
    return setReceiveBufferOf(socket_->socketDescriptor(), bytes);  // the same one until the owner stops the thread
}

std::int32_t TcpReader::openSocket() {
    auto server = std::make_unique<QTcpServer>();
    if (!server->listen(QHostAddress::AnyIPv4, port_)) throwOpening(server->serverError(), server->errorString());
    server_ = std::move(server);
    return server_->serverPort();
}

void TcpReader::accept(std::int64_t requestID) {
    accepted_ = requestID;
}

ReceiveBufferAnswer TcpReader::setReceiveBuffer(int bytes) {
    // Listener and client come and go on the thread, so the handles are its own to touch.
    BufferWish wish{bytes, {}};
    std::future<ReceiveBufferAnswer> answer = wish.answer.get_future();
    {
        const std::lock_guard lock(wishGuard_);
        wish_ = std::move(wish);
    }
    return answer.get();
}

void TcpReader::serve() {
    while (!stopping()) {
        takeRequests();
        takeAccepted();
        takeBufferWish();
        readClient();
    }
    client_.reset();
    requests_.clear();
    server_.reset();
}

void TcpReader::takeRequests() {
    if (!server_) return;
    server_->waitForNewConnection(client_ ? 0 : kTurnMs);
    while (QTcpSocket* const request = server_->nextPendingConnection()) {
        request->setParent(nullptr);  // outlives the server
        requests_[++lastRequest_].reset(request);
        requested(lastRequest_);
    }
}

void TcpReader::takeAccepted() {
    const auto found = requests_.find(accepted_.exchange(0));
    if (found == requests_.end()) return;
    client_ = std::move(found->second);
    requests_.erase(requests_.begin(), std::next(found));  // older requests lose like the client before
    if (receiveBufferBytes_ > 0) tune(*client_, receiveBufferBytes_);
}

void TcpReader::takeBufferWish() {
    const std::lock_guard lock(wishGuard_);
    if (!wish_) return;
    receiveBufferBytes_ = wish_->bytes;
    ReceiveBufferAnswer answer;
    if (server_) answer = setReceiveBufferOf(server_->socketDescriptor(), wish_->bytes);
    if (client_ && answer.systemError == 0) answer = tune(*client_, wish_->bytes);
    wish_->answer.set_value(answer);
    wish_.reset();
}

void TcpReader::readClient() {
    if (!client_) {
        if (!server_) msleep(kTurnMs);
        return;
    }
    client_->waitForReadyRead(kTurnMs);
    const QByteArray bytes = client_->readAll();
    arrived({bytes.data(), static_cast<std::size_t>(bytes.size())});
    if (client_->state() != QAbstractSocket::UnconnectedState) return;
    // The client took the listener's place when it was accepted; with it, listening ends for this run.
    client_.reset();
    if (requests_.empty()) server_.reset();
}
