// The program without its window and without the machine: a list for a socket, a clock set by hand, a folder that goes
// with the test.
#pragma once

#include "model/editor_writer.h"
#include "shell/startup.h"
#include "tests/support/list_socket.h"
#include "tests/support/loading.h"
#include "tests/support/map_settings_store.h"
#include "util/units.h"

struct ShellRig {
    explicit ShellRig(Host& shown) : host(shown) {}

    // A canvas of 60 x 30 pixels with one red bulb of radius 4 at (20, 10), on Qen unit 1, circuit 1.
    static void buildDisplay(ZephSimulation& simulation) {
        NoWatcher nobody;
        ZephGlobalReset(false, simulation, nobody);
        simulation.Background = {0, "", 100, 60 * TwipsPerPixelX, 30 * TwipsPerPixelY};
        simulation.FixtureCount = 1;
        ZephFixture& fixture = simulation.Fixtures[1];
        InitializeFixture(ZephSettings{}, fixture);
        fixture.Fixture_Type = kFixtureBulbs;
        fixture.Name = "Bulb";
        fixture.BulbSize = 4;
        fixture.BulbShape = 3;
        fixture.ChannelCount = 1;
        fixture.Channels[1].DeviceType = kDeviceQen;
        fixture.Channels[1].Controller = 1;
        fixture.Channels[1].Channel = 1;
        fixture.Channels[1].Name = "Bulb";
        fixture.Channels[1].Color = 255;
        fixture.PointCount = 1;
        fixture.DrawPoints[1] = {kPointBulb, 20 * TwipsPerPixelX, 10 * TwipsPerPixelY};
    }

    // Writes an editor file into the folder and gives its path.
    std::string save(ZephSimulation& simulation, const std::string& name) {
        simulation.FilePath = folder.path().toStdString() + "/";
        simulation.FileName = name;
        EXPECT_TRUE(ZephSaveVisualizerXML("1/1/2026 0:00:00 AM", program.files, simulation));
        return simulation.FilePath + name;
    }

    void start() {
        QImage white(1, 1, QImage::Format_RGB32);
        white.fill(Qt::white);
        white.save(folder.filePath("blank.gif"), "PNG");  // pictures are known by their content
        store.set("Advanced Render Engine", "False");     // no OpenGL on the platform of these tests
        EXPECT_TRUE(ZephReadSettingsAtStart(program));
        startUp(nobodyStarting);
    }
    // The steps behind the splash, for a window that stands.
    void startUp(StartupFace& face) {
        ZephStartUp([this](std::string_view text) { steps.emplace_back(text); }, face, program);
    }

    struct NobodyStarting : StartupFace {
        void setUpToolBars() override {}
        void setUpMenus() override {}
        void mnuFileLoad_Click() override {}
        void mnuRecentFiles_Click(int) override {}
        bool openCommandLineFile(const std::string&) override { return false; }
    };

    NobodyStarting nobodyStarting;
    MapSettingsStore store;
    QTemporaryDir folder;
    Host& host;
    ManualClock clock{100'000};
    ListSocket socket;
    Program program{{host, clock, socket, store, [] { return std::vector<ZephAdapter>{}; }, folder.path().toStdString(),
                     folder.path().toStdString(), 1},
                    {}};
    std::vector<std::string> steps;
};

// A frame with one plain command for unit 1, circuit 1, at once to the level.
inline std::string bulbFrame(const std::string& percent) {
    return "\x01"
           "001"   // one payload
           "0036"  // 7 + 29 characters
           "0000"  // light command, plain
           "00001001001"
           "00000000" +
           percent + percent + "\x04";
}
