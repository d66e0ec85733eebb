#include "engine/gl_plan.h"
#include "engine/paint_order.h"
#include "tests/support/drawing_stage.h"

#include <gtest/gtest.h>

namespace {

const GLPlanUnit& unitOf(const GLPlan& plan, std::int32_t fixture, std::int32_t channel) {
    return plan.Units[static_cast<std::size_t>(plan.NumberOf.OfChannel[channelSlot(fixture, channel)])];
}

std::uint32_t slotOf(const GLPlan& plan, std::int32_t index) {
    return plan.Vertices[plan.Indices[static_cast<std::size_t>(index)]].Slot;
}

struct PlanStage : Stage {
    ZephFixture& addBulbs(std::int32_t level, std::int32_t count, std::int32_t channelType = kChannelNormal) {
        ZephFixture& fixture = add(kFixtureBulbs, channelType, 2, 3);
        fixture.ZOrder = level;
        for (std::int32_t b = 0; b < count; ++b)
            addPoint(fixture, kPointBulb, 10 + 10 * b, 20);
        return fixture;
    }
    GLPlan plan() {
        finish();
        return makeGLPlan(*document, tables, *states, masks().GLShapes);
    }
};

}  // namespace

TEST(GLPlan, LaysTrianglesOutInTheOrderOfPainting) {
    PlanStage stage;
    stage.addBulbs(3, 1);
    stage.addBulbs(1, 2, kChannelRgb);
    stage.addBulbs(1, 1).Channels[1].Color = packColor(9, 8, 7);
    const GLPlan plan = stage.plan();

    // Level 1: the channel of fixture 3, then the group of fixture 2; level 3: fixture 1. A square has 6 indices.
    EXPECT_EQ(unitOf(plan, 3, 1).FirstIndex, 0);
    EXPECT_EQ(plan.Units[static_cast<std::size_t>(plan.NumberOf.OfGroup[1])].FirstIndex, 6);
    EXPECT_EQ(plan.Units[static_cast<std::size_t>(plan.NumberOf.OfGroup[1])].IndexCount, 12);
    EXPECT_EQ(unitOf(plan, 1, 1).FirstIndex, 18);
    EXPECT_EQ(plan.SlotColors, (std::vector<std::uint32_t>{0x070809, 0, 0}));
    const GLVertex& corner = plan.Vertices[plan.Indices[0]];
    EXPECT_TRUE((corner.X == 8 || corner.X == 12) && (corner.Y == 18 || corner.Y == 22)) << corner.X << "," << corner.Y;
}

TEST(GLPlan, GivesColoursAndFlashingBulbsSlotsOfTheirOwn) {
    PlanStage stage;
    ZephFixture& multi = stage.addBulbs(1, 5);
    multi.Channels[1].Sub_Type = kSpecialMultiColor;
    multi.Channels[1].Sub_Parm = 2;
    multi.Channels[1].Multi[1] = packColor(1, 0, 0);
    multi.Channels[1].Multi[2] = packColor(2, 0, 0);
    stage.addBulbs(1, 3).Channels[1].Sub_Type = kSpecialStrobes;
    stage.addBulbs(1, 3).Channels[1].Sub_Type = 3;  // no special type that is drawn
    const GLPlan plan = stage.plan();

    const GLPlanUnit& colours = unitOf(plan, 1, 1);
    EXPECT_EQ(colours.SlotCount, 2);
    for (std::int32_t b = 0; b < 5; ++b)
        EXPECT_EQ(slotOf(plan, colours.FirstIndex + 6 * b), static_cast<std::uint32_t>(b % 2)) << b;
    EXPECT_EQ(plan.SlotColors[1], 2U);
    const GLPlanUnit& strobes = unitOf(plan, 2, 1);
    EXPECT_EQ(strobes.SlotCount, 3);
    EXPECT_EQ(slotOf(plan, strobes.FirstIndex + 12), 4U);
    EXPECT_LT(unitOf(plan, 3, 1).Shape, 0);
}

TEST(GLPlan, LeavesBulbsOutThatAreNotDrawn) {
    PlanStage stage;
    ZephFixture& bulbs = stage.addBulbs(1, 1);
    Stage::addPoint(bulbs, kPointPlaceHolder, 50, 50);
    Stage::addPoint(bulbs, kPointBulb, 32'001, 50);
    Stage::addPoint(bulbs, kPointBulb, -32'000, 50);
    stage.addBulbs(1, 1).BulbSize = 17;
    ZephFixture& ribbon = stage.add(kFixtureKesh, kChannelRgb, 2, 11);
    for (std::int32_t p = 0; p < 4; ++p)
        Stage::addPoint(ribbon, kPointBulb, 10 * p, 5);
    const GLPlan plan = stage.plan();

    EXPECT_EQ(unitOf(plan, 1, 1).IndexCount, 12);
    EXPECT_EQ(unitOf(plan, 2, 1).IndexCount, 0);
    EXPECT_EQ(plan.ListedBulbs, 4);  // counted once, though each pixel has a group
    const GLPlanUnit& pixel = plan.Units[static_cast<std::size_t>(plan.NumberOf.OfGroup[1])];
    EXPECT_EQ(pixel.IndexCount, 0);
    EXPECT_GE(pixel.Shape, 0);
}
