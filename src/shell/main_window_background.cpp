// What gives a display its canvas, as the window has it: the new-simulation and background commands with their dialogs,
// and the brightness of the options band.
#include "editor/picture_file.h"
#include "model/data_directories.h"
#include "shell/dialogs/background_dialog.h"
#include "shell/dialogs/new_simulation_dialog.h"
#include "shell/main_window.h"
#include "util/text.h"

#include <QFileInfo>
#include <QStandardPaths>

namespace {

constexpr std::string_view kModule = "frmZephMain";
constexpr QPoint kBelowBand(24, 8);

// Below the tool bars, so that they and the list stay in sight; the window manager keeps it on the screen.
void placeUnder(const QWidget& band, QDialog& dialog) {
    dialog.adjustSize();
    dialog.move(band.mapToGlobal(QPoint(0, band.height())) + kBelowBand);
}

}  // namespace

void frmZephMain::mnuFileNew_Click() try {
    ZephNewSimulation(program_, *this, *this);
    CheckEnable(false);
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::mnuBackgroundProperties_Click() try {
    ZephChangeBackgroundProperties({}, program_, *this, *this);
    CheckEnable(false);
}
ZEPH_GUARD(program_.failures, kModule, )

QString frmZephMain::pictureFolder() const {
    const ZephSimulation& simulation = *program_.simulation;
    const std::string picture = ZephFindBackgroundPicture(simulation);
    for (const std::string& folder : {ZephPathFromFullPath(picture), simulation.FilePath}) {
        const QString path = QString::fromStdString(folder);
        if (!path.isEmpty() && QFileInfo(path).isDir()) return path;
    }
    return QStandardPaths::writableLocation(QStandardPaths::PicturesLocation);
}

std::optional<ZephNewSimulationChoice> frmZephMain::showNewSimulation() {
    frmZephNewSimulation dialog(pictureFolder(), host_, pickPicture, this);
    placeUnder(*CoolBar1_, dialog);
    dialog.exec();
    if (dialog.Cancelled()) return std::nullopt;
    return dialog.choice();
}

std::optional<ZephBackgroundDraft> frmZephMain::showBackground(const ZephBackgroundDraft& draft,
                                                               const BackgroundTerms& terms) {
    // Of the draft, which may be that of a new simulation.
    std::string picture;
    if (draft.Background.BackgroundType == kBackgroundPicture) {
        picture = terms.NewSimulation ? draft.Background.PicFileName : ZephFindBackgroundPicture(*program_.simulation);
    }
    frmZephBackground dialog(draft, {terms.AllowCancel, terms.NewSimulation, picture, pictureFolder()}, {host_}, this);
    placeUnder(*CoolBar1_, dialog);
    dialog.exec();
    if (dialog.Cancelled()) return std::nullopt;
    return dialog.draft();
}

std::string frmZephMain::findPicture(const std::string& missing) {
    const QString name = QString::fromStdString(ZephNameFromFullPath(missing));
    return pickPicture(tr("Where is the picture \"%1\"?").arg(name), pictureFolder(), this).toStdString();
}

void frmZephMain::sldIntensity_Scroll() {
    tmrAdjustBrightness_.start();
    program_.simulation->SimulationDirty = true;
    host_.setStatusPanel(1, "Changed");
}

// The picture is made anew once the slider has stood still for a whole interval.
void frmZephMain::tmrAdjustBrightness_Timer() try {
    const int intensity = CoolBar1_->band().intensity();
    if (intensity != lastIntensity_) {
        lastIntensity_ = intensity;
        return;
    }
    takeIntensity();
}
ZEPH_GUARD(program_.failures, kModule, )

void frmZephMain::takeIntensity() {
    if (!tmrAdjustBrightness_.isActive()) return;
    tmrAdjustBrightness_.stop();
    if (!program_.simulation->SimulationOpen || program_.simulating()) return;
    program_.simulation->Background.PicIntensity = CoolBar1_->band().intensity();
    program_.picBackground = pictureAtIntensity(program_.Picture3, program_.simulation->Background.PicIntensity);
    redrawObjects();
}
