// A display loaded without a window: the document and what it needs around it.
#pragma once

#include "engine/render_table.h"
#include "model/editor_loader.h"
#include "util/message_host.h"

#include <memory>

// Failure reports as lines on standard error, in the form of the program's log.
class PrintedFailures : public FailureReport {
public:
    void ErrReport(std::string_view description, std::string_view procedure, int line) override;
};

struct ToolDocument {
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();
    ZephSettings settings;  // the defaults: the headless companion keeps none
    ZephPathService paths{ZephPathService::userBase()};
    MessageHost host{stderr};
    PrintedFailures failures;
    NoWatcher watcher;
    bool loaded = false;
};

// Loads the file, by any spelling of its path. Messages go to the document's host.
std::unique_ptr<ToolDocument> loadToolDocument(const std::string& file);

// A loaded display, compiled as a simulation compiles it.
struct CompiledDocument {
    std::unique_ptr<ToolDocument> document;
    std::unique_ptr<ZephFixtureStates> states = std::make_unique<ZephFixtureStates>();
    ZephRenderTables tables;

    bool ok() const { return tables.RenderDataCount > 0; }
};

// Loads and compiles. Not ok where the display cannot be loaded or simulated; the message was printed.
CompiledDocument compileToolDocument(const std::string& file);
