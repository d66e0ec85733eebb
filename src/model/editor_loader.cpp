#include "model/editor_loader.h"

#include "model/checksum.h"
#include "model/editor_body.h"
#include "model/source_text.h"
#include "model/xml_scanner.h"

#include <array>
#include <future>
#include <memory>
#include <optional>
#include <vector>

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
constexpr std::string_view kIncompatibleVersion =
    "Error:  The File Version is incompatible for this application.\r\nPlease contact support for an upgrade.";
constexpr std::string_view kBodyErrors = "There were one or more errors encountered loading your simulation.";

constexpr std::string_view kRootName = "Zeph";

struct VersionRow {
    std::string_view version;
    bool version3;  // by LoadVisualizerBody300; the older ones by LoadVisualizerBody200, and they count as upgraded
};
constexpr std::array kVersions{VersionRow{"1.5.2", false}, VersionRow{"2.0.0", false}, VersionRow{"2.0.1", false},
                               VersionRow{"2.1.0", false}, VersionRow{"3.0.0", true}};

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
        if (showErrors) host.messageBox(boxTitle("-Not a valid file"), text, BoxIcon::Critical);
    }
};

// Holds reports back until it is known whether the reading that made them counts.
class HeldFailures : public FailureReport {
public:
    void ErrReport(std::string_view description, std::string_view procedure, int line) override {
        held_.push_back({std::string(description), std::string(procedure), line});
    }
    void passOn(FailureReport& failures) const {
        for (const Held& report : held_)
            failures.ErrReport(report.description, report.procedure, report.line);
    }

private:
    struct Held {
        std::string description;
        std::string procedure;
        int line;
    };
    std::vector<Held> held_;
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

enum class Gate { Body, UnknownVersion };
struct BodyResult {
    Gate gate = Gate::UnknownVersion;
    bool read = false;
};

template <typename Node>
BodyResult readThroughGate(const Node& root, const ZephSettings& settings, const ZephPathService& paths,
                           FailureReport& failures, ZephSimulation& simulation) {
    const std::string version = root.text("zephSaveFileVersion").value_or("");
    simulation.zephSaveFileVersion = version;
    const auto row = std::find_if(kVersions.begin(), kVersions.end(),
                                  [&](const VersionRow& known) { return known.version == version; });
    if (row == kVersions.end()) return {};
    simulation.FileUpgraded = !row->version3;
    const bool read = row->version3 ? LoadVisualizerBody300(root, settings, paths, failures, simulation)
                                    : LoadVisualizerBody200(root, settings, paths, failures, simulation);
    return {Gate::Body, read};
}

bool told(const BodyResult& body, const Speaker& speaker) {
    if (body.gate == Gate::UnknownVersion) speaker.say(kIncompatibleVersion);
    if (body.gate == Gate::Body && !body.read) speaker.say(kBodyErrors);
    return body.read;
}

// Empties the document for a file. A file without a background has no canvas to speak of, whatever was open before.
void emptyForFile(ZephSimulation& simulation, DocumentWatcher& watcher) {
    ZephGlobalReset(false, simulation, watcher);
    simulation.Background.EditorWidthTwips = 0;
    simulation.Background.EditorHeightTwips = 0;
}

// The quick form reads into a document of its own, since a text can turn out unusual at its very end. Nothing then.
std::optional<BodyResult> readQuickly(const SourceText& text, PendingChecksum& checksum,
                                      const EditorFileContext& context, ZephSimulation& simulation) {
    XmlScanner scanner(text.view());
    const ScannedNode root = scanner.root();
    if (!root || root.name() != kRootName) return std::nullopt;
    if (const auto stored = root.text("Chksum")) checksum.start(text.view(), scanner.rootNameOffset(), *stored);
    const auto fresh = std::make_unique<ZephSimulation>();
    NoWatcher nobody;
    emptyForFile(*fresh, nobody);
    fresh->FixtureLedDefault = simulation.FixtureLedDefault;
    HeldFailures failures;
    const BodyResult body = readThroughGate(root, context.settings, context.paths, failures, *fresh);
    if (!scanner.finish()) return std::nullopt;

    emptyForFile(simulation, context.watcher);
    fresh->FilePath = std::move(simulation.FilePath);
    fresh->FileName = std::move(simulation.FileName);
    simulation = std::move(*fresh);
    failures.passOn(context.failures);
    return body;
}

std::optional<BodyResult> readGenerally(const SourceText& text, PendingChecksum& checksum, const Speaker& speaker,
                                        const EditorFileContext& context, ZephSimulation& simulation) {
    pugi::xml_document document;
    const std::string_view utf8 = text.view();
    const pugi::xml_parse_result parsed =
        document.load_buffer(utf8.data(), utf8.size(), pugi::parse_default, pugi::encoding_utf8);
    if (parsed.status == pugi::status_out_of_memory) throw std::bad_alloc();
    const pugi::xml_node rootNode = document.document_element();
    if (!parsed || !rootNode) {
        speaker.say(kInvalidXml);
        return std::nullopt;
    }
    const XmlNode root(rootNode);
    if (root.name() != kRootName) {
        speaker.say(kInvalidRoot);
        return std::nullopt;
    }
    emptyForFile(simulation, context.watcher);
    if (const auto stored = root.text("Chksum")) {
        checksum.start(utf8, static_cast<std::size_t>(rootNode.offset_debug()), *stored);
    }
    return readThroughGate(root, context.settings, context.paths, context.failures, simulation);
}

bool loadSource(SourceText text, TextReading reading, const Speaker& speaker, const EditorFileContext& context,
                ZephSimulation& simulation) {
    PendingChecksum checksum;  // stands behind the text, which it reads until it is gone
    std::optional<BodyResult> body;
    if (reading != TextReading::GeneralOnly) body = readQuickly(text, checksum, context, simulation);
    if (!body && reading != TextReading::QuickOnly) {
        // A text that the quick form began to hash is UTF-8 already, and must stay where it is.
        if (!checksum.started() && !decodeSource(text)) {
            speaker.say(kInvalidXml);
            return false;
        }
        body = readGenerally(text, checksum, speaker, context, simulation);
    }
    if (!body) return false;
    simulation.ChecksumMismatch = checksum.differs();
    return told(*body, speaker);
}

Speaker speakerFor(bool showErrors, const EditorFileContext& context, const ZephSimulation& simulation) {
    return {showErrors, context.host, simulation.FilePath + simulation.FileName};
}

// An exception out of the parse has its own message; it is not one of a record.
bool loadOrSay(const Speaker& speaker, const EditorFileContext& context, auto&& load) try {
    return load();
} catch (...) {
    reportCaughtFailure(context.failures, kLoadModule, "ZephLoadVisualizerXML", __LINE__);
    speaker.say(kBadLoad);
    return false;
}

}  // namespace

bool loadEditorText(std::string_view text, TextReading reading, bool showErrors, const EditorFileContext& context,
                    ZephSimulation& simulation) {
    const Speaker speaker = speakerFor(showErrors, context, simulation);
    return loadOrSay(speaker, context, [&] {
        simulation.ChecksumMismatch = false;
        simulation.FileUpgraded = false;
        return loadSource(SourceText(text), reading, speaker, context, simulation);
    });
}

bool ZephLoadVisualizerXML(bool showErrors, const EditorFileContext& context, ZephSimulation& simulation) {
    const Speaker speaker = speakerFor(showErrors, context, simulation);
    return loadOrSay(speaker, context, [&] {
        simulation.ChecksumMismatch = false;
        simulation.FileUpgraded = false;
        SourceText text;
        const FileReading reading = readWholeFile(speaker.file, text);
        if (reading != FileReading::Read) {
            speaker.say(reading == FileReading::Missing ? kFileNotFound : kBadLoad);
            return false;
        }
        return loadSource(std::move(text), TextReading::QuickThenGeneral, speaker, context, simulation);
    });
}

bool ZephLoadVisualizerXML(const pugi::xml_document& stored, bool showErrors, const EditorFileContext& context,
                           ZephSimulation& simulation) {
    const Speaker speaker = speakerFor(showErrors, context, simulation);
    return loadOrSay(speaker, context, [&] {
        simulation.ChecksumMismatch = false;
        simulation.FileUpgraded = false;
        const XmlNode root(stored.document_element());
        if (!root || root.name() != kRootName) {
            speaker.say(root ? kInvalidRoot : kInvalidXml);
            return false;
        }
        return told(readThroughGate(root, context.settings, context.paths, context.failures, simulation), speaker);
    });
}
