// The check before a run. One physical ribbon or pixel universe may be drawn as several fixtures, each beginning at
// its own physical pixel; the pieces are checked and put together on the main fixture, the one with pixel 1.
#pragma once

#include "engine/render_table.h"

// True if the simulation may go on; the pieces are then assembled. Otherwise every fault was shown in one list and
// nothing was assembled.
bool ValidateKeshs(RenderBuildContext& context);
bool ValidatePixels(RenderBuildContext& context);
