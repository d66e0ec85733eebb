// A simulation that begins empty: what its dialog asks for, and the document that comes of it. No windows here.
#pragma once

#include "model/document.h"

#include <QSize>

#include <string>
#include <string_view>

struct ZephNewSimulationChoice {
    std::int32_t BackgroundType = 0;
    std::string BackgroundFileName;  // full path, of type kBackgroundPicture only
    std::int32_t WidthPixels = 0;
    std::int32_t HeightPixels = 0;
    std::int32_t WidthTwips = 0;
    std::int32_t HeightTwips = 0;
};

// The largest number that the size boxes hold: their mask has four digits.
inline constexpr int kMostMaskPixels = 9999;

// A typed size: digits, "" = 0.
std::int32_t maskPixels(std::string_view typed) noexcept;
// The size as it goes into the boxes: no side above kMostMaskPixels, the proportions kept.
QSize withinMask(QSize size) noexcept;

// CheckEnable of the dialog: both sizes are set and, for a picture, a file is chosen.
bool ZephNewSimulationComplete(const ZephNewSimulationChoice& choice) noexcept;

// The record of the choice. Only a picture keeps a file name.
ZephBackground backgroundOf(const ZephNewSimulationChoice& choice);

// Empties the document, selection and clipboard included, and begins a clean one, which has no file yet, on this
// background. SimulationOpen is left to the caller.
void beginSimulation(const ZephBackground& background, ZephSimulation& simulation, DocumentWatcher& watcher);
