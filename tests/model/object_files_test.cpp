#include "display.h"
#include "model/object_files.h"
#include "tests/support/fixtures.h"
#include "tests/support/loading.h"

namespace {

struct ObjectBench : LoadBench {
    bool channelsSeen = false;

    ObjectBench() { ZephGlobalReset(false, *simulation, watcher); }
    ObjectSaving saving() { return {"today", host, failures}; }
    bool fixtureText(std::string_view text) {
        return loadFixtureFileText(text, TextReading::QuickThenGeneral, context, *simulation, channelsSeen);
    }
    bool propText(std::string_view text) {
        return loadPropFileText(text, TextReading::QuickThenGeneral, context, *simulation, channelsSeen);
    }
    // What the boxes since the last call told, without the program's name.
    std::string told() {
        const std::string texts = host.boxTexts();
        host.boxes.clear();
        return texts.substr(std::min<std::size_t>(texts.size(), 14));
    }
};

constexpr std::string_view kDrawObject =
    "<DrawObject ID=\"9\" Name=\"F\" BulbSize=\"1\" BulbSpacing=\"1\" Comment=\"\" BulbShape=\"1\" ZOrder=\"1\" "
    "AssignedItem=\"7\" Locked=\"False\">%</DrawObject>";

// count fixtures, each with the parts.
std::string objects(int count, std::string_view parts = "") {
    std::string text = "<DrawObjects>";
    for (int n = 1; n <= count; ++n)
        text.append(kDrawObject).replace(text.rfind('%'), 1, parts);
    return text + "</DrawObjects>";
}

// A prop that lists that many members, with numbers of another display.
std::string items(int members, int firstId = 1) {
    std::string text = "<Items><Item ID=\"1\" Name=\"P\" Locked=\"True\" Comment=\"\">";
    for (int n = firstId; n < firstId + members; ++n)
        text += "<AssignedObject ID=\"" + std::to_string(n) + "\" Object=\"" + std::to_string(700 + n) + "\"/>";
    return text + "</Item></Items>";
}

std::string file(std::string_view root, std::string_view version, const std::string& body) {
    const std::string name(root);
    return "<" + name + " zephSaveFileVersion=\"" + std::string(version) + "\">" + body + "</" + name + ">";
}

}  // namespace

// The elements are those of the editor file; here it is what stands round them, and what a choice leaves out.
TEST(ObjectFiles, AFixtureComesAlongAlone) {
    const std::string head = "<?xml version='1.0' encoding='UTF-8'?>\r\n<ZephFixture zephSaveFileVersion=\"3.0.0\" "
                             "CreatedAt=\"today\">\r\n    <DrawObjects>\r\n        <DrawObject ID=\"1\" Name=\"F &amp; "
                             "G\" BulbSize=\"2\"";
    const std::string tail = "        </DrawObject>\r\n    </DrawObjects>\r\n</ZephFixture>";
    for (const std::int32_t type : {kFixtureStrings, kFixtureKesh, kFixtureDmxPixels}) {
        for (const int choice : {kChannelChoiceYes, kChannelChoiceNo}) {
            ObjectBench bench;
            ZephFixture fixture = addFixture(*bench.simulation, type, {{1, 2}, {-1, 3}});
            fixture.Channel_Type = kChannelNormal;
            fixture.Name = "F & G";
            addChannel(fixture, 1, 2).Name = "c";
            fixture.AssignedItem = 3;
            fixture.Kesh.Base_Unit = type == kFixtureKesh ? 5 : 0;
            fixture.DMX.Universe = type == kFixtureDmxPixels ? 9 : 0;
            const std::string path = bench.folder.path("a.zff");
            ASSERT_TRUE(ZephSaveFixtureXML(fixture, path, choice, bench.saving()));
            const std::string text = bench.folder.read("a.zff");
            EXPECT_TRUE(text.starts_with(head) && text.ends_with(tail)) << text;
            EXPECT_TRUE(choice == kChannelChoiceYes || text.find("<Novaline_Data") == std::string::npos) << text;
            bench.simulation->FixtureCount = 6;
            ASSERT_TRUE(ZephLoadFixtureFileXML(path, bench.context, *bench.simulation, bench.channelsSeen));
            const bool channels = choice == kChannelChoiceYes && type == kFixtureStrings;
            EXPECT_EQ(bench.channelsSeen, channels);
            ASSERT_EQ(bench.simulation->FixtureCount, 7);
            fixture.AssignedItem = 0;
            fixture.ChannelCount = channels ? 1 : 0;
            if (!channels) fixture.Channels[1] = {};
            EXPECT_TRUE(bench.simulation->Fixtures[7] == fixture);
        }
    }
}

TEST(ObjectFiles, APropTakesItsFixturesAlongInOrder) {
    ObjectBench bench;
    buildDisplay(*bench.simulation);
    ZephSimulation& document = *bench.simulation;
    const int prop = ++document.PropCount;
    document.Props[prop].QvMatrixInd = 2;
    for (const int fixture : {7, 9, 30})
        ZephAddFixtureToProp(fixture, prop, document);
    const std::string path = bench.folder.path("a.zpf");
    ASSERT_TRUE(ZephSavePropXML(document, document.Props[prop], path, kChannelChoiceYes, bench.saving()));
    const int base = document.FixtureCount;
    ASSERT_TRUE(ZephLoadPropFileXML(path, bench.context, document, bench.channelsSeen));
    EXPECT_TRUE(bench.channelsSeen);
    ZephProp expected = document.Props[prop];
    for (int member = 1; member <= 3; ++member) {
        ZephFixture fixture = document.Fixtures[expected.Object[member]];
        fixture.AssignedItem = prop + 1;
        EXPECT_TRUE(document.Fixtures[base + member] == fixture) << member;
        expected.Object[member] = base + member;
    }
    EXPECT_TRUE(document.Props[prop + 1] == expected);
    EXPECT_EQ(document.FixtureCount, base + 3);

    // A number that is no fixture keeps its place as an empty one.
    document.Props[prop].Object[2] = 5000;
    ASSERT_TRUE(bench.propText(propFileText(document, document.Props[prop], kChannelChoiceNo, "today")));
    EXPECT_FALSE(bench.channelsSeen);
    EXPECT_EQ(document.Fixtures[base + 6].Name, document.Fixtures[30].Name);
    EXPECT_EQ(document.Fixtures[base + 5].Name, "");
}

TEST(ObjectFiles, SayWhatIsWrongWithAFile) {
    const std::string good = objects(1);
    const std::tuple<std::string, bool, const char*> rows[] = {
        {"<ZephFixture", false, "Corrupted Fixture File|Error:  The fixture file is invalid or corrupted."},
        {"", true, "Corrupted Prop File|Error:  The Prop file is invalid or corrupted."},
        {file("Zeph", "3.0.0", good), false,
         "Invalid Fixture File|Error:  This is not a valid fixture file for this application."},
        {file("ZephFixture", "3.0.0", good), true,
         "Invalid Prop File|Error:  This is not a valid Prop file for this application."},
        {file("ZephFixture", "3.0.1", good), false,
         "-Not a valid file|Error:  The File Version is incompatible for this application.\r\nPlease contact "
         "support for an upgrade."},
        {file("ZephFixture", "3.0.0", ""), false, "-Fixture Load|Error:  Could Not load the fixture's body."},
        {file("ZephFixture", "2.0.0", objects(1, "<Sample/>")), false,
         "-Fixture Load|Error:  Could Not load the fixture's body."},
        {file("ZephProp", "2.1.0", good), true, "-Prop Load|Error:  Could Not load the prop's body."}};
    for (const auto& [text, prop, box] : rows) {
        SCOPED_TRACE(text);
        ObjectBench bench;
        EXPECT_FALSE(prop ? bench.propText(text) : bench.fixtureText(text));
        EXPECT_EQ(bench.told(), box);
        EXPECT_TRUE(prop || (bench.simulation->FixtureCount == 0 && bench.simulation->Fixtures[1] == ZephFixture()));
    }
    ObjectBench bench;
    ZephSimulation& document = *bench.simulation;
    EXPECT_FALSE(ZephLoadFixtureFileXML(bench.folder.path("none"), bench.context, document, bench.channelsSeen));
    EXPECT_EQ(bench.told(), "Missing Fixture File|Error:  The fixture file is missing or invalid.");
    EXPECT_FALSE(ZephLoadPropFileXML(bench.folder.path(), bench.context, document, bench.channelsSeen));
    EXPECT_EQ(bench.told(), "Missing Prop File|Error:  The Prop file is missing or invalid.");
    EXPECT_FALSE(ZephSaveFixtureXML({}, bench.folder.path("no/a.zff"), kChannelChoiceNo, bench.saving()));
    EXPECT_EQ(bench.told(), "-Save Error|There was a problem saving the fixture data to disk.  Please try again.");
    EXPECT_FALSE(ZephSavePropXML(document, {}, bench.folder.path("no/a.zpf"), kChannelChoiceNo, bench.saving()));
    EXPECT_EQ(bench.told(), "-Save Error|There was a problem saving the prop data to disk.  Please try again.");
}

TEST(ObjectFiles, KeepWithinTheLimits) {
    ObjectBench bench;
    ZephSimulation& document = *bench.simulation;
    document.FixtureCount = kMaxFixtures;
    EXPECT_FALSE(bench.fixtureText(file("ZephFixture", "3.0.0", objects(1))));
    EXPECT_EQ(bench.told(), "-Too many fixtures|You can not load this fixture since it would exceed the maximum number "
                            "of fixtures allowed.\nQen Visualizer-Fixture Load|Error:  Could Not load the fixture's "
                            "body.");
    // One too many by the prop's own list, then by the fixtures in the file.
    const std::string listed = file("ZephProp", "2.1.0", items(3) + objects(3));
    for (const std::string& text : {listed, file("ZephProp", "2.1.0", items(2) + objects(3))}) {
        document.FixtureCount = kMaxFixtures - 2;
        EXPECT_FALSE(bench.propText(text));
        EXPECT_EQ(bench.told(),
                  "-Too many fixtures|You can not load this prop since it would exceed the maximum number "
                  "of fixtures allowed.\nQen Visualizer-Prop Load|Error:  Could Not load the prop's body.");
        EXPECT_EQ(document.FixtureCount, kMaxFixtures - 2);
        EXPECT_TRUE(document.Fixtures[kMaxFixtures] == ZephFixture());
        EXPECT_TRUE(document.Props[1] == ZephProp());
    }
    document.FixtureCount = kMaxFixtures - 3;
    EXPECT_TRUE(bench.propText(listed));
    document.FixtureCount = 0;
    document.PropCount = kMaxProps;
    EXPECT_FALSE(bench.propText(listed));
    EXPECT_THAT(bench.told(), testing::StartsWith("-Too many props|"));
    EXPECT_EQ(document.FixtureCount, 0);
}

TEST(ObjectFiles, APropListsWhatCameAlongAndNothingElse) {
    for (const auto& [listed, fixtures] : {std::pair{1, 3}, {3, 1}, {0, 2}, {64, 64}}) {
        const int members = std::min(listed, fixtures);
        ObjectBench bench;
        ZephSimulation& document = *bench.simulation;
        document.FixtureCount = 10;
        document.Props[1].QvFF = document.Fixtures[11].AssignedItemName = "left behind by a damaged file";
        ASSERT_TRUE(bench.propText(file("ZephProp", "2.1.0", items(listed) + objects(fixtures))));
        EXPECT_EQ(document.FixtureCount, 10 + fixtures);
        EXPECT_EQ(document.Props[1].AssignedCount, members);
        EXPECT_EQ(document.Props[1].QvFF, "");
        for (int n = 1; n <= kMaxFixturesInProp; ++n) {
            const bool member = n <= members;
            EXPECT_EQ(document.Props[1].Object[n], member ? 10 + n : 0);
            EXPECT_EQ(document.Fixtures[10 + n].AssignedItem, member ? 1 : 0) << n;
            EXPECT_EQ(document.Fixtures[10 + n].AssignedItemName, member ? "P" : "") << n;
        }
    }
    ObjectBench bench;
    EXPECT_FALSE(bench.propText(file("ZephProp", "2.1.0", items(1, 65) + objects(2))));
    EXPECT_EQ(bench.failures.reports.at(0).procedure, "Zeph.modZephLoadSave.LoadProp200");
    EXPECT_EQ(bench.simulation->PropCount, 0);
    EXPECT_EQ(bench.simulation->FixtureCount, 2) << "the fixtures of a failed prop stay";
}
