#include "shell/load_editor_file.h"

#include "editor/background_change.h"
#include "editor/picture_file.h"
#include "shell/startup.h"
#include "util/text.h"

#include <QFileInfo>

namespace {

// From here on the document names the picture that it shows, wherever the display has moved to: saved into another
// folder, it finds it again.
void takeFoundPicture(ZephSimulation& simulation) {
    const std::string found = ZephFindBackgroundPicture(simulation);
    if (QFileInfo(QString::fromStdString(found)).isFile()) simulation.Background.PicFileName = found;
}

}  // namespace

void setEditorFile(std::string_view path, ZephSimulation& simulation) {
    const QString given = QString::fromUtf8(path.data(), static_cast<qsizetype>(path.size()));
    const std::string full = QFileInfo(given).absoluteFilePath().toStdString();
    simulation.FilePath = ZephPathFromFullPath(full);
    simulation.FileName = ZephNameFromFullPath(full);
}

bool LoadEditorFile(bool quiet, Program& program, SimulationFace& face, FileFace& window) try {
    ZephSimulation& simulation = *program.simulation;
    ZephGlobalReset(false, simulation, program.watcher);
    installBackground({}, program);
    face.ZephLoadUIObjectList();
    face.redrawObjects();
    window.showDocument();
    program.seams.host.pumpEvents();

    if (!ZephLoadVisualizerXML(!quiet, program.files, simulation)) return false;
    ZephRebuildStaticFixtureBulbs(simulation, *program.masks, *program.bulbs);
    simulation.SimulationOpen = true;
    takeFoundPicture(simulation);
    const ZephBackgroundSurfaces surfaces =
        ZephResetBackground(simulation, program.seams.programFolder, program.seams.host);
    installBackground(surfaces, program);
    window.showDocument();
    simulation.SimulationDirty = false;
    program.seams.host.setStatusPanel(1, "");
    ZephSwitchMode(kStateSelectFixture, program, face);
    program.autosave.Tag = 0;
    window.setTitle(ZephWindowTitle(simulation.FileName));
    if (surfaces.pictureFailed && !quiet) offerOtherPicture(program, face, window);
    if (!ZephCheckBackground(simulation.Background, program.seams.host)) {
        // Without a way to cancel: the engines draw no larger canvas.
        static_cast<void>(ZephChangeBackgroundProperties({false, false}, program, face, window));
    }
    return true;
}
ZEPH_GUARD(program.failures, "LoadEditorFile", false)
