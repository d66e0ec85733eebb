#include "engine/validation.h"
#include "tests/support/engine_rig.h"

namespace {

constexpr const char* kHead = "There are one or more errors with your simulation that prevent it from running."
                              "  Please correct these errors and try again.";

struct Validation : testing::Test, EngineRig {
    // A piece of ribbon on network 1.
    ZephFixture& piece(int unit, int start, int points) {
        ZephFixture& fixture = addRibbon(unit, points);
        fixture.Kesh.Network = 1;
        fixture.Kesh.Physical_Pixel_Number = start;
        return fixture;
    }
    void run(int universe, int start, int points) { addPixels(universe, points).DMX.Physical_Pixel_Number = start; }
};

}  // namespace

TEST_F(Validation, AssemblyJoinsPiecesFillsGapsWithPlaceHoldersAndStopsAtThePointsOfAFixture) {
    const ZephFixture& child = piece(3, 25, 10);
    const ZephFixture& whole = piece(3, 1, 20);
    const ZephFixture& second = piece(4, 1, 20);
    piece(4, 250, 50);
    piece(2, 1, 5).Kesh.Network = 0;  // network 0 with a unit is a place
    run(7, 1, 170);
    build();
    EXPECT_TRUE(host.compileErrors.empty()) << "the last group is not closed";
    EXPECT_EQ(whole.PointCount, 34);
    EXPECT_EQ(whole.DrawPoints[24], (ZephDrawPoint{kPointPlaceHolder, 0, 0}));
    EXPECT_EQ(whole.DrawPoints[25], child.DrawPoints[1]);
    EXPECT_EQ(child.PointCount, 10);
    EXPECT_EQ(second.PointCount, 256);
    restoreAssembledPoints(*simulation, *states);
    EXPECT_EQ(second.PointCount, 20);
}

TEST_F(Validation, FaultsOfRibbonsAreWordedToTheLetterAndNothingIsAssembled) {
    piece(3, 1, 20);
    piece(3, 20, 5);  // overlaps pixel 20
    piece(4, 1, 51);  // one too many, and another group follows
    piece(5, 2, 5);   // no main
    piece(5, 9, 5);   // compared with the orphan, not reported again
    piece(0, 1, 5);   // no unit
    build();
    EXPECT_THAT(host.compileErrors,
                testing::ElementsAre(
                    std::string(kHead) +
                    "\r\nTarn Fixture F6 does not have a network and/or unit id assigned."
                    "\r\nThe Tarn on Network/Unit Aux A/3,when assembled has duplicate pixels.  The following fixtures "
                    "should be checked:\r\n"
                    "--F1 (Start Pixel=1  Next start pixel should be 21 or higher.)\r\n"
                    "--F2 (Start Pixel=20)\r\n"
                    "\r\nThe Tarn on Network/Unit ID Aux A/4, when assembled has more than 50 pixels (51).  The "
                    "following fixtures should be checked:\r\n"
                    "--F3\r\n"
                    "\r\nChild Tarn fixture F4 does not have a main Tarn Fixture (a Tarn Fixture with physical pixel "
                    "1).  A Tarn Fixture when assembled requires a fixture with pixel #1"));
    EXPECT_EQ(tables.RenderDataCount, 0);
    EXPECT_EQ(simulation->Fixtures[1].PointCount, 20);
    EXPECT_FALSE(host.busyPointer);
}

TEST_F(Validation, FaultsOfPixelsHaveALimitOf170AndTextsOfTheirOwn) {
    run(7, 1, 171);
    run(8, 1, 10);
    run(8, 10, 10);
    run(9, 4, 10);
    run(0, 1, 10);
    build();
    EXPECT_THAT(host.compileErrors,
                testing::ElementsAre(
                    std::string(kHead) +
                    "\r\nDMX Pixel Fixture F5 does not have a universe assigned."
                    "\r\nThe DMX Pixel Universe on Universe Unv 7, when assembled has more than 170 pixels (171).  The "
                    "following fixtures should be checked:\r\n--F1\r\n"
                    "\r\nThe DMX Pixel Universe on Universe Unv 8,when assembled has duplicate pixels.  The following "
                    "fixtures should be checked:\r\n"
                    "--F2 (Start Pixel=1  Next start pixel should be 11 or higher.)\r\n"
                    "--F3 (Start Pixel=10)\r\n"
                    "\r\nChild Pixel fixture F4 does not have a main Pixel Fixture (a Pixel Universe Fixture with "
                    "physical pixel 1).  A Pixel Universe Fixture when assembled requires a fixture with pixel #1"));
}
