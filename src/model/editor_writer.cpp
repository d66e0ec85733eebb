#include "model/editor_writer.h"

#include "model/checksum.h"
#include "model/editor_elements.h"
#include "util/whole_file.h"

#include <algorithm>

namespace {

constexpr std::string_view kSaveModule = "modZephLoadSave";
constexpr std::string_view kRootTag = "<Zeph";

std::size_t upTo(std::int32_t count, int max) {
    return static_cast<std::size_t>(std::clamp(count, 0, max));
}

// What the text will need at most in ordinary cases, so that it grows without being moved.
std::size_t expectedSize(const ZephSimulation& simulation) {
    constexpr std::size_t kHead = 8192, kProp = 512, kMember = 64, kFixture = 1024, kChannel = 384, kPoint = 80;
    std::size_t size = kHead;
    for (int p = 1; p <= simulation.PropCount; ++p)
        size += kProp + kMember * upTo(simulation.Props[p].AssignedCount, kMaxFixturesInProp);
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        const ZephFixture& fixture = simulation.Fixtures[f];
        size += kFixture + kChannel * upTo(fixture.ChannelCount, kMaxChannels) +
                kPoint * upTo(fixture.PointCount, kMaxPoints);
    }
    return size;
}

}  // namespace

std::string editorText(const ZephSimulation& simulation, const ZephPathService& paths, std::string_view createdAt) {
    require(simulation.PropCount <= kMaxProps && simulation.FixtureCount <= kMaxFixtures,
            "A count of the document is beyond its table");
    XmlText text(expectedSize(simulation));
    CreateProcessingInstructions(text);
    CreateTopNode("Zeph", kFileVersion, createdAt, text);
    text.closeStart();
    CreateBackgroundNode(simulation.Background, paths, text);
    CreateLevelsGroupAndNode(simulation, text);

    CreateMasterPropsGroup(simulation.PropCount > 0, text);
    for (int p = 1; p <= simulation.PropCount; ++p)
        CreatePropGroupAndNodes(p, simulation.Props[p], text);
    CloseMasterPropsGroup(simulation.PropCount > 0, text);

    CreateMasterDrawObjectsGroup(simulation.FixtureCount > 0, text);
    for (int f = 1; f <= simulation.FixtureCount; ++f) {
        const ZephFixture& fixture = simulation.Fixtures[f];
        CreateDrawObjectGroup(f, fixture, text);
        CreateSampleColorsNode(fixture, text);
        CreateQvFixtureNode(fixture, text);
        CreateHardwareNode(fixture, true, text);
        CreateDrawPointsGroupAndNode(fixture, text);
        CloseDrawObjectGroup(text);
    }
    CloseMasterDrawObjectsGroup(simulation.FixtureCount > 0, text);
    Indent(0, text);
    text.endTag("Zeph");
    return text.take();
}

void AddHash(bool checksumMismatch, std::string& text) {
    const std::size_t tag = text.find(kRootTag);
    require(tag != std::string::npos, "The document has no root element");
    // No '>' stands in an attribute of the text: it is spelled out there.
    const std::size_t end = text.find('>', tag);
    const std::string value = editorChecksum(text, {end, end}, checksumMismatch);
    text.insert(end, " Chksum=\"" + value + "\"");
}

bool ZephSaveVisualizerXML(std::string_view createdAt, const EditorFileContext& context,
                           const ZephSimulation& simulation) try {
    std::string text = editorText(simulation, context.paths, createdAt);
    AddHash(simulation.ChecksumMismatch, text);
    if (replaceWholeFile(simulation.FilePath + simulation.FileName, text)) return true;
    context.host.messageBox(boxTitle("-Save Error"),
                            "There was a problem saving the editor data to disk.  Please try again.",
                            BoxIcon::Critical);
    return false;
}
ZEPH_GUARD(context.failures, kSaveModule, false)
