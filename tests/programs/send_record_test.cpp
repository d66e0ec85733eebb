// Playing and recording captures, with real sockets over the loopback.
#include "link/capture_file.h"
#include "link/sequencer_message.h"
#include "programs/tool/record_command.h"
#include "programs/tool/send_command.h"
#include "util/settings_store.h"

#include <QCoreApplication>
#include <QElapsedTimer>
#include <QTcpServer>
#include <QTemporaryDir>
#include <QUdpSocket>

#include <gtest/gtest.h>

#include <atomic>
#include <csignal>
#include <fstream>
#include <pthread.h>
#include <sstream>
#include <thread>

namespace {

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

struct SendRecord : testing::TestWithParam<bool> {
    std::string path(const char* name) const { return folder.filePath(name).toStdString(); }

    // A capture of 20 pieces, 10 ms apart.
    void writeCapture() {
        CaptureWriter writer(path("sent.zcap"));
        for (std::int32_t i = 0; i < 20; ++i)
            writer.piece(i * 10, "\x01" + std::to_string(100 + i) + "\\\xFF\x04");
    }
    ToolOptions options() const {
        ToolOptions made;
        made.file = path("sent.zcap");
        made.out = path("heard.zcap");
        made.port = port;
        made.tcp = GetParam();
        return made;
    }
    // Starts a recording and waits until its file stands, which it does once the port is open.
    void startRecording(const ToolOptions& made) {
        recorder = std::thread([this, made] { recorded = runRecord(made); });
        while (!std::ifstream(made.out).is_open() && recorded < 0)
            std::this_thread::sleep_for(std::chrono::milliseconds(2));
    }
    // Stops it as a user would, once the file has the bytes or five seconds are over.
    void stopRecordingAfter(std::size_t bytes) {
        QElapsedTimer clock;
        clock.start();
        while (bytesOf("heard.zcap").size() < bytes && clock.elapsed() < 5000)
            std::this_thread::sleep_for(std::chrono::milliseconds(5));
        pthread_kill(recorder.native_handle(), SIGTERM);
        recorder.join();
    }
    std::string bytesOf(const char* name) const {
        std::string bytes;
        for (const CapturePiece& piece : loadCapture(path(name)).pieces)
            bytes += piece.bytes;
        return bytes;
    }

    int count = 0;
    QCoreApplication application{count, nullptr};
    QTemporaryDir folder;
    std::int32_t port = freePort(GetParam());
    std::thread recorder;
    std::atomic<int> recorded = -1;
};

}  // namespace

TEST_P(SendRecord, WhatIsSentIsRecordedInItsTimeUntilTheUserStops) {
    writeCapture();
    startRecording(options());
    QElapsedTimer clock;
    clock.start();
    EXPECT_EQ(runSend(options()), 0);
    EXPECT_GE(clock.elapsed(), 190);
    stopRecordingAfter(bytesOf("sent.zcap").size());
    EXPECT_EQ(recorded, 0);
    EXPECT_EQ(bytesOf("heard.zcap"), bytesOf("sent.zcap"));
    const Capture heard = loadCapture(path("heard.zcap"));
    EXPECT_GE(heard.pieces.back().timeMs - heard.pieces.front().timeMs, 150);
    if (!GetParam()) {
        EXPECT_EQ(heard.pieces.size(), 20u);  // a datagram stays a piece
    }
}

TEST_P(SendRecord, ATakenPortFailsAndLeavesTheFileAlone) {
    std::ofstream(path("heard.zcap")) << "kept";
    QUdpSocket udp;
    QTcpServer tcp;
    ToolOptions taken = options();
    if (GetParam()) {
        ASSERT_TRUE(tcp.listen(QHostAddress::AnyIPv4));
        taken.port = tcp.serverPort();
    } else {
        ASSERT_TRUE(udp.bind(QHostAddress::LocalHost, 0, QAbstractSocket::DontShareAddress));
        taken.port = udp.localPort();
    }
    testing::internal::CaptureStderr();
    EXPECT_EQ(runRecord(taken), 1);
    EXPECT_NE(testing::internal::GetCapturedStderr().find("already in use by another program"), std::string::npos);
    std::stringstream content;
    content << std::ifstream(path("heard.zcap")).rdbuf();
    EXPECT_EQ(content.str(), "kept");
}

INSTANTIATE_TEST_SUITE_P(Protocols, SendRecord, testing::Values(false, true),
                         [](const auto& protocol) { return std::string(protocol.param ? "Tcp" : "Udp"); });

TEST(Send, LoopsAtItsSpeedUntilTheUserStops) {
    int count = 0;
    const QCoreApplication application(count, nullptr);
    const QTemporaryDir folder;
    ToolOptions options;
    options.file = folder.filePath("loop.zcap").toStdString();
    {
        CaptureWriter writer(options.file);
        writer.piece(0, "a");
        writer.piece(10'000, "b");
    }
    QUdpSocket receiver;
    ASSERT_TRUE(receiver.bind(QHostAddress::LocalHost, 0));
    options.port = receiver.localPort();
    options.loop = true;
    options.speed = 1000;
    std::atomic<int> status = -1;
    std::thread sender([&] { status = runSend(options); });
    int datagrams = 0;
    while (datagrams < 6 && receiver.waitForReadyRead(5000)) {
        char byte = 0;
        while (receiver.hasPendingDatagrams()) {
            EXPECT_EQ(receiver.readDatagram(&byte, 1), 1);
            ++datagrams;
        }
    }
    EXPECT_GE(datagrams, 6);
    pthread_kill(sender.native_handle(), SIGINT);
    sender.join();
    EXPECT_EQ(status, 0);
}

TEST(Send, AnUnusableCaptureOrReceiverIsAMessage) {
    int count = 0;
    const QCoreApplication application(count, nullptr);
    const QTemporaryDir folder;
    ToolOptions options;
    options.file = folder.filePath("missing.zcap").toStdString();
    testing::internal::CaptureStderr();
    EXPECT_EQ(runSend(options), 1);
    EXPECT_NE(testing::internal::GetCapturedStderr().find("missing.zcap cannot be read"), std::string::npos);
    CaptureWriter(options.file).piece(0, std::string(70'000, 'x'));
    options.port = freePort(true);
    for (const bool tcp : {false, true}) {  // too long for a datagram; nobody listens
        options.tcp = tcp;
        testing::internal::CaptureStderr();
        EXPECT_EQ(runSend(options), 1) << tcp;
        EXPECT_NE(testing::internal::GetCapturedStderr(), "");
    }
}

TEST(Send, OnRequestPlaysAndStopsAsTheButtonsAsk) {
    QTemporaryDir folder;
    qputenv("ZEPH_DATA", folder.path().toLocal8Bit());
    const std::string file = folder.filePath("show.zcap").toStdString();
    {
        CaptureWriter writer(file);
        for (std::int32_t i = 0; i < 500; ++i)
            writer.piece(i * 10, "piece");
    }
    QUdpSocket ear;
    ASSERT_TRUE(ear.bind(QHostAddress::LocalHost, 0));
    ToolOptions made;
    made.file = file;
    made.port = ear.localPort();
    made.onRequest = true;
    std::atomic<pthread_t> thread{};
    std::atomic<bool> running = false;
    std::thread player([&] {
        thread = pthread_self();
        running = true;
        EXPECT_EQ(runSend(made), 0);
    });
    const auto seqPid = [] {
        const FileSettingsStore store(FileSettingsStore::userFile());
        return store.value(kSharedIpcKey, "SeqPid").value_or("0");
    };
    const auto heard = [&](int patienceMs) {
        int count = 0;
        while (ear.waitForReadyRead(patienceMs)) {
            while (ear.hasPendingDatagrams())
                ear.readDatagram(nullptr, 0), ++count;
            if (count >= 10) break;
        }
        return count;
    };
    while (!running || seqPid() == "0")
        std::this_thread::sleep_for(std::chrono::milliseconds(5));
    const auto pid = static_cast<std::int32_t>(QCoreApplication::applicationPid());
    EXPECT_EQ(seqPid(), std::to_string(pid));
    EXPECT_EQ(heard(100), 0) << "waits to be asked";
    EXPECT_TRUE(sendToSequencer(pid, SequencerCommand::Start));
    EXPECT_GE(heard(2000), 10);
    EXPECT_TRUE(sendToSequencer(pid, SequencerCommand::Stop));
    std::this_thread::sleep_for(std::chrono::milliseconds(100));
    while (ear.hasPendingDatagrams())
        ear.readDatagram(nullptr, 0);
    EXPECT_EQ(heard(100), 0);
    pthread_kill(thread, SIGTERM);
    player.join();
    EXPECT_EQ(seqPid(), "0") << "no longer registered";
    qunsetenv("ZEPH_DATA");
}
