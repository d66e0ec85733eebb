// Saves a fixture or a prop in a file of its own, as the property dialogs command it.
#pragma once

#include "editor/file_dialogs.h"
#include "model/object_files.h"

struct ObjectSaveContext {
    const ObjectSaving& saving;
    FileDialogs& dialogs;
    ZephSettings& settings;  // remembers the file
};

// The fixture as the dialog shows it. Asks for the file and, where there are channels, whether they are saved too.
void cmdSaveAsFixture_Click(const ZephFixture& fixture, const ObjectSaveContext& context);
void cmdSaveAsProp_Click(const ZephSimulation& simulation, const ZephProp& prop, const ObjectSaveContext& context);
