// Keeps the editor's state in step with a document that is emptied or loses a fixture.
#pragma once

#include "editor/editor_state.h"
#include "model/document.h"

class EditorStateWatcher : public DocumentWatcher {
public:
    explicit EditorStateWatcher(ZephEditorState& editor) : editor_(editor) {}

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
    void clipboardAndStatusCleared() override {}

private:
    ZephEditorState& editor_;
};
