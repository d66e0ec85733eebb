// The window program: puts the parts together and runs the event loop.
#include "link/qt_simulation_socket.h"
#include "shell/dialogs/about_dialog.h"
#include "shell/look.h"
#include "shell/main_window.h"
#include "shell/sequencer_control.h"
#include "shell/startup.h"
#include "util/fault_log.h"

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
    QApplication::setQuitOnLastWindowClosed(false);  // the OpenGL engine hides the main window
    applyLook(application);
    QApplication::setWindowIcon(simulationIcon());

    WindowHost host;
    const SystemClock clock;
    QtSimulationSocket socket;
    FileSettingsStore store(FileSettingsStore::userFile());
    Program program({host, clock, socket, store, listSystemAdapters, ZephPathService::userBase(),
                     QApplication::applicationDirPath().toStdString(), seedFromSystem()},
                    parmsOf(QApplication::arguments()));
    if (!ZephReadSettingsAtStart(program)) return 0;
    installFaultLog(logFileOf(program.paths));

    frmZephMain window(program, host);
    {
        frmZephAbout splash(frmZephAbout::Purpose::Splash);
        splash.adjustSize();
        splash.move(window.geometry().center() - splash.rect().center());
        splash.show();
        ZephStartUp([&](std::string_view text) { splash.StartupMessage(text); }, window, program);
    }
    window.start();
    if (QApplication::arguments().contains(kSimulateSwitch)) {
        window.findChild<QAction*>("mnuSimulationMode")->trigger();
        tellSequencer(SequencerCommand::Start, store, program.failures);
    }
    const int result = QApplication::exec();
    removeFaultLog();
    return result;
}
