// Whole files: each folder under editor_files holds an input and what comes of it: the answer, the boxes, the reports,
// and the document written again in the present version.
#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "tests/support/loading.h"
#include "util/message_host.h"

#include <filesystem>
#include <fstream>

namespace {

const std::filesystem::path kCases = ZEPH_TEST_DATA "/editor_files";

std::string contents(const std::filesystem::path& path) {
    std::ifstream file(path, std::ios::binary);
    return {std::istreambuf_iterator<char>(file), {}};
}

std::string replaced(std::string text, std::string_view from, std::string_view to) {
    for (std::size_t at = text.find(from); at != std::string::npos; at = text.find(from, at + to.size()))
        text.replace(at, from.size(), to);
    return text;
}

std::string flag(const char* name, bool value) {
    return std::string(name) + (value ? ": true\n" : ": false\n");
}

// What comes of a text, in lines. Line numbers of reports are left out: they change with the source.
std::string outcome(std::string_view text, TextReading reading) {
    LoadBench bench;
    bench.simulation->FilePath = "";
    std::string lines = flag("result", bench.read(text, reading));
    lines += flag("upgraded", bench.simulation->FileUpgraded);
    lines += flag("mismatch", bench.simulation->ChecksumMismatch);
    lines += flag("led default", bench.simulation->FixtureLedDefault);
    for (const auto& box : bench.host.boxes)
        lines += "box: " + box.title + " | " + onOneLine(box.text) + "\n";
    for (const auto& report : bench.failures.reports)
        lines += "report: " + report.procedure + ": " + report.description + "\n";
    for (const ZephFixture& fixture : bench.simulation->Fixtures) {
        if (fixture.AssignedItem != 0) lines += "owner of " + fixture.Name + ": " + fixture.AssignedItemName + "\n";
    }
    lines += "document:\n" + editorText(*bench.simulation, bench.paths, "") + "\n";
    return replaced(replaced(std::move(lines), bench.folder.path(), "BASE/"), "\r\n", "\n");
}

}  // namespace

TEST(EditorFiles, ComeToWhatIsExpectedInBothForms) {
    int cases = 0;
    for (const auto& folder : std::filesystem::directory_iterator(kCases)) {
        SCOPED_TRACE(folder.path().filename().string());
        const std::string input = contents(folder.path() / "input.zee");
        const std::string expected = contents(folder.path() / "expected.txt");
        EXPECT_EQ(outcome(input, TextReading::GeneralOnly), expected);
        EXPECT_EQ(outcome(input, TextReading::QuickThenGeneral), expected);
        ++cases;
    }
    EXPECT_GE(cases, 5);
}
