#include "tests/support/recording_host.h"
#include "util/clock.h"
#include "util/color.h"
#include "util/error_log.h"
#include "util/fault_log.h"
#include "util/one_based.h"
#include "util/paths.h"
#include "util/random_source.h"
#include "util/rounding.h"

#include <QDir>
#include <QTemporaryDir>

#include <gtest/gtest.h>

#include <csignal>
#include <fstream>
#include <regex>

TEST(Rounding, TiesGoToTheEvenNeighbour) {
    EXPECT_EQ(roundHalfEven(0.5), 0);
    EXPECT_EQ(roundHalfEven(1.5), 2);
    EXPECT_EQ(roundHalfEven(-2.5), -2);
    EXPECT_EQ(floorToInt(-0.5), -1);
    EXPECT_EQ(truncateToInt(-0.5), 0);
    EXPECT_EQ(divideHalfEven(50 * 255, 100), 128);  // 127.5
    EXPECT_EQ(divideHalfEven(10 * 255, 100), 26);   // 25.5
    EXPECT_EQ(divideHalfEven(30 * 255, 100), 76);   // 76.5
}

TEST(Rounding, SaturatesWhatDoesNotFit) {
    EXPECT_EQ(roundHalfEven(1e12), 2147483647);
    EXPECT_EQ(roundHalfEven(-1e12), -2147483647 - 1);
    EXPECT_EQ(roundHalfEven(std::nan("")), 0);
}

TEST(ApplyIntensity, KeepsTheColourAbove250AndScalesBelow) {
    EXPECT_EQ(ZephApplyIntensity(packColor(200, 100, 3), 251), packColor(200, 100, 3));
    EXPECT_EQ(ZephApplyIntensity(packColor(255, 102, 5), 51), packColor(51, 20, 1));
}

TEST(OneBased, ChecksNumbersFromOutside) {
    OneBased<int, 3> numbers;
    numbers.at(3) = 7;
    EXPECT_EQ(numbers[3], 7);
    EXPECT_THROW(numbers.at(0), Failure);
    EXPECT_THROW(numbers.at(4), Failure);
}

TEST(Random, TheSameSeedGivesTheSameNumbersInRange) {
    SeededRandom first(1);
    SeededRandom second(1);
    SeededRandom other(2);
    bool differs = false;
    for (int i = 0; i < 1000; ++i) {
        const int value = ZephReturnRandomNumber(1, 17, first);
        EXPECT_GE(value, 1);
        EXPECT_LE(value, 17);
        EXPECT_EQ(value, ZephReturnRandomNumber(1, 17, second));
        differs = differs || value != ZephReturnRandomNumber(1, 17, other);
    }
    EXPECT_TRUE(differs);
}

TEST(SystemClock, IsNeverZeroAndPositiveAtTheStart) {
    const SystemClock clock;
    EXPECT_GE(clock.timeGetTime(), SystemClock::kStartMs);
    EXPECT_LT(clock.timeGetTime(), SystemClock::kStartMs + 10'000);
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
    QTemporaryDir folder;
    const std::string file = folder.filePath("errorlog.txt").toStdString();
    RecordingHost host;
    ErrorLog log(file, true, host);
    log.ErrReport("one\r\nmore", "Zeph.modTest.a", 12);
    log.ErrReport("two", "Zeph.modTest.b", 13);
    ASSERT_EQ(host.boxes.size(), 1u);
    EXPECT_EQ(host.boxes[0].title, "Qen Visualizer-Errors Logged");
    EXPECT_EQ(host.boxes[0].text, "Errors have been logged to file:\r\n" + file);

    std::ifstream lines(file);
    std::string first;
    std::string second;
    std::string none;
    std::getline(lines, first);
    std::getline(lines, second);
    EXPECT_FALSE(std::getline(lines, none));
    EXPECT_TRUE(
        std::regex_match(first, std::regex(R"(\d{4}-\d\d-\d\d \d\d:\d\d:\d\d:Zeph\.modTest\.a-12 \(one / more\))")));
    EXPECT_TRUE(second.ends_with(":Zeph.modTest.b-13 (two)"));

    ErrorLog silent(folder.filePath("no/such/folder.txt").toStdString(), false, host);
    silent.ErrReport("three", "Zeph.modTest.c", 1);
    EXPECT_EQ(host.boxes.size(), 1u);
}

TEST(FaultLog, WritesTheNameOfTheFaultAndLetsItGoItsWay) {
    QTemporaryDir folder;
    const std::string file = folder.filePath("errorlog.txt").toStdString();
    EXPECT_EXIT(
        {
            installFaultLog(file);
            raise(SIGILL);
        },
        testing::KilledBySignal(SIGILL), "");
    std::ifstream lines(file);
    std::string line;
    std::getline(lines, line);
    EXPECT_TRUE(std::regex_match(line, std::regex(R"(\d{4}-\d\d-\d\d \d\d:\d\d:\d\d:Illegal Instruction)"))) << line;

    EXPECT_EQ(faultName(SIGFPE, FPE_INTDIV), "Integer Divide By Zero");
    EXPECT_EQ(faultName(SIGSEGV, 0), "Access Violation");
    EXPECT_EQ(faultName(SIGUSR1, 0), "Unknown (&H0000000A)");
}

TEST(Paths, StoredFormIsReversibleBelowTheBaseAndWholeElsewhere) {
    const ZephPathService paths("/tmp/zeph data");
    EXPECT_EQ(paths.GetPath(kPathBase), "/tmp/zeph data/");
    const std::string below = "/tmp/zeph data/Editor/house.png";
    EXPECT_NE(paths.CollapsePath(below, kPathBase), below);
    EXPECT_EQ(paths.ExpandPath(paths.CollapsePath(below, kPathBase), kPathBase), below);
    EXPECT_EQ(ZephPathService("/else").ExpandPath(paths.CollapsePath(below, kPathBase), kPathBase),
              "/else/Editor/house.png");
    EXPECT_EQ(paths.CollapsePath("/tmp/zeph database/x.png", kPathBase), "/tmp/zeph database/x.png");
    EXPECT_EQ(paths.GetPath(9), "");
}

TEST(Paths, StartUpMakesTheFoldersThatAreMissing) {
    QTemporaryDir folder;
    const ZephPathService paths(folder.filePath("new/base").toStdString());
    EXPECT_TRUE(ZephCheckDirectoriesAtStartup(paths));
    EXPECT_TRUE(ZephCheckDirectoriesAtStartup(paths));
    for (const char* name : {"Editor", "Fixtures", "Props", "Curves", "Bulbs", "System"}) {
        EXPECT_TRUE(QDir(QString::fromStdString(paths.GetPath(kPathBase)) + name).exists()) << name;
    }
}
