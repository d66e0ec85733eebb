// The window program: puts the parts together and runs the event loop.
#include "link/qt_simulation_socket.h"
#include "shell/look.h"
#include "shell/main_window.h"
#include "shell/startup.h"

#include <QAction>
#include <QApplication>

namespace {

constexpr int kMostArguments = 10;

// For demonstrations: the simulation runs as soon as the file is open, as if its command had been chosen.
const QString kSimulateSwitch = QStringLiteral("--simulate");

CommandLineParms parmsOf(QStringList arguments) {
    arguments.removeFirst();
    arguments.removeAll(kSimulateSwitch);
    std::vector<std::string> args;
    for (const QString& argument : arguments)
        args.push_back(argument.toStdString());
    return ProcessCommandLineParms(GetCommandLine(commandLineText(args), kMostArguments));
}

}  // namespace

int main(int argc, char** argv) {
    QApplication application(argc, argv);
    QApplication::setApplicationName("zeph");
    applyLook(application);
    QApplication::setWindowIcon(simulationIcon());

    WindowHost host;
    const SystemClock clock;
    QtSimulationSocket socket;
    NoWatcher watcher;
    Program program({host, clock, socket, watcher, listSystemAdapters, ZephPathService::userBase(),
                     QApplication::applicationDirPath().toStdString(), seedFromSystem()},
                    parmsOf(QApplication::arguments()));
    ZephStartUp([](std::string_view) {}, program);
    frmZephMain window(program, host);
    window.start();
    if (QApplication::arguments().contains(kSimulateSwitch)) {
        window.findChild<QAction*>("mnuSimulationMode")->trigger();
    }
    return QApplication::exec();
}
