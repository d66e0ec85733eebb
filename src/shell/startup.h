// How the program comes up: the settings, the steps behind the splash in their fixed order, and what happens first once
// the window stands.
#pragma once

#include "shell/program.h"
#include "shell/settings_registry.h"

#include <functional>

// Shows a step's text on the splash before the step's work begins.
using StartupMessage = std::function<void(std::string_view)>;

// What the start asks of the window.
class StartupFace {
public:
    virtual ~StartupFace() = default;
    virtual void setUpToolBars() = 0;  // tips of the buttons
    virtual void setUpMenus() = 0;     // recent files, what is available, the options band, chkSimplePropMode
    virtual void mnuFileLoad_Click() = 0;
    virtual void mnuRecentFiles_Click(int index) = 0;
    virtual bool openCommandLineFile(const std::string& file) = 0;  // quietly
};

// What reading and writing the settings need of the program.
RegistryContext registryContext(Program& program);

// Reads every setting; the window is made after it, in its stored place. False: the program was closed less than five
// seconds ago, and this start is to end without a word.
[[nodiscard]] bool ZephReadSettingsAtStart(Program& program);

// The engine that the setting "Advanced Render Engine" asks for.
int renderEngineOf(const ZephSettings& settings);

// The steps behind the splash. A step that fails is reported, and the start goes on.
void ZephStartUp(const StartupMessage& status, StartupFace& face, Program& program);

// Once the window is shown: the file of the command line, else what "On Startup" asks for; then this process is
// published to the sequencing program.
void ZephOpenFirst(StartupFace& face, Program& program);

// The window's title: the program's name, " v", the version and a blank, then "-" and the file's name if one is open.
std::string ZephWindowTitle(std::string_view fileName);
