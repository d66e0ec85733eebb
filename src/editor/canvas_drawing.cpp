#include "editor/canvas_drawing.h"

#include <algorithm>

void ZephRedrawObjects(const EditorCanvas& canvas, QImage& picBuffer) {
    picBuffer = canvas.picBackground;
    if (picBuffer.isNull()) return;
    picBuffer.detach();
    const EditorLightsContext lights{canvas.simulation, canvas.bulbs, canvas.curve, canvas.settings.EditInColor};
    const int fixtures = std::clamp(canvas.simulation.FixtureCount, 0, kMaxFixtures);
    for (int level = 1; level <= kLevels; ++level) {
        for (int fixture = 1; fixture <= fixtures; ++fixture) {
            if (canvas.simulation.Fixtures[fixture].ZOrder == level) ZephDrawEditorLights(lights, fixture, picBuffer);
        }
    }
}
