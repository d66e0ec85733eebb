#include "editor/editor_watcher.h"
#include "editor/insert_object.h"
#include "editor/object_operations.h"
#include "editor/save_object.h"
#include "editor/selection.h"
#include "editor/undo_commands.h"
#include "model/object_files.h"
#include "tests/editor/editor_rig.h"
#include "util/whole_file.h"

#include <QTemporaryDir>

#include <limits>

namespace {

constexpr int kPx = TwipsPerPixelX;

// The editor with everything that its commands take: a folder, and dialogs that give the next name of a script.
struct EditCommands : testing::Test, FileDialogs, UndoFace {
    bool chooseInput(const FileDialog&, std::string& fullPath) override {
        ++asked;
        fullPath = chosen;
        return !chosen.empty();
    }
    bool chooseOutput(const FileDialog& dialog, std::string& fullPath) override {
        return chooseInput(dialog, fullPath);
    }
    void switchMode(int uiState) override { rig.editor.ZephUIState = uiState; }
    void documentReplaced(bool changed) override { backgroundChanged = changed; }

    ZephFixture bulbs(std::string name, int x, int y) const {
        ZephFixture fixture;
        InitializeFixture(settings, fixture);
        fixture.Name = std::move(name);
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.BulbSize = 4;
        fixture.ChannelCount = 1;
        fixture.Channels[1].Name = "Channel";
        fixture.PointCount = 2;
        fixture.DrawPoints[1] = {kPointBulb, x, y};
        fixture.DrawPoints[2] = {kPointBulb, x + 10 * kPx, y + 20 * kPx};
        return fixture;
    }
    std::string file(const std::string& name) const { return folder.path().toStdString() + "/" + name; }
    std::string propFile() {
        const auto other = std::make_unique<ZephSimulation>();
        other->FixtureCount = 9;
        other->Fixtures[7] = bulbs("Left", 300 * kPx, 100 * kPx);
        other->Fixtures[9] = bulbs("Right", 200 * kPx, 150 * kPx);
        other->Fixtures[9].Locked = true;
        other->Props[1].Name = "Pair";
        other->Props[1].AssignedCount = 2;
        other->Props[1].Object[1] = 7;
        other->Props[1].Object[2] = 9;
        EXPECT_TRUE(replaceWholeFile(file("pair.zpf"), propFileText(*other, other->Props[1], kChannelChoiceYes, "")));
        return file("pair.zpf");
    }
    std::string fixtureFile() {
        const std::string text = fixtureFileText(bulbs("Star", 40 * kPx, 50 * kPx), kChannelChoiceYes, "");
        EXPECT_TRUE(replaceWholeFile(file("star.zff"), text));
        return file("star.zff");
    }

    EditorRig rig;
    RecordingHost host;
    CollectingFailures failures;
    RecordingModeFace face{rig.editor};
    QTemporaryDir folder;
    ZephSettings settings;
    ZephPathService paths{folder.path().toStdString()};
    ZephUndoStores stores;
    EditorStateWatcher watcher{rig.editor, stores};
    EditorFileContext files{settings, paths, host, failures, watcher};
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> images = std::make_unique<ZephStaticBulbs>();
    EditContext context{{*rig.simulation, rig.editor, host, face, face, failures},
                        {files, rig.editor.ZephUIState, *this},
                        stores,
                        settings,
                        *this,
                        *masks,
                        *images};
    std::string chosen;
    int asked = 0;
    bool backgroundChanged = true;
};

}  // namespace

TEST_F(EditCommands, TheBoxHoldsBulbsAndWhatIsNotLocked) {
    ZephSimulation& document = *rig.simulation;
    for (const int n : {1, 2, 3}) {
        const std::int32_t owner = document.Fixtures[n].AssignedItem;
        document.Fixtures[n] = bulbs("", n * 100 * kPx, n * 100 * kPx);
        document.Fixtures[n].AssignedItem = owner;
    }
    document.Fixtures[3].Fixture_Type = kFixtureStrings;  // whose bulbs do not count
    const auto box = [&](int state, int object, bool whole = false) {
        rig.editor.ZephUIState = state;
        ZephBox found{1, 2, 3, 4};
        ZephFindObjectMinMax(object, whole, document, rig.editor, found);
        return found;
    };
    const ZephBox alone{196 * kPx, 196 * kPx, 214 * kPx, 224 * kPx};
    EXPECT_EQ(box(kStateSelectFixture, 2), alone);
    EXPECT_EQ(box(kStateSelectProp, 2), (ZephBox{196 * kPx, 196 * kPx, 310 * kPx, 320 * kPx}));
    EXPECT_EQ(box(kStateSelectProp, 2, true), alone);
    document.Fixtures[2].Locked = true;
    EXPECT_EQ(box(kStateSelectProp, 2), (ZephBox{300 * kPx, 300 * kPx, 310 * kPx, 320 * kPx}));
    EXPECT_EQ(box(kStateSelectFixture, 2), (ZephBox{1, 2, 3, 4})) << "nothing counts";
    rig.editor.ZephIgnoreLocks = true;
    EXPECT_EQ(box(kStateSelectFixture, 2), alone);
    constexpr std::int32_t kFar = std::numeric_limits<std::int32_t>::max();
    document.Fixtures[1].DrawPoints[1].X = kFar;
    EXPECT_EQ(box(kStateSelectFixture, 1).Right, kFar);
}

TEST_F(EditCommands, AFixtureComesHomeSelectedAsOneStep) {
    chosen = fixtureFile();
    host.answers = {BoxAnswer::No};
    rig.editor.ZephUIState = kStateDrawing;
    mnuInsertFixture_Click(context);
    ASSERT_EQ(rig.simulation->FixtureCount, 4);
    const ZephFixture& star = rig.simulation->Fixtures[4];
    EXPECT_EQ(host.boxes.at(0).text, "The fixture you loaded had one or more channels assigned to it.\r\n"
                                     "Do you want to keep these channel assignments?");
    EXPECT_EQ(star.ChannelCount, 0);
    EXPECT_EQ(star.Channels[1].Name, "");
    EXPECT_EQ(star.DrawPoints[1].X, ZephHandleSize + 4 * kPx);
    EXPECT_EQ(star.DrawPoints[2].Y, ZephHandleSize + 24 * kPx);
    EXPECT_EQ(rig.editor.ZephSelection.Left, ZephHandleSize);
    EXPECT_EQ(face.highlighted, 4);
    EXPECT_EQ(settings.LastFixtureFile, chosen);
    EXPECT_EQ(host.panels[1], "Changed");
    EXPECT_EQ(host.panels[2], "Fixture Selected:Star - Layer:1");

    mnuUndo_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
    EXPECT_EQ(rig.editor.ZephSelection.Object, 0);
    EXPECT_FALSE(backgroundChanged);
    rig.editor.ZephClipboard.resize(2);
    ZephGlobalReset(false, *rig.simulation, watcher);
    EXPECT_TRUE(rig.editor.ZephClipboard.empty());
    mnuUndo_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 0) << "nothing of the old document can be undone";
    mnuRedo_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 4) << "but redone";
}

TEST_F(EditCommands, APropComesHomeAsAWhole) {
    chosen = propFile();
    host.answers = {BoxAnswer::Yes};
    mnuInsertProp_Click(context);
    ASSERT_EQ(rig.simulation->FixtureCount, 5);
    EXPECT_EQ(host.boxes.at(0).text,
              "The prop you loaded had one or more channels assigned to the fixtures attached to it.\r\n"
              "Do you want to keep these channel assignments?");
    EXPECT_EQ(rig.simulation->Fixtures[5].ChannelCount, 1);
    // The box began at (196, 96) pixels.
    EXPECT_EQ(rig.simulation->Fixtures[4].DrawPoints[1].X, ZephHandleSize + 104 * kPx);
    EXPECT_EQ(rig.simulation->Fixtures[5].DrawPoints[1].X, ZephHandleSize + 4 * kPx) << "though it is locked";
    EXPECT_EQ(rig.simulation->Fixtures[5].DrawPoints[1].Y, ZephHandleSize + 54 * kPx);
    EXPECT_EQ(face.modeButton, kToggleProps);
    EXPECT_EQ(host.panels[2], "Prop Selected:Pair (Left)");
    EXPECT_EQ(stores.UndoStore.back().Action, kUndoInsertedProp);
}

TEST_F(EditCommands, WhatCannotBeInsertedLeavesNoStep) {
    chosen = propFile();
    mnuInsertFixture_Click(context);  // not of its kind
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
    EXPECT_FALSE(rig.simulation->SimulationDirty);
    // Of a prop that fails on the way its fixtures stay, and are shown.
    ASSERT_TRUE(replaceWholeFile(file("half.zpf"),
                                 "<ZephProp zephSaveFileVersion=\"3.0.0\"><Items><Item ID=\"1\" Name=\"Half\"/></Items>"
                                 "<DrawObjects><DrawObject ID=\"1\" Name=\"Stray\"/></DrawObjects></ZephProp>"));
    chosen = file("half.zpf");
    mnuInsertProp_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 4);
    EXPECT_TRUE(rig.simulation->SimulationDirty);
    EXPECT_EQ(face.count("list"), 1);

    host.boxes.clear();
    asked = 0;
    rig.simulation->FixtureCount = kMaxFixtures;
    mnuInsertFixture_Click(context);
    mnuInsertProp_Click(context);
    rig.simulation->PropCount = kMaxProps;
    mnuInsertProp_Click(context);
    ASSERT_EQ(host.boxes.size(), 3u);
    EXPECT_EQ(host.boxes[1].text, "You have created the maximum number (1024) of fixtures.");
    EXPECT_EQ(host.boxes[2].text, "You have created the maximum number (512) of props.");
    EXPECT_EQ(asked, 0) << "refused before anybody is asked for a file";
    EXPECT_EQ(stores.UndoPosition, 0);
}

TEST_F(EditCommands, ObjectsAreSavedWithOrWithoutTheirChannels) {
    const ObjectSaving saving{"today", host, failures};
    const ObjectSaveContext out{saving, *this, settings};
    ZephFixture star = bulbs("Star", 0, 0);
    for (const BoxAnswer answer : {BoxAnswer::No, BoxAnswer::Yes}) {
        chosen = file("star.zff");
        host.answers = {answer};
        cmdSaveAsFixture_Click(star, out);
        bool channelsSeen = false;
        ASSERT_TRUE(ZephLoadFixtureFileXML(chosen, files, *rig.simulation, channelsSeen));
        EXPECT_EQ(channelsSeen, answer == BoxAnswer::Yes);
    }
    EXPECT_TRUE(host.boxes.at(0).text.starts_with("Qen Visualizer can save fixtures with or without the associated "
                                                  "channel data. \r\nSaving"));
    host.boxes.clear();
    star.ChannelCount = 0;
    cmdSaveAsFixture_Click(star, out);
    EXPECT_TRUE(host.boxes.empty()) << "there is nothing to ask";
    rig.simulation->Fixtures[2].ChannelCount = 1;
    chosen = file("no/such/folder.zpf");
    cmdSaveAsProp_Click(*rig.simulation, rig.simulation->Props[1], out);
    ASSERT_EQ(host.boxes.size(), 2u);
    EXPECT_TRUE(host.boxes[0].text.ends_with("\r\n\r\nShould channel data be saved with this prop's fixtures?"));
    EXPECT_EQ(host.boxes[1].text, "There was a problem saving the prop data to disk.  Please try again.");
}
