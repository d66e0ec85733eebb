#include "display.h"
#include "model/editor_loader.h"
#include "programs/tool/demo_show.h"
#include "tests/support/engine_rig.h"

#include <QImage>

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
    EXPECT_TRUE(example.rig.simulation->Fixtures == built->Fixtures);
    EXPECT_TRUE(example.rig.simulation->Props == built->Props);
    EXPECT_TRUE(example.rig.simulation->Levels == built->Levels);
    EXPECT_TRUE(example.rig.simulation->Background == built->Background);
}

TEST(Example, CaptureIsTheShowOfTheFileAndEveryBulbLiesOnThePicture) {
    LoadedExample example;
    example.rig.build();
    const ShowCast cast = gatherShowCast(*example.rig.simulation, example.rig.tables, *example.rig.states);
    EXPECT_TRUE(cast.unreachable.empty());
    const std::vector<CapturePiece> show = ZephMakeDemoShow(cast, kDefaultShowMs);
    EXPECT_TRUE(loadCapture(kFolder + "/house.zcap").pieces == show) << "make examples/house.zcap anew";
    EXPECT_EQ(example.rig.host.boxTexts(), "");
    EXPECT_TRUE(example.rig.host.compileErrors.empty());
    EXPECT_TRUE(example.rig.failures.reports.empty());

    const ZephBackground& background = example.rig.simulation->Background;
    const QRect picture = QImage(QString::fromStdString(kFolder + "/house.png")).rect();
    EXPECT_EQ(picture, QRect(0, 0, widthPixels(background), heightPixels(background)));
    for (const ZephBulbLocation& bulb : example.rig.tables.BulbPool)
        EXPECT_TRUE(bulb.Type == kPointPlaceHolder || picture.contains(bulb.X, bulb.Y)) << bulb.X << "," << bulb.Y;
}
