// The commands that give a display its canvas: a new simulation, the background's properties, and finding a picture
// again. They decide and apply; the window opens the dialogs.
#pragma once

#include "editor/background.h"
#include "shell/simulation_mode.h"

class FileFace;

// How the background dialog is opened.
struct BackgroundTerms {
    bool AllowCancel = true;
    bool NewSimulation = false;  // there is no canvas yet whose size could be told
};

// The surfaces become the program's.
void installBackground(const ZephBackgroundSurfaces& surfaces, Program& program);

// mnuFileNew: asks about unsaved work, then for the new display. False where the user thought better of it; the old
// display is then as it was.
bool ZephNewSimulation(Program& program, SimulationFace& face, FileFace& window);

// Opens the background dialog and applies what comes back: record, points, surfaces, options of the grid. Records no
// undo step. False where it was cancelled or failed.
bool ZephChangeBackgroundProperties(const BackgroundTerms& terms, Program& program, SimulationFace& face,
                                    FileFace& window);

// After the picture of the document was not found: lets the user show where it is. Until a picture is chosen, the
// stored name stays.
void offerOtherPicture(Program& program, SimulationFace& face, FileFace& window);
