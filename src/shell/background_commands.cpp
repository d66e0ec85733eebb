#include "shell/background_commands.h"

#include "editor/background_change.h"
#include "editor/new_simulation.h"
#include "editor/picture_file.h"
#include "editor/tool_bar_texts.h"
#include "shell/load_editor_file.h"
#include "shell/startup.h"

namespace {

constexpr std::string_view kModule = "BackgroundCommands";

void applyBackground(const ZephBackground& edited, Program& program, SimulationFace& face, FileFace& window) {
    ZephSimulation& simulation = *program.simulation;
    const bool resized = ZephTakeBackground(edited, simulation);
    Host& host = program.seams.host;
    {
        const BusyPointer busy(host);
        installBackground(loadBackground(simulation, program.seams.programFolder, BackgroundTexts::Change, host),
                          program);
    }
    program.editor.ZephSelection = {};
    face.ZephDeselectflg();
    host.setStatusPanel(2, ZephUpdateStatusBarForUIState(simulation, program.editor, false));
    face.redrawObjects();
    if (resized) window.showDocument();
    if (simulation.SimulationOpen) host.setStatusPanel(1, "Changed");
}

// The background of a new simulation, held to the limit; nothing where the user gives up.
std::optional<ZephBackground> newBackground(Program& program, FileFace& window) {
    const std::optional<ZephNewSimulationChoice> choice = window.showNewSimulation();
    if (!choice) return std::nullopt;
    const ZephBackground background = backgroundOf(*choice);
    if (ZephCheckBackground(background, program.seams.host)) return background;
    const std::optional<ZephBackgroundDraft> held =
        window.showBackground(ZephBackgroundDraftOf(background, program.settings), {true, true});
    if (!held) return std::nullopt;
    takeGridOptions(*held, program.settings);
    return held->Background;
}

}  // namespace

void installBackground(const ZephBackgroundSurfaces& surfaces, Program& program) {
    program.Picture3 = surfaces.Picture3;
    program.picBackground = surfaces.picBackground;
}

bool ZephNewSimulation(Program& program, SimulationFace& face, FileFace& window) try {
    ZephSimulation& simulation = *program.simulation;
    Host& host = program.seams.host;
    if (simulation.SimulationDirty &&
        host.messageBox(boxTitle("-Save?"),
                        "This editor session has not been saved.  Are you sure you want to start a new one?",
                        BoxIcon::Question, BoxButtons::YesNo) != BoxAnswer::Yes) {
        return false;
    }
    const std::optional<ZephBackground> background = newBackground(program, window);
    if (!background) return false;
    beginSimulation(*background, simulation, program.watcher);
    program.autosave.Tag = 0;
    ZephRebuildStaticFixtureBulbs(simulation, *program.masks, *program.bulbs);
    installBackground(ZephResetBackground(simulation, program.seams.programFolder, host), program);
    simulation.SimulationOpen = true;
    host.setStatusPanel(1, "");
    ZephSwitchMode(kStateSelectFixture, program, face);
    window.showDocument();
    window.setTitle(ZephWindowTitle(""));
    return true;
}
ZEPH_GUARD(program.failures, kModule, false)

bool ZephChangeBackgroundProperties(const BackgroundTerms& terms, Program& program, SimulationFace& face,
                                    FileFace& window) try {
    const ZephBackground before = program.simulation->Background;
    const std::optional<ZephBackgroundDraft> edited =
        window.showBackground(ZephBackgroundDraftOf(before, program.settings), terms);
    if (!edited) return false;
    takeGridOptions(*edited, program.settings);
    if (edited->Background == before && !edited->PictureChosen) {
        face.redrawObjects();  // the grid is no part of the display
    } else {
        applyBackground(edited->Background, program, face, window);
    }
    window.showOptionsBand();
    return true;
}
ZEPH_GUARD(program.failures, kModule, false)

void offerOtherPicture(Program& program, SimulationFace& face, FileFace& window) try {
    const ZephBackground& stored = program.simulation->Background;
    for (;;) {
        const std::string file = window.findPicture(stored.PicFileName);
        if (file.empty()) return;
        if (loadPicture(file).isNull()) {
            tellBadPicture(program.seams.host);
            continue;
        }
        ZephBackground found = stored;
        found.PicFileName = file;
        applyBackground(found, program, face, window);
        return;
    }
}
ZEPH_GUARD(program.failures, kModule, )
