// Fixtures as the editor shows them: their bulbs at the present points, in colour or as silhouettes. Drawn from the
// records as they change, so nothing needs to be compiled first; only the fixtures' static images must be up to date.
#pragma once

#include "engine/bulb_images.h"
#include "model/simulation.h"

#include <QImage>

#include <cstdint>

struct EditorLightsContext {
    const ZephSimulation& Document;
    const ZephStaticBulbs& Bulbs;
    const ZephDimmingCurve& Curve;
    bool EditInColor = false;  // the setting of that name
};

// A fixture (1..FixtureCount) as its level and the settings have it: all channels in colour, or one silhouette; dimmed
// on a level that is closed to editing, and not at all where such levels are hidden. canvas: Format_RGB32, canvas
// pixels; bulbs are cut at its edges. Other numbers and formats draw nothing.
void ZephDrawEditorLights(const EditorLightsContext& context, std::int32_t fixture, QImage& canvas);

struct LightsDraw {
    std::int32_t Fixture = 0;
    std::int32_t Channel = 1;
    std::int32_t Intensity = 0;    // 0..100
    bool DrawBlack = false;        // a silhouette
    std::int32_t PixelNumber = 0;  // draws this point alone, unless the fixture has no such point; not for strings
};

// The bulbs of one channel. A fixture without channels is drawn as a silhouette.
void ZephDrawLights(const EditorLightsContext& context, const LightsDraw& draw, QImage& canvas);
