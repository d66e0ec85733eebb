#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "tests/support/limit_document.h"
#include "tests/support/loading.h"
#include "util/whole_file.h"

#include <QFile>

#include <gtest/gtest.h>

namespace {

std::string fileText(const std::string& path) {
    QFile file(QString::fromStdString(path));
    return file.open(QIODevice::ReadOnly) ? file.readAll().toStdString() : std::string("not readable");
}

}  // namespace

TEST(Writing, SpellsTheFileToTheLetter) {
    LoadBench bench;
    ZephSimulation& simulation = *bench.simulation;
    ZephGlobalReset(false, simulation, bench.watcher);
    simulation.Background = {2, bench.folderPath + "house.png", 90, 150, 300};
    simulation.PropCount = 1;
    simulation.Props[1].Name = "P";
    simulation.FixtureCount = 3;
    for (int f = 1; f <= 3; ++f)
        InitializeFixture(bench.settings, simulation.Fixtures[f]);
    simulation.Fixtures[1].Name = "A<&>\"\r\n\t'";
    ZephAddFixtureToProp(1, 1, simulation);
    simulation.Fixtures[1].ChannelCount = 1;
    simulation.Fixtures[1].Channels[1].LED = true;
    simulation.Fixtures[1].PointCount = 1;
    simulation.Fixtures[1].DrawPoints[1] = {6, -15, 2147483647};
    // Ribbons and pixel strings keep no channels, whatever their count says.
    simulation.Fixtures[2].Fixture_Type = kFixtureKesh;
    simulation.Fixtures[2].ChannelCount = 3;
    simulation.Fixtures[3].Fixture_Type = kFixtureDmxPixels;
    simulation.Fixtures[3].ChannelCount = 3;

    std::string expected = "<?xml version='1.0' encoding='UTF-8'?>\n"
                           "<Zeph zephSaveFileVersion=\"3.0.0\" CreatedAt=\"today\">\n"
                           "    <Background BackgroundType=\"2\" PicFileName=\"&lt;base&gt;/house.png\" "
                           "PicIntensity=\"90\" EditorWidthTwips=\"150\" EditorHeightTwips=\"300\"/>\n"
                           "    <Levels Dimmed=\"0\">\n";
    for (int level = 1; level <= 16; ++level) {
        expected += "        <Level ID=\"" + std::to_string(level) +
                    "\" Edit_Enabled=\"True\" Sim_Enabled=\"True\" Name=\"Level " + std::to_string(level) + "\"/>\n";
    }
    const std::string rest = " ZOrder=\"1\" AssignedItem=\"%\" Locked=\"False\" Fixture_Type=\"#\" Channel_Type=\"1\" "
                             "Max_Opacity=\"50\">\n"
                             "            <Sample Background_Color=\"0\" RGB_R=\"0\" RGB_G=\"0\" RGB_B=\"0\"/>\n"
                             "            <Novaline_Data QvReverseOrder=\"False\" QvForceRowColumn=\"False\" "
                             "QvRow=\"0\" QvColumn=\"0\" QvLocations=\"\" QvColorTemp=\"0\"/>\n";
    const auto fixture = [&](const std::string& name, char prop, char type) {
        std::string text = rest;
        text[text.find('%')] = prop;
        text[text.find('#')] = type;
        return "Name=\"" + name + "\" BulbSize=\"2\" BulbSpacing=\"2\" Comment=\"\" BulbShape=\"1\"" + text;
    };
    expected += "    </Levels>\n"
                "    <Items>\n"
                "        <Item ID=\"1\" Name=\"P\" Locked=\"False\" Comment=\"\" QvWU=\"0\" QvFF=\"\" "
                "QvReverseOrder=\"False\" QvForceRowColumn=\"False\" QvRow=\"0\" QvColumn=\"0\" "
                "QvUseMyOrder=\"False\" QvStar=\"False\" QvMatrixInd=\"0\" QvPropColorTemp=\"0\">\n"
                "            <AssignedObject ID=\"1\" Object=\"1\"/>\n"
                "        </Item>\n"
                "    </Items>\n"
                "    <DrawObjects>\n"
                "        <DrawObject ID=\"1\" " +
                fixture("A&lt;&amp;&gt;&quot;&#13;&#10;&#9;'", '1', '1') +
                "            <AssignedChannels>\n"
                "                <Channel ID=\"1\" Name=\"\" DeviceType=\"0\" Network=\"0\" Controller=\"0\" "
                "Channel=\"0\" Color=\"0\" Sub_Type=\"0\" Sub_Parm=\"0\" Multi_1=\"16777215\" Multi_2=\"16777215\" "
                "Multi_3=\"16777215\" Multi_4=\"16777215\" Multi_5=\"16777215\" LED=\"True\"/>\n"
                "            </AssignedChannels>\n"
                "            <DrawPoints>\n"
                "                <DrawPoint ID=\"1\" Type=\"6\" X=\"-15\" Y=\"2147483647\"/>\n"
                "            </DrawPoints>\n"
                "        </DrawObject>\n"
                "        <DrawObject ID=\"2\" " +
                fixture("", '0', '4') +
                "            <Kesh Network=\"0\" Base_Unit=\"0\" Unit_Mode=\"0\" Channel_Mode=\"0\" Resolution=\"0\" "
                "Physical_Pixel_Number=\"1\"/>\n"
                "            <DrawPoints/>\n"
                "        </DrawObject>\n"
                "        <DrawObject ID=\"3\" " +
                fixture("", '0', '5') +
                "            <DMX Universe=\"0\" Physical_Pixel_Number=\"1\"/>\n"
                "            <DrawPoints/>\n"
                "        </DrawObject>\n"
                "    </DrawObjects>\n"
                "</Zeph>";
    for (std::size_t at = expected.find('\n'); at != std::string::npos; at = expected.find('\n', at + 2))
        expected.insert(at, 1, '\r');
    EXPECT_EQ(editorText(simulation, bench.paths, "today"), expected);
}

TEST(Writing, WhatIsWrittenIsReadBackWhole) {
    for (const bool limit : {false, true}) {
        LoadBench bench;
        if (limit) {
            buildLimitDocument(*bench.simulation);
        } else {
            buildTypicalDocument(*bench.simulation);
        }
        bench.simulation->Fixtures[1].Comment = "\xC3\xA4 & \xF0\x9F\x8E\x84\r\n\"<\x01'\xEF\xBF\xBF\xEF\xBC\x81\t\x1F";
        EXPECT_TRUE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
        std::string whole = editorText(*bench.simulation, bench.paths, "today");
        AddHash(false, whole);
        EXPECT_TRUE(fileText(bench.path()) == whole) << "a save is made in pieces, and they must fit";
        const auto written = std::make_unique<ZephSimulation>(*bench.simulation);
        written->zephSaveFileVersion = "3.0.0";
        // No document can hold U+0001, U+001F and U+FFFF.
        written->Fixtures[1].Comment = "\xC3\xA4 & \xF0\x9F\x8E\x84\r\n\"<'\xEF\xBC\x81\t";
        written->SimulationOpen = false;  // that it is open is for whoever asked for the load to say
        EXPECT_TRUE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
        EXPECT_TRUE(*bench.simulation == *written);
        EXPECT_TRUE(bench.host.boxes.empty());
        EXPECT_TRUE(bench.failures.reports.empty());
    }
}

TEST(Writing, AMismatchOutlivesEverySave) {
    LoadBench bench;
    ZephSaveVisualizerXML("today", bench.context, *bench.simulation);
    std::string text = fileText(bench.path());
    text.insert(text.find("<Items"), 1, ' ');
    ASSERT_TRUE(replaceWholeFile(bench.path(), text));
    for (int round = 1; round <= 2; ++round) {
        EXPECT_TRUE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
        EXPECT_TRUE(bench.simulation->ChecksumMismatch);
        EXPECT_TRUE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
    }
    bench.simulation->ChecksumMismatch = false;
    EXPECT_TRUE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
    EXPECT_TRUE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
    EXPECT_FALSE(bench.simulation->ChecksumMismatch);
}

TEST(Writing, AFailureOfTheDiskIsToldAndHarmsNothing) {
    LoadBench bench;
    bench.name("no-such-folder/display.zee");
    EXPECT_FALSE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
    ASSERT_EQ(bench.host.boxes.size(), 1u);
    EXPECT_EQ(bench.host.boxes[0].title, "Qen Visualizer-Save Error");
    EXPECT_EQ(bench.host.boxes[0].text, "There was a problem saving the editor data to disk.  Please try again.");
    bench.name("");  // a folder stands under that name
    EXPECT_FALSE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
}

TEST(Writing, AnyOtherFailureIsReportedAndTheFileStays) {
    LoadBench bench;
    ASSERT_TRUE(replaceWholeFile(bench.path(), "old"));
    bench.simulation->FixtureCount = kMaxFixtures + 1;  // no document has this; the writer must not walk past the end
    EXPECT_FALSE(ZephSaveVisualizerXML("today", bench.context, *bench.simulation));
    ASSERT_EQ(bench.failures.reports.size(), 1u);
    EXPECT_EQ(bench.failures.reports[0].procedure, "Zeph.modZephLoadSave.ZephSaveVisualizerXML");
    EXPECT_EQ(fileText(bench.path()), "old");
}

TEST(Writing, TheTimeOfASaveShowsItsSeconds) {
    const std::string now = createdAtNow();
    EXPECT_NE(now.find(' '), std::string::npos);
    EXPECT_GE(std::count(now.begin(), now.end(), ':') + std::count(now.begin(), now.end(), '.'), 2) << now;
}
