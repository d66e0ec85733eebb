#include "editor/insert_object.h"

#include "editor/limits.h"
#include "editor/object_operations.h"
#include "editor/selection.h"
#include "editor/tool_bar_texts.h"
#include "model/object_files.h"

namespace {

constexpr std::string_view kModule = "frmZephMain";

// One kind of file that can be inserted.
struct InsertKind {
    const FileDialog& dialog;
    std::string ZephSettings::*lastFile;
    std::int32_t action;
    bool (*load)(const std::string&, const EditorFileContext&, ZephSimulation&, bool&);
    std::string_view keepChannels;
};
constexpr InsertKind kFixture{kLoadFixtureFile, &ZephSettings::LastFixtureFile, kUndoInsertedFixture,
                              ZephLoadFixtureFileXML,
                              "The fixture you loaded had one or more channels assigned to it.\r\n"
                              "Do you want to keep these channel assignments?"};
constexpr InsertKind kProp{kLoadPropFile, &ZephSettings::LastPropFile, kUndoInsertedProp, ZephLoadPropFileXML,
                           "The prop you loaded had one or more channels assigned to the fixtures attached to it.\r\n"
                           "Do you want to keep these channel assignments?"};

void makeBulbs(int before, const EditContext& context) {
    const ZephSimulation& simulation = context.modes.simulation;
    for (int fixture = before + 1; fixture <= simulation.FixtureCount; ++fixture)
        ZephCreateStaticFixtureBulbs(simulation.Fixtures[fixture], context.masks, context.bulbs[fixture]);
}

void askToKeepChannels(const InsertKind& kind, int before, const ModeContext& context) {
    if (context.host.messageBox(boxTitle("-Keep Channels"), kind.keepChannels, BoxIcon::Question, BoxButtons::YesNo) !=
        BoxAnswer::No) {
        return;
    }
    for (int n = before + 1; n <= context.simulation.FixtureCount; ++n) {
        ZephFixture& fixture = context.simulation.Fixtures[n];
        fixture.Channels.fill(ZephChannel{});
        fixture.ChannelCount = 0;
    }
}

// Asks, records, loads. False where nothing came in.
bool bringIn(const InsertKind& kind, const EditContext& context) {
    ZephSimulation& simulation = context.modes.simulation;
    std::string path;
    if (!context.dialogs.chooseInput(kind.dialog, path)) return false;
    context.settings.*kind.lastFile = path;

    const int before = simulation.FixtureCount;
    std::int32_t action = kind.action;
    bool channelsSeen = false;
    ZephStartUndoTransaction(context.stores);
    if (!ZephAddUndoDataXML(action, before + 1, "", false, context.undo, simulation, context.stores)) return false;
    if (!kind.load(path, context.undo.files, simulation, channelsSeen)) {
        ZephRollbackUndo(context.stores);
        // Of a prop that fails on the way the fixtures read so far stay, and then they are to be seen.
        if (simulation.FixtureCount != before) {
            makeBulbs(before, context);
            context.modes.face.ZephLoadUIObjectList();
            context.modes.face.redrawObjects();
            markChanged(context.modes);
        }
        return false;
    }
    ZephCommitUndo(context.stores);
    if (channelsSeen) askToKeepChannels(kind, before, context.modes);
    makeBulbs(before, context);
    return true;
}

// Selects what came in, in the state that its kind is selected in.
void showInserted(int state, std::int32_t object, const ModeContext& context) {
    ZephSwitchMode(state, context.editor.ZephDrawTool, context);
    TogglePropFixtureButtons(state, context.editor, context.face);
    ZephFoundObject(object, context);
    HomeThisObject(context);
}

void tellInserted(const ModeContext& context) {
    markChanged(context);
    context.host.setStatusPanel(2, ZephUpdateStatusBarForUIState(context.simulation, context.editor, false));
}

}  // namespace

void mnuInsertFixture_Click(const EditContext& context) try {
    const ModeContext& modes = context.modes;
    if (!editable(modes) || !fixtureFits(modes.simulation, modes.host)) return;
    if (bringIn(kFixture, context)) {
        showInserted(kStateSelectFixture, modes.simulation.FixtureCount, modes);
        tellInserted(modes);
    }
    modes.face.CheckEnable(false);
}
ZEPH_GUARD(context.modes.failures, kModule, )

void mnuInsertProp_Click(const EditContext& context) try {
    const ModeContext& modes = context.modes;
    if (!editable(modes) || !propFits(modes.simulation, modes.host) || !fixtureFits(modes.simulation, modes.host)) {
        return;
    }
    if (bringIn(kProp, context)) {
        const ZephProp& prop = modes.simulation.Props[modes.simulation.PropCount];
        if (prop.Object[1] > 0) showInserted(kStateSelectProp, prop.Object[1], modes);
        tellInserted(modes);
    }
    modes.face.CheckEnable(false);
}
ZEPH_GUARD(context.modes.failures, kModule, )
