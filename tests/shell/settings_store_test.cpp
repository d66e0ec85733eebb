#include "shell/settings_values.h"
#include "tests/shell/settings_rig.h"
#include "tests/support/folder.h"
#include "util/random_source.h"
#include "util/settings_store.h"

namespace {

struct FileStore : testing::Test {
    void put(const QByteArray& content) { folder.write(name, content); }
    QByteArray content() { return QByteArray::fromStdString(folder.read(name)); }

    Folder folder;
    const char* name = "settings.ini";
    std::string file = folder.path(name);
};

constexpr std::string_view kKey = kSettingsKey;

}  // namespace

TEST_F(FileStore, KeepsAnyTextUnderAnyCaseOfItsName) {
    const std::string hard = " a, b;c=\"é😀\" C:\\new\\u0041 %20 @Variant(x)\r\n[# no comment] ";
    file = folder.path(name = "deep/settings.ini");  // in a folder that it makes
    {
        FileSettingsStore store(file);
        EXPECT_EQ(store.value(kKey, "Bulb Size"), std::nullopt);
        store.setValue(kKey, "state", "1");
        store.setValue(kKey, "Text", hard);
        store.setValue(kKey, "Empty", "");
        store.setValue(kKey, "[=;odd] ", "=");
        EXPECT_TRUE(store.flush());
    }
    {
        FileSettingsStore store(file);
        EXPECT_EQ(store.value(kKey, "STATE"), "1");
        EXPECT_EQ(store.value("software\\kalvora\\zeph\\settings", "text"), hard);
        EXPECT_EQ(store.value(kKey, "Empty"), "");
        EXPECT_EQ(store.value(kKey, "[=;odd] "), "=");
        EXPECT_EQ(store.problem(), "");
        store.setValue(kKey, "State", "2");
    }
    EXPECT_TRUE(content().contains("State=2"));
    EXPECT_FALSE(content().contains("state=1"));
    EXPECT_TRUE(content().startsWith("[Software.Kalvora.Zeph.Settings]"));
}

TEST_F(FileStore, RemovesOneKeyOnly) {
    FileSettingsStore store(file);
    store.setValue(kKey, "A", "1");
    store.setValue(kKey, "B", "2");
    store.setValue(kSharedIpcKey, "VisPid", "3");
    store.setValue("Software\\Kalvora\\Zeph\\SettingsOfAnother", "A", "4");
    store.removeKey("SOFTWARE\\Kalvora\\Zeph\\Settings");
    store.flush();
    const FileSettingsStore again(file);
    EXPECT_EQ(again.value(kKey, "A"), std::nullopt);
    EXPECT_EQ(again.value(kKey, "B"), std::nullopt);
    EXPECT_EQ(again.value(kSharedIpcKey, "VisPid"), "3");
    EXPECT_EQ(again.value("Software\\Kalvora\\Zeph\\SettingsOfAnother", "A"), "4");
}

TEST_F(FileStore, TwoProcessesKeepEachOthersValues) {
    FileSettingsStore first(file);
    FileSettingsStore second(file);
    first.setValue(kKey, "A", "1");
    first.flush();
    second.setValue(kKey, "B", "2");
    second.flush();
    EXPECT_EQ(second.value(kKey, "A"), "1");
    EXPECT_EQ(first.value(kKey, "B"), std::nullopt);
    first.flush();
    EXPECT_EQ(first.value(kKey, "B"), "2");
    const FileSettingsStore later(file);
    EXPECT_EQ(later.value(kKey, "A"), "1");
    EXPECT_EQ(later.value(kKey, "B"), "2");
}

// What stands in a file that something else wrote into, or cut short, is read, and nothing of it lost by a write.
TEST_F(FileStore, ADamagedFileGivesWhatIsLegible) {
    struct Case {
        QByteArray line;
        bool damage;           // of the file, not of a value
        std::size_t reported;  // with the damage of values
    };
    const QByteArray heading = "[Software.Kalvora.Zeph.Settings]\r\n";
    for (const Case& each :
         {Case{"; a comment = none", false, 0}, Case{"# neither", false, 0}, Case{"no equals sign", true, 1},
          Case{"=1", true, 1}, Case{"[unclosed", true, 1}, Case{QByteArray("\0\0\0", 3), true, 1},
          Case{QByteArray(200'000, '['), true, 1}, Case{"ZOrder=@Variant(\\0\\0\\x10\\x5\\0)", false, 1},
          Case{"ZOrder=1, 2", false, 1}, Case{"ZOrder=\"open", false, 1}, Case{"ZOrder=\xff\xfe\x80", false, 1},
          Case{"ZOrder=\\u00", false, 1}, Case{"ZOrder=\\", false, 1}, Case{" zOrder = 1 ", false, 0},
          Case{"[]\nZOrder=x", false, 0}, Case{"ZOrder=5\nZOrder=1", false, 0}}) {
        const std::string shown = each.line.left(40).toStdString();
        put("\xef\xbb\xbf" + heading + "Bulb Size=5\r\n" + each.line + "\n" + heading + "Flood Size=7");
        FileSettingsStore store(file);
        SettingsRig rig;
        ASSERT_TRUE(ZephReadRegistryDefaults(rig.on(store), rig.settings, rig.connection, rig.adapters));
        EXPECT_EQ(rig.settings.BulbSize, 5) << shown;
        EXPECT_EQ(rig.settings.FloodSize, 7) << shown;
        EXPECT_EQ(rig.settings.ZOrder, 1) << shown;
        EXPECT_EQ(!store.problem().empty(), each.damage) << shown;
        EXPECT_EQ(rig.failures.reports.size(), each.reported) << shown;
        rig.settings.ZOrder = 4;
        ZephWriteClosingRegistry(rig.on(store), rig.settings, false);
        const FileSettingsStore again(file);
        EXPECT_EQ(again.value(kKey, "Flood Size"), "7") << shown;
        EXPECT_EQ(again.value(kKey, "ZOrder"), "4") << shown;
        if (each.damage) {
            EXPECT_TRUE(content().contains('\n' + each.line + '\n')) << shown;
        }
    }
}

TEST_F(FileStore, AFileWithSpoiltBytesNeverStopsTheStart) {
    SettingsRig rig;
    FileSettingsStore whole(file);
    ZephWriteClosingRegistry(rig.on(whole), rig.settings, false);
    const QByteArray good = content();
    SeededRandom random(7);
    for (int round = 0; round < 40; ++round) {
        QByteArray spoilt = good;
        for (int byte = 0; byte < 60; ++byte)
            spoilt[static_cast<qsizetype>(random.next() * static_cast<double>(spoilt.size()))] =
                static_cast<char>(random.next() * 256);
        put(spoilt);
        FileSettingsStore store(file);
        ASSERT_TRUE(ZephReadRegistryDefaults(rig.on(store), rig.settings, rig.connection, rig.adapters));
        EXPECT_LE(rig.settings.BulbSize, 16);
        EXPECT_LE(rig.settings.SimulationPort, 65535);
    }
}

TEST_F(FileStore, APlaceThatCannotBeUsedIsReportedAndTheStartGoesOn) {
    FileSettingsStore store(folder.path());  // a folder, not a file
    SettingsRig rig;
    ASSERT_TRUE(ZephReadRegistryDefaults(rig.on(store), rig.settings, rig.connection, rig.adapters));
    ASSERT_FALSE(rig.failures.reports.empty());
    EXPECT_NE(rig.failures.reports[0].description.find("cannot be opened"), std::string::npos);
    EXPECT_EQ(rig.settings.SimulationPort, 30303);
}

TEST_F(FileStore, LiesWhereTheDataFolderIsPointedTo) {
    qputenv("ZEPH_DATA", "/some/where");
    EXPECT_EQ(FileSettingsStore::userFile(), "/some/where/settings.ini");
    qunsetenv("ZEPH_DATA");
    EXPECT_TRUE(FileSettingsStore::userFile().ends_with("/Zeph/settings.ini"));
}

TEST_F(FileStore, AValueIsWrittenAsItsKindOrNotAtAll) {
    MapSettingsStore store;
    EXPECT_TRUE(fWriteValue("HKCU", {kKey, "Flag", "B", "true"}, store));
    EXPECT_TRUE(fWriteValue("HKCU", {kKey, "Word", "D", " +7"}, store));
    EXPECT_TRUE(fWriteValue("HKCU", {kKey, "Text", "S", " x "}, store));
    EXPECT_EQ(store.get("Flag"), "True");
    EXPECT_EQ(store.get("Word"), "7");
    EXPECT_EQ(store.get("Text"), " x ");
    EXPECT_FALSE(fWriteValue("HKCU", {kKey, "Flag", "B", "2"}, store));
    EXPECT_FALSE(fWriteValue("HKCU", {kKey, "Word", "D", "x"}, store));
    EXPECT_FALSE(fWriteValue("HKCU", {kKey, "Text", "Q", "x"}, store));
    EXPECT_EQ(store.get("Flag"), "True");

    EXPECT_TRUE(fWriteValue("HKLM", {kKey, "Flag", "B", "False"}, store));  // another root, another value
    EXPECT_EQ(store.get("Flag"), "True");

    const std::string profile = folder.path("other.ini");
    EXPECT_FALSE(fWriteValue(profile, {"Part", "Name", "S", "x"}, store));  // not there
    folder.write("other.ini", "[Part]\nKept=1\n");
    EXPECT_TRUE(fWriteValue(profile, {"Part", "Name", "S", "x"}, store));
    const FileSettingsStore written(profile);
    EXPECT_EQ(written.value("Part", "Name"), "x");
    EXPECT_EQ(written.value("Part", "Kept"), "1");
}
