// The window program: puts the parts together and runs the event loop.
#include "link/qt_simulation_socket.h"
#include "shell/look.h"
#include "shell/main_window.h"
#include "shell/startup.h"

#include <QApplication>

namespace {

constexpr std::size_t kMostArguments = 10;

// The system's shell has parted the command line already.
CommandLineParms parmsOf(const QStringList& arguments) {
    std::vector<std::string> args;
    for (const QString& argument : arguments.mid(1)) {
        if (args.size() < kMostArguments) args.push_back(argument.toStdString());
    }
    return ProcessCommandLineParms(std::move(args));
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
    return QApplication::exec();
}
