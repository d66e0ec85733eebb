#include "tests/shell/window_rig.h"

namespace {

constexpr auto kControlShift = Qt::ControlModifier | Qt::ShiftModifier;

// The window with the display of the rig open.
struct WindowDocuments : WindowRig {
    void SetUp() override {
        WindowRig::SetUp();
        open();
    }
    // The name of the only fixture in a file, as the file has it.
    std::string nameIn(const std::string& fileName) {
        LoadBench reader;
        reader.simulation->FilePath = folder.path();
        reader.simulation->FileName = fileName;
        EXPECT_TRUE(reader.load()) << fileName;
        return reader.simulation->Fixtures[1].Name;
    }
    void change(const std::string& name) {
        document().Fixtures[1].Name = name;
        document().SimulationDirty = true;
    }
};

}  // namespace

TEST_F(WindowDocuments, SavesByKeyAndUnderANewName) {
    change("Changed");
    key(Qt::Key_S, Qt::ControlModifier);
    EXPECT_EQ(nameIn("bulb.zee"), "Changed");
    EXPECT_FALSE(document().SimulationDirty);

    change("Elsewhere");
    key(Qt::Key_S, kControlShift);
    EXPECT_EQ(document().FileName, "bulb.zee");
    EXPECT_TRUE(document().SimulationDirty);
    host.chosen = {folder.qPath("porch")};  // gets its extension
    key(Qt::Key_S, kControlShift);
    EXPECT_EQ(nameIn("porch.zee"), "Elsewhere");
    EXPECT_EQ(window.windowTitle(), "Qen Visualizer v1.0.0 -porch.zee");
    EXPECT_TRUE(action("mnuRecentFiles(0)")->text().endsWith("porch.zee"));
    EXPECT_TRUE(action("mnuRecentFiles(1)")->isVisible());
    // A name without its extension must not run over the file that has it.
    host.chosen = {folder.qPath("bulb"), ""};
    key(Qt::Key_S, kControlShift);
    EXPECT_EQ(host.notes.boxTexts(), "Save File|" + file + " already exists.\r\nDo you want to replace it?");
    EXPECT_EQ(host.asked.size(), 4) << "asked again after the refusal";
    EXPECT_EQ(nameIn("bulb.zee"), "Changed");

    document().Fixtures[1].Name = "Gone";
    action("mnuRecentFiles(1)")->trigger();
    EXPECT_EQ(document().Fixtures[1].Name, "Changed");
}

TEST_F(WindowDocuments, InsertsUndoesAndRedoesByKey) {
    folder.write("star.zff", "<ZephFixture zephSaveFileVersion=\"1.5.2\"><DrawObjects><DrawObject ID=\"1\" "
                             "Name=\"Star\" BulbSize=\"2\" BulbSpacing=\"2\" Comment=\"\" BulbShape=\"1\" "
                             "ZOrder=\"1\" AssignedItem=\"0\" Locked=\"False\"/></DrawObjects></ZephFixture>");
    host.chosen = {folder.qPath("star.zff")};
    key(Qt::Key_F, kControlShift);
    ASSERT_EQ(document().FixtureCount, 2);
    EXPECT_EQ(panel(2), "Fixture Selected:Star - Layer:1");
    EXPECT_EQ(action("mnuUndo")->text(), "Undo Inserted Fixture ");
    key(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(document().FixtureCount, 1);
    EXPECT_EQ(panel(2), "Undo of last action");
    key(Qt::Key_Y, Qt::ControlModifier);
    EXPECT_EQ(document().FixtureCount, 2);
    // Another document: nothing of it can be undone, but redo would bring the old one back.
    key(Qt::Key_Z, Qt::ControlModifier);
    ASSERT_TRUE(openFile());
    EXPECT_FALSE(action("mnuUndo")->isEnabled());
    EXPECT_EQ(action("mnuRedo")->toolTip(), "Redo: Inserted Fixture ");
    EXPECT_TRUE(action("mnuRedo")->isEnabled());
}

TEST_F(WindowDocuments, SavesItselfWhereTheStateAllowsIt) {
    auto* timer = window.findChild<QTimer*>("tmrAutoSave");
    ASSERT_EQ(timer->interval(), 600);
    program.settings.AutoSave = 1;
    change("By itself");
    program.autosave.Tag = 59;
    timer->setInterval(1);
    ASSERT_TRUE(QTest::qWaitFor([this] { return !document().SimulationDirty; }));
    timer->stop();
    EXPECT_EQ(nameIn("bulb.zee"), "By itself");
    EXPECT_EQ(panel(2), "Select Fixture");
    program.autosave.Tag = 40;
    ASSERT_TRUE(openFile());
    EXPECT_EQ(program.autosave.Tag, 0);
}

TEST_F(WindowDocuments, ClosesOnceTheWorkIsSaved) {
    change("Kept");
    document().FileName.clear();
    host.notes.answers = {BoxAnswer::Yes, BoxAnswer::Yes, BoxAnswer::Ok, BoxAnswer::Yes};
    EXPECT_FALSE(window.close()) << "nothing was chosen to save under";
    EXPECT_TRUE(document().SimulationDirty);
    host.chosen = {folder.qPath("gone/kept.zee")};
    EXPECT_FALSE(window.close()) << "the folder is not there";
    EXPECT_EQ(host.notes.boxes.back().text, "There was a problem saving the editor data to disk.  Please try again.");
    EXPECT_TRUE(document().SimulationDirty) << "asked again the next time";
    document().FileName.clear();
    host.chosen = {folder.qPath("kept.zee")};
    EXPECT_TRUE(window.close());
    EXPECT_EQ(nameIn("kept.zee"), "Kept");
}
