#include "link/communications.h"

namespace {

constexpr std::string_view kModule = "modZephCommunications";

std::string openingProblem(const Failure& failure, std::int32_t port) {
    const std::string name = "Port " + std::to_string(port);
    if (dynamic_cast<const PortTaken*>(&failure) != nullptr) {
        return name +
               " is already in use by another program.\r\nEnd that program, or choose another port in the options.";
    }
    return name + " cannot be opened: " + failure.what();
}

void openSocket(const Connection& connection, const std::string& ip, SimulationSocket& socket, Host& host) {
    const std::int32_t port = connection.ZephSimulationPort;
    try {
        if (connection.ZephUseTCP) {
            socket.Listen(port);  // on all addresses: the chosen adapter plays no part
        } else {
            socket.Bind(port, ip);
        }
    } catch (const Failure& failure) {
        // The log alone would leave the user before a simulation that does not start.
        host.messageBox(boxTitle("-Port Error"), openingProblem(failure, port), BoxIcon::Critical);
        throw;
    }
}

bool enlargeReceiveBuffer(const CommunicationsContext& context) {
    const ReceiveBufferAnswer answer = context.socket.SetReceiveBuffer(kReceiveBufferBytes);
    if (answer.systemError != 0) {
        // The option's name is the text that users and support notes know.
        context.host.messageBox(boxTitle("-Port Error"),
                                "Error setting SO_BROADCAST option: " + std::to_string(answer.systemError),
                                BoxIcon::Critical);
        return false;
    }
    if (context.log) {
        context.log("Receive buffer: " + std::to_string(kReceiveBufferBytes) + " bytes asked for, " +
                    std::to_string(answer.grantedBytes) + " granted");
    }
    return true;
}

}  // namespace

bool ZephSetUpCommunications(const CommunicationsContext& context, Connection& connection, ZephAdapters& adapters,
                             std::string& ipOut, std::string& portOut) try {
    ipOut = ZephLoadAdaptersAndReturnIP(connection.ZephAdapterName, context.lister, context.host, adapters);
    if (ipOut.empty() || ipOut == "0.0.0.0") {
        context.host.messageBox(boxTitle("-Port Error"),
                                "(SetUpCommunications:  No IP)\r\n"
                                "There is a problem with your selected network adapter.",
                                BoxIcon::Critical);
        return false;
    }
    if (!connection.ZephPortOpen) {
        openSocket(connection, ipOut, context.socket, context.host);
        connection.ZephPortOpen = true;
    }
    portOut = std::to_string(context.socket.LocalPort());
    return enlargeReceiveBuffer(context);
}
ZEPH_GUARD(context.failures, kModule, false)

std::string simulationActiveText(bool useTCP, std::string_view ip, std::string_view port) {
    std::string text(useTCP ? "TCP" : "UDP");
    text.append(" Simulation active on ").append(ip).append(" (").append(port).append(")");
    return text;
}

void Winsock1_ConnectionRequest(std::int64_t requestID, SimulationSocket& socket, Host& host,
                                FailureReport& failures) try {
    socket.Accept(requestID);
    host.setStatusPanel(2, "Data connection established");
}
ZEPH_GUARD(failures, kModule, )

QueueGaugeUpdate Winsock1_DataArrival(bool simulating, bool openGlOutput, SimulationSocket& socket,
                                      FailureReport& failures, ReceiveState& receive) try {
    StreamBuffer& buffer = receive.Stream.ZephStackBuffer;
    const QueueGaugeUpdate update = ZephUpdateQueueGauge(buffer.size(), openGlOutput, receive.Gauge);
    ZephGetDataFromStack(socket, failures, receive);
    if (!simulating) buffer.clear();
    return update;
}
ZEPH_GUARD(failures, kModule, QueueGaugeUpdate{})

void ZephGetDataFromStack(SimulationSocket& socket, FailureReport& failures, ReceiveState& receive) try {
    ++receive.Stream.ZephReceptionCount;
    while (socket.GetData(receive.Piece) && !receive.Piece.empty())
        receive.Stream.ZephStackBuffer.append(receive.Piece);
}
ZEPH_GUARD(failures, kModule, )
