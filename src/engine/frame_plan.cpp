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

    // Level by level, the plain channels before the groups; then what no entry names, so that every channel has a unit.
    void addAll() {
        for (std::int32_t level = 1; level <= kLevels; ++level) {
            forEachSlot(level, [&](const ZephRenderSlot& slot) {
                if (!slot.isRGB() && slot.KeshMagic == 0) addChannel(slot.Fixture, slot.Channel);
            });
            forEachSlot(level, [&](const ZephRenderSlot& slot) {
                if (slot.isRGB()) addGroup(slot.Fixture, slot.RGBIndex);
            });
        }
        for (std::int32_t fixture = 1; fixture <= document_.FixtureCount; ++fixture) {
            for (std::int32_t channel = 1; channel <= states_[fixture].LocationCount; ++channel) {
                addChannel(fixture, channel);
            }
        }
    }

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
            if (!counted) plan_.ListedBulbs += unit.BulbCount;
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

    void addRuns(PlanUnit& unit, std::size_t number) {
        const std::int32_t radius = unit.Side / 2;
        for (std::int32_t b = 0; b < unit.BulbCount; ++b) {
            const ZephBulbLocation& bulb = tables_.BulbPool[static_cast<std::size_t>(unit.FirstBulb + b)];
            const std::int64_t x = std::int64_t{bulb.X} - radius;
            const std::int64_t y = std::int64_t{bulb.Y} - radius;
            if (bulb.Type == kPointPlaceHolder || !touchesCanvas(x, y, unit.Side, plan_.Width, plan_.Height)) continue;
            const bool whole = x >= 0 && y >= 0 && x + unit.Side <= plan_.Width && y + unit.Side <= plan_.Height;
            const std::int32_t sprite = unit.FirstSprite + b % unit.SpriteCount;
            if (unit.RunCount == 0 || plan_.Runs.back().Sprite != sprite) {
                plan_.Runs.push_back({static_cast<std::int32_t>(number), sprite,
                                      static_cast<std::int32_t>(plan_.Places.size()), 0, true});
                ++unit.RunCount;
            }
            PlanRun& run = plan_.Runs.back();
            ++run.PlaceCount;
            run.WholeOnCanvas = run.WholeOnCanvas && whole;
            plan_.Places.push_back({static_cast<std::int16_t>(x), static_cast<std::int16_t>(y)});
            ++unit.VisibleBulbs;
        }
    }

    const ZephSimulation& document_;
    const ZephRenderTables& tables_;
    const ZephFixtureStates& states_;
    const ZephMasks& masks_;
    const ZephStaticBulbs& bulbs_;
    FramePlan& plan_;
    std::array<bool, kMaxFixtures + 1> counted_{};  // [fixture], its bulbs are among ListedBulbs
};

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
            const std::int32_t first = std::max(0, std::int32_t{place.Y}) / kBandRows;
            const std::int32_t last = std::min(plan.Height, place.Y + side) - 1;
            for (std::int32_t band = first; band <= last / kBandRows; ++band) {
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
    PlanBuilder(document, tables, states, masks, bulbs, plan).addAll();
    sortIntoBands(plan);
    return plan;
}
