// Opening the data socket, and the events of it: what connects the socket to the channel stream.
#pragma once

#include "link/adapters.h"
#include "link/payload_parser.h"
#include "link/queue_gauge.h"
#include "link/simulation_socket.h"
#include "util/failure.h"
#include "util/host.h"

#include <cstdint>
#include <functional>
#include <string>
#include <string_view>

// How the program is connected. Filled from the settings at start-up and by the options dialog.
struct Connection {
    std::string ZephAdapterName;              // caption of the chosen adapter
    std::string ZephAdapterIP;                // the address found for it
    std::int32_t ZephSimulationPort = 30303;  // 0..65535
    bool ZephUseTCP = false;                  // UDP otherwise
    bool ZephPortOpen = false;                // the socket has been opened in this run; never goes back
};

// The socket's receive buffer, bytes; asked of the system on every entry into simulation.
inline constexpr int kReceiveBufferBytes = 2'097'152;

// The receiving side: the stream, its gauge, and the storage through which bytes are moved.
struct ReceiveState {
    ChannelStream Stream;
    QueueGauge Gauge;
    std::string Piece;  // scratch of ZephGetDataFromStack, kept for its capacity
};

// What opening the socket needs of its surroundings.
struct CommunicationsContext {
    SimulationSocket& socket;
    AdapterLister lister;
    Host& host;
    FailureReport& failures;
    std::function<void(std::string_view line)> log;  // takes what the system granted; one line a call
};

// Opens the socket unless it is open, and asks for the receive buffer. ipOut and portOut get address and port for the
// status line. Returns false where there is no usable address, the socket cannot be opened or the system refuses the
// buffer; the user has then been told.
[[nodiscard]] bool ZephSetUpCommunications(const CommunicationsContext& context, Connection& connection,
                                           ZephAdapters& adapters, std::string& ipOut, std::string& portOut);

// The text of the status line while simulation runs, such as "UDP Simulation active on 127.0.0.1 (30303)".
std::string simulationActiveText(bool useTCP, std::string_view ip, std::string_view port);

// The event of a client that connects over TCP: takes it and says so in panel 2.
void Winsock1_ConnectionRequest(std::int64_t requestID, SimulationSocket& socket, Host& host, FailureReport& failures);

// The event of bytes that wait: moves them to the stream's buffer, or throws them away outside simulation. Returns what
// the queue gauge is to show: the length from before the read, since the next tick works off the rest anyway.
QueueGaugeUpdate Winsock1_DataArrival(bool simulating, bool openGlOutput, SimulationSocket& socket,
                                      FailureReport& failures, ReceiveState& receive);

// Moves everything that the socket holds to the end of ZephStackBuffer. Called by the event, and once more when the
// program ends, after the socket was closed.
void ZephGetDataFromStack(SimulationSocket& socket, FailureReport& failures, ReceiveState& receive);
