#include "shell/settings_registry.h"
#include "shell/tool_bands.h"
#include "tests/shell/settings_rig.h"

#include <QRegularExpression>

namespace {

struct Stored {
    std::string name;
    std::string usual;
    std::optional<std::int64_t> least;  // of a number
    std::optional<std::int64_t> most;   // none = any
};

// Of first_run.txt.
std::vector<Stored> firstRun() {
    static const QRegularExpression row("^(.+) = ?(\\S*)(?: in (-?\\d+)\\.\\.(\\d*))?$");
    std::vector<Stored> all;
    for (const QString& line : tableLines("first_run.txt")) {
        const QStringList parts = row.match(line).capturedTexts();
        EXPECT_GE(parts.size(), 3) << line.toStdString();
        Stored& stored = all.emplace_back(Stored{parts[1].toStdString(), parts[2].toStdString(), {}, {}});
        if (parts.size() > 3) stored.least = parts[3].toLongLong();
        if (parts.size() > 4 && !parts[4].isEmpty()) stored.most = parts[4].toLongLong();
    }
    return all;
}

// What a value reads as, told by writing it back.
std::string readAs(const std::string& name, const std::string& text) {
    SettingsRig rig;
    rig.store.set(name, text);
    EXPECT_TRUE(rig.read()) << name;
    rig.write();
    return rig.store.get(name);
}

}  // namespace

TEST(SettingsRegistry, AFirstRunStoresEveryValueAtItsDefault) {
    SettingsRig rig;
    ASSERT_TRUE(rig.read());
    rig.write();
    auto others = rig.store.values;
    for (const Stored& stored : firstRun()) {
        EXPECT_EQ(rig.store.get(stored.name), stored.usual) << stored.name;
        others.erase({lowerCase(kSettingsKey), lowerCase(stored.name)});
    }
    for (const auto& [place, text] : others)
        EXPECT_TRUE(place.second.starts_with("cb band")) << place.second << " is not in the table";
    EXPECT_TRUE(rig.failures.reports.empty());
}

TEST(SettingsRegistry, ANumberKeepsToItsRangeAndAFlagReadsInAnyCase) {
    for (const Stored& stored : firstRun()) {
        SCOPED_TRACE(stored.name);
        if (stored.least) {
            const std::int64_t top = stored.most.value_or(std::numeric_limits<std::int32_t>::max());
            const bool minimum = stored.name == "Width" || stored.name == "Height";
            for (const std::int64_t good : {*stored.least, top})
                EXPECT_EQ(readAs(stored.name, std::to_string(good)), std::to_string(good));
            EXPECT_EQ(readAs(stored.name, std::to_string(*stored.least - 1)),
                      minimum ? std::to_string(*stored.least) : stored.usual);
            if (stored.most) {
                EXPECT_EQ(readAs(stored.name, std::to_string(top + 1)), stored.usual);
            }
            EXPECT_EQ(readAs(stored.name, ""), stored.usual);
        } else if (stored.usual == "True" || stored.usual == "False") {
            const bool other = stored.usual == "False" && stored.name != "Use TCP";  // every run starts on UDP
            EXPECT_EQ(readAs(stored.name, stored.usual == "True" ? "fALSE" : "tRUE"), other ? "True" : "False");
            EXPECT_EQ(readAs(stored.name, ""), stored.usual);
        }
    }
}

TEST(SettingsRegistry, EveryRunStartsOnUdpWithItsAdapterChecked) {
    SettingsRig rig;
    rig.connection.ZephUseTCP = rig.connection.ZephPortOpen = true;
    rig.store.set("Use TCP", "True");
    rig.store.set("Simulation Port", "4000");
    rig.store.set("Adapter To Use", "Stage");
    ASSERT_TRUE(rig.read());
    // Reading settings closes no socket.
    const Connection& link = rig.connection;
    EXPECT_EQ(
        std::tie(link.ZephAdapterName, link.ZephAdapterIP, link.ZephSimulationPort, link.ZephUseTCP, link.ZephPortOpen),
        std::make_tuple("Stage", "192.168.1.20", 4000, false, true));
    EXPECT_TRUE(rig.host.boxes.empty());
    rig.store.set("Adapter To Use", "Spare");
    ASSERT_TRUE(rig.read());
    EXPECT_EQ(rig.host.boxes.size(), 1u) << "an adapter without network is warned of";
}

// Every kind of damage costs its own value and no other, and is told once.
TEST(SettingsRegistry, DamageCostsOneValueAndIsReported) {
    const std::string nul("5\0x", 3);
    const std::string garbage[] = {
        "abc", "5x",   "0x10",         "1.5",   "1e3",         "99999999999999999999",    "- 5",           "+-5", "²",
        nul,   "\x1b", "\xff\xfe\x80", "@Rect", "-2147483649", std::string(100'000, '9'), "5\r\n[Section]"};
    for (const std::string& text : garbage) {
        SettingsRig rig;
        for (const char* name : {"Bulb Size", "Confirm Deletes", "Channel Wizard Color Mask3"})
            rig.store.set(name, text);
        rig.store.set("Left", "1500");
        rig.store.set("Last Prop File", "/elsewhere/a.zpp");
        rig.store.set("Channel Wizard Color Mask4", "4");
        ZephSettings expected;
        expected.AdapterToUse = "Local";
        expected.Left = 1500;
        expected.LastPropFile = "/elsewhere/a.zpp";
        expected.ChannelWizardColorMask[3] = 4;
        ASSERT_TRUE(rig.read());
        EXPECT_EQ(rig.settings, expected);
        ASSERT_EQ(rig.failures.reports.size(), 3u) << text.substr(0, 40);
        EXPECT_EQ(rig.failures.reports[0].procedure, "Zeph.SettingsRegistry.ZephReadRegistryDefaults");
        EXPECT_NE(rig.failures.reports[0].description.find("\"Bulb Size\""), std::string::npos);
        EXPECT_EQ(rig.failures.reports[2].procedure, "Zeph.SettingsRegistry.ReadChannelWizardSettings");
        for (const CollectingFailures::Report& report : rig.failures.reports) {
            EXPECT_LT(report.description.size(), 200u);
            EXPECT_EQ(report.description.find_first_of("\r\n\x1b"), std::string::npos);
        }
    }
}

TEST(SettingsRegistry, PathsAndRecentFilesComeBackCloseTogether) {
    SettingsRig rig;
    rig.settings.AdapterToUse = "Local";
    rig.settings.LastFixtureFile = "/data/Zeph/Fixtures/tree.zff";
    rig.settings.LastPropFile = "/mnt/Größe, \"x\" & more/arch.zpp";
    rig.settings.RecentFiles = {"/data/Zeph/Editor/a.zee", "/b.zee", "", ""};
    rig.write();
    EXPECT_EQ(rig.store.get("Last Fixture File"), "<base>/Fixtures/tree.zff");
    EXPECT_EQ(rig.store.get("Recent File 1"), "<base>/Editor/a.zee");
    EXPECT_EQ(rig.readBack(), rig.settings);
    rig.store.set("Recent File 1", "");
    rig.store.set("Recent File 4", "/c.zee");
    EXPECT_EQ(rig.readBack().RecentFiles, (std::array<std::string, 4>{"/b.zee", "/c.zee", "", ""}));
}

TEST(SettingsRegistry, HoldsOffARestartForFiveSeconds) {
    constexpr std::int32_t kLast = std::numeric_limits<std::int32_t>::max();
    const std::string last = std::to_string(kLast);
    const std::tuple<std::string, std::int32_t, bool> rows[] = {
        {"1000", 1000, true},     {"1000", 1001, false}, {"1000", 5999, false},
        {"1000", 6000, true},     {last, -kLast, true},  {"-" + last, kLast, true},
        {"(absent)", 3000, true}, {"soon", 3000, true},  // the absent one is not zero
    };
    for (const auto& [closedAt, now, starts] : rows) {
        SettingsRig rig;
        if (closedAt != "(absent)") rig.store.set("ShutDownTime", closedAt);
        rig.store.set("Bulb Size", "9");
        rig.clock.set(now);
        EXPECT_EQ(rig.read(), starts) << closedAt << " " << now;
        EXPECT_EQ(rig.settings.BulbSize, starts ? 9 : 2);
        EXPECT_EQ(rig.failures.reports.size(), closedAt == "soon" ? 1u : 0u);
    }
}

TEST(SettingsRegistry, AResetLeavesAFirstRunBehind) {
    SettingsRig rig;
    rig.settings.BulbSize = 9;
    rig.settings.RecentFiles[0] = "/a.zee";
    rig.write(false);
    EXPECT_EQ(rig.store.get("ShutDownTime"), "(absent)");
    rig.write(true);  // only the end of the program
    EXPECT_EQ(rig.store.get("ShutDownTime"), "100000");
    EXPECT_EQ(rig.store.flushes, 2);
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
    EXPECT_EQ(rig.store.value(kSharedIpcKey, "VisPid"), "77");  // not a setting
}
