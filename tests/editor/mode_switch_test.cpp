#include "editor/mode_commands.h"
#include "editor/object_list.h"
#include "tests/editor/editor_rig.h"

namespace {

struct Modes : ModeRig {
    void expect(int state, int button, const char* panel) {
        EXPECT_EQ(rig.editor.ZephUIState, state);
        EXPECT_EQ(face.pressed, button);
        EXPECT_EQ(host.panels[2], panel);
    }
};

}  // namespace

TEST_F(Modes, EachRequestEndsInItsStateWithItsButtonPressed) {
    const std::tuple<int, int, int, int, const char*, CanvasPointer> rows[] = {
        {kStateSelectProp, 1, kStateSelectProp, 2, "Select Prop", CanvasPointer::Default},
        {kModeDrawing, kToolLightStrings, kStateDrawing, 5, "Drawing", CanvasPointer::Pencil},
        {kModeDrawing, kToolPixelWizard, kStateDrawing, 14, "Drawing", CanvasPointer::Pencil},
        {kStateSimulation, 3, kStateSelectFixture, 3, "Select Fixture", CanvasPointer::Default},  // which fails
        {7, 6, kStateSelectFixture, 0, "Select Fixture", CanvasPointer::Default},  // no mode: only the tool changes
    };
    rig.editor.ZephChangeToggle = kToggleProps;
    for (const auto& [request, tool, state, button, panel, pointer] : rows) {
        ZephSwitchMode(request, tool, modes);
        expect(state, button, panel);
        EXPECT_EQ(rig.editor.ZephDrawTool, tool);
        EXPECT_EQ(face.pointer, pointer);
    }
    EXPECT_EQ(face.modeButton, kToggleFixtures);
}

TEST_F(Modes, SelectingIgnoresLocksAndKeepsTheSelection) {
    rig.select(kStateSelectFixture, 2);
    ZephSwitchMode(kStateSelectProp, 1, modes);
    EXPECT_TRUE(rig.editor.ZephIgnoreLocks);
    expect(kStateSelectProp, 2, "Prop Selected:Snowman (arm)");
    EXPECT_EQ(face.calls, (std::vector<std::string>{"restore", "stop timer", "redraw", "list"}));
    face.listFails = true;
    ZephSwitchMode(kStateSelectProp, 1, modes);
    ASSERT_EQ(failures.reports.size(), 1U);
    EXPECT_EQ(failures.reports[0].procedure, "Zeph.modZephEditorFunctions.ZephSwitchMode");
}

TEST_F(Modes, LeavingAStrokeGivesItsFixtureBack) {
    rig.beginStroke();
    ZephSwitchMode(kStateSelectFixture, 1, modes);
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
    EXPECT_EQ(rig.editor.ZephInProgressFixture, ZephFixture{});
    EXPECT_EQ(face.calls[1], "erase");

    rig.beginStroke();
    cancelStroke(modes);
    EXPECT_EQ(rig.editor.ZephUIState, kStateDrawing);
    rig.editor.ZephInProgressAnchor = {0, 0, 90, 90};  // a wizard's box from the upper left corner holds no fixture
    cancelStroke(modes);
    EXPECT_EQ(rig.simulation->FixtureCount, 3);
}

TEST_F(Modes, OnlyLightStringsAreNotArmedTwice) {
    for (const auto& [tool, target] : {std::pair{kToolLightStrings, 2}, {kToolBulbs, 0}}) {
        drawTool_Click(tool, modes);
        rig.editor.ZephAppendTarget = 2;
        drawTool_Click(tool, modes);
        EXPECT_EQ(rig.editor.ZephAppendTarget, target);
    }
}

TEST_F(Modes, AWizardIsRefusedWhereItsPropWouldNotFit) {
    rig.simulation->PropCount = kMaxProps;
    drawTool_Click(kToolTreeWizard, modes);
    ASSERT_EQ(host.boxes.size(), 1U);
    rig.simulation->FixtureCount = kMaxFixtures;
    drawTool_Click(kToolMatrixWizard, modes);
    ASSERT_EQ(host.boxes.size(), 2U);
    EXPECT_EQ(rig.editor.ZephUIState, kStateSelectFixture);
}

TEST_F(Modes, TheListSelectsLockedObjectsAndEndsDrawing) {
    rig.simulation->Fixtures[2].Locked = true;
    rig.editor.ZephUIState = kStateDrawing;
    flgObjectSelect_Click(2, modes);
    expect(kStateSelectFixture, 3, "Fixture Selected:arm - Layer:16");
    EXPECT_EQ(face.highlighted, 2);
    EXPECT_TRUE(rig.editor.ZephIgnoreLocks);
    rig.beginStroke();
    flgObjectSelect_Click(1, modes);
    EXPECT_EQ(rig.editor.ZephSelection.Object, 2);
}
