#include "editor/selection.h"

#include "model/document.h"
#include "util/rounding.h"

#include <algorithm>

namespace {

// Widens the box; the first point is the box.
void include(const ZephFixture& fixture, bool& first, ZephBox& box) {
    const bool sized = fixture.Fixture_Type != kFixtureStrings;
    const std::int64_t halfWidth = sized ? std::int64_t{fixture.BulbSize} * TwipsPerPixelX : 0;
    const std::int64_t halfHeight = sized ? std::int64_t{fixture.BulbSize} * TwipsPerPixelY : 0;
    const int points = std::clamp(fixture.PointCount, 0, kMaxPoints);
    for (int n = 1; n <= points; ++n) {
        const ZephDrawPoint& point = fixture.DrawPoints[n];
        const ZephBox around{saturate(point.X - halfWidth), saturate(point.Y - halfHeight),
                             saturate(point.X + halfWidth), saturate(point.Y + halfHeight)};
        box = first ? around
                    : ZephBox{std::min(box.Left, around.Left), std::min(box.Top, around.Top),
                              std::max(box.Right, around.Right), std::max(box.Bottom, around.Bottom)};
        first = false;
    }
}

}  // namespace

std::vector<std::int32_t> fixturesOfObject(std::int32_t object, const ZephSimulation& simulation,
                                           const ZephEditorState& editor) {
    const std::int32_t owner = fixtureOrEmpty(simulation, object).AssignedItem;
    if (editor.ZephUIState != kStateSelectProp || owner < 1) return {object};
    const ZephProp& prop = propOrEmpty(simulation, owner);
    const int members = std::clamp(prop.AssignedCount, 0, kMaxFixturesInProp);
    return {prop.Object.begin(), prop.Object.begin() + members};
}

void ZephFindObjectMinMax(std::int32_t object, bool wholeFixtureOnly, const ZephSimulation& simulation,
                          const ZephEditorState& editor, ZephBox& box) {
    bool first = true;
    for (const std::int32_t member :
         wholeFixtureOnly ? std::vector<std::int32_t>{object} : fixturesOfObject(object, simulation, editor)) {
        const ZephFixture& fixture = fixtureOrEmpty(simulation, member);
        if (!fixture.Locked || editor.ZephIgnoreLocks) include(fixture, first, box);
    }
}

void ZephFoundObject(std::int32_t object, const ModeContext& context) {
    ZephEditorState& editor = context.editor;
    const std::int32_t owner = fixtureOrEmpty(context.simulation, object).AssignedItem;
    if (editor.SimplePropMode && editor.ZephUIState == kStateSelectProp && owner > 0) {
        object = propOrEmpty(context.simulation, owner).Object[1];
    }
    ZephSelectedObject& selection = editor.ZephSelection;
    selection.Object = object;
    context.face.ZephHighlightflg(object);
    ZephBox box{selection.Left, selection.Top, selection.Right, selection.Bottom};
    ZephFindObjectMinMax(object, false, context.simulation, editor, box);
    selection.Left = box.Left;
    selection.Top = box.Top;
    selection.Right = box.Right;
    selection.Bottom = box.Bottom;
}
