// What the commands that change the document work with: the document and its surroundings, as one record of references
// that the window makes once.
#pragma once

#include "editor/file_dialogs.h"
#include "editor/mode_switch.h"
#include "engine/bulb_images.h"
#include "model/undo.h"

struct EditContext {
    ModeContext modes;  // the document, the editor's state, host and window
    UndoContext undo;
    ZephUndoStores& stores;
    ZephSettings& settings;  // remembers where fixture and prop files lay
    FileDialogs& dialogs;
    const ZephMasks& masks;
    ZephStaticBulbs& bulbs;
};
