// The data socket's test form: bytes from a list, and a script of what opening and tuning it answer.
#pragma once

#include "link/simulation_socket.h"

#include <deque>
#include <stdexcept>
#include <string>
#include <vector>

class ListSocket : public SimulationSocket {
public:
    void Listen(std::int32_t localPort) override { open("listen", localPort); }
    void Bind(std::int32_t localPort, const std::string& localIP) override { open("bind " + localIP, localPort); }
    void Accept(std::int64_t requestID) override { calls.push_back("accept " + std::to_string(requestID)); }
    void Close() override { port = 0; }
    std::int32_t State() const override { return port == 0 ? 0 : 1; }
    std::int32_t LocalPort() const override { return port; }
    bool GetData(std::string& text) override {
        text.clear();
        if (reads.empty()) return !failsWhenEmpty;
        text.swap(reads.front());
        reads.pop_front();
        return true;
    }
    ReceiveBufferAnswer SetReceiveBuffer(int bytes) override {
        calls.push_back("buffer " + std::to_string(bytes));
        return bufferAnswer;
    }

    std::deque<std::string> reads;
    bool failsWhenEmpty = false;
    bool taken = false;       // opening finds the port taken
    std::string openFailure;  // opening fails with these words; empty = it does not
    ReceiveBufferAnswer bufferAnswer{0, 212'992};
    std::vector<std::string> calls;
    std::int32_t port = 0;

private:
    void open(const std::string& call, std::int32_t localPort) {
        calls.push_back(call + " " + std::to_string(localPort));
        if (taken) throw PortTaken("The bound address is already in use");
        if (!openFailure.empty()) throw Failure(openFailure);
        port = localPort;
    }
};
