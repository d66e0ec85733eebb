#include "shell/simulation_mode.h"

#include "editor/background.h"

namespace {

constexpr std::string_view kModule = "modZephEditorFunctions";
constexpr std::string_view kBackwardClock = "Can not enter simulation mode:  Time is running backwards.";

void refuseBackwardClock(Host& host) {
    host.messageBox(
        boxTitle("-Error:  Reboot Required"),
        std::string(kBackwardClock) +
            "\r\n\r\nThe visualizer can not enter simulation mode since Windows is reporting that time is running "
            "backwards.  This is usually caused by not having rebooted the computer in over 24 days.\r\n\r\n"
            "Please save your work and then re-boot your computer.  Some computers when shut down do not actually "
            "shut down but enter sleep mode.  This is not the same as a reboot.",
        BoxIcon::Critical);
}

bool openConnection(Program& program, std::string& ip, std::string& port) {
    const CommunicationsContext context{program.seams.socket, program.seams.lister, program.seams.host,
                                        program.failures, [&](std::string_view line) { program.failures.note(line); }};
    return ZephSetUpCommunications(context, program.connection, program.adapters, ip, port);
}

bool buildTable(Program& program) {
    program.seams.host.setStatusPanel(2, "Creating new simulation pointers...");
    ZephBuildRenderTable(
        {program.settings, program.seams.host, program.failures, *program.simulation, *program.states, program.tables});
    return program.tables.RenderDataCount > 0;
}

// The common last steps: from here on ticks arrive.
void startTimer(int intervalMs, Program& program, SimulationFace& face) {
    program.seams.host.setStatusPanel(2, "Setting Emulation Timer Attributes...");
    program.editor.ZephUIState = kStateSimulation;
    program.clocks = clocksAtEntry(program.seams.clock.timeGetTime());
    face.setTimer(true, intervalMs);
}

void tellConnection(const std::string& ip, const std::string& port, Program& program) {
    program.seams.host.setStatusPanel(2, simulationActiveText(program.connection.ZephUseTCP, ip, port));
    program.seams.host.setStatusPanel(4, "");
}

// Points that validation added stay when a later step fails; only the end of a run takes them back. These are the
// parts of entry that may fail; the caller returns to the editor then.
bool startStandardEngine(Program& program, SimulationFace& face) {
    std::string ip;
    std::string port;
    if (!buildTable(program)) return false;
    program.seams.host.setStatusPanel(2, "Opening data connection...");
    if (!openConnection(program, ip, port)) return false;
    const SurfaceScene scene{*program.simulation, program.tables, *program.states,
                             *program.masks,      *program.bulbs, program.picBackground};
    if (!program.surface.prepare(scene, program.failures)) return false;
    startTimer(kStandardTimerMs, program, face);
    face.showQueueGauge(true);
    tellConnection(ip, port, program);
    face.showFrames(program.surface.image());
    return true;
}

bool startOpenGLEngine(Program& program, SimulationFace& face) {
    Host& host = program.seams.host;
    std::string ip;
    std::string port;
    if (!buildTable(program)) return false;
    host.setStatusPanel(2, "Opening data connection...");
    if (!openConnection(program, ip, port)) return false;
    tellConnection(ip, port, program);
    host.setStatusPanel(2, "Creating Rendering Window");
    GLTarget* const target = face.ZephCreateRenderWindow();
    if (!target) return false;
    host.setStatusPanel(2, "Start Rendering Cycle");
    const bool hasPicture = program.simulation->Background.BackgroundType == kBackgroundPicture;
    const QImage picture = hasPicture ? program.Picture3 : QImage();
    const QSize canvas = canvasSize(program.simulation->Background);
    const GLScene scene{*program.simulation,
                        program.tables,
                        *program.states,
                        program.curve,
                        program.masks->GLShapes,
                        picture,
                        program.simulation->Background.PicIntensity,
                        canvas.width(),
                        canvas.height()};
    if (!program.glSurface.ZephGLStartup(scene, *target, program.failures)) return false;
    face.resizeRenderWindow();
    startTimer(kOpenGLTimerMs, program, face);
    tellConnection(ip, port, program);
    face.showMainWindow(false);
    host.pumpEvents();
    return true;
}

// Memory that runs out on the way is a failed entry like any other.
bool startEngineOfSetting(Program& program, SimulationFace& face) try {
    return program.rendersOpenGL() ? startOpenGLEngine(program, face) : startStandardEngine(program, face);
}
ZEPH_GUARD(program.failures, kModule, false)

bool startEngine(Program& program, SimulationFace& face) {
    if (startEngineOfSetting(program, face)) return true;
    // Every failed entry leaves an editor that is whole.
    program.glSurface.release();
    face.closeRenderWindow();
    ZephRebuildStaticFixtureBulbs(*program.simulation, *program.masks, *program.bulbs);
    face.stopTimer();
    return false;
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
        program.seams.host.setStatusPanel(2, kBackwardClock);
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
    const BusyPointer busy(program_.seams.host);
    return startEngine(program_, face_);
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
    face.stopTimer();
    face.showMainWindow(true);
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
    program.glSurface.release();
    face.closeRenderWindow();
    eraseRenderTables(program.tables);
}

void hrTimer1_Timer(const std::function<void()>& frameDone, Program& program, SimulationFace& face) {
    if (program.clocks.StopRequested) {
        program.clocks.StopRequested = false;
        face.showMainWindow(true);
        EndSimulation(program, face);
        return;
    }
    LightSurface& surface = program.rendersOpenGL() ? static_cast<LightSurface&>(program.glSurface) : program.surface;
    RenderContext run{*program.simulation, program.curve,  program.tables, *program.states,
                      program.clocks,      program.random, surface,        program.failures};
    ZephRenderTick(program.RenderEngine, {program.seams.clock, program.parser, program.seams.host, program.sink,
                                          program.receive.Stream, run, frameDone});
}
