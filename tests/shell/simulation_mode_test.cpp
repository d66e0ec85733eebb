#include "shell/load_editor_file.h"
#include "shell/simulation_mode.h"
#include "tests/shell/shell_rig.h"

namespace {

class RecordingFace : public SimulationFace, public FileFace {
public:
    void setTimer(bool on, int intervalMs) override {
        timerOn = on;
        timerMs = intervalMs;
    }
    void showQueueGauge(bool on) override { gauge = on; }
    void showFrames(const QImage& frame) override { shown = &frame; }
    void redrawObjects() override {
        shown = nullptr;
        ++redraws;
    }
    void SetControlsForSimulation(bool on) override { simulationControls = on; }
    void layOutForEditor() override { simulationControls = false; }
    GLTarget* ZephCreateRenderWindow() override {
        ++renderWindows;
        return nullptr;
    }
    void resizeRenderWindow() override {}
    void closeRenderWindow() override { renderWindows = 0; }
    void showMainWindow(bool shownNow) override { mainShown = shownNow; }
    void CheckEnable(bool) override {}
    void restoreIfMinimized() override {}
    void eraseRubberBand() override {}
    void setCanvasPointer(CanvasPointer) override {}
    void ZephHighlightflg(std::int32_t) override {}
    void ZephDeselectflg() override {}
    void ZephLoadUIObjectList() override {}
    void showPressedDrawButton() override {}
    void showModeButtons() override {}
    void showDocument() override {}
    void setTitle(std::string_view windowTitle) override { title = windowTitle; }

    bool timerOn = false;
    int timerMs = 0;
    bool gauge = false;
    bool simulationControls = false;
    int redraws = 0;
    int renderWindows = 0;
    bool mainShown = true;
    const QImage* shown = nullptr;
    std::string title;
};

struct SimulationMode : testing::Test {
    void SetUp() override {
        rig.start();
        const auto display = std::make_unique<ZephSimulation>();
        ShellRig::buildDisplay(*display);
        open(rig.save(*display, "bulb.zee"));
        host.panel2History.clear();
    }
    bool open(const std::string& path) {
        setEditorFile(path, *rig.program.simulation);
        return LoadEditorFile(false, rig.program, face, face);
    }
    void enter() { mnuSimulationMode_Click(rig.program, face); }
    void tick(std::int32_t ms) {
        rig.clock.set(100'000 + ms);
        hrTimer1_Timer([] {}, rig.program, face);
    }
    void arrive(const std::string& text) {
        rig.socket.reads.push_back(text);
        Winsock1_DataArrival(rig.program.simulating(), false, rig.socket, rig.program.failures, rig.program.receive);
    }

    RecordingHost host;
    ShellRig rig{host};
    RecordingFace face;
};

using Strings = std::vector<std::string>;

}  // namespace

TEST_F(SimulationMode, EntersInTheFixedOrderAndLightsABulb) {
    ASSERT_EQ(face.title, "Qen Visualizer v1.0.0 -bulb.zee");
    enter();
    const Strings& told = host.panel2History;
    EXPECT_EQ(told.front(), "Creating new simulation pointers...");
    EXPECT_EQ(Strings(told.end() - 3, told.end()),
              (Strings{"Opening data connection...", "Setting Emulation Timer Attributes...",
                       "UDP Simulation active on 127.0.0.1 (30303)"}));
    EXPECT_TRUE(face.timerOn);
    EXPECT_EQ(face.timerMs, 9);
    EXPECT_TRUE(face.gauge);
    EXPECT_TRUE(face.simulationControls);
    EXPECT_FALSE(host.busyPointer);
    ASSERT_NE(face.shown, nullptr);
    EXPECT_EQ(face.shown->pixel(20, 10), qRgb(255, 255, 255));
    arrive(bulbFrame("100"));
    tick(9);
    EXPECT_EQ(face.shown->pixel(20, 10), qRgb(255, 0, 0));
    arrive(bulbFrame("000"));
    tick(18);
    tick(27);
    EXPECT_EQ(face.shown->pixel(20, 10), qRgb(255, 255, 255));
}

TEST_F(SimulationMode, LeavesAndComesBackOnTheSameSocket) {
    enter();
    arrive(bulbFrame("100"));
    tick(9);
    EndSimulation(rig.program, face);
    EXPECT_EQ(rig.program.editor.ZephUIState, kStateSelectFixture);
    EXPECT_FALSE(face.timerOn);
    EXPECT_FALSE(face.gauge);
    EXPECT_FALSE(face.simulationControls);
    EXPECT_EQ(face.shown, nullptr);
    EXPECT_EQ(host.panels[2], "Select Fixture");
    EXPECT_EQ(host.panels[3], "");
    EXPECT_EQ(rig.program.tables.RenderDataCount, 0);

    arrive(bulbFrame("100"));  // between two simulations: thrown away
    enter();
    tick(900);
    ASSERT_NE(face.shown, nullptr);
    EXPECT_EQ(face.shown->pixel(20, 10), qRgb(255, 255, 255));
    EXPECT_EQ(std::ranges::count(rig.socket.calls, "bind 127.0.0.1 30303"), 1);
}

TEST_F(SimulationMode, RefusesAClockThatRunsBackwards) {
    rig.clock.set(-1);
    enter();
    EXPECT_FALSE(rig.program.simulating());
    ASSERT_EQ(host.boxes.size(), 1U);
    EXPECT_EQ(host.boxes[0].title, "Qen Visualizer-Error:  Reboot Required");
    EXPECT_EQ(host.boxes[0].icon, BoxIcon::Critical);
    EXPECT_TRUE(rig.socket.calls.empty());
    EXPECT_FALSE(face.timerOn);
}

TEST_F(SimulationMode, ReturnsToTheEditorFromEachFailure) {
    struct Row {
        const char* name;
        std::function<void()> spoil;
        const char* title;
    };
    const Row rows[] = {
        {"nothing to simulate", [&] { rig.program.simulation->Fixtures[1].ChannelCount = 0; }, "Qen Visualizer-Error"},
        {"no port", [&] { rig.socket.taken = true; }, "Qen Visualizer-Port Error"},
    };
    for (const Row& row : rows) {
        host.boxes.clear();
        const ZephFixture before = rig.program.simulation->Fixtures[1];
        row.spoil();
        enter();
        EXPECT_FALSE(rig.program.simulating()) << row.name;
        EXPECT_FALSE(face.timerOn) << row.name;
        EXPECT_FALSE(host.busyPointer) << row.name;
        EXPECT_EQ(host.panels[2], "Select Fixture") << row.name;
        ASSERT_EQ(host.boxes.size(), 1U) << row.name;
        EXPECT_EQ(host.boxes[0].title, row.title) << row.name;
        rig.program.simulation->Fixtures[1] = before;
        rig.socket.taken = false;
    }
    enter();
    EXPECT_TRUE(rig.program.simulating());
}

TEST_F(SimulationMode, TakesAssembledRibbonsApartAgain) {
    ZephSimulation& simulation = *rig.program.simulation;
    simulation.FixtureCount = 3;
    for (const int piece : {2, 3}) {
        ZephFixture& ribbon = simulation.Fixtures[piece];
        ribbon = simulation.Fixtures[1];
        ribbon.Fixture_Type = kFixtureKesh;
        ribbon.Channel_Type = kChannelRgb;
        ribbon.Kesh.Base_Unit = 5;
        ribbon.Kesh.Physical_Pixel_Number = piece == 2 ? 1 : 4;
    }
    enter();
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 4);  // its own, two that are not drawn, and the child's
    EndSimulation(rig.program, face);
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 1);

    simulation.Fixtures[3].Kesh.Physical_Pixel_Number = 1;  // two pieces on the same pixel
    enter();
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_EQ(host.compileErrors.size(), 1U);
    EXPECT_EQ(simulation.Fixtures[2].PointCount, 1);
}

TEST_F(SimulationMode, AFileThatCannotBeOpenedLeavesAnEmptyWindow) {
    EXPECT_FALSE(open(rig.folder.path().toStdString() + "/gone.zee"));
    EXPECT_FALSE(rig.program.simulation->SimulationOpen);
    EXPECT_TRUE(rig.program.picBackground.isNull());
    EXPECT_EQ(rig.program.simulation->FixtureCount, 0);
    ASSERT_EQ(host.boxes.size(), 1U);
    EXPECT_EQ(host.boxes[0].title, "Qen Visualizer-Editor Load Error");
    EXPECT_EQ(face.title, "Qen Visualizer v1.0.0 -bulb.zee");  // the title keeps what it had
}

TEST_F(SimulationMode, WithoutAnOpenGLContextLeadsBackToAWholeEditor) {
    rig.program.RenderEngine = kEngineOpenGL;
    enter();
    EXPECT_FALSE(rig.program.simulating());
    EXPECT_FALSE(face.timerOn);
    EXPECT_TRUE(face.mainShown);
    EXPECT_EQ(face.renderWindows, 0) << "asked for and closed again";
    EXPECT_THAT(host.panel2History,
                testing::IsSupersetOf({"Opening data connection...", "Creating Rendering Window", "Select Fixture"}));
    EXPECT_FALSE(host.busyPointer);
}
