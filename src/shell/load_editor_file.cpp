#include "shell/load_editor_file.h"

#include "editor/background.h"
#include "shell/startup.h"
#include "util/text.h"

#include <QFileInfo>

void setEditorFile(std::string_view path, ZephSimulation& simulation) {
    const QString given = QString::fromUtf8(path.data(), static_cast<qsizetype>(path.size()));
    const std::string full = QFileInfo(given).absoluteFilePath().toStdString();
    simulation.FilePath = ZephPathFromFullPath(full);
    simulation.FileName = ZephNameFromFullPath(full);
}

bool LoadEditorFile(bool quiet, Program& program, SimulationFace& face, FileFace& window) try {
    ZephSimulation& simulation = *program.simulation;
    ZephGlobalReset(false, simulation, program.watcher);
    program.picBackground = QImage();
    face.redrawObjects();
    window.showDocument();
    program.seams.host.pumpEvents();

    if (!ZephLoadVisualizerXML(!quiet, program.files, simulation)) return false;
    ZephRebuildStaticFixtureBulbs(simulation, *program.masks, *program.bulbs);
    simulation.SimulationOpen = true;
    program.picBackground = ZephResetBackground(simulation, program.seams.programFolder, program.seams.host);
    window.showDocument();
    simulation.SimulationDirty = false;
    program.seams.host.setStatusPanel(1, "");
    ZephSwitchMode(kStateSelectFixture, program, face);
    program.autosave.Tag = 0;
    window.setTitle(ZephWindowTitle(simulation.FileName));
    if (widthPixels(simulation.Background) > kMaxCanvasPixels ||
        heightPixels(simulation.Background) > kMaxCanvasPixels) {
        const std::string most = std::to_string(kMaxCanvasPixels);
        program.seams.host.messageBox(boxTitle("-Maximum Size"),
                                      "Your simulation is too large.  The Maximum size is " + most + " by " + most +
                                          ".\r\nPlease resize your simulation",
                                      BoxIcon::Critical);
    }
    return true;
}
ZEPH_GUARD(program.failures, "LoadEditorFile", false)
