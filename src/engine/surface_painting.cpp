// How the standard surface paints what was noted: by bands of rows, each put together in the cache and streamed out,
// or square by square on the frame itself.
#include "engine/standard_surface.h"

#include <algorithm>
#include <bit>
#include <cstring>

namespace {

void copyPixels(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    std::memcpy(to, from, static_cast<std::size_t>(pixels) * sizeof(std::uint32_t));
}

}  // namespace

void StandardSurface::endFrame() {
    if (!scene_) return;
    paintNoted();
    collectTiles();
    if (wholeChanged_) changed_.assign(1, image_.rect());
    wholeChanged_ = false;
    if (passes_ > 1) {
        std::fill(lastAlpha_.begin(), lastAlpha_.end(), std::uint8_t{0});
        std::replace(bandLight_.begin(), bandLight_.end(), BandLight::Runs, BandLight::Unknown);
        lastRepeats_ = false;
    }
    if (anySpriteChanged_) std::fill(spriteChanged_.begin(), spriteChanged_.end(), std::uint8_t{0});
    anySpriteChanged_ = false;
}

// Paints what was noted since the frame began, or since the pass before.
void StandardSurface::paintNoted() {
    const bool repeats = listed_.empty();
    if (passes_ > 0) {
        paintSquares();
    } else if (!repeats || !lastRepeats_ || anySpriteChanged_ || alpha_ != lastAlpha_) {
        if (worthBands()) {
            paintBands();
        } else {
            restoreLit();
            paintSquares();
        }
        lastRepeats_ = repeats;
    }
    ++passes_;
    noted_.clear();
    listed_.clear();
    litBulbs_ = 0;
    litPixels_ = 0;
    alpha_.swap(lastAlpha_);
    std::fill(alpha_.begin(), alpha_.end(), std::uint8_t{0});
}

// A band costs a copy of its pixels whatever is lit on it, a square the cache misses of its rows. Measured: the two
// meet where about a seventh of the canvas is under small bulbs, later for large ones, whose rows are long.
bool StandardSurface::worthBands() const noexcept {
    constexpr std::int64_t kBulbCost = 48;  // in pixels
    const std::int64_t canvas = std::int64_t{plan_.Width} * plan_.Height;
    return litPixels_ + kBulbCost * litBulbs_ > canvas / 2;
}

void StandardSurface::paintBands() {
    for (const BulbSquare& square : lit_) {
        const BandRange bands = bandsOf(square, plan_.Height);
        for (std::int32_t b = bands.First; b <= bands.Last; ++b) {
            bandLight_[static_cast<std::size_t>(b)] = BandLight::Unknown;
        }
    }
    for (const std::int32_t number : litUnits_) {
        const PlanUnit& unit = plan_.Units[static_cast<std::size_t>(number)];
        for (std::int32_t t = 0; t < unit.TileCount; ++t) {
            static_assert(1 << kTileShift == 2 * kBandRows);
            const auto band =
                2 * static_cast<std::size_t>(plan_.Tiles[static_cast<std::size_t>(unit.FirstTile + t)].Row);
            bandLight_[band] = BandLight::Unknown;
            if (band + 1 < bandLight_.size()) bandLight_[band + 1] = BandLight::Unknown;
        }
    }
    litUnits_.clear();
    lit_.clear();
    sortListedIntoBands();
    for (std::size_t band = 0; band < bandLight_.size(); ++band) {
        if (!bandChanged(band)) continue;
        const bool lists = firstBandListed_[band] != firstBandListed_[band + 1];
        const bool lit = paintBand(band);
        bandLight_[band] = lists ? BandLight::Unknown : lit ? BandLight::Runs : BandLight::None;
        changed_.push_back(bandRect(band));
    }
    kernels_.endStreaming();
}

// A counting sort, so that within a band the order of the calls stays.
void StandardSurface::sortListedIntoBands() {
    std::fill(firstBandListed_.begin(), firstBandListed_.end(), 0);
    const auto forBands = [&](const ListedBulb& bulb, auto&& visit) {
        const std::int32_t side = plan_.Units[static_cast<std::size_t>(bulb.Unit)].Side;
        const std::int32_t first = std::max(0, std::int32_t{bulb.Place.Y}) / kBandRows;
        const std::int32_t last = (std::min(plan_.Height, bulb.Place.Y + side) - 1) / kBandRows;
        for (std::int32_t band = first; band <= last; ++band)
            visit(static_cast<std::size_t>(band));
    };
    for (const ListedBulb& bulb : listed_) {
        forBands(bulb, [&](std::size_t band) { ++firstBandListed_[band]; });
    }
    std::int32_t before = 0;
    for (std::int32_t& first : firstBandListed_) {
        before += first;
        first = before;  // for now the end of each band's part
    }
    for (std::size_t i = listed_.size(); i-- > 0;) {
        forBands(listed_[i], [&](std::size_t band) {
            bandListed_[static_cast<std::size_t>(--firstBandListed_[band])] = static_cast<std::int32_t>(i);
        });
    }
}

bool StandardSurface::bandChanged(std::size_t band) const noexcept {
    if (bandLight_[band] == BandLight::Unknown || firstBandListed_[band] != firstBandListed_[band + 1]) return true;
    const auto first = static_cast<std::size_t>(plan_.FirstBandRun[band]);
    const auto end = static_cast<std::size_t>(plan_.FirstBandRun[band + 1]);
    for (std::size_t r = first; r < end; ++r) {
        const auto unit = static_cast<std::size_t>(plan_.BandRuns[r].Unit);
        if (alpha_[unit] != lastAlpha_[unit] || (spriteChanged_[unit] != 0 && alpha_[unit] != 0)) return true;
    }
    return false;
}

// Puts the band together in the cache, runs and listed bulbs merged by the order of their units, and streams it out.
// Gives whether anything is lit on it.
bool StandardSurface::paintBand(std::size_t band) {
    const auto top = static_cast<std::int32_t>(band) * kBandRows;
    const std::int32_t rows = std::min(kBandRows, plan_.Height - top);
    const std::int32_t left = plan_.BandColumns[band].Left / kCacheLinePixels * kCacheLinePixels;
    const std::int32_t pixels = wholeCacheLines(plan_.BandColumns[band].Right - left);
    for (std::int32_t y = 0; y < rows; ++y) {
        copyPixels(background_.row(top + y) + left, band_.row(kBandMarginRows + y) + kBandMargin + left, pixels);
    }

    std::uint32_t* origin = band_.row(kBandMarginRows) + kBandMargin - std::ptrdiff_t{top} * band_.stride();
    const PixelTarget target{origin, band_.stride(), origin};
    const RowRange range{top - kBandMarginRows, top + rows + kBandMarginRows};
    bool lit = false;
    auto listed = static_cast<std::size_t>(firstBandListed_[band]);
    const auto listedEnd = static_cast<std::size_t>(firstBandListed_[band + 1]);
    const auto paintListedBefore = [&](std::int32_t unit) {
        for (; listed < listedEnd; ++listed) {
            const ListedBulb& bulb = listed_[static_cast<std::size_t>(bandListed_[listed])];
            if (bulb.Unit >= unit) return;
            kernels_.blendBulbs(plan_.Sprites[static_cast<std::size_t>(bulb.Sprite)], bulb.Alpha, {&bulb.Place, 1},
                                range, target);
            lit = true;
        }
    };
    const auto end = static_cast<std::size_t>(plan_.FirstBandRun[band + 1]);
    for (auto r = static_cast<std::size_t>(plan_.FirstBandRun[band]); r < end; ++r) {
        const PlanRun& run = plan_.BandRuns[r];
        const std::uint8_t alpha = alpha_[static_cast<std::size_t>(run.Unit)];
        if (alpha == 0) continue;
        paintListedBefore(run.Unit);
        kernels_.blendBulbs(plan_.Sprites[static_cast<std::size_t>(run.Sprite)], alpha,
                            {plan_.BandPlaces.data() + run.FirstPlace, static_cast<std::size_t>(run.PlaceCount)}, range,
                            target);
        lit = true;
    }
    paintListedBefore(static_cast<std::int32_t>(plan_.Units.size()));

    for (std::int32_t y = 0; y < rows; ++y) {
        kernels_.streamRow(band_.row(kBandMarginRows + y) + kBandMargin + left, frame_.row(top + y) + left, pixels);
    }
    return lit;
}

void StandardSurface::paintSquares() {
    const PixelTarget target{frame_.row(0), frame_.stride(), frame_.row(0)};
    // A unit that stands alone goes straight over the background: what it showed before lies under it.
    const PixelTarget aloneTarget{frame_.row(0), frame_.stride(), background_.row(0)};
    const RowRange rows{0, plan_.Height};
    for (const NotedUnit& noted : noted_) {
        const PlanUnit& unit = plan_.Units[static_cast<std::size_t>(noted.Unit)];
        for (std::int32_t i = 0; i < noted.ListedCount; ++i) {
            const ListedBulb& bulb = listed_[static_cast<std::size_t>(noted.FirstListed + i)];
            paintSquare(bulb.Sprite, bulb.Alpha, {bulb.Place, unit.Side});
            noteLit({bulb.Place, unit.Side});
        }
        const std::uint8_t alpha = alpha_[static_cast<std::size_t>(noted.Unit)];
        if (alpha == 0) continue;
        for (std::int32_t r = 0; r < unit.RunCount; ++r) {
            const PlanRun& run = plan_.Runs[static_cast<std::size_t>(unit.FirstRun + r)];
            const std::span<const BulbPlace> places{plan_.Places.data() + run.FirstPlace,
                                                    static_cast<std::size_t>(run.PlaceCount)};
            if (run.WholeOnCanvas) {
                kernels_.blendBulbs(plan_.Sprites[static_cast<std::size_t>(run.Sprite)], alpha, places, rows,
                                    unit.Alone && passes_ == 0 ? aloneTarget : target);
            } else {
                for (const BulbPlace& place : places)
                    paintSquare(run.Sprite, alpha, {place, unit.Side});
            }
            if (passes_ > 0) {
                for (const BulbPlace& place : places)
                    noteLit({place, unit.Side});
            }
        }
        if (passes_ == 0) {
            litUnits_.push_back(noted.Unit);
            markUnitTiles(unit);
        }
    }
}

void StandardSurface::paintSquare(std::int32_t sprite, std::uint8_t alpha, const BulbSquare& square) {
    const BulbSprite& image = plan_.Sprites[static_cast<std::size_t>(sprite)];
    const PixelTarget target{frame_.row(0), frame_.stride(), frame_.row(0)};
    if (square.Place.X >= 0 && square.Place.X + square.Side <= plan_.Width) {
        kernels_.blendBulbs(image, alpha, {&square.Place, 1}, {0, plan_.Height}, target);
    } else {
        blendClipped(image, alpha, square.Place.X, square.Place.Y, {target, plan_.Width, plan_.Height});
    }
}

// Remembers a square for restoring. Where the list is full, which takes a frame that draws bulbs again and again, its
// bands are restored whole.
void StandardSurface::noteLit(const BulbSquare& square) {
    markTiles(square, plan_.Width, plan_.Height, tiles_);
    if (lit_.size() < lit_.capacity()) {
        lit_.push_back(square);
        return;
    }
    const BandRange bands = bandsOf(square, plan_.Height);
    for (std::int32_t b = bands.First; b <= bands.Last; ++b) {
        bandLight_[static_cast<std::size_t>(b)] = BandLight::Unknown;
    }
}

// Brings the background back wherever the frame before left light that will not be painted over.
void StandardSurface::restoreLit() {
    for (std::size_t band = 0; band < bandLight_.size(); ++band) {
        if (bandLight_[band] != BandLight::None) restoreBand(band);
    }
    for (const BulbSquare& square : lit_) {
        markTiles(square, plan_.Width, plan_.Height, tiles_);
        restoreSquare(square);
    }
    lit_.clear();
    for (const std::int32_t number : litUnits_) {
        const PlanUnit& unit = plan_.Units[static_cast<std::size_t>(number)];
        if (unit.Alone && alpha_[static_cast<std::size_t>(number)] != 0) continue;
        markUnitTiles(unit);
        for (std::int32_t r = 0; r < unit.RunCount; ++r) {
            const PlanRun& run = plan_.Runs[static_cast<std::size_t>(unit.FirstRun + r)];
            for (std::int32_t p = 0; p < run.PlaceCount; ++p) {
                restoreSquare({plan_.Places[static_cast<std::size_t>(run.FirstPlace + p)], unit.Side});
            }
        }
    }
    litUnits_.clear();
}

void StandardSurface::restoreSquare(const BulbSquare& square) {
    const std::int32_t left = std::max(0, std::int32_t{square.Place.X});
    const std::int32_t right = std::min(plan_.Width, square.Place.X + square.Side);
    const std::int32_t bottom = std::min(plan_.Height, square.Place.Y + square.Side);
    for (std::int32_t y = std::max(0, std::int32_t{square.Place.Y}); y < bottom; ++y) {
        const std::uint32_t* from = background_.row(y) + left;
        std::uint32_t* to = frame_.row(y) + left;
        std::int32_t x = 0;
        for (; x + 4 <= right - left; x += 4)
            copyPixels(from + x, to + x, 4);
        for (; x < right - left; ++x)
            to[x] = from[x];
    }
}

void StandardSurface::restoreBand(std::size_t band) {
    const QRect rect = bandRect(band);
    for (std::int32_t y = rect.top(); y <= rect.bottom(); ++y) {
        copyPixels(background_.row(y) + rect.left(), frame_.row(y) + rect.left(), rect.width());
    }
    bandLight_[band] = BandLight::None;
    changed_.push_back(rect);
}

// What of the band lights can reach.
QRect StandardSurface::bandRect(std::size_t band) const {
    const auto top = static_cast<std::int32_t>(band) * kBandRows;
    const ColumnRange& columns = plan_.BandColumns[band];
    return {columns.Left, top, columns.Right - columns.Left, std::min(kBandRows, plan_.Height - top)};
}

void StandardSurface::markUnitTiles(const PlanUnit& unit) {
    for (std::int32_t t = 0; t < unit.TileCount; ++t) {
        const TileRow& tiles = plan_.Tiles[static_cast<std::size_t>(unit.FirstTile + t)];
        tiles_[static_cast<std::size_t>(tiles.Row)] |= tiles.Bits;
    }
}

// Runs of tiles in a row become one rectangle.
void StandardSurface::collectTiles() {
    const QRect canvas(0, 0, plan_.Width, plan_.Height);
    for (std::size_t row = 0; row < tiles_.size(); ++row) {
        std::uint64_t bits = tiles_[row];
        while (bits != 0) {
            const int first = std::countr_zero(bits);
            const int length = std::countr_one(bits >> first);
            bits &= ~(((std::uint64_t{1} << length) - 1) << first);
            changed_.push_back(
                QRect(first << kTileShift, static_cast<int>(row) << kTileShift, length << kTileShift, 1 << kTileShift)
                    .intersected(canvas));
        }
        tiles_[row] = 0;
    }
}
