// The state of the running program: one of each. Made by main, or by a test with seams of its own; everything else is
// handed parts of it by reference.
#pragma once

#include "editor/editor_watcher.h"
#include "engine/bulb_images.h"
#include "engine/light_commands.h"
#include "engine/opengl_surface.h"
#include "engine/render_cycle.h"
#include "engine/standard_surface.h"
#include "link/communications.h"
#include "model/autosave.h"
#include "model/dimming_curve.h"
#include "util/command_line.h"
#include "util/error_log.h"
#include "util/paths.h"
#include "util/random_source.h"
#include "util/settings_store.h"

#include <QImage>

#include <memory>
#include <string>

// What differs between the program and a test of it.
struct ProgramSeams {
    Host& host;
    const Clock& clock;
    SimulationSocket& socket;
    SettingsStore& store;
    AdapterLister lister;
    std::string dataFolder;     // base of the user's data folders
    std::string programFolder;  // where the blank picture lies
    std::uint64_t seed = 1;
};

struct Program {
    Program(ProgramSeams seams, CommandLineParms parms);
    Program(const Program&) = delete;  // its parts refer to one another
    Program& operator=(const Program&) = delete;

    ProgramSeams seams;
    CommandLineParms parms;
    ZephPathService paths;
    ErrorLog failures;
    ZephSettings settings;
    bool StartupLoading = false;
    int RenderEngine = kEngineStandard;
    ZephEditorState editor;
    ZephUndoStores undo;
    AutoSaveState autosave;
    EditorStateWatcher watcher{editor, undo};
    EditorFileContext files{settings, paths, seams.host, failures, watcher};

    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    ZephDimmingCurve curve{};
    std::unique_ptr<ZephMasks> masks = std::make_unique<ZephMasks>();
    std::unique_ptr<ZephStaticBulbs> bulbs = std::make_unique<ZephStaticBulbs>();

    QImage Picture3;       // the picture at canvas size and its own brightness; null = no canvas yet
    QImage picBackground;  // the same at the brightness of the document
    QImage picBuffer;      // the editor's composed canvas

    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    ZephRenderTables tables;
    ZephRenderClocks clocks;
    SeededRandom random;
    RenderTableSink sink;
    StandardSurface surface;
    OpenGLSurface glSurface;

    Connection connection;
    ZephAdapters adapters;
    ParserSetup parser;
    ReceiveState receive;

    bool rendersOpenGL() const { return RenderEngine == kEngineOpenGL; }
    bool simulating() const { return editor.ZephUIState == kStateSimulation; }
};

// The log of failures: "errorlog.txt" in the System folder.
std::string logFileOf(const ZephPathService& paths);
