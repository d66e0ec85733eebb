// What the editor remembers between two events: its state, the armed tool, the selection, the stroke under way. One
// record, owned by the program, never saved in a file. Coordinates are twips, a fixture is named by its slot from 1.
#pragma once

#include "model/simulation.h"
#include "model/ui_state.h"

#include <vector>

// The mode that is asked for to get into kStateDrawing; the other modes are asked for by the number of their state.
inline constexpr int kModeDrawing = 5;

// ZephDrawTool.
inline constexpr int kToolLightStrings = 1;
inline constexpr int kToolKesh = 2;
inline constexpr int kToolFloods = 3;
inline constexpr int kToolBulbs = 4;
inline constexpr int kToolArchWizard = 5;
inline constexpr int kToolTreeWizard = 6;
inline constexpr int kToolKeshWizard = 7;
inline constexpr int kToolMatrixWizard = 8;
inline constexpr int kToolPixelWizard = 9;

// ZephChangeToggle: which of the two mode buttons is pressed.
inline constexpr int kToggleFixtures = 0;
inline constexpr int kToggleProps = 1;

struct ZephSelectedObject {
    std::int32_t Object = 0;  // fixture; 0 = nothing is selected
    std::int32_t Left = 0;    // bounding box
    std::int32_t Top = 0;
    std::int32_t Right = 0;
    std::int32_t Bottom = 0;
    std::int32_t Vertex = 0;  // point under edit
    std::int32_t PrevX = -1;  // the point before it; -1, -1 = none to join
    std::int32_t PrevY = -1;
    std::int32_t NextX = -1;  // the point after it; -1, -1 = none to join
    std::int32_t NextY = -1;

    bool operator==(const ZephSelectedObject&) const = default;
};

// The rubber-band line or box of a drawing under way.
struct ZephAnchor {
    std::int32_t StartX = -1;  // StartX and StartY -1 = nothing is under way
    std::int32_t StartY = -1;
    std::int32_t EndX = 0;
    std::int32_t EndY = 0;

    bool operator==(const ZephAnchor&) const = default;
};

struct ZephEditorState {
    int ZephUIState = kStateSelectFixture;
    int ZephDrawTool = kToolLightStrings;
    int ZephChangeToggle = kToggleFixtures;
    int PressedDrawButton = 0;  // index of the button of DrawToolBar that is shown pressed, 0 = none
    ZephSelectedObject ZephSelection;
    bool ZephIgnoreLocks = false;  // locked fixtures can be edited: the selection was made in the list
    bool SimplePropMode = true;    // chkSimplePropMode: a prop counts as one object
    ZephAnchor ZephInProgressAnchor;
    ZephFixture ZephInProgressFixture;       // collects the points of a stroke
    std::int32_t ZephInProgressIndex = 0;    // fixture that a stroke has reserved, 0 = none
    std::int32_t ZephAppendTarget = 0;       // fixture that further bulbs are added to, 0 = none
    std::vector<ZephFixture> ZephClipboard;  // whole copies: one fixture, or those of a prop in its order

    bool operator==(const ZephEditorState&) const = default;
};

constexpr bool strokeActive(const ZephEditorState& editor) noexcept {
    return editor.ZephInProgressAnchor.StartX != -1 && editor.ZephInProgressAnchor.StartY != -1;
}

// In the state Drawing with a stroke under way: nothing else can be reached then. Asks StartX alone, as a point on
// the upper edge may have any StartY.
constexpr bool drawingInProgress(const ZephEditorState& editor) noexcept {
    return editor.ZephUIState == kStateDrawing && editor.ZephInProgressAnchor.StartX != -1;
}

constexpr bool objectSelected(const ZephEditorState& editor) noexcept {
    return editor.ZephSelection.Object > 0;
}

// What the undo stores hold, as far as commands and their captions depend on it.
struct UndoSummary {
    std::int32_t UndoCount = 0;
    std::int32_t RedoCount = 0;
};
