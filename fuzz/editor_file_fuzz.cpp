// Any bytes as an editor file: both forms of reading must agree on the records, the boxes and the reports, and what
// was read must survive being written and read again.
#include "fuzz/reading_rig.h"
#include "model/editor_writer.h"

#include <cstdlib>

namespace {

struct Reader : ReadingRig {
    bool read(std::string_view text, TextReading reading) {
        forgetWhatWasTold();
        return loadEditorText(text, reading, true, context, *simulation);
    }
    // Everything that a reader leaves behind, as text.
    std::string outcome() const {
        std::string lines = editorText(*simulation, paths, "");
        lines += simulation->ChecksumMismatch ? " mismatch" : "";
        lines += simulation->FileUpgraded ? " upgraded" : "";
        lines += simulation->FixtureLedDefault ? " led" : "";
        for (const auto& box : host.boxes)
            lines += "\n" + box.title + box.text;
        for (const auto& report : failures.reports)
            lines += "\n" + report.procedure + report.description + std::to_string(report.line);
        return lines;
    }
};

// Made once for all inputs: two documents of 6 MB for each would leave time for little else. A refused input leaves
// both as the one before it did.
struct Readers {
    Reader quick;
    Reader general;
};

void check(bool condition) {
    if (!condition) std::abort();
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static Readers readers;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    const bool quickResult = readers.quick.read(text, TextReading::QuickThenGeneral);
    const bool generalResult = readers.general.read(text, TextReading::GeneralOnly);
    check(quickResult == generalResult);
    check(readers.quick.outcome() == readers.general.outcome());
    if (!generalResult) return 0;
    const std::string written = editorText(*readers.general.simulation, readers.general.paths, "");
    check(readers.general.read(written, TextReading::GeneralOnly));
    check(readers.quick.read(written, TextReading::QuickThenGeneral));
    check(editorText(*readers.general.simulation, readers.general.paths, "") == written);
    return 0;
}
