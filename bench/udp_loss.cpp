// Whether the data socket loses datagrams of a fast stream while the main thread draws: a sender process paces
// datagrams of 1,400 bytes over the loopback, this one receives them through the program's own socket and parser and
// keeps its main thread busy for a few milliseconds of every tick.
//   udp_loss [datagrams a second] [seconds] [busy ms a tick] [receive buffer, bytes; 0 = the system's default]
#include "link/communications.h"
#include "link/frame_writer.h"
#include "link/qt_simulation_socket.h"

#include <QCoreApplication>
#include <QProcess>
#include <QTimer>

#include <arpa/inet.h>
#include <chrono>
#include <cstdio>
#include <cstdlib>
#include <string_view>
#include <sys/socket.h>
#include <thread>
#include <unistd.h>

namespace {

using SteadyClock = std::chrono::steady_clock;

struct Options {
    int perSecond = 50'000;
    int seconds = 10;
    int busyMs = 5;
    int receiveBufferBytes = kReceiveBufferBytes;
};

constexpr int kCommandsInFrame = 48;  // 48 x 29 + 9 = 1,401 bytes

std::string frameOf(std::int32_t number) {
    FrameWriter writer;
    for (int i = 0; i < kCommandsInFrame; ++i)
        writer.command({.Network = number % 16, .DeviceType = 1, .Unit = 1 + i, .Circuit = 1 + number / 16 % 900}, {});
    return writer.takeFrame();
}

// The sender process: paces by the clock, in bursts of what fell due. Returns the datagrams that it could not send.
int send(const Options& options, std::uint16_t port) {
    const int handle = ::socket(AF_INET, SOCK_DGRAM, 0);
    sockaddr_in to{};
    to.sin_family = AF_INET;
    to.sin_port = htons(port);
    to.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    if (handle < 0 || ::connect(handle, reinterpret_cast<const sockaddr*>(&to), sizeof to) != 0) return 1;
    std::vector<std::string> frames;
    for (std::int32_t number = 0; number < 1000; ++number)
        frames.push_back(frameOf(number));
    const std::int64_t total = std::int64_t{options.perSecond} * options.seconds;
    const SteadyClock::time_point start = SteadyClock::now();
    int failed = 0;
    for (std::int64_t sent = 0; sent < total;) {
        const std::chrono::duration<double> elapsed = SteadyClock::now() - start;
        const auto due = static_cast<std::int64_t>(elapsed.count() * options.perSecond);
        for (; sent < std::min(due, total); ++sent) {
            const std::string& frame = frames[static_cast<std::size_t>(sent % 1000)];
            if (::send(handle, frame.data(), frame.size(), 0) < 0) ++failed;
        }
        std::this_thread::sleep_for(std::chrono::microseconds(100));
    }
    const std::chrono::duration<double> took = SteadyClock::now() - start;
    std::printf("sent %lld datagrams in %.2f s (%.0f a second), %d refused by the system\n",
                static_cast<long long>(total), took.count(), static_cast<double>(total) / took.count(), failed);
    ::close(handle);
    return 0;
}

struct CountingSink : CommandSink {
    void addLightCommands(std::span<const ZephChannelCommand> commands) override { count += commands.size(); }
    std::int32_t virtualChannelKey(std::string_view) const override { return 0; }

    std::size_t count = 0;
};

struct PrintedFailures : FailureReport {
    void ErrReport(std::string_view description, std::string_view, int) override {
        std::fprintf(stderr, "%.*s\n", static_cast<int>(description.size()), description.data());
    }
};

int receive(const Options& options, const QStringList& arguments) {
    QtSimulationSocket socket;
    PrintedFailures failures;
    ReceiveState state;
    CountingSink sink;
    ParserSetup setup;
    ZephSetUpPacketParms(setup.PacketParms);
    socket.dataArrival = [&] { Winsock1_DataArrival(true, false, socket, failures, state); };
    socket.Bind(0, "127.0.0.1");
    int granted = 212'992;  // a common default, named where none was asked for
    if (options.receiveBufferBytes > 0) granted = socket.SetReceiveBuffer(options.receiveBufferBytes).grantedBytes;

    QTimer tick;
    std::size_t most = 0;
    QObject::connect(&tick, &QTimer::timeout, [&] {
        most = std::max(most, state.Stream.ZephStackBuffer.size());
        ZephProcessPayloads(true, setup, sink, failures, state.Stream);
        const SteadyClock::time_point until = SteadyClock::now() + std::chrono::milliseconds(options.busyMs);
        while (SteadyClock::now() < until) {
        }
    });
    tick.setTimerType(Qt::PreciseTimer);
    tick.start(9);

    QProcess sender;
    sender.setProcessChannelMode(QProcess::ForwardedChannels);
    QObject::connect(&sender, &QProcess::finished,
                     [] { QTimer::singleShot(500, QCoreApplication::instance(), &QCoreApplication::quit); });
    QStringList senderArguments{"--send", QString::number(socket.LocalPort())};
    senderArguments += arguments;
    sender.start(QCoreApplication::applicationFilePath(), senderArguments);
    QCoreApplication::exec();

    const std::int64_t sent = std::int64_t{options.perSecond} * options.seconds;
    const auto received = static_cast<std::int64_t>(sink.count / kCommandsInFrame);
    std::printf(
        "received %lld, lost %lld; receive buffer %d bytes, main thread busy %d ms of every 9, at most %zu bytes "
        "waited for the parser\n",
        static_cast<long long>(received), static_cast<long long>(sent - received), granted, options.busyMs, most);
    return received == sent ? 0 : 1;
}

}  // namespace

int main(int count, char** arguments) {
    QCoreApplication application(count, arguments);
    QStringList numbers = QCoreApplication::arguments().mid(1);
    const bool sending = !numbers.isEmpty() && numbers.first() == "--send";
    const std::uint16_t port = sending && numbers.size() > 1 ? static_cast<std::uint16_t>(numbers[1].toInt()) : 0;
    if (sending) numbers = numbers.mid(2);
    Options options;
    int* const fields[] = {&options.perSecond, &options.seconds, &options.busyMs, &options.receiveBufferBytes};
    for (qsizetype i = 0; i < std::min<qsizetype>(numbers.size(), 4); ++i)
        *fields[i] = numbers[i].toInt();
    return sending ? send(options, port) : receive(options, numbers);
}
