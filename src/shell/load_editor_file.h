// The one door through which an editor file reaches the document in normal use.
#pragma once

#include "shell/simulation_mode.h"

// What opening a file asks of the window besides the simulation's face.
class FileFace {
public:
    virtual ~FileFace() = default;
    virtual void showDocument() = 0;  // a new canvas: size, scroll position, lay-out
    virtual void setTitle(std::string_view windowTitle) = 0;
};

// Loads FilePath + FileName of the document. quiet: no message boxes of the loader. False where it failed: the window
// then stays empty.
bool LoadEditorFile(bool quiet, Program& program, SimulationFace& face, FileFace& window);

// Takes a path, absolute or relative to the working folder, apart into FilePath and FileName of the document.
void setEditorFile(std::string_view path, ZephSimulation& simulation);
