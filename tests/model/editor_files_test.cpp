// Whole files: each folder under editor_files holds an input and what comes of it: the answer, the boxes, the reports,
// and the document written again in the present version.
#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "tests/support/loading.h"
#include "util/message_host.h"

#include <filesystem>
#include <sstream>

namespace {

const std::filesystem::path kCases = ZEPH_TEST_DATA "/editor_files";

std::string contents(const std::filesystem::path& path) {
    QFile file(path);
    return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : "not there";
}

// What comes of a text, in lines. Line numbers of reports are left out: they change with the source.
std::string outcome(std::string_view text, TextReading reading) {
    LoadBench bench;
    bench.simulation->FilePath = "";
    std::ostringstream lines;
    lines << std::boolalpha << "result: " << bench.read(text, reading)
          << "\nupgraded: " << bench.simulation->FileUpgraded << "\nmismatch: " << bench.simulation->ChecksumMismatch
          << "\nled default: " << bench.simulation->FixtureLedDefault << "\n";
    for (const auto& box : bench.host.boxes)
        lines << "box: " << box.title << " | " << onOneLine(box.text) << "\n";
    for (const auto& report : bench.failures.reports)
        lines << "report: " << report.procedure << ": " << report.description << "\n";
    for (const ZephFixture& fixture : bench.simulation->Fixtures) {
        if (fixture.AssignedItem != 0) lines << "owner of " << fixture.Name << ": " << fixture.AssignedItemName << "\n";
    }
    lines << "document:\n" << editorText(*bench.simulation, bench.paths, "") << "\n";
    const QByteArray base = QByteArray::fromStdString(bench.folder.path());
    return QByteArray::fromStdString(lines.str()).replace(base, "BASE/").replace("\r\n", "\n").toStdString();
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
    EXPECT_GE(cases, 6);
}
