#include "editor/tool_bar_texts.h"

#include "model/document.h"

namespace {

std::string levelTip(const char* tip, std::int32_t level) {
    return std::string(tip) + " (to level:" + std::to_string(level) + ")";
}

std::string propText(const ZephSimulation& simulation, const ZephEditorState& editor) {
    if (!objectSelected(editor)) return "Select Prop";
    const ZephFixture& fixture = fixtureOrEmpty(simulation, editor.ZephSelection.Object);
    if (fixture.AssignedItem < 1) return "Prop Selected:" + fixture.Name;
    return "Prop Selected:" + propOrEmpty(simulation, fixture.AssignedItem).Name + " (" + fixture.Name + ")";
}

std::string fixtureText(const ZephSimulation& simulation, const ZephEditorState& editor, bool suppressSelected) {
    if (suppressSelected || !objectSelected(editor)) return "Select Fixture";
    const ZephFixture& fixture = fixtureOrEmpty(simulation, editor.ZephSelection.Object);
    return "Fixture Selected:" + fixture.Name + " - Layer:" + std::to_string(fixture.ZOrder);
}

}  // namespace

void SetEditToolBarTips(const ZephSimulation& simulation, const ZephEditorState& editor, const ZephUndoStores& stores,
                        EditToolBarTexts& texts) {
    const bool fixtureSelected = editor.ZephUIState == kStateSelectFixture && objectSelected(editor);
    const std::int32_t level = fixtureOrEmpty(simulation, editor.ZephSelection.Object).ZOrder;
    texts.MoveForwardTip =
        fixtureSelected && level < kLevels ? levelTip("Move Forward", level + 1) : std::string("Move Forward");
    texts.MoveBackwardTip =
        fixtureSelected && level > 1 ? levelTip("Move Backward", level - 1) : std::string("Move Backward");
    texts.Undo = ZephUndoCaptions(stores);
    if (editor.ZephUIState == kStateSelectFixture) texts.ObjectProperties = "Fixture Properties";
    if (editor.ZephUIState == kStateSelectProp) texts.ObjectProperties = "Prop Properties";
}

std::string ZephUpdateStatusBarForUIState(const ZephSimulation& simulation, const ZephEditorState& editor,
                                          bool suppressSelected) {
    if (!simulation.SimulationOpen) return {};
    switch (editor.ZephUIState) {
    case kStateSimulation:
        return "Simulation Active";
    case kStateSelectProp:
        return propText(simulation, editor);
    case kStateSelectFixture:
        return fixtureText(simulation, editor, suppressSelected);
    case kStateDrawing:
        return "Drawing";
    default:
        return {};
    }
}

OptionsBandValues ZephSetOptionsToolbandStuff(const ZephSettings& settings, const ZephSimulation& simulation) {
    return {settings.FixtureTextColor, settings.ToolHandleColor, settings.VertexHandleColor, settings.GridColor,
            settings.ShowGrid, simulation.SimulationOpen ? simulation.Background.PicIntensity : 100,
            // The button means "hide", so it stands pressed where names are not shown.
            settings.DisableFixtureText};
}
