#include "editor/new_simulation.h"

#include "util/text.h"

#include <algorithm>

namespace {

constexpr std::int32_t kDimmed = 50;

}  // namespace

std::int32_t maskPixels(std::string_view typed) noexcept {
    return parseLong(typed).value_or(0);
}

QSize withinMask(QSize size) noexcept {
    constexpr QSize most(kMostMaskPixels, kMostMaskPixels);
    if (size.width() <= most.width() && size.height() <= most.height()) return size;
    return size.scaled(most, Qt::KeepAspectRatio).expandedTo({1, 1});
}

bool ZephNewSimulationComplete(const ZephNewSimulationChoice& choice) noexcept {
    if (choice.WidthPixels < 1 || choice.HeightPixels < 1) return false;
    return choice.BackgroundType != kBackgroundPicture || !choice.BackgroundFileName.empty();
}

ZephBackground backgroundOf(const ZephNewSimulationChoice& choice) {
    ZephBackground background;
    background.BackgroundType = choice.BackgroundType;
    if (choice.BackgroundType == kBackgroundPicture) background.PicFileName = choice.BackgroundFileName;
    background.EditorWidthTwips = choice.WidthTwips;
    background.EditorHeightTwips = choice.HeightTwips;
    return background;
}

void beginSimulation(const ZephBackground& background, ZephSimulation& simulation, DocumentWatcher& watcher) {
    watcher.selectionCleared();
    ZephGlobalReset(true, simulation, watcher);
    // The edit state goes as well: what was copied out of the old display may name fixtures that are no more.
    watcher.clipboardAndStatusCleared();
    simulation.ChecksumMismatch = false;
    simulation.FileUpgraded = false;
    simulation.zephSaveFileVersion.clear();
    simulation.FilePath.clear();
    simulation.FileName.clear();
    simulation.Background = background;
    simulation.SimulationDirty = false;
    simulation.Levels[1].Name = "Background";
    simulation.Levels[kLevels].Name = "Foreground";
    simulation.Dimmed = kDimmed;
}
