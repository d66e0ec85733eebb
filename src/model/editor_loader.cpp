#include "model/editor_loader.h"

#include "model/checksum.h"
#include "model/document_source.h"
#include "model/editor_body.h"
#include "model/editor_elements.h"
#include "model/file_versions.h"

#include <future>

namespace {

struct LoadMessage {
    std::string_view suffix;
    std::string_view before;  // the file's name, if the text has one, stands between before and after
    std::string_view after;
};
constexpr LoadMessage kBadLoad{"-Editor Load Error", "Error:  The editor file '",
                               "' is missing or invalid.\r\n(001-Bad Load)"};
constexpr LoadMessage kInvalidXml{"-Invalid Editor File", "Error:  The editor file '",
                                  "' is invalid or corrupted.\r\n(002-Invalid XML)"};
constexpr LoadMessage kInvalidRoot{"-Not a valid file", "Error:  This file  '",
                                   "' is not a valid editor file for this application.\r\n(003-Invalid Root)"};
constexpr LoadMessage kFileNotFound{"-Editor Load Error", "Error:  The editor file '",
                                    "' is missing.\r\n(005-File Not Found)"};
constexpr std::string_view kBodyErrors = "There were one or more errors encountered loading your simulation.";

constexpr std::string_view kRootName = "Zeph";

// How one load speaks to the user.
struct Speaker {
    bool showErrors;
    Host& host;
    std::string file;

    void say(const LoadMessage& message) const {
        if (!showErrors) return;
        const std::string text = std::string(message.before).append(file).append(message.after);
        host.messageBox(boxTitle(message.suffix), text, BoxIcon::Critical);
    }
    void say(std::string_view text) const {
        if (showErrors) host.messageBox(boxTitle(kIncompatibleVersionTitle), text, BoxIcon::Critical);
    }
};

// One load: how it speaks and what it uses.
struct LoadFrame {
    Speaker speaker;
    const EditorFileContext& context;
};

// The checksum of a text, computed on a second thread while the records are read. The first start counts.
class PendingChecksum {
public:
    void start(std::string_view text, std::size_t rootName, std::string stored) {
        if (started()) return;
        const auto attribute = findChecksumAttribute(text, rootName);
        if (!attribute) return;
        stored_ = std::move(stored);
        // Without a free thread the library computes it in differs().
        computed_ = std::async([text, attribute] { return editorChecksum(text, *attribute, false); });
    }
    bool started() const { return computed_.valid(); }
    bool differs() { return started() && computed_.get() != stored_; }

private:
    std::string stored_;
    std::future<std::string> computed_;
};

enum class BodyResult { Read, Damaged, UnknownVersion };

template <typename Node>
BodyResult readThroughGate(const Node& root, const EditorFileContext& context, ZephSimulation& simulation) {
    const std::string version = root.text("zephSaveFileVersion").value_or("");
    simulation.zephSaveFileVersion = version;
    const FileVersionRow* row = findFileVersion(version);
    if (!row) return BodyResult::UnknownVersion;
    simulation.FileUpgraded = !row->version3;
    const auto& [settings, paths, host, failures, watcher] = context;
    const bool read = row->version3 ? LoadVisualizerBody300(root, settings, paths, failures, simulation)
                                    : LoadVisualizerBody200(root, settings, paths, failures, simulation);
    return read ? BodyResult::Read : BodyResult::Damaged;
}

bool told(BodyResult body, const Speaker& speaker) {
    if (body == BodyResult::UnknownVersion) speaker.say(kIncompatibleVersion);
    if (body == BodyResult::Damaged) speaker.say(kBodyErrors);
    return body == BodyResult::Read;
}

// Empties the document for a file. A file without a background has no canvas to speak of, whatever was open before.
void emptyForFile(ZephSimulation& simulation, DocumentWatcher& watcher) {
    ZephGlobalReset(false, simulation, watcher);
    simulation.Background.EditorWidthTwips = 0;
    simulation.Background.EditorHeightTwips = 0;
}

// The steps behind the parse, the same for both forms. rootName: the offset of the root's name in the text.
template <typename Node>
bool readDocument(const Node& root, std::string_view text, std::size_t rootName, PendingChecksum& checksum,
                  const LoadFrame& load, ZephSimulation& simulation) {
    if (root.name() != kRootName) {
        load.speaker.say(kInvalidRoot);
        return false;
    }
    emptyForFile(simulation, load.context.watcher);
    if (const auto stored = root.text("Chksum")) checksum.start(text, rootName, *stored);
    const BodyResult body = readThroughGate(root, load.context, simulation);
    simulation.ChecksumMismatch = checksum.differs();
    return told(body, load.speaker);
}

bool loadSource(SourceText text, TextReading reading, const LoadFrame& load, ZephSimulation& simulation) {
    PendingChecksum checksum;  // stands behind the text, which it reads until it is gone
    bool read = false;
    const RootReading root = readRoot(
        text, reading,
        [&](const ScannedNode& found, std::size_t rootName) {
            // Before the first look at the whole text, for nothing takes longer than the checksum.
            if (const auto stored = found.text("Chksum")) checksum.start(text.view(), rootName, *stored);
            return checksum.started();
        },
        [&](const auto& found, std::size_t rootName) {
            read = readDocument(found, text.view(), rootName, checksum, load, simulation);
        });
    if (root == RootReading::Malformed) load.speaker.say(kInvalidXml);
    return root == RootReading::Used && read;
}

// What every entry does around the load itself: the flags of the last load go, and an exception out of the parse has
// a message of its own, since it is not one of a record.
bool guardedLoad(bool showErrors, const EditorFileContext& context, ZephSimulation& simulation, auto&& load) {
    const LoadFrame frame{{showErrors, context.host, simulation.FilePath + simulation.FileName}, context};
    try {
        simulation.ChecksumMismatch = false;
        simulation.FileUpgraded = false;
        return load(frame);
    } catch (...) {
        reportCaughtFailure(context.failures, kLoadModule, "ZephLoadVisualizerXML", __LINE__);
        frame.speaker.say(kBadLoad);
        return false;
    }
}

}  // namespace

bool loadEditorText(std::string_view text, TextReading reading, bool showErrors, const EditorFileContext& context,
                    ZephSimulation& simulation) {
    return guardedLoad(showErrors, context, simulation, [&](const LoadFrame& frame) {
        return loadSource(SourceText(text), reading, frame, simulation);
    });
}

bool ZephLoadVisualizerXML(bool showErrors, const EditorFileContext& context, ZephSimulation& simulation) {
    return guardedLoad(showErrors, context, simulation, [&](const LoadFrame& frame) {
        SourceText text;
        const FileReading reading = readWholeFile(frame.speaker.file, text);
        if (reading != FileReading::Read) {
            frame.speaker.say(reading == FileReading::Missing ? kFileNotFound : kBadLoad);
            return false;
        }
        return loadSource(std::move(text), TextReading::QuickThenGeneral, frame, simulation);
    });
}

bool ZephLoadVisualizerXML(const DocumentSnapshot& stored, bool showErrors, const EditorFileContext& context,
                           ZephSimulation& simulation) {
    return guardedLoad(showErrors, context, simulation, [&](const LoadFrame&) {
        restoreSnapshot(stored, context.paths, simulation);
        simulation.zephSaveFileVersion = kFileVersion;
        return true;
    });
}
