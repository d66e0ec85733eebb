// The captions and tips that change with the selection, the undo stores and the document, and the texts of status
// panel 2. Pure: the window shows what comes out.
#pragma once

#include "editor/editor_state.h"
#include "model/undo.h"

#include <string>
#include <string_view>

struct EditToolBarTexts {
    std::string MoveForwardTip = "Move Forward";
    std::string MoveBackwardTip = "Move Backward";
    UndoCaptions Undo;
    std::string ObjectProperties = "Fixture Properties";  // caption and tip
};

// In states that select nothing the name of ObjectProperties stays.
void SetEditToolBarTips(const ZephSimulation& simulation, const ZephEditorState& editor, const ZephUndoStores& stores,
                        EditToolBarTexts& texts);

// Text of status panel 2. suppressSelected: the state alone, as if nothing were selected; told apart in Select Fixture.
std::string ZephUpdateStatusBarForUIState(const ZephSimulation& simulation, const ZephEditorState& editor,
                                          bool suppressSelected);

// What the options band shows; colours packed as in the document.
struct OptionsBandValues {
    std::int32_t TextColor = 0;
    std::int32_t ToolHandleColor = 0;
    std::int32_t VertexHandleColor = 0;
    std::int32_t GridLineColor = 0;
    std::int32_t GridLineOption = 0;  // row of the grid line table
    std::int32_t sldIntensity = 100;  // per cent
    bool chkNames = false;            // pressed = names are hidden

    bool operator==(const OptionsBandValues&) const = default;
};

// The values of the band from the options and the document's PicIntensity.
OptionsBandValues ZephSetOptionsToolbandStuff(const ZephSettings& settings, const ZephSimulation& simulation);
