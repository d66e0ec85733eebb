#include "shell/shutdown.h"

#include "shell/startup.h"
#include "shell/window_place.h"

namespace {

constexpr const char* kModule = "frmZephMain";

// True: go on closing.
bool mayDropDocument(Program& program, ShutdownFace& face) {
    if (!program.simulation->SimulationDirty) return true;
    const BoxAnswer answer = program.seams.host.messageBox(
        boxTitle("-Quit?"), "This editor session has not been saved.  Save the file before exiting? ",
        BoxIcon::Question, BoxButtons::YesNoCancel);
    if (answer == BoxAnswer::Cancel) return false;
    // Work that was to be saved and was not is no work to drop.
    return answer == BoxAnswer::No || face.saveDocument();
}

void storeSettings(Program& program, ShutdownFace& face) {
    ZephKeepWindowPlace(face.windowPlace(), face.windowState(), program.settings);
    SaveCoolbar(face.toolBands(), program.seams.store);
    ZephWriteClosingRegistry(registryContext(program), program.settings, true);
}

}  // namespace

bool Form_Unload(Program& program, SimulationFace& simulation, ShutdownFace& face) try {
    if (program.simulating()) {
        EndSimulation(program, simulation);
        if (program.settings.EndStopsSimulation) return false;  // a second close leaves
    }
    face.restoreIfMinimized();
    program.seams.host.pumpEvents();
    if (program.editor.ZephUIState != kStateSelectFixture) ZephSwitchMode(kStateSelectFixture, program, simulation);
    if (!mayDropDocument(program, face)) return false;

    face.stopTimers();
    program.seams.socket.Close();
    ZephGetDataFromStack(program.seams.socket, program.failures, program.receive);
    storeSettings(program, face);
    ZephWriteVisPid(0, program.seams.store);
    return true;
}
// A failure on the way must not lock the user in.
ZEPH_GUARD(program.failures, kModule, true)
