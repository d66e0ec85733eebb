#include "engine/gl_plan.h"
#include "engine/paint_order.h"
#include "tests/support/drawing_stage.h"

namespace {

const GLPlanUnit& unitOf(const GLPlan& plan, std::int32_t fixture, std::int32_t channel) {
    return plan.Units[static_cast<std::size_t>(plan.NumberOf.OfChannel[channelSlot(fixture, channel)])];
}

const GLPlanUnit& unitOfGroup(const GLPlan& plan, std::size_t group) {
    return plan.Units[static_cast<std::size_t>(plan.NumberOf.OfGroup[group])];
}

struct PlanStage : Stage {
    ZephFixture& addBulbs(std::int32_t level, std::int32_t count) {
        ZephFixture& fixture = addLit(kFixtureBulbs, 2, 3, {});
        fixture.ZOrder = level;
        for (std::int32_t b = 0; b < count; ++b)
            addPoint(fixture, kPointBulb, {10 + 10 * b, 20});
        return fixture;
    }
    GLPlan plan() {
        finish();
        return makeGLPlan(*simulation, tables, *states, masks().GLShapes);
    }
};

}  // namespace

TEST(GLPlan, LaysTrianglesOutInTheOrderOfPainting) {
    PlanStage stage;
    stage.addBulbs(3, 1);
    ZephFixture& group = stage.addBulbs(1, 2);
    group.ChannelCount = 0;
    makeRgb(group, 2, 1);
    stage.addBulbs(1, 1).Channels[1].Color = packColor(9, 8, 7);
    const GLPlan plan = stage.plan();

    // Level 1: the channel of fixture 3, then the group of fixture 2; level 3: fixture 1. A square has 6 indices.
    EXPECT_EQ(unitOf(plan, 3, 1).FirstIndex, 0);
    EXPECT_EQ(unitOfGroup(plan, 1).FirstIndex, 6);
    EXPECT_EQ(unitOfGroup(plan, 1).IndexCount, 12);
    EXPECT_EQ(unitOf(plan, 1, 1).FirstIndex, 18);
    EXPECT_EQ(plan.SlotColors, (std::vector<std::uint32_t>{0x070809, 0, kWhite}));
    const GLVertex& corner = plan.Vertices[plan.Indices[0]];
    EXPECT_TRUE((corner.X == 8 || corner.X == 12) && (corner.Y == 18 || corner.Y == 22)) << corner.X << "," << corner.Y;
}

TEST(GLPlan, LeavesBulbsOutThatAreNotDrawn) {
    PlanStage stage;
    ZephFixture& bulbs = stage.addBulbs(1, 1);
    addPoint(bulbs, kPointPlaceHolder, {50, 50});
    addPoint(bulbs, kPointBulb, {32'001, 50});
    addPoint(bulbs, kPointBulb, {-32'000, 50});
    stage.addBulbs(1, 1).BulbSize = 17;
    stage.addRibbon(9, 4);
    const GLPlan plan = stage.plan();

    EXPECT_EQ(unitOf(plan, 1, 1).IndexCount, 12);
    EXPECT_EQ(unitOf(plan, 2, 1).IndexCount, 0);
    EXPECT_EQ(plan.ListedBulbs, 4);  // counted once, though each pixel has a group
    EXPECT_EQ(unitOfGroup(plan, 1).IndexCount, 0);
    EXPECT_GE(unitOfGroup(plan, 1).Shape, 0);
}
