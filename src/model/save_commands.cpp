#include "model/save_commands.h"

#include "model/editor_writer.h"
#include "util/text.h"

#include <QFile>

#include <optional>

namespace {

constexpr std::string_view kModule = "frmZephMain";
constexpr int kMaxBackups = 1000;
constexpr std::string_view kNoBackupTitle = "Unable to create backup";

std::string backupName(const std::string& fullPath, int n) {
    const std::string digits = "000" + std::to_string(n);
    return fullPath + ".bak" + digits.substr(digits.size() - 4);
}

std::optional<std::string> freeBackupName(const std::string& fullPath) {
    for (int n = 1; n <= kMaxBackups; ++n) {
        std::string candidate = backupName(fullPath, n);
        if (!QFile::exists(QString::fromStdString(candidate))) return candidate;
    }
    return std::nullopt;
}

bool saveAndTell(const SaveContext& context, ZephSimulation& simulation, AutoSaveState& autosave) {
    context.face.addRecentFile(simulation.FilePath + simulation.FileName);
    // A refusal of the disk was told; the commands have always counted the document as saved all the same.
    const bool written = ZephSaveVisualizerXML(context.createdAt, context.files, simulation);
    simulation.SimulationDirty = false;
    context.files.host.setStatusPanel(1, "");
    autosave.Tag = 0;
    simulation.FileUpgraded = false;
    context.face.documentSaved();
    return written;
}

}  // namespace

bool ZephBackUpUpgradedFile(const std::string& fullPath, Host& host) {
    const std::optional<std::string> name = freeBackupName(fullPath);
    if (!name) {
        return host.messageBox(kNoBackupTitle, "Unable to create backup G3 Zeph file.  Do you want to continue?",
                               BoxIcon::Question, BoxButtons::YesNo) == BoxAnswer::Yes;
    }
    // A full disk or a closed folder: the save would replace the only copy of the old file.
    if (!QFile::copy(QString::fromStdString(fullPath), QString::fromStdString(*name))) {
        host.messageBox(kNoBackupTitle, "Unable to create backup G3 Zeph file.", BoxIcon::Critical);
        return false;
    }
    host.messageBox("File Backup",
                    "This Zeph file has been updated to the new G4 file format.  Your existing Zeph file has been "
                    "backed up and is named:\r\n\r\n" +
                        *name,
                    BoxIcon::Information);
    return true;
}

bool mnuFileSave_Click(const SaveContext& context, ZephSimulation& simulation, AutoSaveState& autosave) try {
    if (simulation.FileName.empty()) {
        const bool written = mnuFileSaveAs_Click(context, simulation, autosave);
        simulation.FileUpgraded = false;
        return written;
    }
    const bool goesOn = !simulation.FileUpgraded ||
                        ZephBackUpUpgradedFile(simulation.FilePath + simulation.FileName, context.files.host);
    return goesOn && saveAndTell(context, simulation, autosave);
}
ZEPH_GUARD(context.files.failures, kModule, false)

bool mnuFileSaveAs_Click(const SaveContext& context, ZephSimulation& simulation, AutoSaveState& autosave) try {
    std::string chosen;
    if (!context.face.chooseOutputFile(chosen)) return false;
    simulation.FilePath = ZephPathFromFullPath(chosen);
    simulation.FileName = ZephNameFromFullPath(chosen);
    return saveAndTell(context, simulation, autosave);
}
ZEPH_GUARD(context.files.failures, kModule, false)
