// The data socket with real sockets over the loopback.
#include "link/communications.h"
#include "link/frame_writer.h"
#include "link/qt_simulation_socket.h"
#include "tests/support/recording_host.h"
#include "tests/support/recording_sink.h"

#include <QCoreApplication>
#include <QDeadlineTimer>
#include <QTcpSocket>
#include <QThread>
#include <QUdpSocket>

#include <thread>

namespace {

class RealSocket : public testing::Test {
protected:
    RealSocket() {
        socket.dataArrival = [this] { Winsock1_DataArrival(true, false, socket, failures, receive); };
        socket.connectionRequest = [this](std::int64_t requestID) {
            Winsock1_ConnectionRequest(requestID, socket, host, failures);
        };
    }

    // Lets events run until the condition holds; false after five seconds.
    template <typename Condition>
    bool eventually(Condition condition) {
        const QDeadlineTimer deadline(5000);
        while (!condition() && !deadline.hasExpired()) {
            QCoreApplication::processEvents(QEventLoop::AllEvents, 10);
            QThread::msleep(1);
        }
        return condition();
    }
    std::string_view buffered() { return receive.Stream.ZephStackBuffer.view(); }
    quint16 port() { return static_cast<quint16>(socket.LocalPort()); }

    std::unique_ptr<QTcpSocket> connectClient() {
        auto client = std::make_unique<QTcpSocket>();
        client->connectToHost(QHostAddress::LocalHost, port());
        EXPECT_TRUE(client->waitForConnected(5000));
        return client;
    }
    static void send(QTcpSocket& client, const char* text) {
        client.write(text);
        client.waitForBytesWritten(5000);
    }

    int count_ = 0;
    QCoreApplication application{count_, nullptr};
    QtSimulationSocket socket;
    RecordingHost host;
    CollectingFailures failures;
    ReceiveState receive;
};

}  // namespace

TEST_F(RealSocket, TwoThousandDatagramsSurviveABusyMainThread) {
    constexpr int datagrams = 2000;
    socket.Bind(0, "127.0.0.1");
    EXPECT_GT(socket.SetReceiveBuffer(kReceiveBufferBytes).grantedBytes, 0);
    std::thread sender([port = port()] {
        QUdpSocket out;
        for (int i = 0; i < datagrams; ++i) {
            FrameWriter writer;
            for (int n = 0; n < 48; ++n)
                writer.command({.Network = 1, .DeviceType = 1, .Unit = i / 900, .Circuit = 1 + i % 900}, {});
            const std::string frame = writer.takeFrame();
            out.writeDatagram(frame.data(), static_cast<qint64>(frame.size()), QHostAddress::LocalHost, port);
            if (i % 20 == 19) QThread::msleep(1);
        }
    });
    ParserSetup setup;
    ZephSetUpPacketParms(setup.PacketParms);
    RecordingSink sink;
    const bool all = eventually([&] {
        QThread::msleep(15);  // a frame is drawn
        ZephProcessPayloads(true, setup, sink, failures, receive.Stream);
        return sink.commands.size() >= datagrams * 48;
    });
    sender.join();
    EXPECT_TRUE(all) << sink.commands.size();
    ASSERT_EQ(sink.commands.size(), std::size_t{datagrams} * 48);
    for (int i = 0; i < datagrams; ++i) {
        const ZephLightCommand& command = sink.commands[static_cast<std::size_t>(i) * 48].Command;
        ASSERT_EQ(command.Unit * 900 + command.Circuit, i + 1);
    }
}

TEST_F(RealSocket, ATakenPortIsNamedAsSuch) {
    QtSimulationSocket second;
    socket.Bind(0, "127.0.0.1");
    EXPECT_THROW(second.Bind(socket.LocalPort(), "127.0.0.1"), PortTaken);
    EXPECT_EQ(second.State(), 0);
    QtSimulationSocket listener;
    listener.Listen(0);
    EXPECT_THROW(second.Listen(listener.LocalPort()), PortTaken);
    EXPECT_THROW(second.Bind(0, "192.0.2.1"), Failure);  // no address of this machine
    second.Bind(0, "127.0.0.1");                         // a failure does not spoil the socket
    EXPECT_NE(second.State(), 0);
}

TEST_F(RealSocket, WhatArrivedBeforeClosingCanStillBeDrained) {
    socket.dataArrival = nullptr;
    socket.Bind(0, "127.0.0.1");
    QUdpSocket out;
    out.writeDatagram("last words", 10, QHostAddress::LocalHost, port());
    socket.Close();
    EXPECT_EQ(socket.State(), 0);
    ZephGetDataFromStack(socket, failures, receive);
    EXPECT_EQ(buffered(), "last words");
}

TEST_F(RealSocket, TheNewestTcpClientWins) {
    socket.Listen(0);
    const quint16 listening = port();
    EXPECT_EQ(socket.SetReceiveBuffer(kReceiveBufferBytes).systemError, 0);
    const auto first = connectClient();
    send(*first, "one ");
    EXPECT_TRUE(eventually([&] { return buffered() == "one "; }));
    EXPECT_EQ(host.panels[2], "Data connection established");
    EXPECT_EQ(socket.SetReceiveBuffer(kReceiveBufferBytes).systemError, 0);

    auto second = connectClient();
    send(*second, "two ");
    EXPECT_TRUE(eventually([&] { return buffered() == "one two "; }));
    EXPECT_TRUE(eventually([&] { return first->state() == QAbstractSocket::UnconnectedState; }));

    // Once it has gone, none is accepted.
    send(*second, "last");
    second.reset();
    EXPECT_TRUE(eventually([&] { return buffered() == "one two last"; }));
    EXPECT_TRUE(eventually([&] {
        QTcpSocket next;
        next.connectToHost(QHostAddress::LocalHost, listening);
        return !next.waitForConnected(500);
    }));
    // Entering simulation again is no failure: the socket counts as open until the program ends.
    EXPECT_NE(socket.State(), 0);
    EXPECT_EQ(socket.SetReceiveBuffer(kReceiveBufferBytes).systemError, 0);
}
