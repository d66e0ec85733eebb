#include "display.h"
#include "model/editor_writer.h"
#include "model/ui_state.h"
#include "model/undo.h"
#include "tests/support/limit_document.h"
#include "tests/support/loading.h"
#include "util/random_source.h"

namespace {

struct UndoBench : LoadBench, UndoFace {
    int ZephUIState = kStateSelectFixture;
    ZephUndoStores stores;
    std::vector<int> modes;
    int replaced = 0;
    bool restoreProperties = true;
    UndoContext undo{context, ZephUIState, *this};

    void switchMode(int uiState) override {
        ZephUIState = uiState;
        modes.push_back(uiState);
    }
    void documentReplaced(bool) override { ++replaced; }

    std::int32_t add(std::int32_t action, int object = 0) {
        EXPECT_TRUE(ZephAddUndoDataXML(action, object, "8 bundles", false, undo, *simulation, stores));
        return action;
    }
    // A whole step that changes one name.
    void step(std::int32_t action, int fixture, std::string name) {
        ZephStartUndoTransaction(stores);
        add(action, fixture);
        simulation->Fixtures[fixture].Name = std::move(name);
        ZephCommitUndo(stores);
    }
    void takeBack() { EXPECT_TRUE(ZephUndoLastAction(undo, *simulation, stores, restoreProperties)); }
    void again() { EXPECT_TRUE(ZephRedoLastAction(undo, *simulation, stores, restoreProperties)); }
    std::string text() const { return editorText(*simulation, paths, ""); }
    std::string name(int fixture) const { return simulation->Fixtures[fixture].Name; }
};

// Every third fixture of the example: all kinds, and a text that is soon written.
void openDisplay(UndoBench& bench) {
    ZephGlobalReset(true, *bench.simulation, bench.watcher);
    buildDisplay(*bench.simulation);
    for (int f = bench.simulation->FixtureCount; f >= 1; --f) {
        if (f % 3 != 0) ZephDeleteThisFixture(f, true, *bench.simulation, bench.watcher);
    }
}

// What is written of a document that has read the text: a reader knows the device 99 by another number.
std::string asRead(const std::string& text) {
    return QByteArray::fromStdString(text).replace("DeviceType=\"99\"", "DeviceType=\"-1\"").toStdString();
}

// One change of the kind that commands, dialogs and damaged files leave behind.
void change(RandomSource& random, UndoBench& bench) {
    ZephSimulation& document = *bench.simulation;
    const auto pick = [&](int low, int high) { return static_cast<int>(ZephReturnRandomNumber(low, high, random)); };
    const int f = pick(1, std::max(document.FixtureCount, 1));
    const int p = pick(1, std::max(document.PropCount, 1));
    ZephFixture& fixture = document.Fixtures[f];
    const bool some = document.FixtureCount > 0;
    const int kind = pick(0, 22);
    if (kind == 0 && some) ZephDeleteThisFixture(f, true, document, bench.watcher);
    if (kind == 1 && document.PropCount > 0) ZephDeleteThisProp(p, document);
    if (kind == 2 && some && document.PropCount > 0) ZephAddFixtureToProp(f, p, document);
    if (kind == 3 && some) ZephDisassociateFromProp(f, fixture.AssignedItem, document);
    if (kind == 4 && document.FixtureCount < 80) document.Fixtures[++document.FixtureCount] = fixture;
    if (kind == 5 && document.PropCount < 20) ++document.PropCount;
    if (kind == 6)
        fixture.Name = "\x01 a\r\n\t<&>\"\xC3\xA4\x1F\xEF\xBF\xBE\xEF\xBC\x81" + std::to_string(pick(0, 999));
    if (kind == 7) fixture.PointCount = pick(-1, 300);
    if (kind == 8) fixture.DrawPoints[pick(1, kMaxPoints)] = {kPointBulb, -1, pick(-100000, 100000)};
    if (kind == 9) fixture.ChannelCount = pick(-1, 20);
    if (kind == 10)
        fixture.Channels[pick(1, kMaxChannels)].DeviceType = pick(0, 2) ? pick(-5, 7) : kDeviceClearedInFile;
    if (kind == 11) fixture.Fixture_Type = pick(0, 6);
    if (kind == 12) fixture.Kesh.Base_Unit = fixture.DMX.Universe = pick(0, 9);
    if (kind == 13) fixture.AssignedItem = pick(-2, kMaxProps + 2);
    if (kind == 14) fixture.AssignedItemName = "stale";
    if (kind == 15) document.Props[p].AssignedCount = pick(-1, 70);
    if (kind == 16) document.Props[p].Object[pick(1, kMaxFixturesInProp)] = pick(-1, 2000);
    if (kind == 17) document.Background = {pick(0, 2), (pick(0, 1) ? bench.folder.path() : "/") + "a\x02.png"};
    if (kind == 18) document.Levels[pick(1, kLevels)] = {pick(0, 1) == 0, pick(0, 1) == 0, "L"};
    if (kind == 19) document.Dimmed = pick(-1, 101);
    if (kind == 20) document.Fixtures[kMaxFixtures].Name = "left behind";  // beyond the counts, where no writer looks
    if (kind == 21) document.Props[kMaxProps].AssignedCount = 3;
    if (kind == 22) std::swap(fixture, document.Fixtures[pick(1, std::max(document.FixtureCount, 1))]);
}

}  // namespace

TEST(Undo, GivesExactlyWhatWritingAndReadingWouldGive) {
    UndoBench bench;
    LoadBench reader;
    reader.paths = bench.paths;
    SeededRandom random(7);
    openDisplay(bench);
    int undone = 0;
    for (int round = 0; round < 90 && !HasFailure(); ++round) {
        std::vector<std::string> texts;  // the document before each step
        const int steps = ZephReturnRandomNumber(1, 24, random);
        for (int step = 0; step < steps; ++step) {
            texts.push_back(asRead(bench.text()));
            ZephStartUndoTransaction(bench.stores);
            bench.add(kUndoChanged);
            for (int changes = ZephReturnRandomNumber(1, 3, random); changes > 0; --changes)
                change(random, bench);
            ZephCommitUndo(bench.stores);
        }
        const std::string last = asRead(bench.text());
        const int kept = std::min(steps, kMaxUndo);
        for (int step = 0; step < kept; ++step, ++undone) {
            bench.takeBack();
            ASSERT_EQ(bench.text(), texts[texts.size() - 1 - static_cast<std::size_t>(step)]);
        }
        ASSERT_TRUE(reader.read(bench.text(), TextReading::GeneralOnly));
        for (auto flag : {&ZephSimulation::SimulationDirty, &ZephSimulation::SimulationOpen})
            (*reader.simulation).*flag = (*bench.simulation).*flag;
        reader.simulation->FilePath = bench.simulation->FilePath;
        ASSERT_TRUE(*bench.simulation == *reader.simulation) << "round " << round;
        if (round % 2 == 0) continue;
        for (int step = 0; step < kept; ++step)
            bench.again();
        ASSERT_EQ(bench.text(), last);
        if (bench.simulation->FixtureCount < 10) openDisplay(bench);
    }
    EXPECT_GT(undone, 700);
    EXPECT_TRUE(bench.failures.reports.empty());
}

TEST(Undo, SharesWhatDidNotChange) {
    UndoBench bench;
    buildLimitDocument(*bench.simulation, {.fixtures = 60, .points = 20});
    ZephSimulation& document = *bench.simulation;
    const DocumentSnapshot before = takeSnapshot(document, bench.paths, {});
    document.Fixtures[3].DrawPoints[20].Y += 15;
    document.Fixtures[1].Channels[16].LED ^= true;
    ZephDeleteThisFixture(10, true, document, bench.watcher);
    ZephDeleteThisFixture(30, true, document, bench.watcher);
    const DocumentSnapshot after = takeSnapshot(document, bench.paths, before);
    const auto shared = [&](const PackedRecord& record) { return std::ranges::count(before.Fixtures, record) > 0; };
    EXPECT_EQ(std::ranges::count_if(after.Fixtures, shared), 56) << "all but the two changed and the two deleted";
    restoreSnapshot(before, bench.paths, document);
    const DocumentSnapshot again = takeSnapshot(document, bench.paths, after);
    const auto kept = [&](const PackedRecord& record) { return std::ranges::count(after.Fixtures, record) > 0; };
    EXPECT_EQ(std::ranges::count_if(again.Fixtures, kept), 56) << "also where the two come back";
}

TEST(Undo, KeepsTwentyStepsAndRunsBackAndForth) {
    UndoBench bench;
    bench.simulation->FixtureCount = 1;
    for (int n = 1; n <= 21; ++n)
        bench.step(kUndoChanged, 1, std::to_string(n));
    bench.simulation->SimulationDirty = false;
    bench.simulation->FileUpgraded = bench.simulation->ChecksumMismatch = true;
    for (int n = 1; n <= 21; ++n)
        bench.takeBack();
    EXPECT_EQ(bench.name(1), "1") << "the last found nothing to take back";
    EXPECT_EQ(bench.replaced, 20);
    EXPECT_FALSE(bench.restoreProperties);
    EXPECT_FALSE(bench.simulation->SimulationDirty);
    EXPECT_FALSE(bench.simulation->FileUpgraded || bench.simulation->ChecksumMismatch) << "each load clears both";
    EXPECT_EQ(bench.watcher.clipboards, 0);
    for (int n = 1; n <= 21; ++n)
        bench.again();
    EXPECT_EQ(bench.name(1), "21");
    bench.takeBack();
    bench.step(kUndoChanged, 1, "new");
    EXPECT_EQ(bench.stores.RedoPosition, 0) << "a new change ends what could be redone";
    bench.again();
    EXPECT_EQ(bench.name(1), "new");
}

TEST(Undo, DescribesEachActionAndReturnsToItsState) {
    UndoBench bench;
    ZephSimulation& document = *bench.simulation;
    document.Fixtures[1].Name = "F";
    document.Fixtures[1].AssignedItem = 3;
    document.Props[1].Name = "P1";
    document.Props[3].Name = "P3";
    const std::tuple<int, std::int32_t, int, std::int32_t, const char*, int> rows[] = {
        {3, 1, 1, 1, "Deleted F", 3},
        {3, 4, 1, 4, "End Drawing of F", 3},
        {4, 4, 2, 4, "End New Drawing", 4},
        {3, 6, 1, 6, "Cut F", 3},
        {2, 6, 1, 21, "Cut P3", 2},
        {2, 7, 1, 23, "Pasted P3", 2},
        {2, 9, 1, 24, "Changed P3", 2},
        {2, 10, 1, 25, "Sent Home P3", 2},
        {2, 8, 1, 8, "Properties Change Of F", 3},
        {3, 16, 1, 16, "UnLocked Fixture F", 3},
        {3, 19, 1, 19, "Changed Prop P1", 2},
        {3, 20, 1, 20, "Deleted P3", 3},
        {3, 17, 600, 17, "Created Prop Name ", 3},
        {3, 29, 1, 29, "Ran Mega Tree Wizard - 8 bundles", 3},
        {4, 34, 1, 34, "Changed Editor Properties", 3},
        {4, 36, 1, 36, "", 4},
        {4, 99, 1, 99, "", 4}};
    for (const auto& [state, action, object, kept, text, mode] : rows) {
        SCOPED_TRACE(text);
        ZephStartUndoTransaction(bench.stores);
        bench.ZephUIState = state;
        EXPECT_EQ(bench.add(action, object), kept);
        const ZephUndoEntry& entry = bench.stores.UndoStore.back();
        EXPECT_EQ(entry.Text, text);
        EXPECT_EQ(entry.EditorMode, mode);
    }
    ZephCommitUndo(bench.stores);
    bench.ZephUIState = kStateSelectFixture;
    bench.takeBack();
    EXPECT_EQ(bench.modes, std::vector<int>{kStateDrawing});
}

TEST(Undo, ARunOfLevelStepsIsOneStep) {
    UndoBench bench;
    std::vector<int> steps;
    for (const std::int32_t action :
         {kUndoMovedForward, kUndoMovedForward, kUndoMovedBackward, kUndoMovedForward, kUndoChanged, kUndoChanged}) {
        bench.step(action, 1, "changed");
        steps.push_back(bench.stores.UndoPosition);
    }
    EXPECT_EQ(steps, (std::vector{1, 1, 2, 3, 4, 5}));
}

TEST(Undo, ARollbackLeavesNoStepAndNothingToRedo) {
    UndoBench bench;
    bench.step(kUndoChanged, 1, "a");
    bench.takeBack();
    ZephStartUndoTransaction(bench.stores);
    bench.add(kUndoChanged);
    ZephRollbackUndo(bench.stores);
    EXPECT_EQ(bench.stores.UndoPosition, 0);
    EXPECT_EQ(bench.stores.UndoStore.size(), 1u);
    EXPECT_EQ(bench.stores.RedoPosition, 0) << "the add emptied it";
    // A transaction that nobody ended is dropped by the next.
    bench.add(kUndoChanged);
    bench.step(kUndoCreatedProp, 1, "b");
    EXPECT_EQ(bench.stores.UndoPosition, 1);

    bench.simulation->FixtureCount = kMaxFixtures + 1;  // no document has this
    std::int32_t action = kUndoChanged;
    EXPECT_FALSE(ZephAddUndoDataXML(action, 1, "", false, bench.undo, *bench.simulation, bench.stores));
    EXPECT_EQ(bench.failures.reports.at(0).procedure, "Zeph.modZephUndo.ZephAddUndoDataXML");
    ZephCommitUndo(bench.stores);
    EXPECT_EQ(bench.stores.UndoPosition, 1) << "what cannot be kept is no step";
}

TEST(Undo, RedoOutlivesALoadAndNamesNothing) {
    UndoBench bench;
    bench.simulation->FixtureCount = 1;
    bench.step(kUndoDeletedFixture, 1, "old");
    bench.takeBack();
    EXPECT_EQ(ZephUndoCaptions(bench.stores).redoItem, "Redo Deleted ");
    ZephGlobalReset(false, *bench.simulation, bench.watcher);
    bench.stores.UndoPosition = 0;  // as the window's watcher does
    bench.again();
    EXPECT_EQ(bench.name(1), "old");
    EXPECT_EQ(bench.stores.UndoPosition, 1);
    EXPECT_EQ(ZephUndoCaptions(bench.stores).undoItem, "Undo Deleted ");
    bench.step(kUndoDeletedFixture, 1, "new");
    const auto [undoItem, undoTip, redoItem, redoTip] = ZephUndoCaptions(bench.stores);
    EXPECT_EQ(undoItem + "|" + undoTip, "Undo Deleted old|Undo: Deleted old");
    EXPECT_EQ(redoItem + "|" + redoTip, "Redo|Redo");
}
