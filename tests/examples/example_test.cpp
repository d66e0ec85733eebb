#include "display.h"
#include "model/editor_loader.h"
#include "programs/tool/demo_show.h"
#include "tests/support/compiled_display.h"

#include <QImage>

TEST(Example, FileIsWhatTheGeneratorBuildsWithItsShowAndEveryBulbOnThePicture) {
    const std::string folder = ZEPH_EXAMPLES;
    CompiledDisplay example;
    ZephSimulation& document = *example.simulation;
    document.FilePath = folder + "/";
    document.FileName = "house.zee";
    const ZephPathService paths(folder);
    NoWatcher watcher;
    ASSERT_TRUE(
        ZephLoadVisualizerXML(true, {example.settings, paths, example.host, example.failures, watcher}, document));
    EXPECT_FALSE(document.ChecksumMismatch);
    const auto built = std::make_unique<ZephSimulation>();
    buildDisplay(*built);
    EXPECT_TRUE(document.Fixtures == built->Fixtures);
    EXPECT_TRUE(document.Props == built->Props);
    EXPECT_TRUE(document.Levels == built->Levels);
    EXPECT_TRUE(document.Background == built->Background);

    example.build();
    const ShowCast cast = gatherShowCast(document, example.tables, *example.states);
    EXPECT_TRUE(cast.unreachable.empty());
    const std::vector<CapturePiece> show = ZephMakeDemoShow(cast, kDefaultShowMs);
    EXPECT_TRUE(loadCapture(folder + "/house.zcap").pieces == show) << "make examples/house.zcap anew";
    EXPECT_EQ(example.host.boxTexts(), "");
    EXPECT_TRUE(example.host.compileErrors.empty());
    EXPECT_TRUE(example.failures.reports.empty());

    const QRect picture = QImage(QString::fromStdString(folder + "/house.png")).rect();
    EXPECT_EQ(picture, QRect(0, 0, widthPixels(document.Background), heightPixels(document.Background)));
    for (const ZephBulbLocation& bulb : example.tables.BulbPool)
        EXPECT_TRUE(bulb.Type == kPointPlaceHolder || picture.contains(bulb.X, bulb.Y)) << bulb.X << "," << bulb.Y;
}
