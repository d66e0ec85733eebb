// What the background dialog and the size dialog work on and by: the draft, the limits of the canvas with their
// messages, and taking a changed background into the document. No windows here.
#pragma once

#include "model/settings.h"
#include "model/simulation.h"
#include "util/host.h"

#include <QSize>

#include <optional>
#include <string_view>

// What the background dialog edits: a copy of the record, and the options of the grid.
struct ZephBackgroundDraft {
    ZephBackground Background;
    bool PictureChosen = false;       // to be loaded anew, even if it is the same file: it may have been retouched
    std::int32_t GridLineOption = 0;  // row of the grid line table
    std::int32_t GridSpacing = 1;     // tens of pixels, 1..20
    std::int32_t GridLineColor = 0;   // packed

    bool operator==(const ZephBackgroundDraft&) const = default;
};

ZephBackgroundDraft ZephBackgroundDraftOf(const ZephBackground& background, const ZephSettings& settings);
void takeGridOptions(const ZephBackgroundDraft& draft, ZephSettings& settings);

// The size of the record in pixels, without a limit.
QSize sizePixels(const ZephBackground& background) noexcept;
// Where the size in pixels is the same already, the twips stay to the twip.
void setSizePixels(QSize size, ZephBackground& background) noexcept;

// More than 2500 pixels wide or high.
bool exceedsMaximumSize(const ZephBackground& background) noexcept;
void tellMaximumSize(Host& host);
// True where the size is within the limit; tells where it is not.
[[nodiscard]] bool ZephCheckBackground(const ZephBackground& background, Host& host);

// A file that was chosen as a background is no picture.
void tellBadPicture(Host& host);

// The size typed into two boxes; nothing, after a message, unless both are numbers from 1 to 2500.
std::optional<QSize> ZephCheckNewSize(std::string_view width, std::string_view height, Host& host);
// The other side of a rectangle that keeps its proportions: side x otherSide / thisSide, halves upwards.
std::int32_t proportionalSide(std::int32_t side, std::int32_t otherSide, std::int32_t thisSide) noexcept;

// Moves every point by new / old of its axis, each rounded with ties to even; bulbs keep their size. An axis whose
// twips are the same stays untouched. A size below one pixel counts as one pixel. False: both axes are the same.
bool ZephScaleDrawPoints(const ZephBackground& before, const ZephBackground& after, ZephSimulation& simulation);

// The edited record becomes the document's, the drawing keeps its place on the new canvas, the document is dirty. True
// where points were moved.
bool ZephTakeBackground(const ZephBackground& edited, ZephSimulation& simulation);
