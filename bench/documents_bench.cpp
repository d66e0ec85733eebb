// Keeping and bringing back the limit document, and carrying a large prop to another display, beside what one would
// take instead: the document as text, and as a tree of a general parser.
#include "bench/bench_report.h"
#include "model/editor_writer.h"
#include "model/object_files.h"
#include "model/ui_state.h"
#include "model/undo.h"
#include "tests/support/limit_document.h"
#include "tests/support/recording_host.h"

#include <QTemporaryDir>

#include <cstdio>
#include <memory>
#include <pugixml.hpp>

namespace {

constexpr int kRuns = 15;

std::string millisecondsText(double microseconds) {
    char text[32];
    std::snprintf(text, sizeof text, "%.2f ms", microseconds / 1000);
    return text;
}

class NoFace : public UndoFace {
public:
    void switchMode(int) override {}
    void documentReplaced(bool) override {}
};

// A display with what procedures need around it.
struct Display {
    QTemporaryDir folder;
    ZephPathService paths{folder.path().toStdString()};
    ZephSettings settings;
    RecordingHost host;
    CollectingFailures failures;
    NoWatcher watcher;
    EditorFileContext context{settings, paths, host, failures, watcher};
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
};

}  // namespace

void benchUndo(BenchReport& report) {
    Display display;
    ZephSimulation& document = *display.simulation;
    buildLimitDocument(document);
    NoFace face;
    const int state = kStateSelectFixture;
    const UndoContext context{display.context, state, face};
    ZephUndoStores stores;
    std::int32_t action = kUndoChanged;
    const auto record = [&] {
        ZephStartUndoTransaction(stores);
        ZephAddUndoDataXML(action, 1, "", false, context, document, stores);
        ZephCommitUndo(stores);
    };
    int moved = 0;
    const auto move = [&] {
        for (ZephDrawPoint& point : document.Fixtures[1 + ++moved % kMaxFixtures].DrawPoints)
            point.X += 15;
    };
    const double first = microsecondsOf(record);
    const double later = medianMicroseconds(kRuns, move, record);
    bool restore = false;
    const double back = medianMicroseconds(kRuns, [&] { ZephUndoLastAction(context, document, stores, restore); });
    const double forth = medianMicroseconds(kRuns, [&] { ZephRedoLastAction(context, document, stores, restore); });

    const auto other = std::make_unique<ZephSimulation>();
    const double copy = medianMicroseconds(5, [&] { *other = document; });
    std::string text;
    const double asText = medianMicroseconds(5, [&] { text = editorText(document, display.paths, ""); });
    pugi::xml_document tree;
    const double asTree = medianMicroseconds(3, [&] {
        text = editorText(document, display.paths, "");
        keepResult(tree.load_buffer(text.data(), text.size()).status);
    });
    const double readText = medianMicroseconds(
        5, [&] { keepResult(loadEditorText(text, TextReading::QuickThenGeneral, true, display.context, *other)); });

    const std::string group = "One undo step of the limit document";
    report.row(group, "keep the document as a tree (pugixml)", asTree);
    report.row(group, "keep it as text", asText);
    report.row(group, "copy all records", copy);
    report.row(group, "keep it, nothing kept yet", first);
    report.row(group, "keep it, one fixture moved", later);
    const std::string backGroup = "One step of the limit document taken back";
    report.row(backGroup, "read the records from text", readText);
    report.row(backGroup, "undo", back);
    report.row(backGroup, "redo", forth);
    const bool good = display.failures.reports.empty() && document.FixtureCount == kMaxFixtures;
    report.goal("undo-record", millisecondsText(later), "at most 3 ms a step", good && later <= 3000);
    report.goal("undo", millisecondsText(back), "at most 10 ms before the redrawing", good && back <= 10'000);
}

void benchObjectFiles(BenchReport& report) {
    Display display;
    ZephSimulation& document = *display.simulation;
    buildLimitDocument(document, {.fixtures = kMaxFixturesInProp, .props = 1});
    const std::string path = display.folder.path().toStdString() + "/large.zpf";
    const ObjectSaving saving{"21.11.26 10:00:00", display.host, display.failures};
    bool good = true;
    bool channelsSeen = false;
    const auto write = [&] {
        good = ZephSavePropXML(document, document.Props[1], path, kChannelChoiceYes, saving) && good;
    };
    const auto forget = [&] {
        document.FixtureCount = kMaxFixturesInProp;
        document.PropCount = 1;
    };
    const auto read = [&] { good = ZephLoadPropFileXML(path, display.context, document, channelsSeen) && good; };
    const double writing = medianMicroseconds(kRuns, write);
    const double reading = medianMicroseconds(kRuns, forget, read);
    const double both = medianMicroseconds(kRuns, forget, [&] {
        write();
        read();
    });
    good = good && document.FixtureCount == 2 * kMaxFixturesInProp && document.Props[2].AssignedCount == 64;

    pugi::xml_document tree;
    const double peer = medianMicroseconds(
        kRuns, [&] { good = tree.load_file(path.c_str()) && tree.save_file((path + ".tree").c_str()) && good; });
    const std::string group = "A prop of 64 fixtures of 256 points and 16 channels";
    report.row(group, "pugixml, tree read and written, no records", peer);
    report.row(group, "write the prop file (flushed to the disk)", writing);
    report.row(group, "read it into the document", reading);
    report.row(group, "write and read", both);
    report.goal("prop-file", millisecondsText(both), "at most 20 ms written and read", good && both <= 20'000);
}
