// Keeps the editor's state and the undo stores in step with a document that is emptied or loses a fixture.
#pragma once

#include "editor/editor_state.h"
#include "model/undo.h"

class EditorStateWatcher : public DocumentWatcher {
public:
    EditorStateWatcher(ZephEditorState& editor, ZephUndoStores& stores) : editor_(editor), stores_(stores) {}

    void selectionCleared() override { editor_.ZephSelection = {}; }
    void fixtureRemoved(int fixture) override {
        if (editor_.ZephAppendTarget == fixture) editor_.ZephAppendTarget = 0;
        if (editor_.ZephAppendTarget > fixture) --editor_.ZephAppendTarget;
    }
    void objectListChanged() override {}
    void canvasChanged() override {}
    void editSessionReset() override {
        editor_.ZephInProgressFixture = {};
        editor_.ZephInProgressIndex = 0;
        editor_.ZephInProgressAnchor = {};
        editor_.ZephAppendTarget = 0;
    }
    // RedoPosition stays: until the next change, redo brings the old document back.
    void clipboardAndStatusCleared() override {
        editor_.ZephClipboard.clear();
        stores_.UndoPosition = 0;
    }

private:
    ZephEditorState& editor_;
    ZephUndoStores& stores_;
};
