#include "editor/background_change.h"

#include "util/rounding.h"
#include "util/text.h"
#include "util/units.h"

#include <algorithm>

ZephBackgroundDraft ZephBackgroundDraftOf(const ZephBackground& background, const ZephSettings& settings) {
    return {background, false, settings.ShowGrid, settings.GridDensity, settings.GridColor};
}

void takeGridOptions(const ZephBackgroundDraft& draft, ZephSettings& settings) {
    settings.ShowGrid = draft.GridLineOption;
    settings.GridDensity = draft.GridSpacing;
    settings.GridColor = draft.GridLineColor;
}

QSize sizePixels(const ZephBackground& background) noexcept {
    return {widthPixels(background), heightPixels(background)};
}

void setSizePixels(QSize size, ZephBackground& background) noexcept {
    if (size == sizePixels(background)) return;
    background.EditorWidthTwips = size.width() * TwipsPerPixelX;
    background.EditorHeightTwips = size.height() * TwipsPerPixelY;
}

bool exceedsMaximumSize(const ZephBackground& background) noexcept {
    return widthPixels(background) > kMaxCanvasPixels || heightPixels(background) > kMaxCanvasPixels;
}

void tellMaximumSize(Host& host) {
    const std::string most = std::to_string(kMaxCanvasPixels);
    host.messageBox(boxTitle("-Maximum Size"),
                    "Your simulation is too large.  The Maximum size is " + most + " by " + most +
                        ".\r\nPlease resize your simulation",
                    BoxIcon::Critical);
}

bool ZephCheckBackground(const ZephBackground& background, Host& host) {
    if (!exceedsMaximumSize(background)) return true;
    tellMaximumSize(host);
    return false;
}

void tellBadPicture(Host& host) {
    host.messageBox(boxTitle("-Picture Load Error"),
                    "There was a problem loading this background picture.  Please select another.", BoxIcon::Critical);
}

std::optional<QSize> ZephCheckNewSize(std::string_view width, std::string_view height, Host& host) {
    const auto valid = [](std::optional<std::int32_t> side) { return side && *side >= 1 && *side <= kMaxCanvasPixels; };
    const std::optional<std::int32_t> newWidth = parseLong(width);
    const std::optional<std::int32_t> newHeight = parseLong(height);
    if (valid(newWidth) && valid(newHeight)) return QSize(*newWidth, *newHeight);
    const std::string most = std::to_string(kMaxCanvasPixels);
    host.messageBox(boxTitle("-Bad Simulation Size"),
                    "Invalid simulation size.  Simulation size must be between 1x1 and\r\n" + most + "x" + most + ".",
                    BoxIcon::Critical);
    return std::nullopt;
}

std::int32_t proportionalSide(std::int32_t side, std::int32_t otherSide, std::int32_t thisSide) noexcept {
    return scaleHalfUp(side, otherSide, thisSide);
}

bool ZephScaleDrawPoints(const ZephBackground& before, const ZephBackground& after, ZephSimulation& simulation) {
    const std::int32_t oldWidth = std::max(before.EditorWidthTwips, TwipsPerPixelX);
    const std::int32_t oldHeight = std::max(before.EditorHeightTwips, TwipsPerPixelY);
    const std::int32_t newWidth = std::max(after.EditorWidthTwips, TwipsPerPixelX);
    const std::int32_t newHeight = std::max(after.EditorHeightTwips, TwipsPerPixelY);
    if (newWidth == oldWidth && newHeight == oldHeight) return false;
    const int fixtures = std::clamp(simulation.FixtureCount, 0, kMaxFixtures);
    for (int f = 1; f <= fixtures; ++f) {
        ZephFixture& fixture = simulation.Fixtures[f];
        const int points = std::clamp(fixture.PointCount, 0, kMaxPoints);
        for (int p = 1; p <= points; ++p) {
            ZephDrawPoint& point = fixture.DrawPoints[p];
            point.X = scaleHalfEven(point.X, newWidth, oldWidth);
            point.Y = scaleHalfEven(point.Y, newHeight, oldHeight);
        }
    }
    return true;
}

bool ZephTakeBackground(const ZephBackground& edited, ZephSimulation& simulation) {
    const ZephBackground before = simulation.Background;
    simulation.SimulationDirty = true;
    simulation.Background = edited;
    return ZephScaleDrawPoints(before, edited, simulation);
}
