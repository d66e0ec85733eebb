#include "shell/startup.h"

#include "model/data_directories.h"

namespace {

constexpr int kCurvesFolder = 4;

void loadDimmingCurve(Program& program) {
    const std::string file =
        ZephReturnDataDirectory(kCurvesFolder, program.paths, program.settings) + "standarddimmingcurve.xml";
    if (!ZephLoadDimmingCurveXML(file, program.failures, program.curve)) {
        program.curve = ZephCreateDummyDimmingCurve();
    }
}

void setUpCommunications(Program& program) {
    const AdapterChoice choice = ZephCheckAdapterAtStartup(program.settings.AdapterToUse, program.seams.lister,
                                                           program.seams.host, program.adapters);
    program.connection.ZephAdapterName = choice.ZephAdapterName;
    program.connection.ZephAdapterIP = choice.ZephAdapterIP;
    program.connection.ZephSimulationPort = program.settings.SimulationPort;
    program.connection.ZephUseTCP = program.settings.UseTCP;
}

}  // namespace

void ZephStartUp(const StartupMessage& status, Program& program) try {
    program.StartupLoading = true;
    setUpCommunications(program);
    program.RenderEngine = kEngineStandard;  // whatever the setting says, as long as there is no other output
    ZephGlobalReset(false, *program.simulation, program.seams.watcher);
    status("Checking Directories");
    ZephCheckDirectoriesAtStartup(program.paths);
    status("Loading Dimming Curve");
    loadDimmingCurve(program);
    status("Creating Bulb Masks");
    ZephSetUpMasks(program.curve, status, *program.masks);
    status("Set up Communications Parameters");
    ZephSetUpPacketParms(program.parser.PacketParms);
    status("Ready");
    program.StartupLoading = false;
}
ZEPH_GUARD(program.failures, "Startup", )

std::string ZephWindowTitle(std::string_view fileName) {
    std::string title = std::string(kProgramName) + " v" ZEPH_VERSION " ";
    if (!fileName.empty()) title.append("-").append(fileName);
    return title;
}
