// The place of the main window between two runs. The settings hold it in twips, the window has it in pixels.
#pragma once

#include "model/settings.h"

#include <QRect>

// The place moved, and where need be shrunk, so that it lies in what is available.
QRect placedInside(const QRect& wanted, const QRect& available);

// Where the window is to stand, in pixels. available: the part of its screen that windows may cover.
QRect ZephWindowPlace(const ZephSettings& settings, const QRect& available);

// Keeps the place for the next run. place: of the window when it is neither maximised nor minimised, pixels.
// state: 0 normal, 1 minimised, 2 maximised.
void ZephKeepWindowPlace(const QRect& place, int state, ZephSettings& settings);
