#include "engine/frame_plan.h"

#include "engine/bulb_walk.h"
#include "engine/item_sort.h"
#include "engine/pixel_store.h"

#include <algorithm>
#include <map>
#include <utility>

namespace {

// Collects units in the order in which the render cycle calls for them.
class PlanBuilder {
public:
    PlanBuilder(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                const ZephMasks& masks, const ZephStaticBulbs& bulbs, FramePlan& plan)
        : document_(document), tables_(tables), states_(states), masks_(masks), bulbs_(bulbs), plan_(plan) {
        plan_.Units.resize(1);
    }

    void addAll() { numberUnitsPainted(tables_, *this, plan_.NumberOf); }

    void addChannel(std::int32_t fixture, std::int32_t channel) {
        const std::int32_t number = addUnit(fixture, channel);
        const ZephFixture& record = document_.Fixtures[fixture];
        const std::int32_t subType = record.Channels[channel].Sub_Type;
        if (subType < kSpecialNone || subType > kSpecialMultiColor) return;  // a special type that is not drawn

        PlanUnit& unit = plan_.Units.back();
        const std::int32_t colors = multiColors(record.Channels[channel]);
        for (std::int32_t color = 1; color <= colors; ++color) {
            const BulbImage& image = channelImage(record, channel, color, bulbs_[fixture]);
            if (image.Mask == nullptr || 2 * image.Mask->Size != unit.Side) return;  // not made for this look
            plan_.SpriteOf.push_back(sharedSprite(image));
        }
        unit.SpriteCount = colors;
        addItems(unit, number);
        if (subType == kSpecialStrobes) plan_.ListedBulbs += unit.BulbCount;
    }

    void addGroup(std::int32_t fixture) {
        const std::int32_t number = addUnit(fixture, 0);
        const ZephFixture& record = document_.Fixtures[fixture];
        ++plan_.Groups;
        if (record.Fixture_Type == kFixtureFlood) {
            ++plan_.FloodGroups;
            plan_.MaxFloodSize = std::max(plan_.MaxFloodSize, std::clamp(record.BulbSize, 0, kMaxFloodSize));
        }
        const BulbMask* mask = maskOf(masks_, record);
        if (mask == nullptr) return;

        PlanUnit& unit = plan_.Units.back();
        plan_.SpriteOf.push_back(static_cast<std::int32_t>(plan_.Sprites.size()));
        plan_.Sprites.push_back({mask, 0, nullptr});
        unit.SpriteCount = 1;
        if (record.Fixture_Type == kFixtureKesh || record.Fixture_Type == kFixtureDmxPixels) {
            // Its bulbs come as lists; the groups of a fixture share its bulbs out among them.
            bool& counted = counted_[static_cast<std::size_t>(fixture)];
            if (!counted) {
                plan_.ListedBulbs += unit.BulbCount;
                forEachPlace(unit, [&](BulbPlace place, std::int32_t) { reachColumns(place, unit.Side); });
            }
            counted = true;
        } else {
            addItems(unit, number);
        }
    }

private:
    std::int32_t addUnit(std::int32_t fixture, std::int32_t channel) {
        const ZephFixtureState& state = states_[fixture];
        PlanUnit unit{.Fixture = fixture};
        unit.FirstSprite = static_cast<std::int32_t>(plan_.SpriteOf.size());
        unit.FirstItem = static_cast<std::int32_t>(plan_.Items.size());
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

    // Images of the same mask and colour are the same, so few different ones stay in the cache.
    std::int32_t sharedSprite(const BulbImage& image) {
        const auto [found, isNew] =
            shared_.try_emplace({image.Mask, image.Color}, static_cast<std::int32_t>(plan_.Sprites.size()));
        if (isNew) plan_.Sprites.push_back(spriteOf(image));
        return found->second;
    }

    // visit(place, bulb0) for each bulb that touches the canvas.
    template <typename Visit>
    void forEachPlace(const PlanUnit& unit, Visit visit) const {
        for (std::int32_t b = 0; b < unit.BulbCount; ++b) {
            const ZephBulbLocation& bulb = tables_.BulbPool[static_cast<std::size_t>(unit.FirstBulb + b)];
            const std::int64_t x = std::int64_t{bulb.X} - unit.Side / 2;
            const std::int64_t y = std::int64_t{bulb.Y} - unit.Side / 2;
            if (bulb.Type == kPointPlaceHolder || !touchesCanvas(x, y, unit.Side, plan_.Width, plan_.Height)) continue;
            visit(BulbPlace{static_cast<std::int16_t>(x), static_cast<std::int16_t>(y)}, b);
        }
    }

    void addItems(PlanUnit& unit, std::int32_t number) {
        forEachPlace(unit, [&](BulbPlace place, std::int32_t bulb0) {
            const std::int32_t sprite =
                plan_.SpriteOf[static_cast<std::size_t>(unit.FirstSprite + bulb0 % unit.SpriteCount)];
            plan_.Items.push_back({place, number, sprite});
            reachColumns(place, unit.Side);
        });
        unit.ItemCount = static_cast<std::int32_t>(plan_.Items.size()) - unit.FirstItem;
    }

    void reachColumns(BulbPlace place, std::int32_t side) {
        const BandRange bands = bandsOf(place, side, plan_.Height);
        for (std::int32_t band = bands.First; band <= bands.Last; ++band) {
            ColumnRange& columns = plan_.BandColumns[static_cast<std::size_t>(band)];
            columns.Left = std::min(columns.Left, std::max(0, std::int32_t{place.X}));
            columns.Right = std::max(columns.Right, std::min(plan_.Width, place.X + side));
        }
    }

    const ZephSimulation& document_;
    const ZephRenderTables& tables_;
    const ZephFixtureStates& states_;
    const ZephMasks& masks_;
    const ZephStaticBulbs& bulbs_;
    FramePlan& plan_;
    std::array<bool, kMaxFixtures + 1> counted_{};  // [fixture], its bulbs are among ListedBulbs
    std::map<std::pair<const BulbMask*, std::uint32_t>, std::int32_t> shared_;
};

void cutIntoTiles(FramePlan& plan) {
    constexpr std::int32_t kLeastSides = 8;  // of the largest image, to a tile
    const std::int32_t wanted = std::max(kLeastTileWidth, kLeastSides * plan.MaxSide);
    plan.TileWidth = wholeCacheLines(std::min(wanted, plan.Width));
    plan.TileColumns = (plan.Width + plan.TileWidth - 1) / plan.TileWidth;
    plan.FirstTileItem.assign(static_cast<std::size_t>(plan.BandCount * plan.TileColumns) + 1, 0);
    sortItems([&](auto&& visit) { std::for_each(plan.Items.begin(), plan.Items.end(), visit); },
              [&](const BulbItem& item, auto&& visit) {
                  forEachTile(item.Place, plan.Units[static_cast<std::size_t>(item.Unit)].Side, plan, visit);
              },
              plan.TileItems, plan.FirstTileItem);
}

}  // namespace

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
    plan.BandColumns.assign(static_cast<std::size_t>(plan.BandCount), {width, 0});
    PlanBuilder(document, tables, states, masks, bulbs, plan).addAll();
    cutIntoTiles(plan);
    return plan;
}
