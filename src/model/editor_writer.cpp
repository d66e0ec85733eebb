#include "model/editor_writer.h"

#include "model/checksum.h"
#include "model/editor_elements.h"
#include "util/whole_file.h"

#include <algorithm>
#include <deque>

namespace {

constexpr std::string_view kSaveModule = "modZephLoadSave";
constexpr std::string_view kRootName = "Zeph";
// Large enough that handing a piece over costs nothing, small enough to be hashed and written out of the cache.
constexpr std::size_t kPiece = 512 * 1024;
constexpr std::size_t kChecksumDigits = 32;

void writeFixture(int id, const ZephFixture& fixture, XmlText& text) {
    CreateDrawObjectGroup(id, fixture, text);
    CreateSampleColorsNode(fixture, text);
    CreateQvFixtureNode(fixture, text);
    CreateHardwareNode(fixture, true, text);
    CreateDrawPointsGroupAndNode(fixture, text);
    CloseDrawObjectGroup(text);
}

// Hands the text over in pieces, each as soon as it is large enough: take(piece), the first with the whole start tag
// of the root.
template <typename Take>
void writePieces(const ZephSimulation& simulation, const ZephPathService& paths, std::string_view createdAt,
                 Take take) {
    require(simulation.PropCount <= kMaxProps && simulation.FixtureCount <= kMaxFixtures,
            "A count of the document is beyond its table");
    constexpr std::size_t kLargestRecord = 64 * 1024;  // in ordinary cases; a larger one grows the piece
    XmlText text(kPiece + kLargestRecord);
    const auto recordWritten = [&] {
        if (text.size() < kPiece) return;
        take(text.take());
        text = XmlText(kPiece + kLargestRecord);
    };
    CreateProcessingInstructions(text);
    CreateTopNode(kRootName, kFileVersion, createdAt, text);
    text.closeStart();
    CreateBackgroundNode(simulation.Background, paths, text);
    CreateLevelsGroupAndNode(simulation, text);

    CreateMasterPropsGroup(simulation.PropCount > 0, text);
    for (int p = 1; p <= simulation.PropCount; ++p) {
        CreatePropGroupAndNodes(p, simulation.Props[p], text);
        recordWritten();
    }
    CloseMasterPropsGroup(simulation.PropCount > 0, text);

    CreateMasterDrawObjectsGroup(simulation.FixtureCount > 0, text);
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        writeFixture(f, simulation.Fixtures[f], text);
        recordWritten();
    }
    CloseMasterDrawObjectsGroup(simulation.FixtureCount > 0, text);
    Indent(0, text);
    text.endTag(kRootName);
    take(text.take());
}

// Where the checksum's attribute goes: behind the other attributes of the root.
std::size_t checksumPlace(std::string_view text) {
    const std::size_t tag = text.find("<" + std::string(kRootName));
    require(tag != std::string::npos, "The document has no root element");
    // No '>' stands in an attribute of the text: it is spelled out there.
    return text.find('>', tag);
}

std::string checksumAttribute(std::string_view value) {
    return std::string(" Chksum=\"").append(value).append("\"");
}

// Writes the pieces while a second thread hashes them. The checksum stands near the beginning and is known at the
// end, so its place is kept free and filled last.
class FileWithChecksum {
public:
    explicit FileWithChecksum(const std::string& path) : file_(path) {}

    void add(std::string piece) {
        const std::string_view text = pieces_.emplace_back(std::move(piece));
        checksum_.add(text);
        if (pieces_.size() > 1) return file_.append(text);
        place_ = checksumPlace(text);
        file_.append(text.substr(0, place_));
        file_.append(checksumAttribute(std::string(kChecksumDigits, '0')));
        file_.append(text.substr(place_));
    }
    bool finish(bool checksumMismatch) {
        file_.overwrite(place_, checksumAttribute(checksum_.value(checksumMismatch)));
        return file_.commit();
    }

private:
    std::deque<std::string> pieces_;  // stays where it is while it grows: the checksum reads it meanwhile
    std::size_t place_ = 0;
    WholeFile file_;
    RunningChecksum checksum_;
};

}  // namespace

std::string editorText(const ZephSimulation& simulation, const ZephPathService& paths, std::string_view createdAt) {
    std::vector<std::string> pieces;
    writePieces(simulation, paths, createdAt, [&](std::string piece) { pieces.push_back(std::move(piece)); });
    if (pieces.size() == 1) return std::move(pieces.front());
    std::size_t size = 0;
    for (const std::string& piece : pieces)
        size += piece.size();
    std::string text;
    text.reserve(size);
    for (const std::string& piece : pieces)
        text += piece;
    return text;
}

void AddHash(bool checksumMismatch, std::string& text) {
    const std::size_t place = checksumPlace(text);
    text.insert(place, checksumAttribute(editorChecksum(text, {place, place}, checksumMismatch)));
}

bool ZephSaveVisualizerXML(std::string_view createdAt, const EditorFileContext& context,
                           const ZephSimulation& simulation) try {
    FileWithChecksum file(simulation.FilePath + simulation.FileName);
    writePieces(simulation, context.paths, createdAt, [&](std::string piece) { file.add(std::move(piece)); });
    if (file.finish(simulation.ChecksumMismatch)) return true;
    context.host.messageBox(boxTitle("-Save Error"),
                            "There was a problem saving the editor data to disk.  Please try again.",
                            BoxIcon::Critical);
    return false;
}
ZEPH_GUARD(context.failures, kSaveModule, false)
