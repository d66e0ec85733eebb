#include "tests/support/folder.h"
#include "tests/support/recording_host.h"
#include "util/color.h"
#include "util/error_log.h"
#include "util/fault_log.h"
#include "util/one_based.h"
#include "util/paths.h"
#include "util/random_source.h"
#include "util/rounding.h"

#include <cmath>
#include <csignal>

TEST(Rounding, TiesGoToTheEvenNeighbourAndTooMuchSaturates) {
    for (const auto& [value, whole] :
         {std::pair{0.5, 0}, {1.5, 2}, {-2.5, -2}, {1e12, 2147483647}, {-1e12, -2147483647 - 1}, {std::nan(""), 0}})
        EXPECT_EQ(roundHalfEven(value), whole) << value;
    EXPECT_EQ(floorToInt(-0.5), -1);
    EXPECT_EQ(truncateToInt(-0.5), 0);
    for (const auto& [percent, level] : {std::pair{50, 128}, {10, 26}, {30, 76}})  // 127.5, 25.5, 76.5
        EXPECT_EQ(divideHalfEven(percent * 255, 100), level);
}

TEST(ApplyIntensity, KeepsTheColourAbove250AndScalesBelow) {
    EXPECT_EQ(ZephApplyIntensity(packColor(200, 100, 3), 251), packColor(200, 100, 3));
    EXPECT_EQ(ZephApplyIntensity(packColor(255, 102, 5), 51), packColor(51, 20, 1));
}

TEST(Random, TheSameSeedGivesTheSameNumbersInRange) {
    SeededRandom one(1), same(1);
    std::vector<int> drawn(1000);
    for (int& value : drawn) {
        value = ZephReturnRandomNumber(1, 17, one);
        ASSERT_EQ(value, ZephReturnRandomNumber(1, 17, same));
    }
    EXPECT_THAT(drawn, testing::Each(testing::AllOf(testing::Ge(1), testing::Le(17))));
    EXPECT_THAT(drawn, testing::IsSupersetOf({1, 17}));
}

namespace {

constexpr int kFailingLine = __LINE__ + 4;

bool failing(FailureReport& failures) try {
    OneBased<int, 2> numbers;
    return numbers.at(3) == 0;
}
ZEPH_GUARD(failures, "modTest", false)

}  // namespace

TEST(Guard, ReportsTheProcedureAndTheLineOfTheFailure) {
    CollectingFailures failures;
    EXPECT_FALSE(failing(failures));
    ASSERT_EQ(failures.reports.size(), 1u);
    EXPECT_EQ(failures.reports[0].procedure, "Zeph.modTest.failing");
    EXPECT_EQ(failures.reports[0].line, kFailingLine);
}

TEST(ErrorLog, ShowsOnlyTheFirstReportOfARunAndOnlyWithTheSwitch) {
    const Folder folder;
    RecordingHost host;
    ErrorLog log(folder.path("log"), true, host);
    log.ErrReport("one\r\nmore", "Zeph.modTest.a", 12);
    log.ErrReport("two", "Zeph.modTest.b", 13);
    ErrorLog silent(folder.path("no/such/folder.txt"), false, host);
    silent.ErrReport("three", "Zeph.modTest.c", 1);
    EXPECT_EQ(host.boxTexts(),
              "Qen Visualizer-Errors Logged|Errors have been logged to file:\r\n" + folder.path("log"));
    EXPECT_THAT(folder.read("log"),
                testing::MatchesRegex("[0-9]{4}-[0-9]{2}-[0-9]{2} [0-9]{2}:[0-9]{2}:[0-9]{2}:"
                                      "Zeph.modTest.a-12 .one / more.\n.*:Zeph.modTest.b-13 .two.\n"));
}

TEST(FaultLog, WritesTheNameOfTheFaultAndLetsItGoItsWay) {
    const Folder folder;
    const auto fault = [&] {
        installFaultLog(folder.path("log"));
        raise(SIGILL);
    };
    EXPECT_EXIT(fault(), testing::KilledBySignal(SIGILL), "");
    EXPECT_THAT(folder.read("log"), testing::MatchesRegex("[-0-9]{10} [:0-9]{8}:Illegal Instruction\n"));
    EXPECT_EQ(faultName(SIGFPE, FPE_INTDIV), "Integer Divide By Zero");
    EXPECT_EQ(faultName(SIGSEGV, 0), "Access Violation");
    EXPECT_EQ(faultName(SIGUSR1, 0), "Unknown (&H0000000A)");
}

TEST(Paths, StoredFormIsReversibleBelowTheBaseAndWholeElsewhere) {
    const ZephPathService paths("/tmp/zeph data");
    const std::string below = "/tmp/zeph data/Editor/house.png";
    const std::string stored = paths.CollapsePath(below, kPathBase);
    EXPECT_EQ(paths.ExpandPath(stored, kPathBase), below);
    EXPECT_EQ(ZephPathService("/else").ExpandPath(stored, kPathBase), "/else/Editor/house.png");
    EXPECT_EQ(paths.CollapsePath("/tmp/zeph database/x.png", kPathBase), "/tmp/zeph database/x.png");
}

TEST(Paths, StartUpMakesTheFoldersThatAreMissing) {
    const Folder folder;
    for (int start = 1; start <= 2; ++start)
        EXPECT_TRUE(ZephCheckDirectoriesAtStartup(ZephPathService(folder.path("new/base"))));
    EXPECT_EQ(QDir(folder.qPath("new/base")).entryList(QDir::Dirs | QDir::NoDotAndDotDot),
              (QStringList{"Bulbs", "Curves", "Editor", "Fixtures", "Props", "Shared", "System"}));
}
