// Saving as the user commands it: the back-up of a file of an older version, the save itself, and what follows it. The
// window hands in its dialog and follows what happened.
#pragma once

#include "model/autosave.h"
#include "model/editor_loader.h"

class SaveFace {
public:
    virtual ~SaveFace() = default;
    // GetZephEditorOutputFilename's dialog, which asks before it takes a file that exists. False when cancelled.
    virtual bool chooseOutputFile(std::string& fullPath) = 0;
    virtual void addRecentFile(std::string_view fullPath) = 0;  // to the top of the list and of the menu
    virtual void documentSaved() = 0;                           // commands (CheckEnable) and window title
};

struct SaveContext {
    const EditorFileContext& files;
    std::string_view createdAt;  // see createdAtNow
    SaveFace& face;
};

// Copies an editor file to the first free of NAME.bak0001 to NAME.bak1000 and tells its name. Where all are taken the
// user is asked. False when nothing is to be saved: the answer was so, or the copy failed, which was told.
[[nodiscard]] bool ZephBackUpUpgradedFile(const std::string& fullPath, Host& host);

// Saves under the document's own name; a document without one is asked for it. The document counts as saved even
// when the disk refused, which was told. True where the file was written.
bool mnuFileSave_Click(const SaveContext& context, ZephSimulation& simulation, AutoSaveState& autosave);
// Asks for the name first. No back-up: the file of the older version stays as it is.
bool mnuFileSaveAs_Click(const SaveContext& context, ZephSimulation& simulation, AutoSaveState& autosave);
