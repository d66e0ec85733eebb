// The document in compact form, as undo and redo keep it: exactly what writing it and reading it again would give, and
// nothing else. Records that did not change since an earlier snapshot are shared with it, so that a step costs what
// the step changed, apart from the look at every record that finds it out.
#pragma once

#include "model/simulation.h"
#include "util/paths.h"

#include <memory>
#include <string>
#include <vector>

// One record's fields and used slots, one after the other, in this machine's byte order; never stored.
using PackedRecord = std::shared_ptr<const std::string>;

struct DocumentSnapshot {
    PackedRecord Head;                   // background, levels, Dimmed; null in a snapshot that was never taken
    std::vector<PackedRecord> Props;     // prop n at n - 1, as many as PropCount says
    std::vector<PackedRecord> Fixtures;  // likewise

    bool taken() const noexcept { return Head != nullptr; }
};

// The document as it is. earlier: the snapshot to share with, most usefully the last one taken or restored. Throws
// Failure where a count of the document is beyond its table.
DocumentSnapshot takeSnapshot(const ZephSimulation& simulation, const ZephPathService& paths,
                              const DocumentSnapshot& earlier);

// Fills a document whose records the caller has emptied. Path, name and the state flags stay as they are.
void restoreSnapshot(const DocumentSnapshot& snapshot, const ZephPathService& paths, ZephSimulation& simulation);
