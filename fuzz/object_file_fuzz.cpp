// Any bytes as a fixture file and as a prop file: both forms of reading must agree, what fails is taken back, and what
// was read must survive being written and read again.
#include "fuzz/reading_rig.h"
#include "model/editor_writer.h"
#include "model/object_files.h"

#include <cstdlib>

namespace {

void check(bool condition) {
    if (!condition) std::abort();
}

struct Reader : ReadingRig {
    bool channelsSeen = false;

    bool read(std::string_view text, TextReading reading, bool prop) {
        empty();
        simulation->FixtureLedDefault = false;
        forgetWhatWasTold();
        return prop ? loadPropFileText(text, reading, context, *simulation, channelsSeen)
                    : loadFixtureFileText(text, reading, context, *simulation, channelsSeen);
    }
    // Only what a load can have filled: to look at all of a document would take most of the time.
    void empty() {
        for (; simulation->FixtureCount > 0; --simulation->FixtureCount)
            simulation->Fixtures[simulation->FixtureCount] = ZephFixture{};
        for (; simulation->PropCount > 0; --simulation->PropCount)
            simulation->Props[simulation->PropCount] = ZephProp{};
    }
    std::string outcome() const {
        std::string lines = editorText(*simulation, paths, "");
        lines += channelsSeen ? " channels" : "";
        for (const auto& box : host.boxes)
            lines += "\n" + box.title + box.text;
        for (const auto& report : failures.reports)
            lines += "\n" + report.procedure + report.description + std::to_string(report.line);
        return lines;
    }
    std::string written(bool prop) const {
        return prop ? propFileText(*simulation, simulation->Props[1], kChannelChoiceYes, "")
                    : fixtureFileText(simulation->Fixtures[1], kChannelChoiceYes, "");
    }
};

// Made once for all inputs, since a document takes 6 MB.
struct Readers {
    Reader quick;
    Reader general;
};

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    static Readers readers;
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    for (const bool prop : {false, true}) {
        const bool read = readers.quick.read(text, TextReading::QuickThenGeneral, prop);
        check(read == readers.general.read(text, TextReading::GeneralOnly, prop));
        const std::string outcome = readers.quick.outcome();
        check(outcome == readers.general.outcome());
        const ZephSimulation& document = *readers.quick.simulation;
        check(document.PropCount == (read && prop ? 1 : 0));
        if (!prop) check(document.FixtureCount == (read ? 1 : 0));
        if (!read) continue;
        const std::string written = readers.quick.written(prop);
        check(readers.general.read(written, TextReading::QuickThenGeneral, prop));
        check(readers.general.written(prop) == written);
    }
    return 0;
}
