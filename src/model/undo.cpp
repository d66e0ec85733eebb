#include "model/undo.h"

#include "model/ui_state.h"

namespace {

constexpr std::string_view kUndoModule = "modZephUndo";

std::int32_t upperBound(const std::vector<ZephUndoEntry>& store) {
    return static_cast<std::int32_t>(store.size()) - 1;
}

void cut(std::int32_t newUpperBound, std::vector<ZephUndoEntry>& store) {
    store.resize(static_cast<std::size_t>(newUpperBound) + 1);
}

const ZephUndoEntry& entryAt(const std::vector<ZephUndoEntry>& store, std::int32_t slot) {
    return store.at(static_cast<std::size_t>(slot));
}

bool isLevelStep(std::int32_t action) {
    return action == kUndoMovedForward || action == kUndoMovedBackward;
}

DocumentSnapshot keepDocument(const UndoContext& context, const ZephSimulation& simulation, ZephUndoStores& stores) {
    stores.Latest = takeSnapshot(simulation, context.files.paths, stores.Latest);
    return stores.Latest;
}

// The state before an undo, described as the step that is undone.
void AddRedoData(const UndoContext& context, const ZephSimulation& simulation, ZephUndoStores& stores) {
    ZephUndoEntry entry = entryAt(stores.UndoStore, stores.UndoPosition);
    entry.Document = keepDocument(context, simulation, stores);
    cut(stores.RedoPosition, stores.RedoStore);
    stores.RedoStore.push_back(std::move(entry));
    ++stores.RedoPosition;
}

void switchTo(std::int32_t mode, const UndoContext& context) {
    if (mode != 0 && mode != context.ZephUIState) context.face.switchMode(mode);
}

// A failure of the load has been told; the document then stays partial, and the step is used up all the same.
void putBack(const DocumentSnapshot& document, const UndoContext& context, ZephSimulation& simulation,
             ZephUndoStores& stores) {
    context.files.watcher.selectionCleared();
    const ZephBackground before = simulation.Background;
    ZephGlobalReset(true, simulation, context.files.watcher);
    stores.Latest = document;
    static_cast<void>(ZephLoadVisualizerXML(document, true, context.files, simulation));
    context.face.documentReplaced(!(simulation.Background == before));
}

std::string captioned(std::string_view word, std::string_view between, const std::vector<ZephUndoEntry>& store,
                      std::int32_t position) {
    if (position < 1) return std::string(word);
    return std::string(word).append(between).append(entryAt(store, position).Text);
}

}  // namespace

void ZephStartUndoTransaction(ZephUndoStores& stores) {
    cut(stores.UndoPosition, stores.UndoStore);
}

bool ZephAddUndoDataXML(std::int32_t& action, int objectIndex, std::string_view comment, bool keepRedo,
                        const UndoContext& context, const ZephSimulation& simulation, ZephUndoStores& stores) try {
    if (isLevelStep(action) && stores.UndoPosition > 0 &&
        entryAt(stores.UndoStore, stores.UndoPosition).Action == action) {
        return true;
    }
    if (!keepRedo) {
        cut(0, stores.RedoStore);
        stores.RedoPosition = 0;
    }
    ZephUndoEntry entry;
    entry.Document = keepDocument(context, simulation, stores);
    if (context.ZephUIState == kStateSelectProp) action = undoActionOnProps(action);
    const int forcedMode = undoActionRow(action).forcedMode;
    entry.Action = action;
    entry.EditorMode = forcedMode != 0 ? forcedMode : context.ZephUIState;
    entry.ObjectIndex = objectIndex;
    entry.Text = undoText(action, objectIndex, comment, simulation);
    stores.UndoStore.push_back(std::move(entry));
    return true;
}
ZEPH_GUARD(context.files.failures, kUndoModule, false)

void ZephCommitUndo(ZephUndoStores& stores) {
    const std::int32_t surplus = upperBound(stores.UndoStore) - kMaxUndo;
    if (surplus > 0) stores.UndoStore.erase(stores.UndoStore.begin() + 1, stores.UndoStore.begin() + 1 + surplus);
    stores.UndoPosition = upperBound(stores.UndoStore);
}

void ZephRollbackUndo(ZephUndoStores& stores) {
    cut(stores.UndoPosition, stores.UndoStore);
}

bool ZephUndoLastAction(const UndoContext& context, ZephSimulation& simulation, ZephUndoStores& stores,
                        bool& restoreProperties) try {
    restoreProperties = false;
    if (stores.UndoPosition < 1) return true;
    AddRedoData(context, simulation, stores);
    const ZephUndoEntry step = entryAt(stores.UndoStore, stores.UndoPosition);
    switchTo(step.EditorMode, context);
    putBack(step.Document, context, simulation, stores);
    --stores.UndoPosition;
    cut(stores.UndoPosition, stores.UndoStore);
    return true;
}
ZEPH_GUARD(context.files.failures, kUndoModule, false)

bool ZephRedoLastAction(const UndoContext& context, ZephSimulation& simulation, ZephUndoStores& stores,
                        bool& restoreProperties) try {
    restoreProperties = false;
    if (stores.RedoPosition < 1) return true;
    const ZephUndoEntry step = entryAt(stores.RedoStore, stores.RedoPosition);
    switchTo(step.EditorMode, context);
    ZephStartUndoTransaction(stores);
    // Object 0: the entry is known by its bare text, as users have come to know it.
    std::int32_t action = step.Action;
    if (!ZephAddUndoDataXML(action, 0, "", true, context, simulation, stores)) return false;
    ZephCommitUndo(stores);
    putBack(step.Document, context, simulation, stores);
    --stores.RedoPosition;
    cut(stores.RedoPosition, stores.RedoStore);
    return true;
}
ZEPH_GUARD(context.files.failures, kUndoModule, false)

UndoCaptions ZephUndoCaptions(const ZephUndoStores& stores) {
    const auto undo = [&](std::string_view between) {
        return captioned("Undo", between, stores.UndoStore, stores.UndoPosition);
    };
    const auto redo = [&](std::string_view between) {
        return captioned("Redo", between, stores.RedoStore, stores.RedoPosition);
    };
    return {undo(" "), undo(": "), redo(" "), redo(": ")};
}
