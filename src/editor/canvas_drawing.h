// Composes the editor's canvas: the background and, over it, the fixtures by level. Drawn on an image, without a
// window.
#pragma once

#include "engine/editor_lights.h"
#include "model/settings.h"

struct EditorCanvas {
    const ZephSimulation& simulation;
    const ZephSettings& settings;
    const ZephDimmingCurve& curve;
    const ZephStaticBulbs& bulbs;
    const QImage& picBackground;  // null = no canvas
};

// picBuffer becomes the background with every fixture on it, level 1 to 16 and fixture 1 to FixtureCount within a
// level; null where there is no canvas.
void ZephRedrawObjects(const EditorCanvas& canvas, QImage& picBuffer);
