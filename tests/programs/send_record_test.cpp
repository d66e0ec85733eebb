// Playing and recording captures, with real sockets over the loopback.
#include "link/capture_file.h"
#include "link/sequencer_message.h"
#include "programs/tool/record_command.h"
#include "programs/tool/send_command.h"
#include "tests/support/folder.h"
#include "util/settings_store.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTcpServer>
#include <QUdpSocket>

#include <atomic>
#include <csignal>
#include <pthread.h>
#include <thread>

namespace {

using namespace std::chrono_literals;

// A port that was free a moment ago.
std::int32_t freePort(bool tcp) {
    if (tcp) {
        QTcpServer server;
        server.listen(QHostAddress::AnyIPv4);
        return server.serverPort();
    }
    QUdpSocket socket;
    socket.bind(QHostAddress::LocalHost, 0);
    return socket.localPort();
}

// A command of the tool on a thread of its own, stopped as a user would stop it.
class Running {
public:
    explicit Running(std::function<int()> command) : thread_([this, command] { status_ = command(); }) {}
    ~Running() {
        if (thread_.joinable()) stop(SIGTERM);
    }
    int stop(int signal) {
        pthread_kill(thread_.native_handle(), signal);
        thread_.join();
        return status_;
    }

private:
    std::atomic<int> status_ = -1;
    std::thread thread_;
};

// Waits until the condition holds; false after five seconds.
bool eventually(const std::function<bool()>& condition) {
    QElapsedTimer clock;
    clock.start();
    while (!condition() && clock.elapsed() < 5000)
        std::this_thread::sleep_for(2ms);
    return condition();
}

struct Sending : testing::Test {
    // So many pieces, some ms apart.
    void writeCapture(const char* name, std::int32_t pieces, std::int32_t stepMs) {
        CaptureWriter writer(folder.path(name));
        for (std::int32_t i = 0; i < pieces; ++i)
            writer.piece(i * stepMs, "\x01" + std::to_string(100 + i) + "\\\xFF\x04");
    }
    // What a command that fails wrote to standard error.
    static std::string messageOf(int (*command)(const ToolOptions&), const ToolOptions& options) {
        testing::internal::CaptureStderr();
        EXPECT_EQ(command(options), 1);
        return testing::internal::GetCapturedStderr();
    }
    // To send a capture to an ear.
    ToolOptions sending(const char* name, QUdpSocket& ear) const {
        EXPECT_TRUE(ear.bind(QHostAddress::LocalHost, 0));
        ToolOptions made;
        made.file = folder.path(name);
        made.port = ear.localPort();
        return made;
    }
    // Datagrams that arrive, up to ten, until none comes for so long.
    static int heard(QUdpSocket& ear, int patienceMs) {
        int datagrams = 0;
        while (datagrams < 10 && ear.waitForReadyRead(patienceMs)) {
            for (; ear.hasPendingDatagrams(); ++datagrams)
                ear.readDatagram(nullptr, 0);
        }
        return datagrams;
    }

    int count = 0;
    QCoreApplication application{count, nullptr};
    Folder folder;
};

struct SendRecord : Sending, testing::WithParamInterface<bool> {
    ToolOptions options() const {
        ToolOptions made;
        made.file = folder.path("sent.zcap");
        made.out = folder.path("heard.zcap");
        made.port = port;
        made.tcp = GetParam();
        return made;
    }
    std::string bytesOf(const char* name) const {
        std::string bytes;
        for (const CapturePiece& piece : loadCapture(folder.path(name)).pieces)
            bytes += piece.bytes;
        return bytes;
    }
    std::int32_t port = freePort(GetParam());
};

}  // namespace

TEST_P(SendRecord, WhatIsSentIsRecordedInItsTimeUntilTheUserStops) {
    writeCapture("sent.zcap", 20, 10);
    Running recorder([made = options()] { return runRecord(made); });
    // Its file stands once the port is open.
    ASSERT_TRUE(eventually([&] { return QFile::exists(folder.qPath("heard.zcap")); }));
    QElapsedTimer clock;
    clock.start();
    EXPECT_EQ(runSend(options()), 0);
    EXPECT_GE(clock.elapsed(), 190);
    eventually([&] { return bytesOf("heard.zcap").size() >= bytesOf("sent.zcap").size(); });
    EXPECT_EQ(recorder.stop(SIGTERM), 0);
    EXPECT_EQ(bytesOf("heard.zcap"), bytesOf("sent.zcap"));
    const Capture heard = loadCapture(folder.path("heard.zcap"));
    EXPECT_GE(heard.pieces.back().timeMs - heard.pieces.front().timeMs, 150);
    EXPECT_TRUE(GetParam() || heard.pieces.size() == 20u) << "a datagram stays a piece";
}

TEST_P(SendRecord, ATakenPortFailsAndLeavesTheFileAlone) {
    folder.write("heard.zcap", "kept");
    QUdpSocket udp;
    QTcpServer tcp;
    ASSERT_TRUE(tcp.listen(QHostAddress::AnyIPv4));
    ASSERT_TRUE(udp.bind(QHostAddress::LocalHost, 0, QAbstractSocket::DontShareAddress));
    port = GetParam() ? tcp.serverPort() : udp.localPort();
    EXPECT_THAT(messageOf(runRecord, options()), testing::HasSubstr("already in use by another program"));
    EXPECT_EQ(folder.read("heard.zcap"), "kept");
}

INSTANTIATE_TEST_SUITE_P(Protocols, SendRecord, testing::Values(false, true),
                         [](const auto& protocol) { return std::string(protocol.param ? "Tcp" : "Udp"); });

TEST_F(Sending, LoopsAtItsSpeedUntilTheUserStops) {
    writeCapture("loop.zcap", 2, 10'000);
    QUdpSocket ear;
    ToolOptions options = sending("loop.zcap", ear);
    options.loop = true;
    options.speed = 1000;
    Running sender([options] { return runSend(options); });
    EXPECT_GE(heard(ear, 5000), 10);
    EXPECT_EQ(sender.stop(SIGINT), 0);
}

TEST_F(Sending, AnUnusableCaptureOrReceiverIsAMessage) {
    ToolOptions options;
    options.file = folder.path("missing.zcap");
    EXPECT_THAT(messageOf(runSend, options), testing::HasSubstr("missing.zcap cannot be read"));
    CaptureWriter(options.file).piece(0, std::string(70'000, 'x'));
    options.port = freePort(true);
    for (const bool tcp : {false, true}) {  // too long for a datagram; nobody listens
        options.tcp = tcp;
        EXPECT_NE(messageOf(runSend, options), "");
    }
}

TEST_F(Sending, OnRequestPlaysAndStopsAsTheButtonsAsk) {
    qputenv("ZEPH_DATA", folder.qPath().toLocal8Bit());
    writeCapture("show.zcap", 500, 10);
    QUdpSocket ear;
    ToolOptions options = sending("show.zcap", ear);
    options.onRequest = true;
    const auto pid = static_cast<std::int32_t>(QCoreApplication::applicationPid());
    const auto registered = [] {
        const FileSettingsStore store(FileSettingsStore::userFile());
        return store.value(kSharedIpcKey, "SeqPid").value_or("0");
    };
    Running player([options] { return runSend(options); });
    ASSERT_TRUE(eventually([&] { return registered() == std::to_string(pid); }));
    EXPECT_EQ(heard(ear, 100), 0) << "waits to be asked";
    EXPECT_TRUE(sendToSequencer(pid, SequencerCommand::Start));
    EXPECT_GE(heard(ear, 2000), 10);
    EXPECT_TRUE(sendToSequencer(pid, SequencerCommand::Stop));
    std::this_thread::sleep_for(100ms);
    while (ear.hasPendingDatagrams())
        ear.readDatagram(nullptr, 0);
    EXPECT_EQ(heard(ear, 100), 0);
    EXPECT_EQ(player.stop(SIGTERM), 0);
    EXPECT_EQ(registered(), "0");
    Running second([options] { return runSend(options); });
    ASSERT_TRUE(eventually([&] { return registered() == std::to_string(pid); }));
    FileSettingsStore(FileSettingsStore::userFile()).setValue(kSharedIpcKey, "SeqPid", "1");
    EXPECT_EQ(second.stop(SIGTERM), 0);
    EXPECT_EQ(registered(), "1") << "who registered since keeps the place";
    qunsetenv("ZEPH_DATA");
}
