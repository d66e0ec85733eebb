#include "shell/startup.h"

#include "model/data_directories.h"
#include "shell/recent_files.h"

#include <QCoreApplication>

namespace {

constexpr const char* kModule = "frmZephMain";
constexpr int kCurvesFolder = 4;

void loadDimmingCurve(Program& program) {
    const std::string file =
        ZephReturnDataDirectory(kCurvesFolder, program.paths, program.settings) + "standarddimmingcurve.xml";
    if (!ZephLoadDimmingCurveXML(file, program.failures, program.curve)) {
        program.curve = ZephCreateDummyDimmingCurve();
    }
}

}  // namespace

RegistryContext registryContext(Program& program) {
    return {program.seams.store, program.seams.clock, program.paths,
            program.failures,    program.seams.host,  program.seams.lister};
}

int renderEngineOf(const ZephSettings& settings) {
    return settings.AdvancedRenderEngine ? kEngineOpenGL : kEngineStandard;
}

bool ZephReadSettingsAtStart(Program& program) {
    program.StartupLoading = true;
    // The guard is about a program that was closed a moment ago, so it stands before everything else.
    if (!ZephReadRegistryDefaults(registryContext(program), program.settings, program.connection, program.adapters)) {
        return false;
    }
    program.RenderEngine = renderEngineOf(program.settings);
    ZephGlobalReset(false, *program.simulation, program.watcher);
    return true;
}

void ZephStartUp(const StartupMessage& status, StartupFace& face, Program& program) try {
    status("Checking Directories");
    ZephCheckDirectoriesAtStartup(program.paths);
    status("Loading Dimming Curve");
    loadDimmingCurve(program);
    status("Setting up Sequence Editor color curves");  // users know the step; its work went away long ago
    status("Setup Clipboard");
    program.editor.ZephAppendTarget = 0;
    status("Loading Symbol Preview");
    status("Loading Constants");
    program.editor.SimplePropMode = program.settings.SimplePropDisplay;
    status("Creating Bulb Masks");
    ZephSetUpMasks(program.curve, status, *program.masks);
    status("Setting Initial Locations");
    status("Setup Toolbars");
    face.setUpToolBars();
    status("Hook Wheel Movements");
    status("Update Recent File Menu");
    face.setUpMenus();
    status("Set up Communications Parameters");
    ZephSetUpPacketParms(program.parser.PacketParms);
    status("Ready");
    program.StartupLoading = false;
}
ZEPH_GUARD(program.failures, kModule, )

void ZephOpenFirst(StartupFace& face, Program& program) try {
    const bool opened = !program.parms.FileToOpen.empty() && face.openCommandLineFile(program.parms.FileToOpen);
    if (!opened) {
        switch (ZephStartupAction(program.settings)) {
        case StartupAction::Nothing:
            break;
        case StartupAction::ShowOpenDialog:
            face.mnuFileLoad_Click();
            break;
        case StartupAction::OpenNewest:
            face.mnuRecentFiles_Click(0);
            break;
        }
    }
    ZephWriteVisPid(QCoreApplication::applicationPid(), program.seams.store);
}
ZEPH_GUARD(program.failures, kModule, )

std::string ZephWindowTitle(std::string_view fileName) {
    std::string title = std::string(kProgramName) + " v" ZEPH_VERSION " ";
    if (!fileName.empty()) title.append("-").append(fileName);
    return title;
}
