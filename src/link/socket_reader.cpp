#include "link/socket_reader.h"

#include <QNetworkProxy>

#include <array>
#include <cerrno>
#include <vector>

#ifdef Q_OS_WIN
#include <winsock2.h>
#else
#include <sys/socket.h>
#endif
#ifdef Q_OS_LINUX
#include <poll.h>
#include <pthread.h>
#include <sched.h>
#include <sys/syscall.h>
#include <unistd.h>
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

// How long the thread lets datagrams gather after a read. Far below what the smallest receive buffer holds (about 90
// datagrams of 1,400 bytes, 1.8 ms at 50,000 a second), and it saves a change of threads for each of them.
constexpr unsigned long kGatherUs = 100;

// The thread works for a few microseconds at a time, but must not wait for its turn behind threads that compute for
// milliseconds: real-time scheduling where the system grants it, else the shortest time slice, which the scheduler of
// recent kernels answers with an early turn. What is refused is no failure; then the receive buffer has to do.
void askForPromptTurns() {
    const sched_param lowest{::sched_get_priority_min(SCHED_RR)};
    if (::pthread_setschedparam(::pthread_self(), SCHED_RR, &lowest) == 0) return;
    // struct sched_attr of sched_setattr(2), for which the C library has no wrapper.
    struct {
        std::uint32_t size = 48;
        std::uint32_t policy = SCHED_OTHER;
        std::uint64_t flags = 0;
        std::int32_t nice = 0;
        std::uint32_t priority = 0;
        std::uint64_t runtimeNs = 100'000;  // the slice; the kernel takes 0.1 ms at the least
        std::uint64_t deadlineNs = 0;
        std::uint64_t periodNs = 0;
    } attributes;
    ::syscall(SYS_sched_setattr, 0, &attributes, 0);
}

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

    // Hands over every datagram that waits, up to kMostRounds batches: under a flood the others get their turn too.
    // Returns false where the read failed.
    template <typename Take>
    bool drain(int handle, Take take) {
        for (int round = 0; round < kMostRounds; ++round) {
            const int count = ::recvmmsg(handle, messages_.data(), kDatagrams, MSG_DONTWAIT, nullptr);
            if (count < 0) return errno == EAGAIN || errno == EWOULDBLOCK || errno == EINTR;
            for (int i = 0; i < count; ++i) {
                const std::size_t n = static_cast<std::size_t>(i);
                take(std::string_view(space_.data() + n * kLongest, messages_[n].msg_len));
            }
            if (count < static_cast<int>(kDatagrams)) break;
        }
        return true;
    }

private:
    static constexpr int kMostRounds = 64;
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
    queue_.handOver();
}

int SocketReader::tellGathered() {
    constexpr int soonMs = 1;
    const ReceiveQueue::HandOver handOver = queue_.tryHandOver();
    if (handOver == ReceiveQueue::HandOver::Busy) return soonMs;
    if (handOver == ReceiveQueue::HandOver::Done && !told_.exchange(true)) {
        QMetaObject::invokeMethod(
            events_.receiver,
            [this] {
                told_ = false;  // before the owner reads: what comes in meanwhile is told again
                events_.dataArrival();
            },
            Qt::QueuedConnection);
    }
    return kTurnMs;
}

void SocketReader::requested(std::int64_t requestID) {
    QMetaObject::invokeMethod(
        events_.receiver, [this, requestID] { events_.connectionRequest(requestID); }, Qt::QueuedConnection);
}

std::int32_t UdpReader::openSocket() {
    auto socket = std::make_unique<QUdpSocket>();
    socket->setProxy(QNetworkProxy::NoProxy);  // the stream comes straight from its sender
    // Not shared: two receivers on one port would each get a part of the stream.
    if (!socket->bind(address_, port_, QAbstractSocket::DontShareAddress)) {
        throwOpening(socket->error(), socket->errorString());
    }
    socket_ = std::move(socket);
    return socket_->localPort();
}

void UdpReader::serve() {
#ifdef Q_OS_LINUX
    askForPromptTurns();
    DatagramBatch batch;
    const auto take = [this](std::string_view bytes) { gather(bytes); };
    pollfd waiting{static_cast<int>(socket_->socketDescriptor()), POLLIN, 0};
    int waitMs = kTurnMs;
    while (!stopping()) {
        if (::poll(&waiting, 1, waitMs) > 0) {
            // A read that fails (a network that went down, say) is no error of the program; it must not spin either.
            if (!batch.drain(waiting.fd, take)) msleep(kTurnMs);
            waitMs = tellGathered();
            usleep(kGatherUs);
        } else {
            waitMs = tellGathered();
        }
    }
    batch.drain(waiting.fd, take);
#else
    std::vector<char> datagram(65'536);
    int waitMs = kTurnMs;
    while (!stopping()) {
        socket_->waitForReadyRead(waitMs);
        while (socket_->hasPendingDatagrams()) {
            const qint64 length = socket_->readDatagram(datagram.data(), static_cast<qint64>(datagram.size()));
            if (length < 0) break;
            gather({datagram.data(), static_cast<std::size_t>(length)});
        }
        waitMs = tellGathered();
    }
#endif
    socket_.reset();
}

ReceiveBufferAnswer UdpReader::setReceiveBuffer(int bytes) {
    return setReceiveBufferOf(socket_->socketDescriptor(), bytes);  // the same one until the owner stops the thread
}

std::int32_t TcpReader::openSocket() {
    auto server = std::make_unique<QTcpServer>();
    server->setProxy(QNetworkProxy::NoProxy);
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
    gather({bytes.data(), static_cast<std::size_t>(bytes.size())});
    tellGathered();
    if (client_->state() != QAbstractSocket::UnconnectedState) return;
    // The client took the listener's place when it was accepted; with it, listening ends for this run.
    client_.reset();
    if (requests_.empty()) server_.reset();
}
