// A small open document and a window that notes what it is asked to show.
#pragma once

#include "editor/command_states.h"
#include "editor/mode_switch.h"
#include "model/document.h"
#include "tests/support/recording_host.h"

#include <algorithm>
#include <memory>

// 1 "Wreath", alone, level 5; 2 "arm" and 3 "Hat" of the prop "Snowman", levels 16 and 1.
struct EditorRig {
    EditorRig() {
        simulation->SimulationOpen = true;
        simulation->FixtureCount = 3;
        simulation->PropCount = 1;
        simulation->Props[1].Name = "Snowman";
        ZephAddFixtureToProp(3, 1, *simulation);
        ZephAddFixtureToProp(2, 1, *simulation);
        int fixture = 0;
        for (const auto& [name, level] : {std::pair{"Wreath", 5}, {"arm", 16}, {"Hat", 1}}) {
            simulation->Fixtures[++fixture].Name = name;
            simulation->Fixtures[fixture].ZOrder = level;
        }
    }

    void select(int state, int fixture) {
        editor.ZephUIState = state;
        editor.ZephSelection.Object = fixture;
    }
    // A stroke of light strings has begun at (30, 45) and reserved a fixture.
    void beginStroke() {
        editor.ZephUIState = kStateDrawing;
        editor.ZephInProgressAnchor = {30, 45, 30, 45};
        editor.ZephInProgressIndex = ++simulation->FixtureCount;
        editor.ZephInProgressFixture.PointCount = 1;
    }
    CommandInputs inputs() const { return {*simulation, editor, undo, 1, false}; }

    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    ZephEditorState editor;
    UndoSummary undo;
};

class RecordingModeFace : public ModeFace, public SimulationDoor {
public:
    explicit RecordingModeFace(ZephEditorState& state) : editor(state) {}

    void restoreIfMinimized() override { calls.push_back("restore"); }
    void eraseRubberBand() override { calls.push_back("erase"); }
    void setCanvasPointer(CanvasPointer shown) override { pointer = shown; }
    void stopTimer() override { calls.push_back("stop timer"); }
    void redrawObjects() override { calls.push_back("redraw"); }
    void ZephHighlightflg(std::int32_t object) override { highlighted = object; }
    void ZephDeselectflg() override { highlighted = 0; }
    void ZephLoadUIObjectList() override {
        require(!listFails, "no list");
        calls.push_back("list");
    }
    void showPressedDrawButton() override { pressed = editor.PressedDrawButton; }
    void showModeButtons() override { modeButton = editor.ZephChangeToggle; }
    void CheckEnable(bool) override { calls.push_back("enable"); }
    bool enterSimulation() override { return false; }
    void ZephCleanUpAfterSimulation() override {}
    long count(const std::string& call) const { return std::ranges::count(calls, call); }

    ZephEditorState& editor;
    std::vector<std::string> calls;
    CanvasPointer pointer = CanvasPointer::Default;
    int pressed = -1;
    int modeButton = -1;
    std::int32_t highlighted = 0;
    bool listFails = false;
};

// The rig with that window around it.
struct ModeRig : testing::Test {
    EditorRig rig;
    RecordingHost host;
    CollectingFailures failures;
    RecordingModeFace face{rig.editor};
    ModeContext modes{*rig.simulation, rig.editor, host, face, face, failures};
};
