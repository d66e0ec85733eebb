#include "editor/object_operations.h"

#include "editor/selection.h"
#include "util/rounding.h"

#include <algorithm>

void markChanged(const ModeContext& context) {
    context.simulation.SimulationDirty = true;
    context.host.setStatusPanel(1, "Changed");
}

void HomeThisObject(const ModeContext& context) {
    const ZephSelectedObject selection = context.editor.ZephSelection;
    const std::int64_t dx = std::int64_t{ZephHandleSize} - selection.Left;
    const std::int64_t dy = std::int64_t{ZephHandleSize} - selection.Top;
    for (const std::int32_t member : fixturesOfObject(selection.Object, context.simulation, context.editor)) {
        if (!context.simulation.Fixtures.contains(member)) continue;
        ZephFixture& fixture = context.simulation.Fixtures[member];
        const int points = std::clamp(fixture.PointCount, 0, kMaxPoints);
        for (int n = 1; n <= points; ++n) {
            fixture.DrawPoints[n].X = saturate(fixture.DrawPoints[n].X + dx);
            fixture.DrawPoints[n].Y = saturate(fixture.DrawPoints[n].Y + dy);
        }
    }
    ZephFoundObject(selection.Object, context);
    context.face.redrawObjects();
    context.face.CheckEnable(false);
}
