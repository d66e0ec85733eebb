#include "display.h"
#include "model/editor_loader.h"
#include "model/tables.h"
#include "programs/tool/demo_show.h"
#include "tests/support/engine_rig.h"

#include <QImage>

#include <set>

namespace {

const std::string kFolder = ZEPH_EXAMPLES;

// The rig with the example file in it.
struct LoadedExample {
    LoadedExample() {
        rig.simulation->FilePath = kFolder + "/";
        rig.simulation->FileName = "house.zee";
        const ZephPathService paths(kFolder);
        NoWatcher watcher;
        loaded = ZephLoadVisualizerXML(true, {rig.settings, paths, rig.host, rig.failures, watcher}, *rig.simulation);
    }
    EngineRig rig;
    bool loaded = false;
};

}  // namespace

TEST(Example, FileIsWhatTheGeneratorBuilds) {
    const LoadedExample example;
    ASSERT_TRUE(example.loaded);
    EXPECT_FALSE(example.rig.simulation->ChecksumMismatch);
    const auto built = std::make_unique<ZephSimulation>();
    buildDisplay(*built);
    EXPECT_EQ(example.rig.simulation->FixtureCount, built->FixtureCount);
    EXPECT_TRUE(example.rig.simulation->Fixtures == built->Fixtures);
    EXPECT_TRUE(example.rig.simulation->Props == built->Props);
    EXPECT_TRUE(example.rig.simulation->Levels == built->Levels);
    EXPECT_TRUE(example.rig.simulation->Background == built->Background);
}

TEST(Example, CaptureIsTheShowOfTheFile) {
    LoadedExample example;
    example.rig.build();
    const ShowCast cast = gatherShowCast(*example.rig.simulation, example.rig.tables, *example.rig.states);
    EXPECT_TRUE(cast.unreachable.empty());
    const std::vector<CapturePiece> show = ZephMakeDemoShow(cast, kDefaultShowMs);
    EXPECT_TRUE(loadCapture(kFolder + "/house.zcap").pieces == show) << "make examples/house.zcap anew";
    EXPECT_EQ(example.rig.host.boxTexts(), "");
    EXPECT_TRUE(example.rig.host.compileErrors.empty());
    EXPECT_TRUE(example.rig.failures.reports.empty());
}

TEST(Example, ShowsEveryKindOfLightOnThePicture) {
    const auto display = std::make_unique<ZephSimulation>();
    buildDisplay(*display);
    const QImage picture(QString::fromStdString(kFolder + "/house.png"));
    EXPECT_EQ(picture.width(), widthPixels(display->Background));
    EXPECT_EQ(picture.height(), heightPixels(display->Background));
    std::set<std::int32_t> types, shapes, specials, devices;
    for (int f = 1; f <= display->FixtureCount; ++f) {
        const ZephFixture& fixture = display->Fixtures[f];
        types.insert(fixture.Fixture_Type);
        shapes.insert(fixture.BulbShape);
        for (int c = 1; c <= fixture.ChannelCount; ++c) {
            specials.insert(fixture.Channels[c].Sub_Type);
            devices.insert(fixture.Channels[c].DeviceType);
        }
    }
    EXPECT_EQ(types.size(), kFixtureTypes.size());
    EXPECT_EQ(shapes.size(), kBulbTypes.size());
    EXPECT_EQ(specials.size(), ZephSpecialType.size());
    EXPECT_EQ(devices.size(), ZephDeviceType.size());
    EXPECT_GE(display->FixtureCount, 60);

    LoadedExample example;
    example.rig.build();
    EXPECT_GE(example.rig.tables.BulbPool.size(), 4'000u);
    for (const ZephBulbLocation& bulb : example.rig.tables.BulbPool)
        EXPECT_TRUE(bulb.Type == kPointPlaceHolder || picture.rect().contains(bulb.X, bulb.Y))
            << bulb.X << "," << bulb.Y;
}
