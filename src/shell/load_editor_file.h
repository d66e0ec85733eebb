// The one door through which an editor file reaches the document in normal use.
#pragma once

#include "editor/background_change.h"
#include "editor/new_simulation.h"
#include "shell/background_commands.h"
#include "shell/simulation_mode.h"

// What opening a file and giving it a canvas ask of the window besides the simulation's face. A dialog gets a copy and
// gives back what it became, or nothing.
class FileFace {
public:
    virtual ~FileFace() = default;
    virtual void showDocument() = 0;     // a new canvas: size, scroll position, lay-out
    virtual void showOptionsBand() = 0;  // the options and the brightness are others now
    virtual std::optional<ZephNewSimulationChoice> showNewSimulation() = 0;
    virtual std::optional<ZephBackgroundDraft> showBackground(const ZephBackgroundDraft& draft,
                                                              const BackgroundTerms& terms) = 0;
    // The file that takes the place of a missing picture; "" for none.
    virtual std::string findPicture(const std::string& missing) = 0;
    virtual void setTitle(std::string_view windowTitle) = 0;
};

// Loads FilePath + FileName of the document. quiet: no message boxes of the loader. False where it failed: the window
// then stays empty.
bool LoadEditorFile(bool quiet, Program& program, SimulationFace& face, FileFace& window);

// Takes a path, absolute or relative to the working folder, apart into FilePath and FileName of the document.
void setEditorFile(std::string_view path, ZephSimulation& simulation);
