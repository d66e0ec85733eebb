// A program that is killed in the middle of saving leaves the old file or the new one, never anything between.
#include "model/editor_writer.h"
#include "tests/support/limit_document.h"
#include "tests/support/loading.h"
#include "util/random_source.h"

#include <QElapsedTimer>
#include <QProcess>
#include <QThread>

namespace {

constexpr int kKills = 30;

// A display of that many fixtures under the name, large enough that much of a run is saving.
void writeDisplay(LoadBench& bench, const char* name, std::int32_t fixtures) {
    ZephGlobalReset(false, *bench.simulation, bench.watcher);
    buildLimitDocument(*bench.simulation, {.fixtures = fixtures, .channels = 4});
    bench.name(name);
    ASSERT_TRUE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
}

}  // namespace

TEST(KilledWhileSaving, TheFileIsWholeEachTime) {
    LoadBench bench;
    constexpr std::int32_t kFixtures[] = {300, 400};
    writeDisplay(bench, "a.zee", kFixtures[0]);
    writeDisplay(bench, "b.zee", kFixtures[1]);
    writeDisplay(bench, "out.zee", kFixtures[0]);
    const QString folder = bench.folder.qPath();
    SeededRandom random(3);
    qint64 whole = 0;  // what an undisturbed run takes, ms
    int killed = 0;
    for (int run = 0; run <= kKills; ++run) {
        QProcess process;
        QElapsedTimer clock;
        clock.start();
        process.start(ZEPH_TOOL,
                      {"convert", folder + (run % 2 == 0 ? "a.zee" : "b.zee"), folder + "out.zee", "--force"});
        ASSERT_TRUE(process.waitForStarted());
        if (run == 0) {
            ASSERT_TRUE(process.waitForFinished(60'000));
            ASSERT_EQ(process.exitCode(), 0);
            whole = std::max<qint64>(clock.elapsed(), 1);
            continue;
        }
        const auto most = static_cast<std::int32_t>(whole * 1000);
        QThread::usleep(static_cast<unsigned long>(ZephReturnRandomNumber(most / 4, most, random)));
        process.kill();
        ASSERT_TRUE(process.waitForFinished(60'000));
        if (process.exitStatus() == QProcess::CrashExit) ++killed;

        bench.name("out.zee");
        ASSERT_TRUE(bench.load()) << "run " << run;
        EXPECT_FALSE(bench.simulation->ChecksumMismatch) << "run " << run;
        const std::int32_t fixtures = bench.simulation->FixtureCount;
        EXPECT_TRUE(fixtures == kFixtures[0] || fixtures == kFixtures[1]) << fixtures;
    }
    EXPECT_GT(killed, 0) << "no run was interrupted";
}
