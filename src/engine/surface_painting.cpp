// How the standard surface paints what was noted. A densely lit frame: each tile is put together in the cache, from
// the background up, and streamed out. A thinly lit one: its bulbs are sorted by bands, and in each band those of
// the frame before are taken away and the new ones blended where they lie.
#include "engine/item_sort.h"
#include "engine/standard_surface.h"

#include <algorithm>
#include <bit>
#include <cstring>

namespace {

constexpr std::int32_t kTileShift = 6;  // columns of 64 pixels tell what of a band has changed
static_assert(kMaxCanvasPixels >> kTileShift < 63);
constexpr std::size_t kFetchAhead = 16;  // bulbs

void copyPixels(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    std::memcpy(to, from, static_cast<std::size_t>(pixels) * sizeof(std::uint32_t));
}

// Pixels of the image's side. The few images stay in the cache, the many units do not.
std::int32_t sideOf(const BulbItem& item, const FramePlan& plan) noexcept {
    return 2 * plan.Sprites[static_cast<std::size_t>(item.Sprite)].Mask->Size;
}

// pixels is a multiple of four.
void copyFours(const std::uint32_t* from, std::uint32_t* to, std::int32_t pixels) noexcept {
    for (std::int32_t x = 0; x < pixels; x += 4)
        copyPixels(from + x, to + x, 4);
}

// The rows of a square from one place to another; strides are pixels.
template <typename Square>
void copySquare(const std::uint32_t* from, std::ptrdiff_t fromStride, std::uint32_t* to, std::ptrdiff_t toStride,
                const Square& square) noexcept {
    for (std::int32_t y = square.Top; y < square.Bottom; ++y, from += fromStride, to += toStride) {
        copyFours(from, to, square.Width);
    }
}

}  // namespace

RowRange StandardSurface::bandRows(std::size_t band) const noexcept {
    const auto top = static_cast<std::int32_t>(band) * kBandRows;
    return {top, std::min(top + kBandRows, plan_.Height)};
}

inline std::uint64_t StandardSurface::tilesOf(const BulbItem& item) const noexcept {
    const std::int32_t side = sideOf(item, plan_);
    const std::int32_t left = std::max(0, std::int32_t{item.Place.X}) >> kTileShift;
    const std::int32_t right = (std::min(plan_.Width, item.Place.X + side) - 1) >> kTileShift;
    return (std::uint64_t{2} << right) - (std::uint64_t{1} << left);
}

// The rows of the image within the band, whole fours of pixels wide.
inline StandardSurface::Square StandardSurface::squareOf(const BulbItem& item, RowRange rows) const noexcept {
    const std::int32_t side = sideOf(item, plan_);
    return {item.Place.X, (side + 3) / 4 * 4, std::max(rows.Top, std::int32_t{item.Place.Y}),
            std::min(rows.Bottom, item.Place.Y + side)};
}

void StandardSurface::endFrame() {
    if (!scene_) return;
    paintNoted();
    if (passes_ > 1) lastRepeats_ = false;
    if (wholeChanged_) changed_.assign(1, image_.rect());
    wholeChanged_ = false;
    if (anySpriteChanged_) std::fill(spriteChanged_.begin(), spriteChanged_.end(), std::uint8_t{0});
    anySpriteChanged_ = false;
}

// Paints what was noted since the frame began, or since the pass before.
void StandardSurface::paintNoted() {
    if (passes_ > 0) {
        paintOver();
    } else {
        const bool repeats = listed_.empty();
        if (!repeats || !lastRepeats_ || anySpriteChanged_ || whole_ != lastWhole_) {
            if (worthBands()) {
                paintDense();
            } else if (repeats && lastRepeats_ && notedWhole_ == lastNotedWhole_ && showsLastList()) {
                paintThinAgain();
            } else {
                paintThin();
            }
        }
        lastRepeats_ = repeats;
        alpha_.swap(lastAlpha_);
        whole_.swap(lastWhole_);
    }
    ++passes_;
    std::fill(alpha_.begin(), alpha_.end(), std::uint8_t{0});
    std::fill(whole_.begin(), whole_.end(), std::uint8_t{0});
    if (passes_ == 1) notedWhole_.swap(lastNotedWhole_);
    notedWhole_.clear();
    listed_.clear();
    lastUnit_ = 0;
    litBulbs_ = 0;
    litPixels_ = 0;
}

// Dense painting costs a copy of all that lights can reach, thin painting the cache misses of every bulb. Measured on
// scattered bulbs of size 2, the two meet where a sixth of the canvas lies under bulbs; large bulbs, whose rows are
// long, lie thin for longer.
bool StandardSurface::worthBands() const noexcept {
    constexpr std::int64_t kBulbCost = 58;  // in pixels painted thin
    return litPixels_ + kBulbCost * litBulbs_ > thinLimit_;
}

// visit(item) for all that was noted, in the order of painting.
template <typename Visit>
void StandardSurface::forEachNoted(Visit visit) const {
    std::size_t listed = 0;
    for (const std::int32_t unit : notedWhole_) {
        for (; listed < listed_.size() && listed_[listed].Unit < unit; ++listed)
            visit(listed_[listed]);
        const PlanUnit& planned = plan_.Units[static_cast<std::size_t>(unit)];
        for (std::int32_t i = 0; i < planned.ItemCount; ++i) {
            visit(plan_.Items[static_cast<std::size_t>(planned.FirstItem + i)]);
        }
    }
    for (; listed < listed_.size(); ++listed)
        visit(listed_[listed]);
}

void StandardSurface::paintDense() {
    sortItems([&](auto&& visit) { std::for_each(listed_.begin(), listed_.end(), visit); },
              [&](const BulbItem& item, auto&& visit) { forEachTile(item.Place, sideOf(item, plan_), plan_, visit); },
              tileListed_.Items, tileListed_.First);
    const auto columns = static_cast<std::size_t>(plan_.TileColumns);
    for (std::size_t band = 0; band < bandLight_.size(); ++band) {
        if (!denseBandChanged(band)) continue;
        for (std::size_t tile = band * columns; tile < (band + 1) * columns; ++tile)
            paintTileDense(tile);
        const bool listed = !tileListed_.of(band * columns, (band + 1) * columns).empty();
        bandLight_[band] = listed ? BandLight::Unknown : BandLight::Whole;
        tellBand(band);
    }
    kernels_.endStreaming();
}

bool StandardSurface::denseBandChanged(std::size_t band) const noexcept {
    const std::size_t first = band * static_cast<std::size_t>(plan_.TileColumns);
    const std::size_t end = first + static_cast<std::size_t>(plan_.TileColumns);
    if (bandLight_[band] == BandLight::Listed || bandLight_[band] == BandLight::Unknown ||
        !tileListed_.of(first, end).empty()) {
        return true;
    }
    return std::ranges::any_of(itemsOf(plan_.TileItems, plan_.FirstTileItem, first, end), [&](const BulbItem& item) {
        const auto unit = static_cast<std::size_t>(item.Unit);
        return whole_[unit] != lastWhole_[unit] || (spriteChanged_[unit] != 0 && whole_[unit] != 0);
    });
}

StandardSurface::TileArea StandardSurface::tileArea(std::size_t tile) const noexcept {
    const auto columns = static_cast<std::size_t>(plan_.TileColumns);
    const ColumnRange reached = plan_.BandColumns[tile / columns];
    const std::int32_t left = static_cast<std::int32_t>(tile % columns) * plan_.TileWidth;
    TileArea area{bandRows(tile / columns), std::max(left, reached.Left / kCacheLinePixels * kCacheLinePixels),
                  std::min(left + plan_.TileWidth, wholeCacheLines(reached.Right))};
    area.Right = std::max(area.Left, area.Right);
    return area;
}

// Puts the tile together in the cache and streams it out.
void StandardSurface::paintTileDense(std::size_t tile) {
    const TileArea area = tileArea(tile);
    if (area.Left == area.Right) return;
    const std::int32_t pixels = area.Right - area.Left;
    const PixelTarget target{tile_.row(kBandMarginRows) - std::ptrdiff_t{area.Rows.Top} * tile_.stride() - area.Left,
                             tile_.stride()};
    for (std::int32_t y = area.Rows.Top; y < area.Rows.Bottom; ++y) {
        copyPixels(background_.row(y) + area.Left, target.Origin + y * target.Stride + area.Left, pixels);
    }
    paintItemsDense(tile, {area.Rows.Top - kBandMarginRows, area.Rows.Bottom + kBandMarginRows}, target);
    for (std::int32_t y = area.Rows.Top; y < area.Rows.Bottom; ++y) {
        kernels_.streamRow(target.Origin + y * target.Stride + area.Left, frame_.row(y) + area.Left, pixels);
    }
}

// Planned and listed bulbs merged by the order of their units.
void StandardSurface::paintItemsDense(std::size_t tile, RowRange rows, const PixelTarget& target) {
    const std::span<const BulbItem> items = itemsOf(plan_.TileItems, plan_.FirstTileItem, tile, tile + 1);
    const std::span<const BulbItem> listed = tileListed_.of(tile);
    std::size_t item = 0;
    std::size_t list = 0;
    const auto paintItemsUpTo = [&](std::size_t end) {
        kernels_.blendItems(items.subspan(item, end - item), whole_.data(), plan_.Sprites.data(), rows, target);
        item = end;
    };
    // The next tile's background is fetched row by row meanwhile: blending leaves the memory idle.
    const TileArea next = tile + 2 < plan_.FirstTileItem.size() ? tileArea(tile + 1) : TileArea{};
    for (std::int32_t part = 1; part <= kBandRows; ++part) {
        fetchTileRow(next, part - 1);
        const std::size_t end = items.size() * static_cast<std::size_t>(part) / kBandRows;
        while (list < listed.size() && end > 0 && listed[list].Unit < items[end - 1].Unit) {
            const std::int32_t unit = listed[list].Unit;
            const auto later = std::find_if(items.begin() + static_cast<std::ptrdiff_t>(item), items.end(),
                                            [&](const BulbItem& other) { return other.Unit > unit; });
            paintItemsUpTo(static_cast<std::size_t>(later - items.begin()));
            const std::int32_t before = items[item].Unit;
            const std::size_t first = list;
            while (list < listed.size() && listed[list].Unit < before)
                ++list;
            kernels_.blendItems(listed.subspan(first, list - first), alpha_.data(), plan_.Sprites.data(), rows, target);
        }
        if (item < end) paintItemsUpTo(end);
    }
    kernels_.blendItems(listed.subspan(list), alpha_.data(), plan_.Sprites.data(), rows, target);
}

void StandardSurface::fetchTileRow(const TileArea& area, std::int32_t row0) const noexcept {
    const std::int32_t y = area.Rows.Top + row0;
    if (y >= area.Rows.Bottom) return;
    const std::uint32_t* row = background_.row(y);
    for (std::int32_t x = area.Left; x < area.Right; x += kCacheLinePixels) {
        __builtin_prefetch(row + x, 0, 2);
    }
}

void StandardSurface::paintThin() {
    sortItems([&](auto&& visit) { forEachNoted(visit); },
              [&](const BulbItem& item, auto&& visit) {
                  const BandRange bands = bandsOf(item.Place, sideOf(item, plan_), plan_.Height);
                  for (std::int32_t band = bands.First; band <= bands.Last; ++band)
                      visit(static_cast<std::size_t>(band));
              },
              bandListed_.Items, bandListed_.First);
    saved_.Used = 0;
    for (std::size_t band = 0; band < bandLight_.size(); ++band)
        paintBandThin(band);
    std::swap(bandListed_, lastListed_);
    std::swap(saved_, lastSaved_);
    aloneFound_ = false;
}

bool StandardSurface::showsLastList() const noexcept {
    return std::ranges::none_of(
        bandLight_, [](BandLight light) { return light == BandLight::Whole || light == BandLight::Unknown; });
}

// The same bulbs as in the frame before at other strengths, as in every fade: the lists stand, and so does what was
// saved under the bulbs that lie alone, which are therefore touched once instead of twice.
void StandardSurface::paintThinAgain() {
    if (!aloneFound_) findAlone();
    for (std::size_t band = 0; band < bandLight_.size(); ++band) {
        const std::span<const BulbItem> items = lastListed_.of(band);
        const bool same = std::ranges::all_of(items, [&](const BulbItem& item) {
            const auto unit = static_cast<std::size_t>(item.Unit);
            return alpha_[unit] == lastAlpha_[unit] && spriteChanged_[unit] == 0;
        });
        if (!same) paintBandThinAgain(band);
    }
}

void StandardSurface::paintBandThinAgain(std::size_t band) {
    const RowRange rows = bandRows(band);
    const std::span<const BulbItem> items = lastListed_.of(band);
    const std::uint8_t* const alone = alone_.data() + lastListed_.First[band];
    // Those that lie over others are taken away first, from the top down.
    std::uint32_t* saved = lastSaved_.Pixels.data() + lastSaved_.End[band + 1];
    for (std::size_t i = items.size(); i-- > 0;) {
        const Square square = squareOf(items[i], rows);
        saved -= square.Width * (square.Bottom - square.Top);
        if (alone[i] == 0)
            copySquare(saved, square.Width, frame_.row(square.Top) + square.Left, frame_.stride(), square);
    }
    const PixelTarget target{frame_.row(0), frame_.stride()};
    std::uint64_t tiles = 0;
    for (std::size_t i = 0; i < items.size(); ++i) {
        if (i + kFetchAhead < items.size()) fetchItem(items[i + kFetchAhead]);
        const Square square = squareOf(items[i], rows);
        std::uint32_t* const lit = frame_.row(square.Top) + square.Left;
        if (alone[i] != 0) {
            copySquare(saved, square.Width, lit, frame_.stride(), square);
        } else {
            copySquare(lit, frame_.stride(), saved, square.Width, square);
        }
        kernels_.blendItems(items.subspan(i, 1), alpha_.data(), plan_.Sprites.data(), rows, target);
        saved += square.Width * (square.Bottom - square.Top);
        tiles |= tilesOf(items[i]);
    }
    tellTiles(band, tiles);
}

void StandardSurface::findAlone() {
    const std::int32_t words = coveredWords(plan_.Width);
    for (std::size_t band = 0; band < bandLight_.size(); ++band) {
        const RowRange rows = bandRows(band);
        const std::span<const BulbItem> items = lastListed_.of(band);
        std::fill(covered_.begin(), covered_.end(), std::uint64_t{0});
        for (std::size_t i = 0; i < items.size(); ++i) {
            const Square square = squareOf(items[i], rows);
            bool alone = true;
            for (std::int32_t y = square.Top; y < square.Bottom; ++y) {
                std::uint64_t* const row = covered_.data() + (y - rows.Top) * words;
                for (std::int32_t x = square.Left + kCoveredMargin; x < square.Left + kCoveredMargin + square.Width;
                     ++x) {
                    const std::uint64_t bit = std::uint64_t{1} << (x & 63);
                    alone = alone && (row[x >> 6] & bit) == 0;
                    row[x >> 6] |= bit;
                }
            }
            alone_[static_cast<std::size_t>(lastListed_.First[band]) + i] = alone ? 1 : 0;
        }
    }
    aloneFound_ = true;
}

void StandardSurface::paintBandThin(std::size_t band) {
    const RowRange rows = bandRows(band);
    const std::span<const BulbItem> items = bandListed_.of(band);
    std::uint64_t tiles = 0;
    if (bandLight_[band] == BandLight::Listed) {
        const std::span<const BulbItem> last = lastListed_.of(band);
        const bool same = std::equal(
            items.begin(), items.end(), last.begin(), last.end(), [&](const BulbItem& item, const BulbItem& before) {
                const auto unit = static_cast<std::size_t>(item.Unit);
                return item == before && alpha_[unit] == lastAlpha_[unit] && spriteChanged_[unit] == 0;
            });
        if (same) {
            keepSaved(band);
            return;
        }
        tiles |= restoreBand(band, last);
    } else if (bandLight_[band] != BandLight::None) {
        const ColumnRange columns = plan_.BandColumns[band];
        for (std::int32_t y = rows.Top; y < rows.Bottom; ++y) {
            copyPixels(background_.row(y) + columns.Left, frame_.row(y) + columns.Left, columns.Right - columns.Left);
        }
        tellBand(band);
    }

    const PixelTarget target{frame_.row(0), frame_.stride()};
    for (std::size_t i = 0; i < items.size(); ++i) {
        if (i + kFetchAhead < items.size()) fetchItem(items[i + kFetchAhead]);
        saveUnder(items[i], rows);
        kernels_.blendItems(items.subspan(i, 1), alpha_.data(), plan_.Sprites.data(), rows, target);
        tiles |= tilesOf(items[i]);
    }
    saved_.End[band + 1] = saved_.Used;
    tellTiles(band, tiles);
    bandLight_[band] = items.empty() ? BandLight::None : BandLight::Listed;
}

// What lies under a bulb is saved before it is blended and put back in reverse order in the next frame: read one after
// the other, where the background's own rows would be so many more cache misses.
std::uint64_t StandardSurface::restoreBand(std::size_t band, std::span<const BulbItem> last) {
    const RowRange rows = bandRows(band);
    std::uint64_t tiles = 0;
    const std::uint32_t* from = lastSaved_.Pixels.data() + lastSaved_.End[band + 1];
    for (std::size_t i = last.size(); i-- > 0;) {
        if (i >= kFetchAhead) fetchItem(last[i - kFetchAhead]);
        const Square square = squareOf(last[i], rows);
        from -= square.Width * (square.Bottom - square.Top);
        copySquare(from, square.Width, frame_.row(square.Top) + square.Left, frame_.stride(), square);
        tiles |= tilesOf(last[i]);
    }
    return tiles;
}

void StandardSurface::saveUnder(const BulbItem& item, RowRange rows) {
    const Square square = squareOf(item, rows);
    copySquare(frame_.row(square.Top) + square.Left, frame_.stride(), saved_.Pixels.data() + saved_.Used, square.Width,
               square);
    saved_.Used += square.Width * (square.Bottom - square.Top);
}

// The band stays as it is, and so does what lies under its bulbs.
void StandardSurface::keepSaved(std::size_t band) {
    const auto first = lastSaved_.Pixels.begin() + lastSaved_.End[band];
    const auto end = lastSaved_.Pixels.begin() + lastSaved_.End[band + 1];
    std::copy(first, end, saved_.Pixels.begin() + saved_.Used);
    saved_.Used += static_cast<std::int32_t>(end - first);
    saved_.End[band + 1] = saved_.Used;
}

// Calls out of the planned order come here: over what the passes before painted.
void StandardSurface::paintOver() {
    const PixelTarget target{frame_.row(0), frame_.stride()};
    forEachNoted([&](const BulbItem& item) {
        kernels_.blendItems({&item, 1}, alpha_.data(), plan_.Sprites.data(), {0, plan_.Height}, target);
        const BandRange bands = bandsOf(item.Place, sideOf(item, plan_), plan_.Height);
        for (std::int32_t b = bands.First; b <= bands.Last; ++b) {
            const auto band = static_cast<std::size_t>(b);
            // One that is Unknown by now was painted in this frame and told then.
            if (bandLight_[band] != BandLight::Unknown) tellBand(band);
            bandLight_[band] = BandLight::Unknown;
        }
    });
}

// Asks for the rows of a small bulb ahead of their use; the rows of large ones the processor fetches by itself.
void StandardSurface::fetchItem(const BulbItem& item) const noexcept {
    constexpr std::int32_t kSmallBulb = 4;  // pixels, both ways
    const std::int32_t first = std::max(0, std::int32_t{item.Place.Y});
    const std::int32_t end = std::min(plan_.Height, item.Place.Y + kSmallBulb);
    // A row may lie on two cache lines.
    const std::int32_t last = item.Place.X + kSmallBulb - 1;
    for (std::int32_t y = first; y < end; ++y) {
        const std::uint32_t* const row = frame_.row(y);
        __builtin_prefetch(row + item.Place.X, 1, 3);
        __builtin_prefetch(row + last, 1, 3);
    }
}

void StandardSurface::tellBand(std::size_t band) {
    const RowRange rows = bandRows(band);
    const ColumnRange columns = plan_.BandColumns[band];
    changed_.emplace_back(columns.Left, rows.Top, columns.Right - columns.Left, rows.Bottom - rows.Top);
}

// Tiles side by side become one rectangle.
void StandardSurface::tellTiles(std::size_t band, std::uint64_t tiles) {
    const RowRange rows = bandRows(band);
    while (tiles != 0) {
        const int first = std::countr_zero(tiles);
        const int count = std::countr_one(tiles >> first);
        tiles &= ~(((std::uint64_t{1} << count) - 1) << first);
        const std::int32_t left = first << kTileShift;
        changed_.emplace_back(left, rows.Top, std::min(plan_.Width - left, count << kTileShift),
                              rows.Bottom - rows.Top);
    }
}
