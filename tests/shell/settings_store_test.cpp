#include "shell/settings_values.h"
#include "tests/shell/settings_rig.h"
#include "util/random_source.h"
#include "util/settings_store.h"

#include <QFile>
#include <QTemporaryDir>

namespace {

struct FileStore : testing::Test {
    void put(const QByteArray& content) {
        QFile made(QString::fromStdString(file));
        ASSERT_TRUE(made.open(QIODevice::WriteOnly));
        made.write(content);
    }
    QByteArray content() {
        QFile made(QString::fromStdString(file));
        EXPECT_TRUE(made.open(QIODevice::ReadOnly));
        return made.readAll();
    }

    QTemporaryDir folder;
    std::string file = folder.filePath("deep/settings.ini").toStdString();
};

constexpr std::string_view kKey = kSettingsKey;

}  // namespace

TEST_F(FileStore, KeepsAnyTextUnderAnyCaseOfItsName) {
    const std::string hard = "a, b;c=\"é\" \\ %20 @Variant(x)\n# no comment ";
    {
        FileSettingsStore store(file);
        EXPECT_EQ(store.value(kKey, "Bulb Size"), std::nullopt);
        store.setValue(kKey, "state", "1");
        store.setValue(kKey, "Text", hard);
        store.setValue(kKey, "Empty", "");
        EXPECT_TRUE(store.flush());
    }
    {
        FileSettingsStore store(file);
        EXPECT_EQ(store.value(kKey, "STATE"), "1");
        EXPECT_EQ(store.value("software\\kalvora\\zeph\\settings", "text"), hard);
        EXPECT_EQ(store.value(kKey, "Empty"), "");
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
    const FileSettingsStore later(file);
    EXPECT_EQ(later.value(kKey, "A"), "1");
    EXPECT_EQ(later.value(kKey, "B"), "2");
}

// A file that something else wrote into, or cut short, still gives every value that stands in it.
TEST_F(FileStore, ADamagedFileGivesWhatIsLegible) {
    FileSettingsStore(file).setValue(kKey, "Bulb Size", "3");  // makes the folder
    const QByteArray head = "[Software.Kalvora.Zeph.Settings]\nBulb%20Size=5\n";
    const QByteArray tail = "\n[Software.Kalvora.Zeph.Settings]\nFlood%20Size=7\n";
    for (const QByteArray& garbage :
         {QByteArray("no equals sign"), QByteArray("ZOrder=@Rect(1 2 3 4)"),
          QByteArray("ZOrder=@Variant(\\0\\0\\0\\x7f\\0)"), QByteArray("ZOrder=@ByteArray(x)"),
          QByteArray("ZOrder=1, 2"), QByteArray("ZOrder=\"open"), QByteArray("[unclosed"),
          QByteArray("ZOrder=\xff\xfe\x80"), QByteArray("=1"), QByteArray("\0\0\0", 3), QByteArray("ZOrder=\\x"),
          QByteArray(200'000, '[')}) {
        put(head + garbage + tail);
        FileSettingsStore store(file);
        SettingsRig rig;
        const RegistryContext context{store, rig.clock, rig.paths, rig.failures, rig.host, rig.context.lister};
        ASSERT_TRUE(ZephReadRegistryDefaults(context, rig.settings, rig.connection, rig.adapters));
        EXPECT_EQ(rig.settings.BulbSize, 5) << garbage.left(40).toStdString();
        EXPECT_EQ(rig.settings.ZOrder, 1) << garbage.left(40).toStdString();
        if (!garbage.contains("open")) {
            EXPECT_EQ(rig.settings.FloodSize, 7) << garbage.left(40).toStdString();
        }
    }
}

TEST_F(FileStore, AFileWithSpoiltBytesNeverStopsTheStart) {
    SettingsRig rig;
    FileSettingsStore whole(file);
    ZephWriteClosingRegistry({whole, rig.clock, rig.paths, rig.failures, rig.host, rig.context.lister}, rig.settings,
                             false);
    const QByteArray good = content();
    SeededRandom random(7);
    for (int round = 0; round < 100; ++round) {
        QByteArray spoilt = good;
        for (int byte = 0; byte < 60; ++byte)
            spoilt[static_cast<qsizetype>(random.next() * static_cast<double>(spoilt.size()))] =
                static_cast<char>(random.next() * 256);
        put(spoilt);
        FileSettingsStore store(file);
        const RegistryContext context{store, rig.clock, rig.paths, rig.failures, rig.host, rig.context.lister};
        ASSERT_TRUE(ZephReadRegistryDefaults(context, rig.settings, rig.connection, rig.adapters));
        EXPECT_LE(rig.settings.BulbSize, 16);
        EXPECT_LE(rig.settings.SimulationPort, 65535);
    }
}

TEST_F(FileStore, APlaceThatCannotBeUsedIsReportedAndTheStartGoesOn) {
    FileSettingsStore store(folder.path().toStdString());  // a folder, not a file
    SettingsRig rig;
    const RegistryContext context{store, rig.clock, rig.paths, rig.failures, rig.host, rig.context.lister};
    ASSERT_TRUE(ZephReadRegistryDefaults(context, rig.settings, rig.connection, rig.adapters));
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

    const std::string profile = folder.filePath("other.ini").toStdString();
    EXPECT_FALSE(fWriteValue(profile, {"Part", "Name", "S", "x"}, store));  // not there
    QFile made(QString::fromStdString(profile));
    ASSERT_TRUE(made.open(QIODevice::WriteOnly));
    made.write("[Part]\nKept=1\n");
    made.close();
    EXPECT_TRUE(fWriteValue(profile, {"Part", "Name", "S", "x"}, store));
    const FileSettingsStore written(profile);
    EXPECT_EQ(written.value("Part", "Name"), "x");
    EXPECT_EQ(written.value("Part", "Kept"), "1");
}
