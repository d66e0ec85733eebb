#include "engine/frame_plan.h"

#include "engine/bulb_walk.h"

#include <algorithm>

namespace {

std::size_t channelSlot(std::int32_t fixture, std::int32_t channel) noexcept {
    return static_cast<std::size_t>(fixture * (kMaxChannels + 1) + channel);
}

// Collects units in the order in which the render cycle calls for them.
class PlanBuilder {
public:
    PlanBuilder(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                const ZephMasks& masks, const ZephStaticBulbs& bulbs, FramePlan& plan)
        : document_(document), tables_(tables), states_(states), masks_(masks), bulbs_(bulbs), plan_(plan) {
        plan_.Units.resize(1);
        plan_.UnitOfChannel.assign(channelSlot(kMaxFixtures + 1, 0), 0);
        plan_.UnitOfGroup.assign(tables.RGBData.size(), 0);
    }

    // Level by level, the plain channels before the groups.
    void addAll() {
        for (std::int32_t level = 1; level <= kLevels; ++level) {
            forEachSlot(level, [&](const ZephRenderSlot& slot) {
                if (!slot.isRGB() && slot.KeshMagic == 0) addChannel(slot.Fixture, slot.Channel);
            });
            forEachSlot(level, [&](const ZephRenderSlot& slot) {
                if (slot.isRGB()) addGroup(slot.Fixture, slot.RGBIndex);
            });
        }
    }

    // Of bulbs that are only ever drawn by lists.
    std::span<const BulbSquare> listedSquares() const noexcept { return listedSquares_; }

private:
    template <typename Visit>
    void forEachSlot(std::int32_t level, Visit visit) const {
        for (const ZephRenderData& entry : tables_.RenderData) {
            if ((entry.LevelUsed >> level & 1U) == 0) continue;
            for (std::int32_t s = 0; s < entry.SlotCount; ++s) {
                const ZephRenderSlot& slot = tables_.Slots[static_cast<std::size_t>(entry.FirstSlot + s)];
                if (slot.Level == level) visit(slot);
            }
        }
    }

    void addChannel(std::int32_t fixture, std::int32_t channel) {
        if (!OneBased<ZephFixture, kMaxFixtures>::contains(fixture) || channel < 1 || channel > kMaxChannels) return;
        std::int32_t& number = plan_.UnitOfChannel[channelSlot(fixture, channel)];
        if (number != 0) return;
        number = addUnit(fixture, channel);
        const ZephFixture& record = document_.Fixtures[fixture];
        const std::int32_t subType = record.Channels[channel].Sub_Type;
        if (subType < kSpecialNone || subType > kSpecialMultiColor) return;  // a special type that is not drawn

        PlanUnit& unit = plan_.Units.back();
        const std::int32_t colors = multiColors(record.Channels[channel]);
        for (std::int32_t color = 1; color <= colors; ++color) {
            const BulbImage& image = channelImage(record, channel, color, bulbs_[fixture]);
            if (image.Mask == nullptr) return;
            plan_.Sprites.push_back(spriteOf(image));
        }
        unit.SpriteCount = colors;
        addRuns(unit, plan_.Units.size() - 1);
        if (subType == kSpecialStrobes) plan_.ListedBulbs += unit.BulbCount;
    }

    void addGroup(std::int32_t fixture, std::int32_t rgbIndex) {
        if (!OneBased<ZephFixture, kMaxFixtures>::contains(fixture)) return;
        std::int32_t& number = plan_.UnitOfGroup.at(static_cast<std::size_t>(rgbIndex));
        if (number != 0) return;
        number = addUnit(fixture, 0);
        const ZephFixture& record = document_.Fixtures[fixture];
        ++plan_.Groups;
        if (record.Fixture_Type == kFixtureFlood) {
            ++plan_.FloodGroups;
            plan_.MaxFloodSize = std::max(plan_.MaxFloodSize, std::clamp(record.BulbSize, 0, kMaxFloodSize));
        }
        const BulbMask* mask = maskOf(masks_, record);
        if (mask == nullptr) return;

        PlanUnit& unit = plan_.Units.back();
        plan_.Sprites.push_back({mask, 0, nullptr});
        unit.SpriteCount = 1;
        if (record.Fixture_Type == kFixtureKesh || record.Fixture_Type == kFixtureDmxPixels) {
            // Its bulbs come as lists; the groups of a fixture share its bulbs out among them.
            bool& counted = counted_[static_cast<std::size_t>(fixture)];
            if (!counted) {
                plan_.ListedBulbs += unit.BulbCount;
                addListedPlaces(unit);
            }
            counted = true;
        } else {
            addRuns(unit, plan_.Units.size() - 1);
        }
    }

    std::int32_t addUnit(std::int32_t fixture, std::int32_t channel) {
        const ZephFixtureState& state = states_[fixture];
        PlanUnit unit{.Fixture = fixture, .Channel = channel};
        unit.FirstSprite = static_cast<std::int32_t>(plan_.Sprites.size());
        unit.FirstRun = static_cast<std::int32_t>(plan_.Runs.size());
        const std::int32_t location = channel == 0 ? 1 : channel;
        if (location <= state.LocationCount) {
            const ZephBulbLocations& bulbs = state.BulbLocations[static_cast<std::size_t>(location)];
            unit.FirstBulb = bulbs.First;
            unit.BulbCount = bulbs.Count;
        }
        const BulbMask* mask = maskOf(masks_, document_.Fixtures[fixture]);
        unit.Side = mask != nullptr ? 2 * mask->Size : 0;
        plan_.MaxSide = std::max(plan_.MaxSide, unit.Side);
        plan_.Units.push_back(unit);
        return static_cast<std::int32_t>(plan_.Units.size() - 1);
    }

    // visit(place, bulb0, whole) for each bulb that touches the canvas; whole: it is not cut by the edge.
    template <typename Visit>
    void forEachPlace(const PlanUnit& unit, Visit visit) const {
        for (std::int32_t b = 0; b < unit.BulbCount; ++b) {
            const ZephBulbLocation& bulb = tables_.BulbPool[static_cast<std::size_t>(unit.FirstBulb + b)];
            const std::int64_t x = std::int64_t{bulb.X} - unit.Side / 2;
            const std::int64_t y = std::int64_t{bulb.Y} - unit.Side / 2;
            if (bulb.Type == kPointPlaceHolder || !touchesCanvas(x, y, unit.Side, plan_.Width, plan_.Height)) continue;
            const bool whole = x >= 0 && y >= 0 && x + unit.Side <= plan_.Width && y + unit.Side <= plan_.Height;
            visit(BulbPlace{static_cast<std::int16_t>(x), static_cast<std::int16_t>(y)}, b, whole);
        }
    }

    void addListedPlaces(const PlanUnit& unit) {
        forEachPlace(unit, [&](BulbPlace place, std::int32_t, bool) { listedSquares_.push_back({place, unit.Side}); });
    }

    void addRuns(PlanUnit& unit, std::size_t number) {
        std::vector<std::uint64_t> tiles(kMaxTileRows, 0);
        unit.Alone = true;
        forEachPlace(unit, [&](BulbPlace place, std::int32_t bulb0, bool whole) {
            const std::int32_t sprite = unit.FirstSprite + bulb0 % unit.SpriteCount;
            if (unit.RunCount == 0 || plan_.Runs.back().Sprite != sprite) {
                plan_.Runs.push_back({static_cast<std::int32_t>(number), sprite,
                                      static_cast<std::int32_t>(plan_.Places.size()), 0, true});
                ++unit.RunCount;
            }
            PlanRun& run = plan_.Runs.back();
            ++run.PlaceCount;
            run.WholeOnCanvas = run.WholeOnCanvas && whole;
            unit.Alone = unit.Alone && whole;
            plan_.Places.push_back(place);
            ++unit.VisibleBulbs;
            markTiles({place, unit.Side}, plan_.Width, plan_.Height, tiles);
        });
        unit.FirstTile = static_cast<std::int32_t>(plan_.Tiles.size());
        for (std::size_t row = 0; row < tiles.size(); ++row) {
            if (tiles[row] != 0) plan_.Tiles.push_back({static_cast<std::int32_t>(row), tiles[row]});
        }
        unit.TileCount = static_cast<std::int32_t>(plan_.Tiles.size()) - unit.FirstTile;
    }

    const ZephSimulation& document_;
    const ZephRenderTables& tables_;
    const ZephFixtureStates& states_;
    const ZephMasks& masks_;
    const ZephStaticBulbs& bulbs_;
    FramePlan& plan_;
    std::array<bool, kMaxFixtures + 1> counted_{};  // [fixture], its bulbs are among ListedBulbs
    std::vector<BulbSquare> listedSquares_;
};

// visit(unit number, square) for each bulb of all runs.
template <typename Visit>
void forEachRunSquare(const FramePlan& plan, Visit visit) {
    for (const PlanRun& run : plan.Runs) {
        const std::int32_t side = plan.Units[static_cast<std::size_t>(run.Unit)].Side;
        for (std::int32_t p = 0; p < run.PlaceCount; ++p) {
            visit(run.Unit, BulbSquare{plan.Places[static_cast<std::size_t>(run.FirstPlace + p)], side});
        }
    }
}

// Clears Alone wherever two bulbs touch, what the kernels write beside an image included.
void findLoneUnits(std::span<const BulbSquare> listed, FramePlan& plan) {
    constexpr std::int32_t kListedOwner = -1;
    const auto footprint = [](std::int32_t side) { return side <= 4 ? 4 : (side + 7) / 8 * 8; };
    std::int64_t pixels = 0;
    forEachRunSquare(plan, [&](std::int32_t, const BulbSquare& square) {
        pixels += std::int64_t{footprint(square.Side)} * square.Side;
    });
    if (pixels > 2 * std::int64_t{plan.Width} * plan.Height) {  // not worth the search: hardly any can stand alone
        for (PlanUnit& unit : plan.Units)
            unit.Alone = false;
        return;
    }
    std::vector<std::int32_t> owners(static_cast<std::size_t>(plan.Width) * static_cast<std::size_t>(plan.Height), 0);
    const auto own = [&](std::int32_t owner, const BulbSquare& square) {
        const std::int32_t right = std::min(plan.Width, square.Place.X + footprint(square.Side));
        const std::int32_t bottom = std::min(plan.Height, square.Place.Y + square.Side);
        for (std::int32_t y = std::max(0, std::int32_t{square.Place.Y}); y < bottom; ++y) {
            for (std::int32_t x = std::max(0, std::int32_t{square.Place.X}); x < right; ++x) {
                std::int32_t& present = owners[static_cast<std::size_t>(y * plan.Width + x)];
                if (present != 0) {
                    if (present > 0) plan.Units[static_cast<std::size_t>(present)].Alone = false;
                    if (owner > 0) plan.Units[static_cast<std::size_t>(owner)].Alone = false;
                }
                present = owner;
            }
        }
    };
    for (const BulbSquare& square : listed)
        own(kListedOwner, square);
    forEachRunSquare(plan, own);
}

void findBandColumns(std::span<const BulbSquare> listed, FramePlan& plan) {
    plan.BandColumns.assign(static_cast<std::size_t>(plan.BandCount), {plan.Width, 0});
    const auto reach = [&](std::int32_t, const BulbSquare& square) {
        const BandRange bands = bandsOf(square, plan.Height);
        for (std::int32_t band = bands.First; band <= bands.Last; ++band) {
            ColumnRange& columns = plan.BandColumns[static_cast<std::size_t>(band)];
            columns.Left = std::min(columns.Left, std::max(0, std::int32_t{square.Place.X}));
            columns.Right = std::max(columns.Right, std::min(plan.Width, square.Place.X + square.Side));
        }
    };
    for (const BulbSquare& square : listed)
        reach(0, square);
    forEachRunSquare(plan, reach);
}

// Shares the places of all runs out among the bands that they touch; the order within a band is that of the runs.
void sortIntoBands(FramePlan& plan) {
    struct BandBulb {
        std::int32_t Unit;
        std::int32_t Sprite;
        BulbPlace Place;
    };
    std::vector<std::vector<BandBulb>> bands(static_cast<std::size_t>(plan.BandCount));
    for (const PlanRun& run : plan.Runs) {
        const std::int32_t side = plan.Units[static_cast<std::size_t>(run.Unit)].Side;
        for (std::int32_t p = 0; p < run.PlaceCount; ++p) {
            const BulbPlace place = plan.Places[static_cast<std::size_t>(run.FirstPlace + p)];
            const BandRange touched = bandsOf({place, side}, plan.Height);
            for (std::int32_t band = touched.First; band <= touched.Last; ++band) {
                bands[static_cast<std::size_t>(band)].push_back({run.Unit, run.Sprite, place});
            }
        }
    }
    for (const std::vector<BandBulb>& band : bands) {
        plan.FirstBandRun.push_back(static_cast<std::int32_t>(plan.BandRuns.size()));
        std::int32_t sprite = -1;
        for (const BandBulb& bulb : band) {
            if (bulb.Sprite != sprite) {
                sprite = bulb.Sprite;
                plan.BandRuns.push_back(
                    {bulb.Unit, bulb.Sprite, static_cast<std::int32_t>(plan.BandPlaces.size()), 0, false});
            }
            ++plan.BandRuns.back().PlaceCount;
            plan.BandPlaces.push_back(bulb.Place);
        }
    }
    plan.FirstBandRun.push_back(static_cast<std::int32_t>(plan.BandRuns.size()));
}

}  // namespace

BandRange bandsOf(const BulbSquare& square, std::int32_t height) noexcept {
    return {std::max(0, std::int32_t{square.Place.Y}) / kBandRows,
            (std::min(height, square.Place.Y + square.Side) - 1) / kBandRows};
}

void markTiles(const BulbSquare& square, std::int32_t width, std::int32_t height,
               std::span<std::uint64_t> tiles) noexcept {
    const std::int32_t left = std::max(0, std::int32_t{square.Place.X}) >> kTileShift;
    const std::int32_t right = (std::min(width, square.Place.X + square.Side) - 1) >> kTileShift;
    const std::int32_t top = std::max(0, std::int32_t{square.Place.Y}) >> kTileShift;
    const std::int32_t bottom = (std::min(height, square.Place.Y + square.Side) - 1) >> kTileShift;
    const std::uint64_t bits = (std::uint64_t{2} << right) - (std::uint64_t{1} << left);
    for (std::int32_t row = top; row <= bottom; ++row)
        tiles[static_cast<std::size_t>(row)] |= bits;
}

bool touchesCanvas(std::int64_t x, std::int64_t y, std::int32_t side, std::int32_t width,
                   std::int32_t height) noexcept {
    return x + side > 0 && y + side > 0 && x < width && y < height;
}

FramePlan makeFramePlan(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                        const ZephMasks& masks, const ZephStaticBulbs& bulbs, std::int32_t width, std::int32_t height) {
    FramePlan plan;
    plan.Width = width;
    plan.Height = height;
    plan.BandCount = (height + kBandRows - 1) / kBandRows;
    PlanBuilder builder(document, tables, states, masks, bulbs, plan);
    builder.addAll();
    findLoneUnits(builder.listedSquares(), plan);
    findBandColumns(builder.listedSquares(), plan);
    sortIntoBands(plan);
    return plan;
}
