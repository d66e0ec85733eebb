#include "model/save_commands.h"
#include "model/ui_state.h"
#include "tests/support/loading.h"
#include "util/whole_file.h"

#include <QDir>
#include <QFile>

#include <gtest/gtest.h>

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
    std::string text(const std::string& name) const {
        QFile file(QString::fromStdString(folderPath + name));
        return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : "not there";
    }
    void openOldFile() {
        ASSERT_TRUE(replaceWholeFile(path(), kOldFile));
        ASSERT_TRUE(ZephLoadVisualizerXML(true, context, *simulation));
        ASSERT_TRUE(simulation->FileUpgraded);
        simulation->SimulationDirty = true;
    }
};

}  // namespace

TEST(Saving, AnOlderFileIsBackedUpOnce) {
    SaveBench bench;
    bench.openOldFile();
    for (int n = 1; n <= 6; ++n)
        ASSERT_TRUE(replaceWholeFile(bench.path() + ".bak000" + std::to_string(n), "taken"));
    bench.autosave.Tag = 9;
    mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
    ASSERT_EQ(bench.host.boxes.size(), 1u);
    EXPECT_EQ(bench.host.boxes[0].title, "File Backup");
    EXPECT_EQ(bench.host.boxes[0].text,
              "This Zeph file has been updated to the new G4 file format.  Your existing Zeph "
              "file has been backed up and is named:\r\n\r\n" +
                  bench.path() + ".bak0007");
    EXPECT_EQ(bench.text("display.zee.bak0007"), kOldFile);
    EXPECT_NE(bench.text("display.zee").find("\"3.0.0\""), std::string::npos);
    EXPECT_EQ(bench.recent, std::vector<std::string>{bench.path()});
    EXPECT_EQ(bench.saved, 1);
    EXPECT_EQ(bench.autosave.Tag, 0);
    EXPECT_FALSE(bench.simulation->SimulationDirty || bench.simulation->FileUpgraded);
    mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
    EXPECT_EQ(bench.text("display.zee.bak0008"), "not there");
}

TEST(Saving, AsksWhereNoBackUpCanBeMade) {
    for (const BoxAnswer answer : {BoxAnswer::No, BoxAnswer::Yes}) {
        SaveBench bench;
        bench.openOldFile();
        for (int n = 1; n <= 1000; ++n) {
            const QString digits = QString::number(n).rightJustified(4, '0');
            QFile taken(QString::fromStdString(bench.path()) + ".bak" + digits);
            ASSERT_TRUE(taken.open(QIODevice::WriteOnly));
        }
        bench.host.answers = {answer};
        mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
        EXPECT_EQ(bench.host.boxes.at(0).title, "Unable to create backup");
        EXPECT_EQ(bench.host.boxes.at(0).text, "Unable to create backup G3 Zeph file.  Do you want to continue?");
        EXPECT_EQ(bench.saved, answer == BoxAnswer::Yes ? 1 : 0);
        EXPECT_EQ(bench.text("display.zee") == kOldFile, answer == BoxAnswer::No);
        EXPECT_EQ(bench.simulation->SimulationDirty, answer == BoxAnswer::No);
    }
}

TEST(Saving, UnderANewNameLeavesTheOldFileAlone) {
    SaveBench bench;
    bench.openOldFile();
    mnuFileSaveAs_Click(bench.saving, *bench.simulation, bench.autosave);  // cancelled
    EXPECT_TRUE(bench.simulation->FileUpgraded && bench.simulation->SimulationDirty);
    bench.chosen = bench.folderPath + "new.zee";
    mnuFileSaveAs_Click(bench.saving, *bench.simulation, bench.autosave);
    EXPECT_TRUE(bench.host.boxes.empty());
    EXPECT_EQ(bench.text("display.zee"), kOldFile);
    EXPECT_EQ(bench.path(), bench.chosen);
    EXPECT_FALSE(bench.simulation->FileUpgraded);
    EXPECT_NE(bench.text("new.zee"), "not there");

    bench.simulation->FileName.clear();
    bench.simulation->FileUpgraded = true;
    bench.chosen = bench.folderPath + "named.zee";
    mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
    EXPECT_NE(bench.text("named.zee"), "not there");
    bench.simulation->FileName.clear();
    bench.simulation->FileUpgraded = true;
    bench.chosen.clear();
    mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
    EXPECT_FALSE(bench.simulation->FileUpgraded) << "even when the dialog is cancelled";
    EXPECT_EQ(bench.saved, 2);
}

TEST(Saving, AProtectedFileIsToldAndTheDocumentCountsAsSaved) {
    SaveBench bench;
    ASSERT_TRUE(replaceWholeFile(bench.path(), "protected"));
    ASSERT_TRUE(QFile::setPermissions(QString::fromStdString(bench.path()), QFile::ReadOwner));
    bench.simulation->SimulationDirty = true;
    mnuFileSave_Click(bench.saving, *bench.simulation, bench.autosave);
    ASSERT_EQ(bench.host.boxes.size(), 1u);
    EXPECT_EQ(bench.host.boxes[0].title, "Qen Visualizer-Save Error");
    EXPECT_FALSE(bench.simulation->SimulationDirty);
    EXPECT_EQ(bench.text("display.zee"), "protected");
    EXPECT_EQ(QDir(bench.folder.path()).entryList(QDir::Files).size(), 1) << "nothing is left beside it";
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
    EXPECT_EQ(bench.host.panels[2], "kept");
    EXPECT_EQ(bench.host.panel2History, (std::vector<std::string>{"Autosave in progress.", "kept"}));
    bench.tick(240);
    EXPECT_EQ(bench.saved, 1) << "nothing has changed since";
    EXPECT_EQ(bench.autosave.Tag, 0);
}

TEST(AutoSave, WaitsForAStateThatAllowsIt) {
    SaveBench bench;
    bench.settings.AutoSave = 1;
    bench.simulation->SimulationOpen = bench.simulation->SimulationDirty = true;
    for (const int state : {kStateSimulation, kStateSelectProp}) {
        bench.ZephUIState = state;
        bench.tick(100);
    }
    bench.ZephUIState = kStateDrawing;
    bench.stroke = true;
    bench.tick(100);
    EXPECT_EQ(bench.saved, 0);
    bench.stroke = false;
    bench.tick(1);
    EXPECT_EQ(bench.saved, 1);
}

TEST(AutoSave, WarnsAgainAndAgainWhereThereIsNoName) {
    SaveBench bench;
    bench.settings.AutoSave = 1;
    bench.simulation->FileName.clear();
    bench.simulation->SimulationOpen = bench.simulation->SimulationDirty = true;
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
    EXPECT_EQ(bench.saved, 0);
}
