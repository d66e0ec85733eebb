// What a user waits for at the window, on a real screen: the start of the program until its window stands with the
// example display open, and going into simulation and out again with the limit document, on either engine.
#include "bench/bench_report.h"
#include "link/qt_simulation_socket.h"
#include "model/editor_writer.h"
#include "shell/main_window.h"
#include "shell/startup.h"
#include "tests/support/limit_document.h"
#include "util/random_source.h"

#include <QAction>
#include <QApplication>
#include <QProcess>
#include <QTemporaryDir>
#include <QThread>

#include <cstdio>
#include <cstdlib>

namespace {

constexpr int kStarts = 10;
constexpr int kRounds = 11;
constexpr double kStartGoalMs = 500;
constexpr double kEnterGoalMs = 400;
constexpr double kLeaveGoalMs = 200;

template <typename... Values>
std::string text(const char* format, Values... values) {
    char buffer[160];
    std::snprintf(buffer, sizeof buffer, format, values...);
    return buffer;
}

[[noreturn]] void giveUp(const char* why) {
    std::fprintf(stderr, "bench: %s\n", why);
    std::exit(1);
}

// Once its window stands and the file is open, the program publishes its process in the settings that programs of the
// family share.
void waitUntilPublished(QProcess& process, const QString& settings) {
    const QByteArray line = "VisPid=" + QByteArray::number(process.processId());
    for (;;) {
        QFile file(settings);
        if (file.open(QIODevice::ReadOnly) && file.readAll().contains(line)) return;
        if (process.waitForFinished(0)) giveUp("the program ended while it was starting");
        QThread::usleep(500);
    }
}

void benchStart(BenchReport& report) {
    const QTemporaryDir folder;
    qputenv("ZEPH_DATA", folder.path().toUtf8());
    std::vector<double> times;
    for (int run = 0; run < kStarts; ++run) {
        QProcess process;
        times.push_back(microsecondsOf([&] {
            process.start(ZEPH_PROGRAM, {ZEPH_EXAMPLE});
            if (!process.waitForStarted()) giveUp("the program cannot be started");
            waitUntilPublished(process, folder.filePath("settings.ini"));
        }));
        process.kill();  // so that it notes no time of closing, which would refuse the next start
        process.waitForFinished();
    }
    const double time = medianOf(times);
    report.row("Start of the program", "until its window stands with the example open", time);
    report.goal("start", text("%.0f ms", time / 1000), text("at most %.0f ms", kStartGoalMs),
                time <= 1000 * kStartGoalMs);
}

class SilentHost : public WindowHost {
public:
    BoxAnswer messageBox(std::string_view title, std::string_view message, BoxIcon, BoxButtons) override {
        std::fprintf(stderr, "bench: %s\n%s\n", std::string(title).c_str(), std::string(message).c_str());
        return BoxAnswer::No;
    }
};

struct WindowUnderTest {
    QTemporaryDir folder;
    SilentHost host;
    SystemClock clock;
    QtSimulationSocket socket;
    FileSettingsStore store{folder.filePath("settings.ini").toStdString()};
    Program program{{host, clock, socket, store, listSystemAdapters, folder.path().toStdString() + "/",
                     QFileInfo(ZEPH_PROGRAM).path().toStdString(), seedFromSystem()},
                    {}};
    frmZephMain window{program, host};

    WindowUnderTest() {
        if (!ZephReadSettingsAtStart(program)) giveUp("the settings cannot be read");
        ZephStartUp([](std::string_view) {}, window, program);
        window.start();
        const auto limit = std::make_unique<ZephSimulation>();
        buildLimitDocument(*limit);
        limit->FilePath = folder.path().toStdString() + "/";
        limit->FileName = "limit.zee";
        if (!ZephSaveVisualizerXML("", program.files, *limit) ||
            !window.openFile(folder.filePath("limit.zee"), false)) {
            giveUp("the limit document cannot be opened");
        }
        QApplication::processEvents();
    }

    void enter() {
        window.findChild<QAction*>("mnuSimulationMode")->trigger();
        if (!program.simulating()) giveUp("simulation could not be entered");
    }
    // As the OpenGL window's stop button does; the tick after it takes the simulation down.
    void leave() {
        program.clocks.StopRequested = true;
        while (program.simulating())
            QApplication::processEvents(QEventLoop::WaitForMoreEvents);
    }
};

struct RoundTimes {
    double enterMs = 0;
    double leaveMs = 0;
};

RoundTimes measureRounds(int engine, const char* name, WindowUnderTest& test, BenchReport& report) {
    test.program.RenderEngine = engine;
    std::vector<double> enter;
    std::vector<double> leave;
    for (int round = 0; round < kRounds; ++round) {
        enter.push_back(microsecondsOf([&] { test.enter(); }));
        for (int tick = 0; tick < 3; ++tick)
            QApplication::processEvents(QEventLoop::WaitForMoreEvents);
        leave.push_back(microsecondsOf([&] { test.leave(); }));
        QApplication::processEvents();
    }
    const double in = medianOf(enter);
    const double out = medianOf(leave);
    report.row("Simulation of the limit document", text("entered, %s", name), in);
    report.row("Simulation of the limit document", text("left, %s", name), out);
    return {in / 1000, out / 1000};
}

void benchEnter(BenchReport& report) {
    WindowUnderTest test;
    const RoundTimes standard = measureRounds(kEngineStandard, "standard engine", test, report);
    const RoundTimes openGl = measureRounds(kEngineOpenGL, "OpenGL engine", test, report);
    report.goal("enter",
                text("standard %.0f ms in, %.0f ms out; OpenGL %.0f ms in, %.0f ms out", standard.enterMs,
                     standard.leaveMs, openGl.enterMs, openGl.leaveMs),
                text("at most %.0f ms in, %.0f ms out", kEnterGoalMs, kLeaveGoalMs),
                std::max(standard.enterMs, openGl.enterMs) <= kEnterGoalMs &&
                    std::max(standard.leaveMs, openGl.leaveMs) <= kLeaveGoalMs);
}

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    QApplication::setQuitOnLastWindowClosed(false);  // the OpenGL engine hides the main window
    BenchReport report;
    benchStart(report);
    benchEnter(report);
    report.print(argc == 2 && std::string_view(argv[1]) == "--goals");
    return 0;
}
