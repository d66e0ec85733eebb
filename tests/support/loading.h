// A temporary data folder with everything that loading and saving take, and a record of what they did.
#pragma once

#include "model/editor_loader.h"
#include "tests/support/folder.h"
#include "tests/support/recording_host.h"

#include <memory>

// Counts what the document's primitives tell.
class CountingWatcher : public DocumentWatcher {
public:
    void selectionCleared() override { ++selections; }
    void fixtureRemoved(int fixture) override { removed.push_back(fixture); }
    void objectListChanged() override { ++lists; }
    void canvasChanged() override {}
    void editSessionReset() override {}
    void clipboardAndStatusCleared() override { ++clipboards; }

    std::vector<int> removed;
    int selections = 0;
    int lists = 0;
    int clipboards = 0;
};

// The bytes of each code unit, the low one first.
inline std::string utf16Bytes(std::u16string_view units) {
    std::string bytes;
    for (const char16_t unit : units)
        bytes.append({static_cast<char>(unit & 0xFF), static_cast<char>(unit >> 8)});
    return bytes;
}

// One document with its surroundings, in a folder that goes when it goes.
struct LoadBench {
    Folder folder;
    ZephSettings settings;
    ZephPathService paths{folder.path()};
    RecordingHost host;
    CollectingFailures failures;
    CountingWatcher watcher;
    EditorFileContext context{settings, paths, host, failures, watcher};
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();

    LoadBench() { name("display.zee"); }
    void name(std::string fileName) {
        simulation->FilePath = folder.path();
        simulation->FileName = std::move(fileName);
    }
    std::string path() const { return simulation->FilePath + simulation->FileName; }
    // Of the file under that name, and of a text as if it were the file.
    bool load() { return ZephLoadVisualizerXML(true, context, *simulation); }
    bool read(std::string_view text, TextReading reading = TextReading::QuickThenGeneral) {
        return loadEditorText(text, reading, true, context, *simulation);
    }
};
