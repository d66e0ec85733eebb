// What the main window does for documents: it shows where they are saved, when they save themselves, and what undo and
// redo bring back.
#include "editor/background.h"
#include "model/editor_elements.h"
#include "shell/main_window.h"
#include "shell/recent_files.h"

EditContext frmZephMain::editContext() {
    return {modes_.context(), {program_.files, program_.editor.ZephUIState, *this},
            program_.undo,    program_.settings,
            dialogs_,         *program_.masks,
            *program_.bulbs};
}

bool frmZephMain::mnuFileSave_Click() {
    takeIntensity();  // the autosave comes here without a command
    const std::string now = createdAtNow();
    return ::mnuFileSave_Click({program_.files, now, *this}, *program_.simulation, program_.autosave);
}

void frmZephMain::mnuFileSaveAs_Click() {
    const std::string now = createdAtNow();
    ::mnuFileSaveAs_Click({program_.files, now, *this}, *program_.simulation, program_.autosave);
}

bool frmZephMain::chooseOutputFile(std::string& fullPath) {
    return dialogs_.chooseOutput(kSaveEditorFile, fullPath);
}

void frmZephMain::addRecentFile(std::string_view fullPath) {
    ZephUpdateRecentFilesList(fullPath, program_.settings);
    UpdateRecentFileMenu();
}

void frmZephMain::documentSaved() {
    CheckEnable(false);
    setTitle(ZephWindowTitle(program_.simulation->FileName));
}

bool frmZephMain::saveDocument() {
    if (mnuFileSave_Click()) return true;
    // The window stays, and what could not be saved is asked for again when it closes the next time.
    markChanged(modes_.context());
    return false;
}

void frmZephMain::tmrAutoSave_Timer() {
    ::tmrAutoSave_Timer({program_.settings, *program_.simulation, program_.editor.ZephUIState,
                         drawingInProgress(program_.editor), host_, program_.failures, *this},
                        program_.autosave);
}

std::string frmZephMain::statusPanel2() {
    return StatusBar1_->panel(2).toStdString();
}

void frmZephMain::save() {
    mnuFileSave_Click();
}

void frmZephMain::switchMode(int uiState) {
    ZephSwitchMode(uiState == kStateDrawing ? kModeDrawing : uiState, program_, *this);
}

void frmZephMain::documentReplaced(bool backgroundChanged) {
    ZephRebuildStaticFixtureBulbs(*program_.simulation, *program_.masks, *program_.bulbs);
    if (backgroundChanged) {
        installBackground(ZephResetBackground(*program_.simulation, program_.seams.programFolder, host_), program_);
    }
    ZephLoadUIObjectList();
    redrawObjects();
    showOptionsBand();
}
