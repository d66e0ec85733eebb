#include "model/object_files.h"

#include "model/editor_elements.h"
#include "model/file_versions.h"
#include "model/object_bodies.h"
#include "util/whole_file.h"

namespace {

using namespace object_bodies_detail;

// One kind of file: its root and what is said about it.
struct ObjectKind {
    std::string_view rootName;
    std::string_view missingTitle;  // as they are shown: these titles come without a separator
    std::string_view missing;
    std::string_view corruptedTitle;
    std::string_view corrupted;
    std::string_view invalidTitle;
    std::string_view invalid;
    std::string_view bodyTitle;
    std::string_view body;
    std::string_view saveError;
    const char* loader;
};
constexpr ObjectKind kFixtureFile{"ZephFixture",
                                  "Missing Fixture File",
                                  "Error:  The fixture file is missing or invalid.",
                                  "Corrupted Fixture File",
                                  "Error:  The fixture file is invalid or corrupted.",
                                  "Invalid Fixture File",
                                  "Error:  This is not a valid fixture file for this application.",
                                  "-Fixture Load",
                                  "Error:  Could Not load the fixture's body.",
                                  "There was a problem saving the fixture data to disk.  Please try again.",
                                  "ZephLoadFixtureFileXML"};
constexpr ObjectKind kPropFile{"ZephProp",
                               "Missing Prop File",
                               "Error:  The Prop file is missing or invalid.",
                               "Corrupted Prop File",
                               "Error:  The Prop file is invalid or corrupted.",
                               "Invalid Prop File",
                               "Error:  This is not a valid Prop file for this application.",
                               "-Prop Load",
                               "Error:  Could Not load the prop's body.",
                               "There was a problem saving the prop data to disk.  Please try again.",
                               "ZephLoadPropFileXML"};

// What a file needs at most in ordinary cases, a fixture with all its channels and points.
constexpr std::size_t kExpectedFixtureBytes = 32 * 1024;

void openFile(const ObjectKind& kind, std::string_view createdAt, XmlText& text) {
    CreateProcessingInstructions(text);
    CreateTopNode(kind.rootName, kFileVersion, createdAt, text);
    text.closeStart();
}

std::string closeFile(const ObjectKind& kind, XmlText& text) {
    Indent(0, text);
    text.endTag(kind.rootName);
    return text.take();
}

bool save(const ObjectKind& kind, const std::string& path, std::string_view text, Host& host) {
    return replaceWholeFile(path, text) || refuse(host, "-Save Error", kind.saveError);
}

// The steps behind the parse: root, version, body. body(root, version3) reads it.
template <typename Node, typename Body>
bool readObject(const Node& root, const ObjectKind& kind, Host& host, Body body) {
    if (root.name() != kind.rootName) return refuse(host, kind.invalidTitle, kind.invalid);
    const FileVersionRow* row = findFileVersion(root.text("zephSaveFileVersion").value_or(""));
    if (!row) return refuse(host, kIncompatibleVersionTitle, kIncompatibleVersion);
    return body(root, row->version3) || refuse(host, kind.bodyTitle, kind.body);
}

template <typename Body>
bool readText(SourceText& text, TextReading reading, const ObjectKind& kind, Host& host, Body body) {
    bool read = false;
    const RootReading root = readRoot(
        text, reading, [](const auto&, std::size_t) { return false; },
        [&](const auto& found, std::size_t) { read = readObject(found, kind, host, body); });
    if (root == RootReading::Malformed) return refuse(host, kind.corruptedTitle, kind.corrupted);
    return root == RootReading::Used && read;
}

auto fixtureBody(const EditorFileContext& context, ZephSimulation& simulation, bool& channelsSeen) {
    return [&](const auto& root, bool version3) {
        return version3 ? LoadFixtureBody300(root, context, simulation, channelsSeen)
                        : LoadFixtureBody200(root, context, simulation, channelsSeen);
    };
}

auto propBody(const EditorFileContext& context, ZephSimulation& simulation, bool& channelsSeen) {
    return [&](const auto& root, bool version3) {
        return version3 ? LoadPropBody300(root, context, simulation, channelsSeen)
                        : LoadPropBody200(root, context, simulation, channelsSeen);
    };
}

// An exception out of the parse, such as a file too large for the memory, has the message of a missing file.
template <typename Load>
bool guardedLoad(const ObjectKind& kind, const EditorFileContext& context, bool& channelsSeen, Load load) {
    channelsSeen = false;
    try {
        return load();
    } catch (...) {
        reportCaughtFailure(context.failures, kLoadModule, kind.loader, __LINE__);
        return refuse(context.host, kind.missingTitle, kind.missing);
    }
}

template <typename Body>
bool loadFile(const std::string& path, const ObjectKind& kind, const EditorFileContext& context, Body body) {
    SourceText text;
    if (readWholeFile(path, text) != FileReading::Read) return refuse(context.host, kind.missingTitle, kind.missing);
    return readText(text, TextReading::QuickThenGeneral, kind, context.host, body);
}

}  // namespace

std::string fixtureFileText(const ZephFixture& fixture, int channelChoice, std::string_view createdAt) {
    XmlText text(kExpectedFixtureBytes);
    openFile(kFixtureFile, createdAt, text);
    CreateMasterDrawObjectsGroup(true, text);
    CreateDrawObjectGroup(1, fixture, text);
    CreateSampleColorsNode(fixture, text);
    CreateHardwareNode(fixture, channelChoice == kChannelChoiceYes, text);
    CreateDrawPointsGroupAndNode(fixture, text);
    CloseDrawObjectGroup(text);
    CloseMasterDrawObjectsGroup(true, text);
    return closeFile(kFixtureFile, text);
}

std::string propFileText(const ZephSimulation& simulation, const ZephProp& prop, int channelChoice,
                         std::string_view createdAt) {
    const int members = std::clamp(prop.AssignedCount, 0, kMaxFixturesInProp);
    XmlText text(kExpectedFixtureBytes * static_cast<std::size_t>(members + 1));
    openFile(kPropFile, createdAt, text);
    CreateMasterPropsGroup(true, text);
    CreatePropGroupAndNodes(1, prop, text);
    CloseMasterPropsGroup(true, text);
    CreateMasterDrawObjectsGroup(members > 0, text);
    for (int member = 1; member <= members; ++member) {
        const ZephFixture& fixture = fixtureOrEmpty(simulation, prop.Object[member]);
        CreateDrawObjectGroup(member, fixture, text);
        CreateSampleColorsNode(fixture, text);
        CreateQvFixtureNode(fixture, text);
        CreateHardwareNode(fixture, channelChoice == kChannelChoiceYes, text);
        CreateDrawPointsGroupAndNode(fixture, text);
        CloseDrawObjectGroup(text);
    }
    CloseMasterDrawObjectsGroup(members > 0, text);
    return closeFile(kPropFile, text);
}

bool ZephSaveFixtureXML(const ZephFixture& fixture, const std::string& path, int channelChoice,
                        const ObjectSaving& saving) try {
    return save(kFixtureFile, path, fixtureFileText(fixture, channelChoice, saving.createdAt), saving.host);
}
ZEPH_GUARD(saving.failures, kLoadModule, false)

bool ZephSavePropXML(const ZephSimulation& simulation, const ZephProp& prop, const std::string& path, int channelChoice,
                     const ObjectSaving& saving) try {
    return save(kPropFile, path, propFileText(simulation, prop, channelChoice, saving.createdAt), saving.host);
}
ZEPH_GUARD(saving.failures, kLoadModule, false)

bool ZephLoadFixtureFileXML(const std::string& path, const EditorFileContext& context, ZephSimulation& simulation,
                            bool& channelsSeen) {
    return guardedLoad(kFixtureFile, context, channelsSeen, [&] {
        return loadFile(path, kFixtureFile, context, fixtureBody(context, simulation, channelsSeen));
    });
}

bool ZephLoadPropFileXML(const std::string& path, const EditorFileContext& context, ZephSimulation& simulation,
                         bool& channelsSeen) {
    return guardedLoad(kPropFile, context, channelsSeen,
                       [&] { return loadFile(path, kPropFile, context, propBody(context, simulation, channelsSeen)); });
}

bool loadFixtureFileText(std::string_view text, TextReading reading, const EditorFileContext& context,
                         ZephSimulation& simulation, bool& channelsSeen) {
    return guardedLoad(kFixtureFile, context, channelsSeen, [&] {
        SourceText source(text);
        return readText(source, reading, kFixtureFile, context.host, fixtureBody(context, simulation, channelsSeen));
    });
}

bool loadPropFileText(std::string_view text, TextReading reading, const EditorFileContext& context,
                      ZephSimulation& simulation, bool& channelsSeen) {
    return guardedLoad(kPropFile, context, channelsSeen, [&] {
        SourceText source(text);
        return readText(source, reading, kPropFile, context.host, propBody(context, simulation, channelsSeen));
    });
}
