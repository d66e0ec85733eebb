// What the fuzz targets of the loaders read with: a document of its own, and a list for boxes and reports.
#pragma once

#include "model/editor_loader.h"
#include "tests/support/recording_host.h"

#include <memory>

struct ReadingRig {
    ZephSettings settings;
    ZephPathService paths{"/base"};
    RecordingHost host;
    CollectingFailures failures;
    NoWatcher watcher;
    EditorFileContext context{settings, paths, host, failures, watcher};
    std::unique_ptr<ZephSimulation> simulation = std::make_unique<ZephSimulation>();

    void forgetWhatWasTold() {
        host.boxes.clear();
        failures.reports.clear();
    }
};
