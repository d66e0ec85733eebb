// The threads behind the data socket: one reads datagrams, one serves a TCP client. Each owns its Qt socket; the
// others only pass wishes in and take bytes out.
#pragma once

#include "link/receive_queue.h"
#include "link/simulation_socket.h"

#include <QHostAddress>
#include <QObject>
#include <QTcpServer>
#include <QTcpSocket>
#include <QThread>
#include <QUdpSocket>

#include <atomic>
#include <functional>
#include <future>
#include <map>
#include <memory>
#include <mutex>
#include <optional>

class SocketReader : public QThread {
public:
    // What the owner is told, on the thread of `receiver`.
    struct Events {
        QObject* receiver = nullptr;
        std::function<void()> dataArrival;
        std::function<void(std::int64_t requestID)> connectionRequest;
    };

    explicit SocketReader(Events events) : events_(std::move(events)) {}

    // Starts the thread and opens the socket there; throws what the opening throws.
    void open();
    // Stops the thread and closes the socket; what arrived before stays in the queue.
    void stop();

    std::int32_t localPort() const { return localPort_; }
    ReceiveQueue& queue() { return queue_; }
    virtual ReceiveBufferAnswer setReceiveBuffer(int bytes) = 0;
    virtual void accept(std::int64_t) {}

protected:
    // The longest that a wish of the owner or the end waits for the thread, ms.
    static constexpr int kTurnMs = 20;

    virtual std::int32_t openSocket() = 0;  // returns the port in use
    virtual void serve() = 0;               // until stopping()

    bool stopping() const { return stopping_; }
    void arrived(std::string_view bytes);
    void requested(std::int64_t requestID);

private:
    void run() override;

    Events events_;
    ReceiveQueue queue_;
    std::promise<std::int32_t> opened_;
    std::int32_t localPort_ = 0;
    std::atomic<bool> stopping_ = false;
    std::atomic<bool> told_ = false;  // an arrival is underway to the owner
};

class UdpReader : public SocketReader {
public:
    UdpReader(Events events, QHostAddress address, std::uint16_t port)
        : SocketReader(std::move(events)), address_(std::move(address)), port_(port) {}
    ~UdpReader() override { stop(); }

    ReceiveBufferAnswer setReceiveBuffer(int bytes) override;

private:
    std::int32_t openSocket() override;
    void serve() override;

    QHostAddress address_;
    std::uint16_t port_;
    std::unique_ptr<QUdpSocket> socket_;
};

class TcpReader : public SocketReader {
public:
    TcpReader(Events events, std::uint16_t port) : SocketReader(std::move(events)), port_(port) {}
    ~TcpReader() override { stop(); }

    ReceiveBufferAnswer setReceiveBuffer(int bytes) override;
    void accept(std::int64_t requestID) override;

private:
    std::int32_t openSocket() override;
    void serve() override;
    void takeRequests();
    void takeAccepted();
    void takeBufferWish();
    void readClient();

    std::uint16_t port_;
    std::unique_ptr<QTcpServer> server_;
    std::map<std::int64_t, std::unique_ptr<QTcpSocket>> requests_;  // connected, not yet accepted
    std::unique_ptr<QTcpSocket> client_;
    std::int64_t lastRequest_ = 0;
    int receiveBufferBytes_ = 0;  // wished last, 0 = never; clients that come later get it too

    // Wishes of the owner, until the thread's next turn takes them.
    struct BufferWish {
        int bytes;
        std::promise<ReceiveBufferAnswer> answer;
    };
    std::atomic<std::int64_t> accepted_ = 0;  // request that the owner accepted, 0 = none
    std::mutex wishGuard_;
    std::optional<BufferWish> wish_;
};
