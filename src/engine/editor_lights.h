// The lights as the editor shows them: straight from the points of the document, without a render table.
#pragma once

#include "engine/bulb_images.h"
#include "model/dimming_curve.h"
#include "model/settings.h"

#include <QImage>

struct EditorLights {
    const ZephSimulation& simulation;
    const ZephSettings& settings;
    const ZephDimmingCurve& curve;
    const ZephStaticBulbs& bulbs;
};

// Paints one fixture: in colour or as a silhouette, at full strength or dimmed where its level is closed to editing.
// target: Format_RGB32, canvas size.
void ZephDrawEditorLights(const EditorLights& lights, int fixture, QImage& target);

// Paints the bulbs of one channel, 1..16, at an intensity of 0..100. drawBlack: as a silhouette. pixelNumber: that
// point alone, for fixtures whose points are bulbs; 0 = all.
void ZephDrawLights(const EditorLights& lights, int fixture, int channel, std::int32_t intensity, bool drawBlack,
                    std::int32_t pixelNumber, QImage& target);
