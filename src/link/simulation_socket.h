// The seam of the one data socket: the real form stands in qt_simulation_socket.h, tests hand in bytes from a list.
// All procedures and both events run on one thread, the one that works off the stream.
#pragma once

#include "util/failure.h"

#include <cstdint>
#include <functional>
#include <string>

// The port is held by another program.
class PortTaken : public Failure {
public:
    using Failure::Failure;
};

// What became of a wish for a larger receive buffer.
struct ReceiveBufferAnswer {
    int systemError = 0;   // 0 = the system took the wish
    int grantedBytes = 0;  // as the system counts them, its own bookkeeping included
};

class SimulationSocket {
public:
    virtual ~SimulationSocket() = default;

    std::function<void()> dataArrival;                              // bytes wait; told once until they are read
    std::function<void(std::int64_t requestID)> connectionRequest;  // TCP: a client has connected

    // TCP: waits for a connection on localPort (0 = any free one), on all addresses.
    // Throws PortTaken, or Failure with the system's words.
    virtual void Listen(std::int32_t localPort) = 0;
    // UDP: receives on localPort (0 = any free one) of the local address. Throws like Listen.
    virtual void Bind(std::int32_t localPort, const std::string& localIP) = 0;
    // TCP: takes the client of that request and closes the one before: the newest wins. When the client that holds the
    // connection goes, nothing listens any more.
    virtual void Accept(std::int64_t requestID) = 0;
    virtual void Close() = 0;

    virtual std::int32_t State() const = 0;      // zero = closed
    virtual std::int32_t LocalPort() const = 0;  // the port in use, 0 while closed

    // Replaces text by what waits, or a part of it; empty when nothing does. Returns false where the read failed.
    // Bytes that had arrived before Close can still be read.
    virtual bool GetData(std::string& text) = 0;

    // setsockopt: level SOL_SOCKET, option SO_RCVBUF.
    virtual ReceiveBufferAnswer SetReceiveBuffer(int bytes) = 0;
};
