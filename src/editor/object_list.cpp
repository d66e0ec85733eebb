#include "editor/object_list.h"

#include "editor/selection.h"
#include "editor/tool_bar_texts.h"
#include "model/document.h"
#include "util/text.h"

namespace {

ZephListEntry fixtureEntry(const ZephFixture& fixture, std::int32_t object) {
    return {lowerCase(fixture.Name), object, fixture.Name, fixture.Locked};
}

ZephListEntry memberEntry(const ZephFixture& fixture, const ZephProp& prop, bool simple, std::int32_t object) {
    if (simple) return {prop.Name, object, prop.Name, prop.Locked};
    const std::string text = prop.Name + "\n(" + fixture.Name + ")";
    return {lowerCase(text), object, text, prop.Locked};
}

}  // namespace

std::vector<ZephListEntry> ZephListIndex(const ZephSimulation& simulation, const ZephEditorState& editor) {
    std::vector<ZephListEntry> rows;
    if (!simulation.SimulationOpen) return rows;
    for (std::int32_t object = 1; object <= simulation.FixtureCount; ++object) {
        const ZephFixture& fixture = simulation.Fixtures[object];
        if (editor.ZephUIState != kStateSelectProp || fixture.AssignedItem < 1) {
            rows.push_back(fixtureEntry(fixture, object));
            continue;
        }
        const ZephProp& prop = propOrEmpty(simulation, fixture.AssignedItem);
        if (editor.SimplePropMode && prop.Object[1] != object) continue;
        rows.push_back(memberEntry(fixture, prop, editor.SimplePropMode, object));
    }
    std::ranges::stable_sort(rows, {}, &ZephListEntry::SortKey);
    return rows;
}

bool listTakesClicks(const ZephSimulation& simulation, const ZephEditorState& editor) noexcept {
    return simulation.SimulationOpen && editor.ZephUIState != kStateSimulation && !drawingInProgress(editor);
}

void flgObjectSelect_Click(std::int32_t object, const ModeContext& context) try {
    ZephEditorState& editor = context.editor;
    if (!listTakesClicks(context.simulation, editor)) return;
    if (editor.ZephUIState == kStateDrawing) ZephSwitchMode(kStateSelectFixture, editor.ZephDrawTool, context);
    context.face.ZephDeselectflg();
    // The list is the way to reach an object that is locked, so it can be edited until the canvas selects another.
    editor.ZephIgnoreLocks = true;
    ZephFoundObject(object, context);
    context.face.redrawObjects();
    context.host.setStatusPanel(2, ZephUpdateStatusBarForUIState(context.simulation, editor, false));
    context.face.CheckEnable(false);
}
ZEPH_GUARD(context.failures, "frmZephMain", )
