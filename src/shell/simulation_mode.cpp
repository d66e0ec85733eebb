#include "shell/simulation_mode.h"

namespace {

void refuseBackwardClock(Host& host) {
    host.messageBox(
        boxTitle("-Error:  Reboot Required"),
        "Can not enter simulation mode:  Time is running backwards.\r\n\r\n"
        "The visualizer can not enter simulation mode since Windows is reporting that time is running backwards.  This "
        "is usually caused by not having rebooted the computer in over 24 days.\r\n\r\n"
        "Please save your work and then re-boot your computer.  Some computers when shut down do not actually shut "
        "down "
        "but enter sleep mode.  This is not the same as a reboot.",
        BoxIcon::Critical);
}

bool openConnection(Program& program, std::string& ip, std::string& port) {
    const CommunicationsContext context{program.seams.socket, program.seams.lister, program.seams.host,
                                        program.failures, [&](std::string_view line) { program.failures.note(line); }};
    return ZephSetUpCommunications(context, program.connection, program.adapters, ip, port);
}

// Points that validation added stay when a later step fails; only the end of a run takes them back. This is the part
// of entry that may fail; the caller returns to the editor then.
bool startStandardEngine(Program& program, SimulationFace& face) {
    Host& host = program.seams.host;
    host.setStatusPanel(2, "Creating new simulation pointers...");
    ZephBuildRenderTable(
        {program.settings, host, program.failures, *program.simulation, *program.states, program.tables});
    if (program.tables.RenderDataCount < 1) {
        ZephRebuildStaticFixtureBulbs(*program.simulation, *program.masks, *program.bulbs);
        return false;
    }
    host.setStatusPanel(2, "Opening data connection...");
    std::string ip;
    std::string port;
    if (!openConnection(program, ip, port)) return false;
    const SurfaceScene scene{*program.simulation, program.tables, *program.states,
                             *program.masks,      *program.bulbs, program.picBackground};
    if (!program.surface.prepare(scene, program.failures)) return false;

    host.setStatusPanel(2, "Setting Emulation Timer Attributes...");
    program.editor.ZephUIState = kStateSimulation;
    program.clocks = clocksAtEntry(program.seams.clock.timeGetTime());
    face.setTimer(true, kStandardTimerMs);
    face.showQueueGauge(true);
    host.setStatusPanel(2, simulationActiveText(program.connection.ZephUseTCP, ip, port));
    host.setStatusPanel(4, "");
    face.showFrames(program.surface.image());
    return true;
}

}  // namespace

void mnuSimulationMode_Click(Program& program, SimulationFace& face) {
    if (program.simulating()) return;
    if (objectSelected(program.editor)) {
        face.ZephDeselectflg();
        program.editor.ZephSelection.Object = 0;
        face.redrawObjects();
    }
    if (program.seams.clock.timeGetTime() < 0) {
        refuseBackwardClock(program.seams.host);
        ZephSwitchMode(kStateSelectFixture, program, face);
        face.layOutForEditor();
        return;
    }
    ZephSwitchMode(kStateSimulation, program, face);
    face.CheckEnable(false);
    if (program.simulating()) {
        face.SetControlsForSimulation(true);
    } else {
        face.layOutForEditor();
        face.CheckEnable(false);
    }
}

bool ProgramModes::enterSimulation() {
    clearLevelDumps(program_.receive.Stream.Dumps);
    program_.receive.Stream.ZephStackBuffer.clear();  // only what arrives from now on counts
    program_.seams.host.setBusyPointer(true);
    const bool started = startStandardEngine(program_, face_);
    program_.seams.host.setBusyPointer(false);
    if (!started) face_.stopTimer();
    return started;
}

void ProgramModes::ZephCleanUpAfterSimulation() {
    ::ZephCleanUpAfterSimulation(program_, face_);
}

void ZephSwitchMode(int requestedMode, Program& program, SimulationFace& face) {
    ProgramModes modes(program, face);
    ZephSwitchMode(requestedMode, program.editor.ZephDrawTool, modes.context());
}

void EndSimulation(Program& program, SimulationFace& face) {
    if (!program.simulating()) return;
    face.setTimer(false, kStandardTimerMs);
    restoreAssembledPoints(*program.simulation, *program.states);
    ZephSwitchMode(kStateSelectFixture, program, face);
    program.receive.Stream.ZephStackBuffer.clear();
    program.receive.Stream.ZephPayloadSerial = 0;
    face.layOutForEditor();
}

void ZephCleanUpAfterSimulation(Program& program, SimulationFace& face) {
    face.showQueueGauge(false);
    program.seams.host.setStatusPanel(3, "");
    ZephRebuildStaticFixtureBulbs(*program.simulation, *program.masks, *program.bulbs);
    face.showFrames(program.picBuffer);  // the window must let go of the frame before its pixels are given back
    program.surface.release();
    eraseRenderTables(program.tables);
}

void hrTimer1_Timer(const std::function<void()>& frameDone, Program& program, SimulationFace& face) {
    if (program.clocks.StopRequested) {
        program.clocks.StopRequested = false;
        EndSimulation(program, face);
        return;
    }
    RenderContext run{*program.simulation, program.curve,  program.tables,  *program.states,
                      program.clocks,      program.random, program.surface, program.failures};
    ZephRenderTick(program.RenderEngine, {program.seams.clock, program.parser, program.seams.host, program.sink,
                                          program.receive.Stream, run, frameDone});
}
