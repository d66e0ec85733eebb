#include "shell/settings_registry.h"
#include "shell/tool_bands.h"
#include "tests/shell/settings_rig.h"
#include "tests/shell/stored_names.h"
#include "util/random_source.h"

#include <set>

namespace {

// What a value reads as, told by writing it back.
std::string readAs(const std::string& name, const std::string& text) {
    SettingsRig rig;
    rig.store.set(name, text);
    EXPECT_TRUE(rig.read()) << name;
    rig.write();
    return rig.store.get(name);
}

bool keepsOutside(std::string_view name) {
    return name == "Width" || name == "Height";
}

}  // namespace

TEST(SettingsRegistry, AFirstRunStoresEveryValueAtItsDefault) {
    SettingsRig rig;
    ASSERT_TRUE(rig.read());
    EXPECT_EQ(rig.settings.AdapterToUse, "Local");
    rig.write();
    std::set<std::string> expected;
    for (const stored::Number& number : stored::kNumbers) {
        EXPECT_EQ(rig.store.get(number.name), std::to_string(number.usual)) << number.name;
        expected.insert(lowerCase(number.name));
    }
    for (const stored::Flag& flag : stored::kFlags) {
        EXPECT_EQ(rig.store.get(flag.name), flag.usual) << flag.name;
        expected.insert(lowerCase(flag.name));
    }
    for (int n = 1; n <= 16; ++n) {
        const std::string name = "Channel Wizard Color Mask" + std::to_string(n);
        EXPECT_EQ(rig.store.get(name), "16777215");
        expected.insert(lowerCase(name));
    }
    for (const char* name :
         {"adapter to use", "last fixture file", "last prop file", "recent file 1", "recent file 2", "recent file 3",
          "recent file 4", "channel wizard repeating channels", "vmj", "vmn", "rev", "cb height", "cb band qty"})
        expected.insert(name);
    std::set<std::string> written;
    for (const auto& [place, text] : rig.store.values) {
        if (!place.second.starts_with("cb band") || place.second == "cb band qty") written.insert(place.second);
    }
    EXPECT_EQ(written, expected);
    EXPECT_TRUE(rig.failures.reports.empty());
}

TEST(SettingsRegistry, ANumberOutsideItsRangeReadsAsTheDefault) {
    for (const stored::Number& number : stored::kNumbers) {
        const std::string name = number.name;
        const std::string outside = std::to_string(keepsOutside(name) ? number.least : number.usual);
        EXPECT_EQ(readAs(name, std::to_string(number.least)), std::to_string(number.least)) << name;
        EXPECT_EQ(readAs(name, std::to_string(number.most)), std::to_string(number.most)) << name;
        EXPECT_EQ(readAs(name, std::to_string(number.least - 1)), outside) << name;
        if (number.most != stored::kNoLimit) {
            EXPECT_EQ(readAs(name, std::to_string(number.most + 1)), outside) << name;
        }
        EXPECT_EQ(readAs(name, ""), std::to_string(number.usual)) << name;
    }
    EXPECT_EQ(readAs("Simulation Port", "70000"), "30303");
    EXPECT_EQ(readAs("Width", "100"), "2100");
    EXPECT_EQ(readAs("Channel Wizard Color Mask16", "16777216"), "16777215");
    EXPECT_EQ(readAs("Channel Wizard Color Mask1", "255"), "255");
    EXPECT_EQ(readAs("Channel Wizard Repeating Channels", "17"), "1");
}

TEST(SettingsRegistry, AFlagReadsInAnyCaseAndComesBack) {
    for (const stored::Flag& flag : stored::kFlags) {
        const bool usual = flag.usual == std::string("True");
        const std::string other = usual ? "False" : "True";
        const std::string kept = flag.name == std::string("Use TCP") ? "False" : other;
        EXPECT_EQ(readAs(flag.name, usual ? "fALSE" : "tRUE"), kept) << flag.name;
        EXPECT_EQ(readAs(flag.name, ""), flag.usual) << flag.name;
    }
}

TEST(SettingsRegistry, EveryRunStartsOnUdp) {
    SettingsRig rig;
    rig.connection.ZephUseTCP = true;
    rig.connection.ZephPortOpen = true;
    rig.store.set("Use TCP", "True");
    rig.store.set("Simulation Port", "4000");
    rig.store.set("Adapter To Use", "Stage");
    ASSERT_TRUE(rig.read());
    EXPECT_FALSE(rig.connection.ZephUseTCP);
    EXPECT_EQ(rig.connection.ZephSimulationPort, 4000);
    EXPECT_EQ(rig.connection.ZephAdapterName, "Stage");
    EXPECT_EQ(rig.connection.ZephAdapterIP, "192.168.1.20");
    EXPECT_TRUE(rig.connection.ZephPortOpen);  // reading settings closes no socket
    EXPECT_TRUE(rig.host.boxes.empty());
}

TEST(SettingsRegistry, WarnsOfAnAdapterWithoutNetwork) {
    SettingsRig rig;
    rig.store.set("Adapter To Use", "Spare");
    ASSERT_TRUE(rig.read());
    ASSERT_EQ(rig.host.boxes.size(), 1u);
    EXPECT_EQ(rig.host.boxes[0].title, "Qen Visualizer-Port Error");
    EXPECT_EQ(rig.settings.AdapterToUse, "Spare");
}

// Every kind of damage costs its own value and no other, and is told once.
TEST(SettingsRegistry, DamageCostsOneValueAndIsReported) {
    const std::string nul("5\0x", 3);
    const std::string garbage[] = {
        "abc", "5x",   "0x10",         "1.5",   "1e3",         "99999999999999999999",    "- 5",           "+-5", "²",
        nul,   "\x1b", "\xff\xfe\x80", "@Rect", "-2147483649", std::string(100'000, '9'), "5\r\n[Section]"};
    for (const std::string& text : garbage) {
        SettingsRig rig;
        rig.store.set("Bulb Size", text);
        rig.store.set("Confirm Deletes", text);
        rig.store.set("Channel Wizard Color Mask3", text);
        rig.store.set("Left", "1500");
        rig.store.set("Flood Size", "7");
        rig.store.set("Last Prop File", "/elsewhere/a.zpp");
        rig.store.set("Channel Wizard Color Mask4", "4");
        ASSERT_TRUE(rig.read());
        EXPECT_EQ(rig.settings.BulbSize, 2);
        EXPECT_TRUE(rig.settings.ConfirmDeletes);
        EXPECT_EQ(rig.settings.ChannelWizardColorMask[2], 16777215);
        EXPECT_EQ(rig.settings.Left, 1500);
        EXPECT_EQ(rig.settings.FloodSize, 7);
        EXPECT_EQ(rig.settings.LastPropFile, "/elsewhere/a.zpp");
        EXPECT_EQ(rig.settings.ChannelWizardColorMask[3], 4);
        ASSERT_EQ(rig.failures.reports.size(), 3u) << text.substr(0, 40);
        EXPECT_EQ(rig.failures.reports[0].procedure, "Zeph.SettingsRegistry.ZephReadRegistryDefaults");
        EXPECT_NE(rig.failures.reports[0].description.find("\"Bulb Size\""), std::string::npos);
        EXPECT_EQ(rig.failures.reports[2].procedure, "Zeph.SettingsRegistry.ReadChannelWizardSettings");
        for (const CollectingFailures::Report& report : rig.failures.reports) {
            EXPECT_LT(report.description.size(), 200u);
            EXPECT_EQ(report.description.find_first_of("\r\n\x1b"), std::string::npos);
            EXPECT_GT(report.line, 0);
        }
    }
}

// Whatever the store holds, what comes out is a record that the program can work with.
TEST(SettingsRegistry, RandomContentGivesNumbersWithinTheirRanges) {
    const std::string alphabet("0123456789+-. TrueFalse\\/<>base@(),\"%&\0\n\xc3\xa9\xff", 42);
    SeededRandom random(2024);
    const auto any = [&](int below) { return static_cast<std::size_t>(random.next() * below); };
    for (int round = 0; round < 150; ++round) {
        SettingsRig rig;
        rig.write();
        for (auto& [place, text] : rig.store.values) {
            if (any(4) == 0) continue;
            text.clear();
            for (std::size_t length = any(12); length > 0; --length)
                text.push_back(alphabet[any(static_cast<int>(alphabet.size()))]);
        }
        ASSERT_TRUE(rig.read());
        ZephInitializeFromRegistryCoolbar(rig.store, rig.failures);
        rig.write();
        for (const stored::Number& number : stored::kNumbers) {
            const int value = std::stoi(rig.store.get(number.name));
            EXPECT_GE(value, number.least) << number.name;
            EXPECT_LE(value, number.most) << number.name;
        }
        EXPECT_EQ(rig.readBack(), rig.settings);
    }
}

TEST(SettingsRegistry, EveryChangedValueComesBack) {
    SettingsRig rig;
    for (const stored::Number& number : stored::kNumbers)
        rig.store.set(number.name, std::to_string(number.usual == number.most ? number.least : number.usual + 1));
    for (const stored::Flag& flag : stored::kFlags)
        rig.store.set(flag.name, flag.usual == std::string("True") ? "False" : "True");
    ASSERT_TRUE(rig.read());
    rig.settings.AdapterToUse = "Stage";
    rig.settings.LastFixtureFile = "/data/Zeph/Fixtures/tree.zff";
    rig.settings.LastPropFile = "/mnt/Größe, \"x\" & more/arch.zpp";
    rig.settings.RecentFiles = {"/data/Zeph/Editor/a.zee", "/b.zee", "", ""};
    rig.settings.ChannelWizardColorMask[0] = 1;
    rig.settings.ChannelWizardColorMask[15] = 16;
    rig.settings.ChannelWizardRepeatingChannels = 16;
    rig.write();
    EXPECT_EQ(rig.store.get("Last Fixture File"), "<base>/Fixtures/tree.zff");
    EXPECT_EQ(rig.store.get("Recent File 1"), "<base>/Editor/a.zee");
    EXPECT_EQ(rig.store.get("Recent File 3"), "");
    EXPECT_EQ(rig.readBack(), rig.settings);
    EXPECT_NE(rig.settings, ZephSettings{});
}

TEST(SettingsRegistry, EmptyRecentEntriesCloseUp) {
    SettingsRig rig;
    rig.store.set("Recent File 2", "<base>/Editor/a.zee");
    rig.store.set("Recent File 3", "");
    rig.store.set("Recent File 4", "/b.zee");
    rig.settings.RecentFiles = {"/old.zee", "/older.zee", "", ""};
    ASSERT_TRUE(rig.read());
    EXPECT_EQ(rig.settings.RecentFiles, (std::array<std::string, 4>{"/data/Zeph/Editor/a.zee", "/b.zee", "", ""}));
}

TEST(SettingsRegistry, HoldsOffARestartForFiveSeconds) {
    struct Case {
        std::int64_t closedAt;
        std::int32_t now;
        bool starts;
    };
    constexpr std::int32_t kLast = std::numeric_limits<std::int32_t>::max();
    for (const Case& each :
         {Case{1000, 1000, true}, Case{1000, 1001, false}, Case{1000, 5999, false}, Case{1000, 6000, true},
          Case{90'000'000, 2000, true}, Case{kLast, -kLast, true}, Case{-kLast, kLast, true}}) {
        SettingsRig rig;
        rig.store.set("ShutDownTime", std::to_string(each.closedAt));
        rig.store.set("Bulb Size", "9");
        rig.clock.set(each.now);
        EXPECT_EQ(rig.read(), each.starts) << each.closedAt << " " << each.now;
        EXPECT_EQ(rig.settings.BulbSize, each.starts ? 9 : 2);
        EXPECT_TRUE(rig.host.boxes.empty());
    }
    SettingsRig soonAfterTheMachine;
    soonAfterTheMachine.clock.set(3000);
    EXPECT_TRUE(soonAfterTheMachine.read());  // absent is not zero
    SettingsRig damaged;
    damaged.store.set("ShutDownTime", "soon");
    EXPECT_TRUE(damaged.read());
    EXPECT_EQ(damaged.failures.reports.size(), 1u);
}

TEST(SettingsRegistry, OnlyTheEndOfTheProgramWritesItsTime) {
    SettingsRig rig;
    rig.write(false);
    EXPECT_EQ(rig.store.get("ShutDownTime"), "(absent)");
    rig.write(true);
    EXPECT_EQ(rig.store.get("ShutDownTime"), "100000");
    EXPECT_EQ(rig.store.flushes, 2);
    EXPECT_TRUE(rig.read());
    rig.clock.set(100'500);
    EXPECT_FALSE(rig.read());
}

TEST(SettingsRegistry, AResetLeavesAFirstRunBehind) {
    SettingsRig rig;
    rig.settings.BulbSize = 9;
    rig.settings.RecentFiles[0] = "/a.zee";
    rig.write(true);
    ToolBandLayout moved = firstToolBandLayout();
    moved.Height = 1200;
    SaveCoolbar(moved, rig.store);
    ZephWriteVisPid(77, rig.store);
    rig.clock.set(100'500);

    ZephDeleteZephRegistry(rig.store);
    ASSERT_TRUE(rig.read());
    ZephSettings fresh;
    fresh.AdapterToUse = "Local";
    EXPECT_EQ(rig.settings, fresh);
    EXPECT_EQ(rig.store.get("CB Height"), "870");
    EXPECT_EQ(rig.store.get("CB Band Qty"), "3");
    EXPECT_EQ(rig.store.value(kSharedIpcKey, "VisPid"), "77");  // not a setting
}
