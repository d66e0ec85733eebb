// The scenes of a demo show. Each writes its span of the timeline and leaves the lights as it says.
#pragma once

#include "programs/tool/show_stage.h"

// The display wakes level by level, from left to right, in the colours of its props.
void washScene(ShowStage& stage, ShowSpan span);
// Bright bars run across the whole display, there and back. Leaves everything dim.
void sweepScene(ShowStage& stage, ShowSpan span);
// Spirals climb the pixel props; the circuits of a string chase each other, the rest breathes.
void spiralScene(ShowStage& stage, ShowSpan span);
// The ribbons show their motions, their resolutions and their colour effects on their seven own channels. Ends in the
// dark.
void ribbonScene(ShowStage& stage, ShowSpan span);
// Every second light in turn, by level dumps of the controllers and by commands of 256 steps. Leaves solo lights dark.
void beatScene(ShowStage& stage, ShowSpan span);
// Everything twinkles and glitters.
void finaleScene(ShowStage& stage, ShowSpan span);
// From the foreground to the background every channel fades out, and ribbons return to rest.
void fadeOutScene(ShowStage& stage, ShowSpan span);

// Ends all motions and effects of the ribbons, at their own resolution.
void restRibbons(ShowStage& stage, std::int32_t timeMs);
