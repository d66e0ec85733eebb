#include "model/save_commands.h"
#include "model/ui_state.h"
#include "tests/support/loading.h"
namespace {

constexpr const char* kOldFile = "<Zeph zephSaveFileVersion=\"2.1.0\"/>";

struct SaveBench : LoadBench, SaveFace, AutoSaveFace {
    std::string chosen;  // by the dialog; "" = cancelled
    std::vector<std::string> recent;
    int saved = 0;
    AutoSaveState autosave;
    int ZephUIState = kStateSelectFixture;
    bool stroke = false;
    SaveContext saving{context, "today", *this};

    bool chooseOutputFile(std::string& fullPath) override {
        fullPath = chosen;
        return !chosen.empty();
    }
    void addRecentFile(std::string_view fullPath) override { recent.emplace_back(fullPath); }
    void documentSaved() override { ++saved; }
    std::string statusPanel2() override { return host.panels[2]; }
    void save() override {
        tick(1);  // while its boxes are up, the timer goes on elsewhere
        mnuFileSave_Click(saving, *simulation, autosave);
    }

    void tick(int ticks) {
        for (int n = 0; n < ticks; ++n)
            tmrAutoSave_Timer({settings, *simulation, ZephUIState, stroke, host, failures, *this}, autosave);
    }
    void openOldFile() {
        folder.write("display.zee", kOldFile);
        ASSERT_TRUE(load() && simulation->FileUpgraded);
        simulation->SimulationDirty = true;
    }
    void saveNow() { mnuFileSave_Click(saving, *simulation, autosave); }
};

}  // namespace

TEST(Saving, AnOlderFileIsBackedUpOnce) {
    SaveBench bench;
    bench.openOldFile();
    for (char n = '1'; n <= '6'; ++n)
        bench.folder.write(std::string("display.zee.bak000") + n, "taken");
    bench.autosave.Tag = 9;
    bench.saveNow();
    EXPECT_EQ(bench.host.boxTexts(), "File Backup|This Zeph file has been updated to the new G4 file format.  Your "
                                     "existing Zeph file has been backed up and is named:\r\n\r\n" +
                                         bench.path() + ".bak0007");
    EXPECT_EQ(bench.folder.read("display.zee.bak0007"), kOldFile);
    EXPECT_NE(bench.folder.read("display.zee").find("\"3.0.0\""), std::string::npos);
    EXPECT_EQ(bench.recent, std::vector<std::string>{bench.path()});
    EXPECT_EQ(bench.autosave.Tag, 0);
    EXPECT_FALSE(bench.simulation->SimulationDirty || bench.simulation->FileUpgraded);
    bench.saveNow();
    EXPECT_EQ(bench.folder.read("display.zee.bak0008"), "not there");
}

TEST(Saving, AsksWhereNoBackUpCanBeMade) {
    for (const BoxAnswer answer : {BoxAnswer::No, BoxAnswer::Yes}) {
        SaveBench bench;
        bench.openOldFile();
        for (int n = 1; n <= 1000; ++n)
            bench.folder.write("display.zee.bak" + std::to_string(10000 + n).substr(1), "");
        bench.host.answers = {answer};
        bench.saveNow();
        EXPECT_EQ(bench.host.boxTexts(),
                  "Unable to create backup|Unable to create backup G3 Zeph file.  Do you want to continue?");
        EXPECT_EQ(bench.folder.read("display.zee") == kOldFile, answer == BoxAnswer::No);
        EXPECT_EQ(bench.simulation->SimulationDirty, answer == BoxAnswer::No);
    }
}

TEST(Saving, UnderANewNameLeavesTheOldFileAlone) {
    SaveBench bench;
    bench.openOldFile();
    for (const char* name : {"", "new.zee"}) {  // the first time cancelled
        EXPECT_TRUE(bench.simulation->FileUpgraded && bench.simulation->SimulationDirty);
        bench.chosen = *name ? bench.folder.path(name) : "";
        mnuFileSaveAs_Click(bench.saving, *bench.simulation, bench.autosave);
    }
    EXPECT_EQ(bench.host.boxTexts(), "");
    EXPECT_EQ(bench.folder.read("display.zee"), kOldFile);
    EXPECT_EQ(bench.path(), bench.chosen);
    EXPECT_FALSE(bench.simulation->FileUpgraded);

    for (const char* name : {"named.zee", ""}) {
        bench.simulation->FileName.clear();
        bench.simulation->FileUpgraded = true;
        bench.chosen = *name ? bench.folder.path(name) : "";
        bench.saveNow();
        EXPECT_FALSE(bench.simulation->FileUpgraded) << "even when the dialog is cancelled";
    }
    EXPECT_NE(bench.folder.read("named.zee"), "not there");
    EXPECT_EQ(bench.saved, 2);
}

TEST(Saving, AFailureLeavesTheOldFileAsItIs) {
    SaveBench bench;
    bench.openOldFile();
    const std::string longName = std::string(246, 'x') + ".zee";  // no room for ".bak0001" in a name
    bench.simulation->FileName = longName;
    bench.folder.write(longName, kOldFile);
    bench.saveNow();
    EXPECT_EQ(bench.host.boxTexts(), "Unable to create backup|Unable to create backup G3 Zeph file.");
    EXPECT_EQ(bench.folder.read(longName), kOldFile);
    EXPECT_TRUE(bench.simulation->SimulationDirty && bench.simulation->FileUpgraded);

    bench.simulation->FileUpgraded = false;
    bench.folder.protect(longName);
    bench.saveNow();
    EXPECT_EQ(bench.host.boxes.at(1).title, "Qen Visualizer-Save Error");
    EXPECT_FALSE(bench.simulation->SimulationDirty) << "the document counts as saved";
    EXPECT_EQ(bench.folder.read(longName), kOldFile);
    EXPECT_EQ(bench.folder.files(), 2) << "nothing is left beside it";
}

TEST(AutoSave, SavesAfterThirtySixSecondsAMinute) {
    SaveBench bench;
    bench.settings.AutoSave = 2;
    bench.simulation->SimulationOpen = bench.simulation->SimulationDirty = true;
    bench.host.panels[2] = "kept";
    bench.tick(119);
    EXPECT_EQ(bench.saved, 0);
    bench.tick(1);
    EXPECT_EQ(bench.saved, 1);
    EXPECT_EQ(bench.host.panel2History, (std::vector<std::string>{"Autosave in progress.", "kept"}));
    bench.tick(240);
    EXPECT_EQ(bench.saved, 1) << "nothing has changed since";

    bench.simulation->SimulationDirty = true;
    for (const int state : {kStateSimulation, kStateSelectProp, kStateDrawing}) {
        bench.ZephUIState = state;
        bench.stroke = state == kStateDrawing;
        bench.tick(100);
    }
    EXPECT_EQ(bench.saved, 1) << "waits for a state that allows it";
    bench.stroke = false;
    bench.tick(1);
    EXPECT_EQ(bench.saved, 2);
}

TEST(AutoSave, WarnsAgainAndAgainWhereThereIsNoName) {
    SaveBench bench;
    bench.settings.AutoSave = 1;
    bench.simulation->SimulationOpen = bench.simulation->SimulationDirty = true;
    bench.simulation->FileName.clear();
    bench.tick(179);
    EXPECT_EQ(bench.host.panel2History,
              std::vector<std::string>(2, "Warning:  Autosave is disabled until you save this new file"));
    bench.settings.AutoSave = 0;
    bench.tick(1);
    EXPECT_EQ(bench.autosave.Tag, 0);
    bench.settings.AutoSave = 1;
    bench.simulation->SimulationOpen = false;
    bench.tick(200);
    EXPECT_EQ(bench.host.panel2History.size(), 2u);
}
