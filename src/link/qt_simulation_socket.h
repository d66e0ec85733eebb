// The data socket on Qt's sockets. A thread of its own blocks on the socket and gathers what arrives, because the
// system's receive buffer holds only a few milliseconds of a fast stream while the main thread may be drawing; the
// events are told on the thread that made the socket, through its event loop, several arrivals as one.
#pragma once

#include "link/simulation_socket.h"
#include "link/socket_reader.h"

#include <QObject>

#include <memory>

class QtSimulationSocket : public SimulationSocket {
public:
    QtSimulationSocket();
    ~QtSimulationSocket() override;

    void Listen(std::int32_t localPort) override;
    void Bind(std::int32_t localPort, const std::string& localIP) override;
    void Accept(std::int64_t requestID) override;
    void Close() override;
    std::int32_t State() const override;
    std::int32_t LocalPort() const override;
    bool GetData(std::string& text) override;
    ReceiveBufferAnswer SetReceiveBuffer(int bytes) override;

private:
    SocketReader::Events events();
    void open(std::unique_ptr<SocketReader> reader);

    QObject receiver_;  // its thread is the one that the events are told on; events underway die with it
    std::unique_ptr<SocketReader> reader_;  // stays behind Close for what it has gathered
    bool open_ = false;
};
