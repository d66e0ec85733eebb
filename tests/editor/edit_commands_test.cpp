#include "editor/editor_watcher.h"
#include "editor/insert_object.h"
#include "editor/object_operations.h"
#include "editor/save_object.h"
#include "editor/selection.h"
#include "editor/undo_commands.h"
#include "model/object_files.h"
#include "tests/editor/editor_rig.h"
#include "tests/support/fixtures.h"
#include "tests/support/folder.h"

namespace {

constexpr int kPx = TwipsPerPixelX;

// The editor with everything that its commands take: a folder, and dialogs that give the next name of a script.
struct EditCommands : ModeRig, FileDialogs, UndoFace {
    bool chooseInput(const FileDialog&, std::string& fullPath) override {
        ++asked;
        fullPath = chosen;
        return !chosen.empty();
    }
    bool chooseOutput(const FileDialog& dialog, std::string& fullPath) override {
        return chooseInput(dialog, fullPath);
    }
    void switchMode(int uiState) override { rig.editor.ZephUIState = uiState; }
    void documentReplaced(bool) override {}

    // Two bulbs with a channel; the first stands at that pixel.
    static ZephFixture bulbs(std::string name, int x, int y) {
        ZephFixture fixture;
        InitializeFixture({}, fixture);
        fixture.Name = std::move(name);
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.BulbSize = 4;
        fixture.ChannelCount = 1;
        addPoint(fixture, kPointBulb, {x, y});
        addPoint(fixture, kPointBulb, {x + 10, y + 20});
        return fixture;
    }
    // Chooses a file of that content.
    void choose(const std::string& name, const std::string& text) {
        folder.write(name, QByteArray::fromStdString(text));
        chosen = folder.path(name);
    }
    void chooseProp() {
        const auto other = std::make_unique<ZephSimulation>();
        other->FixtureCount = 9;
        other->Fixtures[7] = bulbs("Left", 300, 100);
        other->Fixtures[9] = bulbs("Right", 200, 150);
        other->Fixtures[9].Locked = true;
        other->Props[1].Name = "Pair";
        ZephAddFixtureToProp(7, 1, *other);
        ZephAddFixtureToProp(9, 1, *other);
        choose("pair.zpf", propFileText(*other, other->Props[1], kChannelChoiceYes, ""));
    }

    Folder folder;
    ZephSettings settings;
    ZephPathService paths{folder.path()};
    ZephUndoStores stores;
    EditorStateWatcher watcher{rig.editor, stores};
    EditorFileContext files{settings, paths, host, failures, watcher};
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> images = std::make_unique<ZephStaticBulbs>();
    UndoContext undo{files, rig.editor.ZephUIState, *this};
    EditContext context{modes, undo, stores, settings, *this, *masks, *images};
    std::string chosen;
    int asked = 0;
};

}  // namespace

TEST_F(EditCommands, TheBoxHoldsBulbsAndWhatIsNotLocked) {
    ZephSimulation& document = *rig.simulation;
    for (const int n : {1, 2, 3}) {
        document.Fixtures[n] = bulbs("", n * 100, n * 100);
        document.Fixtures[n].AssignedItem = n == 1 ? 0 : 1;
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
    document.Fixtures[1].DrawPoints[1].X = 2'147'483'647;  // to which nothing is added
    EXPECT_EQ(box(kStateSelectFixture, 1).Right, 2'147'483'647);
}

TEST_F(EditCommands, AFixtureComesHomeSelectedAsOneStep) {
    choose("star.zff", fixtureFileText(bulbs("Star", 40, 50), kChannelChoiceYes, ""));
    host.answers = {BoxAnswer::No};
    rig.editor.ZephUIState = kStateDrawing;
    mnuInsertFixture_Click(context);
    ASSERT_EQ(rig.simulation->FixtureCount, 4);
    const ZephFixture& star = rig.simulation->Fixtures[4];
    EXPECT_EQ(host.boxes.at(0).text, "The fixture you loaded had one or more channels assigned to it.\r\n"
                                     "Do you want to keep these channel assignments?");
    EXPECT_EQ(star.ChannelCount, 0);
    EXPECT_EQ(star.DrawPoints[2].Y, ZephHandleSize + 24 * kPx);
    EXPECT_EQ(settings.LastFixtureFile, chosen);
    EXPECT_EQ(host.panels[2], "Fixture Selected:Star - Layer:1");
    choose("bare.zff", fixtureFileText(bulbs("Bare", 40, 50), kChannelChoiceNo, ""));
    mnuInsertFixture_Click(context);
    EXPECT_EQ(host.boxes.size(), 1U) << "nothing to ask about";

    mnuUndo_Click(context);
    mnuUndo_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
    EXPECT_EQ(rig.editor.ZephSelection.Object, 0);
    rig.simulation->SimulationOpen = false;
    mnuRedo_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 3) << "there is no document to fill";
}

TEST_F(EditCommands, APropComesHomeAsAWhole) {
    chooseProp();
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
    EXPECT_EQ(face.modeButton, kToggleProps);
    EXPECT_EQ(host.panels[2], "Prop Selected:Pair (Left)");
    EXPECT_EQ(stores.UndoStore.back().Action, kUndoInsertedProp);
}

TEST_F(EditCommands, WhatCannotBeInsertedLeavesNoStep) {
    chooseProp();
    mnuInsertFixture_Click(context);  // not of its kind
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
    // Of a prop that fails on the way its fixtures stay, and are shown.
    choose("half.zpf", "<ZephProp zephSaveFileVersion=\"3.0.0\"><Items><Item ID=\"1\" Name=\"Half\"/></Items>"
                       "<DrawObjects><DrawObject ID=\"1\" Name=\"Stray\"/></DrawObjects></ZephProp>");
    mnuInsertProp_Click(context);
    EXPECT_EQ(rig.simulation->FixtureCount, 4);
    EXPECT_EQ(face.count("list"), 1);

    host.boxes.clear();
    asked = 0;
    rig.simulation->FixtureCount = kMaxFixtures;
    mnuInsertFixture_Click(context);
    rig.simulation->PropCount = kMaxProps;
    mnuInsertProp_Click(context);
    EXPECT_EQ(host.boxTexts(), "Qen Visualizer-Error|You have created the maximum number (1024) of fixtures.\n"
                               "Qen Visualizer-Error|You have created the maximum number (512) of props.");
    EXPECT_EQ(asked, 0) << "refused before anybody is asked for a file";
    EXPECT_EQ(stores.UndoPosition, 0);
}

TEST_F(EditCommands, ObjectsAreSavedWithOrWithoutTheirChannels) {
    const ObjectSaving saving{"today", host, failures};
    const ObjectSaveContext out{saving, *this, settings};
    ZephFixture star = bulbs("Star", 0, 0);
    for (const BoxAnswer answer : {BoxAnswer::No, BoxAnswer::Yes}) {
        chosen = folder.path("star.zff");
        host.answers = {answer};
        cmdSaveAsFixture_Click(star, out);
        bool channelsSeen = false;
        ASSERT_TRUE(ZephLoadFixtureFileXML(chosen, files, *rig.simulation, channelsSeen));
        EXPECT_EQ(channelsSeen, answer == BoxAnswer::Yes);
    }
    EXPECT_THAT(host.boxes.at(0).text, testing::StartsWith("Qen Visualizer can save fixtures with or without the "
                                                           "associated channel data. \r\nSaving"));
    host.boxes.clear();
    star.ChannelCount = 0;
    cmdSaveAsFixture_Click(star, out);
    EXPECT_TRUE(host.boxes.empty()) << "there is nothing to ask";
    rig.simulation->Fixtures[2].ChannelCount = 1;
    chosen = folder.path("no/such/folder.zpf");
    cmdSaveAsProp_Click(*rig.simulation, rig.simulation->Props[1], out);
    ASSERT_EQ(host.boxes.size(), 2u);
    EXPECT_TRUE(host.boxes[0].text.ends_with("\r\n\r\nShould channel data be saved with this prop's fixtures?"));
    EXPECT_EQ(host.boxes[1].text, "There was a problem saving the prop data to disk.  Please try again.");
}
