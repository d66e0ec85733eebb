#include "engine/gl_plan.h"

#include "engine/bulb_walk.h"
#include "util/failure.h"

#include <array>
#include <map>

namespace {

constexpr std::int32_t kFarthestPixel = 32'000;  // a bulb's corners still fit 16 bits
constexpr std::size_t kMostIndices = std::size_t{1} << 30;

class GLPlanBuilder {
public:
    GLPlanBuilder(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                  const ZephGLShapes& shapes, GLPlan& plan)
        : document_(document), tables_(tables), states_(states), shapes_(shapes), plan_(plan) {
        plan_.Units.resize(1);
    }

    void addAll() { numberUnitsPainted(tables_, *this, plan_.NumberOf); }

    void addChannel(std::int32_t fixture, std::int32_t channel) {
        const ZephChannel& record = document_.Fixtures[fixture].Channels[channel];
        GLPlanUnit unit = newUnit(fixture, channel);
        switch (record.Sub_Type) {
        case kSpecialNone:
            plan_.SlotColors.push_back(packed(record.Color));
            break;
        case kSpecialStrobes:
            plan_.SlotColors.insert(plan_.SlotColors.end(), static_cast<std::size_t>(unit.BulbCount),
                                    packed(record.Color));
            break;
        case kSpecialMultiColor:
            for (std::int32_t color = 1; color <= multiColors(record); ++color)
                plan_.SlotColors.push_back(packed(record.Multi[color]));
            break;
        default:
            unit.Shape = -1;  // a special type that is not drawn
        }
        addUnit(unit);
    }

    void addGroup(std::int32_t fixture) {
        GLPlanUnit unit = newUnit(fixture, 1);
        const std::int32_t type = document_.Fixtures[fixture].Fixture_Type;
        if (type == kFixtureKesh || type == kFixtureDmxPixels) {
            // The groups of a fixture share its bulbs out among them, and not always in the same way.
            bool& counted = counted_[static_cast<std::size_t>(fixture)];
            if (!counted) plan_.ListedBulbs += unit.BulbCount;
            counted = true;
        } else {
            plan_.SlotColors.push_back(0);
        }
        addUnit(unit);
    }

private:
    static std::uint32_t packed(std::int32_t color) noexcept {
        return static_cast<std::uint32_t>(color) & static_cast<std::uint32_t>(kWhite);
    }

    GLPlanUnit newUnit(std::int32_t fixture, std::int32_t location) {
        const ZephFixture& record = document_.Fixtures[fixture];
        GLPlanUnit unit{.Fixture = fixture};
        unit.FirstSlot = static_cast<std::int32_t>(plan_.SlotColors.size());
        if (const ZephBulbLocations* bulbs = bulbLocations(states_[fixture], location)) {
            unit.FirstBulb = bulbs->First;
            unit.BulbCount = bulbs->Count;
        }
        if (const GLFill* fill = fillOf(shapes_, shapeDrawn(record), record.BulbSize)) unit.Shape = shapeNumber(*fill);
        return unit;
    }

    // Files the unit, with the triangles of its bulbs if it has slots for their colours.
    void addUnit(GLPlanUnit unit) {
        unit.SlotCount = static_cast<std::int32_t>(plan_.SlotColors.size()) - unit.FirstSlot;
        unit.FirstIndex = static_cast<std::int32_t>(plan_.Indices.size());
        if (unit.Shape >= 0 && unit.SlotCount > 0) {
            const ZephFixture& record = document_.Fixtures[unit.Fixture];
            const GLFill& fill = *fillOf(shapes_, shapeDrawn(record), record.BulbSize);
            for (std::int32_t b = 0; b < unit.BulbCount; ++b) {
                const ZephBulbLocation& bulb = tables_.BulbPool[static_cast<std::size_t>(unit.FirstBulb + b)];
                if (drawnBulb(bulb))
                    addBulb(fill, bulb, static_cast<std::uint32_t>(unit.FirstSlot + b % unit.SlotCount));
            }
            require(plan_.Indices.size() <= kMostIndices, "The display has too many bulbs for the OpenGL output");
        }
        unit.IndexCount = static_cast<std::int32_t>(plan_.Indices.size()) - unit.FirstIndex;
        plan_.Units.push_back(unit);
    }

    void addBulb(const GLFill& fill, const ZephBulbLocation& bulb, std::uint32_t slot) {
        const auto first = static_cast<std::uint32_t>(plan_.Vertices.size());
        for (const ShapeVertex& corner : fill.Corners) {
            plan_.Vertices.push_back(
                {static_cast<std::int16_t>(bulb.X + corner.X), static_cast<std::int16_t>(bulb.Y + corner.Y), slot});
        }
        for (const std::uint8_t corner : fill.Triangles)
            plan_.Indices.push_back(first + corner);
    }

    std::int32_t shapeNumber(const GLFill& fill) {
        const auto [found, isNew] = numbers_.try_emplace(&fill, static_cast<std::int32_t>(plan_.Shapes.size()));
        if (!isNew) return found->second;
        const std::size_t first = plan_.Corners.size();
        plan_.Shapes.push_back(
            {static_cast<std::int32_t>(plan_.CornerIndices.size()), static_cast<std::int32_t>(fill.Triangles.size())});
        for (const ShapeVertex& corner : fill.Corners)
            plan_.Corners.push_back({static_cast<std::int16_t>(corner.X), static_cast<std::int16_t>(corner.Y)});
        for (const std::uint8_t corner : fill.Triangles)
            plan_.CornerIndices.push_back(static_cast<std::uint16_t>(first + corner));
        return found->second;
    }

    const ZephSimulation& document_;
    const ZephRenderTables& tables_;
    const ZephFixtureStates& states_;
    const ZephGLShapes& shapes_;
    GLPlan& plan_;
    std::map<const GLFill*, std::int32_t> numbers_;
    std::array<bool, kMaxFixtures + 1> counted_{};  // [fixture], its bulbs are among ListedBulbs
};

}  // namespace

bool drawnBulb(const ZephBulbLocation& bulb) noexcept {
    return bulb.Type != kPointPlaceHolder && bulb.X >= -kFarthestPixel && bulb.X <= kFarthestPixel &&
           bulb.Y >= -kFarthestPixel && bulb.Y <= kFarthestPixel;
}

GLPlan makeGLPlan(const ZephSimulation& document, const ZephRenderTables& tables, const ZephFixtureStates& states,
                  const ZephGLShapes& shapes) {
    GLPlan plan;
    GLPlanBuilder(document, tables, states, shapes, plan).addAll();
    return plan;
}
