// Undo and redo. A step is the whole document as it was before the change. Every change follows the same order:
//   ZephStartUndoTransaction, ZephAddUndoDataXML (once or more), the change, then ZephCommitUndo, or ZephRollbackUndo
//   where the change was given up.
// Called by every command that changes the document. Entries count from 1; slot 0 of both stores exists and is unused.
#pragma once

#include "model/editor_loader.h"
#include "model/undo_actions.h"

inline constexpr int kMaxUndo = 20;

struct ZephUndoEntry {
    std::int32_t Action = 0;       // kUndo...
    std::string Text;              // shown in the menu
    std::int32_t EditorMode = 0;   // the ZephUIState to return to, 0 = stay
    std::int32_t ObjectIndex = 0;  // fixture or prop that the change was on, when it was made
    DocumentSnapshot Document;     // as it was before
};

struct ZephUndoStores {
    std::vector<ZephUndoEntry> UndoStore = std::vector<ZephUndoEntry>(1);
    std::vector<ZephUndoEntry> RedoStore = std::vector<ZephUndoEntry>(1);
    // Committed entries. Behind UndoPosition stand those of a transaction under way, or left open. A new or a loaded
    // document starts with UndoPosition 0: the watcher sets it in clipboardAndStatusCleared. RedoPosition stays then,
    // so that redo brings the old document back until the next change.
    std::int32_t UndoPosition = 0;
    std::int32_t RedoPosition = 0;
    DocumentSnapshot Latest;  // taken or restored last: the next one shares what did not change since
};

// What undo and redo ask of the window.
class UndoFace {
public:
    virtual ~UndoFace() = default;
    virtual void switchMode(int uiState) = 0;
    // Everything that is made from the records: bulbs of every fixture, object list, canvas, tools and, where the
    // record of the background is another one now, its picture, which takes longer than all the rest.
    virtual void documentReplaced(bool backgroundChanged) = 0;
};

struct UndoContext {
    const EditorFileContext& files;
    const int& ZephUIState;
    UndoFace& face;
};

void ZephStartUndoTransaction(ZephUndoStores& stores);

// Keeps the document as it is, before the change. While props are selected, action changes to the code for props. A
// step in the order of levels right behind another one makes no entry. keepRedo false empties the redo store, even
// when the change is then rolled back. False where the document could not be kept, which is reported; no entry then.
bool ZephAddUndoDataXML(std::int32_t& action, int objectIndex, std::string_view comment, bool keepRedo,
                        const UndoContext& context, const ZephSimulation& simulation, ZephUndoStores& stores);

void ZephCommitUndo(ZephUndoStores& stores);
void ZephRollbackUndo(ZephUndoStores& stores);

// Bring the document before the last change back, or the one before the last undo; nothing where there is none. They
// leave SimulationDirty as it is. restoreProperties always comes back false. False where they failed, which is
// reported.
bool ZephUndoLastAction(const UndoContext& context, ZephSimulation& simulation, ZephUndoStores& stores,
                        bool& restoreProperties);
bool ZephRedoLastAction(const UndoContext& context, ZephSimulation& simulation, ZephUndoStores& stores,
                        bool& restoreProperties);

// What the menus and the tool bar show.
struct UndoCaptions {
    std::string undoItem = "Undo";  // mnuUndo, popUndo
    std::string undoTip = "Undo";
    std::string redoItem = "Redo";  // mnuRedo, popRedo
    std::string redoTip = "Redo";
};
UndoCaptions ZephUndoCaptions(const ZephUndoStores& stores);
