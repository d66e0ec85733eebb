// What a drawing surface works out once, at entry into simulation: every plain channel and RGB group in the order in
// which frames paint them, and their bulbs twice over: by group, and by tiles of the canvas in the order of painting.
#pragma once

#include "engine/blend.h"
#include "engine/bulb_images.h"
#include "engine/fixture_state.h"
#include "engine/paint_order.h"
#include "engine/render_table.h"

#include <algorithm>
#include <cstdint>
#include <span>
#include <vector>

// The canvas is cut into bands of rows, and each band into tiles. A tile of small bulbs fits the first-level cache,
// margins included; wider images come with wider tiles, so that little of their width lies over the edges.
inline constexpr std::int32_t kBandRows = 32;
inline constexpr std::int32_t kLeastTileWidth = 128;  // pixels

// A plain channel or an RGB group. Units are numbered from 1 in the order of painting.
struct PlanUnit {
    std::int32_t Fixture = 0;
    std::int32_t FirstSprite = 0;  // into SpriteOf: one, or one a colour of a Multi Color channel
    std::int32_t SpriteCount = 0;  // 0 = the fixture's size or shape has no mask: nothing is drawn
    std::int32_t FirstItem = 0;    // into Items: its bulbs, unless they come as lists
    std::int32_t ItemCount = 0;
    std::int32_t FirstBulb = 0;  // into BulbPool, as in ZephBulbLocations
    std::int32_t BulbCount = 0;
    std::int32_t Side = 0;  // pixels, of a bulb's image
};

struct ColumnRange {
    std::int32_t Left = 0;   // pixels
    std::int32_t Right = 0;  // one past the last
};

struct FramePlan {
    std::int32_t Width = 0;  // pixels, the canvas
    std::int32_t Height = 0;
    std::int32_t BandCount = 0;
    std::int32_t TileWidth = 0;               // pixels, whole cache lines
    std::int32_t TileColumns = 0;             // tiles of a band; tile number = band x TileColumns + column, from 0
    std::vector<PlanUnit> Units;              // [0] not used, draws nothing
    UnitNumbers NumberOf;                     // into Units
    std::vector<std::int32_t> SpriteOf;       // into Sprites, by unit
    std::vector<BulbSprite> Sprites;          // those of groups change from frame to frame, the others are shared
    std::vector<BulbItem> Items;              // by unit
    std::vector<BulbItem> TileItems;          // by tile, within it in the order of painting
    std::vector<std::int32_t> FirstTileItem;  // [tile], one more than tiles
    std::vector<ColumnRange> BandColumns;     // [band], all that lights can reach
    std::int32_t ListedBulbs = 0;             // bulbs of units that are drawn by lists: ribbons, pixels, strobes
    std::int32_t MaxSide = 0;                 // pixels
    std::int32_t Groups = 0;                  // RGB groups
    std::int32_t FloodGroups = 0;
    std::int32_t MaxFloodSize = 0;  // of the flood groups
};

struct BandRange {
    std::int32_t First = 0;
    std::int32_t Last = 0;
};
// The bands that an image touches, given that it touches the canvas.
inline BandRange bandsOf(BulbPlace place, std::int32_t side, std::int32_t height) noexcept {
    return {std::max(0, std::int32_t{place.Y}) / kBandRows, (std::min(height, place.Y + side) - 1) / kBandRows};
}

// The columns of tiles that an image touches, given that it touches the canvas.
inline BandRange tileColumnsOf(BulbPlace place, std::int32_t side, const FramePlan& plan) noexcept {
    return {std::max(0, std::int32_t{place.X}) / plan.TileWidth,
            (std::min(plan.Width, place.X + side) - 1) / plan.TileWidth};
}

// visit(tile) for each tile that an image touches.
template <typename Visit>
void forEachTile(BulbPlace place, std::int32_t side, const FramePlan& plan, Visit visit) {
    const BandRange bands = bandsOf(place, side, plan.Height);
    const BandRange columns = tileColumnsOf(place, side, plan);
    for (std::int32_t band = bands.First; band <= bands.Last; ++band) {
        for (std::int32_t column = columns.First; column <= columns.Last; ++column) {
            visit(static_cast<std::size_t>(band * plan.TileColumns + column));
        }
    }
}

// A place whose image touches the canvas.
bool touchesCanvas(std::int64_t x, std::int64_t y, std::int32_t side, std::int32_t width, std::int32_t height) noexcept;

// width, height: the canvas in pixels, 1..kMaxCanvasPixels.
FramePlan makeFramePlan(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                        const ZephMasks& masks, const ZephStaticBulbs& bulbs, std::int32_t width, std::int32_t height);
