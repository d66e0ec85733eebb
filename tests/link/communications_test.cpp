#include "link/communications.h"
#include "tests/support/list_socket.h"
#include "tests/support/recording_host.h"

namespace {

struct Communications : testing::Test {
    bool setUp() { return ZephSetUpCommunications(context, connection, adapters, ip, port); }

    ListSocket socket;
    RecordingHost host;
    CollectingFailures failures;
    std::vector<ZephAdapter> machine{{"eth0", "192.168.1.20"}, {"wlan0", "0.0.0.0"}};
    std::vector<std::string> log;
    CommunicationsContext context{socket, [this] { return machine; }, host, failures,
                                  [this](std::string_view line) { log.emplace_back(line); }};
    Connection connection;
    ZephAdapters adapters;
    std::string ip;
    std::string port;
};

using Strings = std::vector<std::string>;

}  // namespace

TEST_F(Communications, BindOrListenOnceAndTuneTheBufferOnEachCall) {
    connection.ZephAdapterName = "eth0";
    EXPECT_TRUE(setUp());
    connection.ZephSimulationPort = 5;  // takes effect with the next start of the program
    EXPECT_TRUE(setUp());
    EXPECT_EQ(simulationActiveText(false, ip, port), "UDP Simulation active on 192.168.1.20 (30303)");
    EXPECT_EQ(socket.calls, (Strings{"bind 192.168.1.20 30303", "buffer 2097152", "buffer 2097152"}));
    EXPECT_EQ(log, Strings(2, "Receive buffer: 2097152 bytes asked for, 212992 granted"));

    // An unknown adapter falls back to Local, and TCP listens on all addresses.
    socket = {};
    connection = {};
    connection.ZephAdapterName = "eth7";
    connection.ZephUseTCP = true;
    EXPECT_TRUE(setUp());
    EXPECT_EQ(simulationActiveText(true, ip, port), "TCP Simulation active on 127.0.0.1 (30303)");
    EXPECT_EQ(socket.calls.front(), "listen 30303");
}

TEST_F(Communications, EachFailureIsToldAndTriedAgainNextTime) {
    using Row = std::tuple<std::function<void()>, const char*, bool, std::size_t>;  // spoils, box, port open, reports
    for (const auto& [spoil, box, open, reports] : {
             Row{[&] { connection.ZephAdapterName = "wlan0"; },
                 "(SetUpCommunications:  No IP)\r\nThere is a problem with your selected network adapter.", false, 0},
             Row{[&] { socket.taken = true; }, "Port 30303 is already in use", false, 1},
             Row{[&] { socket.openFailure = "The address is protected"; },
                 "Port 30303 cannot be opened: The address is protected", false, 1},
             Row{[&] { socket.bufferAnswer.systemError = 22; }, "Error setting SO_BROADCAST option: 22", true, 0},
         }) {
        SCOPED_TRACE(box);
        socket = {};
        connection = {};
        host.boxes.clear();
        failures.reports.clear();
        spoil();
        EXPECT_FALSE(setUp());
        EXPECT_EQ(connection.ZephPortOpen, open);
        EXPECT_THAT(host.boxTexts(), testing::StartsWith(std::string("Qen Visualizer-Port Error|") + box));
        EXPECT_EQ(host.boxes.at(0).icon, BoxIcon::Critical);
        EXPECT_EQ(failures.reports.size(), reports);
        for (const CollectingFailures::Report& report : failures.reports)
            EXPECT_EQ(report.procedure, "Zeph.modZephCommunications.ZephSetUpCommunications");
        socket = {};
        connection.ZephAdapterName = "eth0";
        EXPECT_TRUE(setUp());
    }
}

TEST_F(Communications, ArrivalMovesEverythingAndGaugesTheLengthFromBefore) {
    ReceiveState receive;
    socket.reads = {"ab", "c"};
    socket.failsWhenEmpty = true;
    EXPECT_EQ(Winsock1_DataArrival(true, false, socket, failures, receive).value, 0);
    EXPECT_EQ(receive.Stream.ZephStackBuffer.view(), "abc");
    socket.reads = {"d"};
    EXPECT_EQ(Winsock1_DataArrival(true, false, socket, failures, receive).value, 3);
    EXPECT_EQ(receive.Stream.ZephReceptionCount, 2u);
    socket.reads = {"e"};
    EXPECT_EQ(Winsock1_DataArrival(false, false, socket, failures, receive).value, 4);
    EXPECT_TRUE(receive.Stream.ZephStackBuffer.empty());
    EXPECT_TRUE(failures.reports.empty());
}

TEST(Adapters, FillTheSlotsInOrderAndTheFirstEqualNameWins) {
    RecordingHost host;
    ZephAdapters adapters;
    std::vector<ZephAdapter> machine{{"eth0", "10.0.0.1"}, {"eth0", "10.0.0.2"}, {"Eth0", "10.0.0.3"}};
    const AdapterLister lister = [&] { return machine; };
    EXPECT_EQ(ZephLoadAdaptersAndReturnIP("eth0", lister, host, adapters), "10.0.0.1");
    EXPECT_EQ(ZephLoadAdaptersAndReturnIP("Eth0", lister, host, adapters), "10.0.0.3");
    EXPECT_EQ(adapters[1], (ZephAdapter{"Local", "127.0.0.1"}));
    EXPECT_EQ(adapters[4], (ZephAdapter{"Eth0", "10.0.0.3"}));
    machine.clear();
    EXPECT_EQ(ZephLoadAdaptersAndReturnIP("Eth0", lister, host, adapters), "127.0.0.1");
    EXPECT_EQ(adapters[2], ZephAdapter{});  // rebuilt, not added to

    machine.resize(31);
    machine.back() = {"last", "10.0.0.31"};
    EXPECT_EQ(ZephLoadAdaptersAndReturnIP("last", lister, host, adapters), "10.0.0.31");
    EXPECT_EQ(host.boxTexts(), "");
    machine.resize(32);
    EXPECT_EQ(ZephLoadAdaptersAndReturnIP("last", lister, host, adapters), "10.0.0.31");
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Error|Your system has more than 32 network adapters.  "
                               "Only the first 32 will be used.");
}

TEST(Adapters, TheStartUpCheckChoosesAndWarns) {
    const auto lister = [] {
        return std::vector<ZephAdapter>{{"eth0", "10.0.0.1"}, {"wlan0", "0.0.0.0"}, {"odd", ""}};
    };
    using Row = std::array<const char*, 4>;  // stored, name, address, how the box begins ("" = no box)
    for (const auto& [stored, name, ip, boxBegins] : {
             Row{"", "Local", "127.0.0.1", ""},
             Row{"eth0", "eth0", "10.0.0.1", ""},
             Row{"gone", "gone", "127.0.0.1", ""},
             Row{"wlan0", "wlan0", "0.0.0.0", "Your network adapter is present, however"},
             Row{"odd", "Local", "127.0.0.1",
                 "The previously assigned network adapter no longer exists on this system.\r\n"},
         }) {
        RecordingHost host;
        ZephAdapters adapters;
        const AdapterChoice choice = ZephCheckAdapterAtStartup(stored, lister, host, adapters);
        EXPECT_EQ(choice.ZephAdapterName, name);
        EXPECT_EQ(choice.ZephAdapterIP, ip);
        ASSERT_EQ(host.boxes.size(), *boxBegins ? 1u : 0u) << stored;
        if (host.boxes.empty()) continue;
        EXPECT_THAT(host.boxes[0].text, testing::StartsWith(boxBegins));
        EXPECT_EQ(host.boxes[0].icon, BoxIcon::Warning);
    }
}
