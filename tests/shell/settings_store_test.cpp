#include "shell/settings_values.h"
#include "tests/shell/settings_rig.h"
#include "tests/support/folder.h"
#include "util/settings_store.h"

namespace {

struct FileStore : testing::Test {
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
        store.setValue(kKey, "state", "1");
        store.setValue(kKey, "Text", hard);
        store.setValue(kKey, "Empty", "");
        store.setValue(kKey, "[=;odd] ", "=");
        EXPECT_TRUE(store.flush());
    }
    {
        // Under another name, since QSettings gives a file that it knows from its memory.
        ASSERT_TRUE(QFile::copy(folder.qPath(name), folder.qPath("copy.ini")));
        file = folder.path(name = "copy.ini");
        FileSettingsStore store(file);
        EXPECT_EQ(store.value(kKey, "STATE"), "1");
        EXPECT_EQ(store.value("software\\kalvora\\zeph\\settings", "text"), hard);
        EXPECT_EQ(store.value(kKey, "Empty"), "");
        EXPECT_EQ(store.value(kKey, "[=;odd] "), "=");
        store.setValue(kKey, "State", "2");
    }
    EXPECT_TRUE(content().contains("State=2"));
    EXPECT_FALSE(content().contains("state=1"));
    EXPECT_TRUE(content().startsWith("[Software.Kalvora.Zeph.Settings]"));
}

TEST_F(FileStore, RemovesOneKeyOnly) {
    FileSettingsStore store(file);
    store.setValue(kKey, "A", "1");
    store.setValue(kSharedIpcKey, "VisPid", "3");
    store.setValue("Software\\Kalvora\\Zeph\\SettingsOfAnother", "A", "4");
    store.removeKey("SOFTWARE\\Kalvora\\Zeph\\Settings");
    store.flush();
    const FileSettingsStore again(file);
    EXPECT_EQ(again.value(kKey, "A"), std::nullopt);
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
    EXPECT_EQ(FileSettingsStore(file).value(kKey, "A"), "1");
}

// What stands in a file that something else wrote into, or cut short, is read, and nothing of it lost by a write.
TEST_F(FileStore, ADamagedFileGivesWhatIsLegible) {
    const QByteArray heading = "[Software.Kalvora.Zeph.Settings]\r\n";
    struct Row {
        QByteArray line;
        std::size_t reported = 0;  // damaged values
    };
    for (const auto& [line, reported] :
         {Row{"; a comment = none"}, Row{"# neither"}, Row{" zOrder = 1 "}, Row{"[]\nZOrder=x"},
          Row{"ZOrder=5\nZOrder=1"}, Row{"ZOrder=@Variant(\\0\\0\\x10\\x5\\0)", 1}, Row{"ZOrder=1, 2", 1},
          Row{"ZOrder=\"open", 1}, Row{"ZOrder=\xff\xfe\x80", 1}, Row{"ZOrder=\\u00", 1}, Row{"ZOrder=\\", 1},
          Row{"no equals sign", 1}, Row{"=1", 1}, Row{"[unclosed", 1}, Row{QByteArray("\0\0\0", 3), 1},
          Row{QByteArray(200'000, '['), 1}}) {
        SCOPED_TRACE(line.left(40).toStdString());
        const bool ofFile = reported == 1 && !line.startsWith("ZOrder");  // the damage; not of a value
        folder.write(name, "\xef\xbb\xbf" + heading + "Bulb Size=5\r\n" + line + "\n" + heading + "Flood Size=7");
        FileSettingsStore store(file);
        SettingsRig rig;
        ASSERT_TRUE(ZephReadRegistryDefaults(rig.on(store), rig.settings, rig.connection, rig.adapters));
        EXPECT_EQ(rig.settings.BulbSize, 5);
        EXPECT_EQ(rig.settings.FloodSize, 7);
        EXPECT_EQ(rig.settings.ZOrder, 1);
        EXPECT_EQ(!store.problem().empty(), ofFile);
        EXPECT_EQ(rig.failures.reports.size(), reported);
        rig.settings.ZOrder = 4;
        ZephWriteClosingRegistry(rig.on(store), rig.settings, false);
        const FileSettingsStore again(file);
        EXPECT_EQ(again.value(kKey, "Flood Size"), "7");
        EXPECT_EQ(again.value(kKey, "ZOrder"), "4");
        if (ofFile) {
            EXPECT_TRUE(content().contains('\n' + line + '\n'));
        }
    }
}

TEST_F(FileStore, APlaceThatCannotBeUsedIsReportedAndTheStartGoesOn) {
    FileSettingsStore store(folder.path());  // a folder, not a file
    SettingsRig rig;
    ASSERT_TRUE(ZephReadRegistryDefaults(rig.on(store), rig.settings, rig.connection, rig.adapters));
    ASSERT_FALSE(rig.failures.reports.empty());
    EXPECT_NE(rig.failures.reports[0].description.find("cannot be opened"), std::string::npos);

    qputenv("ZEPH_DATA", "/some/where");
    EXPECT_EQ(FileSettingsStore::userFile(), "/some/where/settings.ini");
    qunsetenv("ZEPH_DATA");
    EXPECT_TRUE(FileSettingsStore::userFile().ends_with("/Zeph/settings.ini"));
}

TEST_F(FileStore, AValueIsWrittenAsItsKindOrNotAtAll) {
    struct Row {
        const char* kind;
        const char* text;
        const char* stored;
    };
    MapSettingsStore store;
    for (const Row& row : {Row{"B", "true", "True"},
                           {"D", " +7", "7"},
                           {"S", " x ", " x "},
                           {"B", "2", nullptr},
                           {"D", "x", nullptr},
                           {"Q", "x", nullptr}}) {
        store.set("Name", "before");
        EXPECT_EQ(fWriteValue("HKCU", {kKey, "Name", row.kind, row.text}, store), row.stored != nullptr) << row.text;
        EXPECT_EQ(store.get("Name"), row.stored != nullptr ? row.stored : "before");
    }
    EXPECT_TRUE(fWriteValue("HKLM", {kKey, "Name", "B", "False"}, store));  // another root, another value
    EXPECT_EQ(store.get("Name"), "before");

    EXPECT_FALSE(fWriteValue(file, {"Part", "Name", "S", "x"}, store));  // not there
    folder.write(name, "[Part]\nKept=1\n");
    EXPECT_TRUE(fWriteValue(file, {"Part", "Name", "S", "x"}, store));
    const FileSettingsStore written(file);
    EXPECT_EQ(written.value("Part", "Name"), "x");
    EXPECT_EQ(written.value("Part", "Kept"), "1");
}
