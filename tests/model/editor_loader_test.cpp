#include "display.h"
#include "model/editor_loader.h"
#include "model/editor_writer.h"
#include "tests/support/loading.h"

#include <pugixml.hpp>

TEST(Loading, RefusalsAreToldInTheGivenWords) {
    const char* const corrupted = "Qen Visualizer-Invalid Editor File|Error:  The editor file '%1' is invalid or "
                                  "corrupted.\r\n(002-Invalid XML)";
    const char* const incompatible = "Qen Visualizer-Not a valid file|Error:  The File Version is incompatible for "
                                     "this application.\r\nPlease contact support for an upgrade.";
    const std::tuple<const char*, const char*, bool> rows[] = {
        // text, box (%1 = the file), keeps the document
        {"", corrupted, true},
        {"<Zeph zephSaveFileVersion=\"3.0.0\"><Levels Dimmed=\"1\">", corrupted, true},
        {"<?xml version=\"1.0\" encoding=\"EBCDIC\"?><Zeph zephSaveFileVersion=\"3.0.0\"/>", corrupted, true},
        {"<zeph zephSaveFileVersion=\"3.0.0\"/>",
         "Qen Visualizer-Not a valid file|Error:  This file  '%1' is not a valid editor file for this "
         "application.\r\n(003-Invalid Root)",
         true},
        {"<Zeph zephSaveFileVersion=\"3.0.1\"/>", incompatible, false},
        {"<Zeph zephSaveFileVersion=\"1.5.0\"/>", incompatible, false},
        {"<Zeph/>", incompatible, false},
        {"<Zeph zephSaveFileVersion=\"3.0.0\"><Odd/></Zeph>",
         "Qen Visualizer-Not a valid file|There were one or more errors encountered loading your simulation.", false}};
    for (const auto& [text, told, keepsDocument] : rows) {
        SCOPED_TRACE(text);
        LoadBench bench;
        bench.simulation->FixtureCount = 1;
        bench.folder.write("display.zee", text);
        EXPECT_FALSE(ZephLoadVisualizerXML(false, bench.context, *bench.simulation));
        EXPECT_EQ(bench.host.boxTexts(), "");
        EXPECT_EQ(bench.simulation->FixtureCount == 1, keepsDocument);
        EXPECT_FALSE(bench.load());
        EXPECT_EQ(bench.host.boxTexts(), QString(told).replace("%1", bench.path().c_str()).toStdString());
        EXPECT_EQ(bench.host.boxes.at(0).icon, BoxIcon::Critical);
    }
    LoadBench bench;
    EXPECT_FALSE(bench.load());
    EXPECT_EQ(bench.host.boxTexts(), "Qen Visualizer-Editor Load Error|Error:  The editor file '" + bench.path() +
                                         "' is missing.\r\n(005-File Not Found)");
    bench.name("");  // a folder stands under that name
    EXPECT_FALSE(bench.load());
    EXPECT_EQ(bench.host.boxes.at(1).text,
              "Error:  The editor file '" + bench.path() + "' is missing or invalid.\r\n(001-Bad Load)");
    EXPECT_FALSE(ZephLoadVisualizerXML(DocumentSnapshot(), true, bench.context, *bench.simulation));
    EXPECT_EQ(bench.host.boxes.at(2).title, "Qen Visualizer-Editor Load Error");
}

TEST(Loading, ReplacesEverythingThatWasOpen) {
    LoadBench bench;
    buildDisplay(*bench.simulation);
    bench.simulation->ChecksumMismatch = bench.simulation->FileUpgraded = bench.simulation->SimulationDirty = true;
    LoadBench blank;
    blank.simulation->FilePath = bench.simulation->FilePath;
    for (LoadBench* each : {&bench, &blank})
        EXPECT_TRUE(each->read("<Zeph zephSaveFileVersion=\"3.0.0\"></Zeph>"));
    EXPECT_TRUE(*bench.simulation == *blank.simulation);
    EXPECT_EQ(bench.simulation->Levels[1].Name, "Level 1");
    EXPECT_EQ(widthPixels(bench.simulation->Background), 1) << "no background, so one pixel";
    EXPECT_EQ(bench.watcher.selections, 1);
    EXPECT_EQ(bench.watcher.clipboards, 1);
}

TEST(Loading, EachVersionHasItsBodyAndOldOnesCountAsUpgraded) {
    for (const std::string version : {"1.5.2", "2.0.0", "2.0.1", "2.1.0", "3.0.0"}) {
        LoadBench bench;
        // Without the export fields a prop is whole in version 2 and damaged in version 3.
        const bool old = version != "3.0.0";
        EXPECT_EQ(bench.read("<Zeph zephSaveFileVersion=\"" + version +
                             "\"><Items><Item ID=\"1\" Name=\"P\" Locked=\"True\" Comment=\"\"/></Items></Zeph>"),
                  old);
        EXPECT_EQ(bench.simulation->FileUpgraded, old) << version;
        EXPECT_EQ(bench.simulation->PropCount, 1);
    }
}

TEST(Loading, TheLedDefaultOutlivesTheLoadThatSetIt) {
    LoadBench bench;
    const auto ledAfter = [&](std::string_view version, std::string_view led) {
        std::string text =
            "<Zeph zephSaveFileVersion=\"%1\"><DrawObjects><DrawObject ID=\"1\" Name=\"F\" BulbSize=\"1\" "
            "BulbSpacing=\"1\" Comment=\"\" BulbShape=\"1\" ZOrder=\"1\" AssignedItem=\"0\" Locked=\"False\"%2>"
            "<AssignedChannels><Channel ID=\"1\" Name=\"c\" DeviceType=\"1\" Network=\"0\" Controller=\"1\" "
            "Channel=\"1\" Color=\"0\"/></AssignedChannels></DrawObject></DrawObjects></Zeph>";
        EXPECT_TRUE(bench.read(text.replace(text.find("%2"), 2, led).replace(text.find("%1"), 2, version)));
        return bench.simulation->Fixtures[1].Channels[1].LED;
    };
    EXPECT_FALSE(ledAfter("3.0.0", " LED=\"True\"")) << "version 3 does not look at it";
    EXPECT_TRUE(ledAfter("2.1.0", " LED=\"True\""));
    EXPECT_TRUE(ledAfter("2.1.0", ""));
    EXPECT_TRUE(ledAfter("3.0.0", ""));
    EXPECT_FALSE(ledAfter("2.0.0", " LED=\"False\""));
    EXPECT_FALSE(ledAfter("3.0.0", ""));
}

TEST(Loading, TheChecksumOnlyRaisesItsFlag) {
    LoadBench bench;
    buildDisplay(*bench.simulation);
    std::string text = editorText(*bench.simulation, bench.paths, "now");
    AddHash(false, text);
    const std::size_t attribute = text.find(" Chksum=\"");
    const std::string checksum = text.substr(attribute, 42);
    const std::string none = std::string(text).erase(attribute, checksum.size());
    const auto with = [](std::string base, std::size_t at, std::string_view inserted) {
        return base.insert(at, inserted);
    };
    std::string lower = checksum;
    std::ranges::transform(checksum.substr(9), lower.begin() + 9, [](char c) { return std::tolower(c); });
    const std::pair<std::string, bool> rows[] = {
        {text, false},
        {none, false},
        {with(none, text.find("<Zeph") + 5, checksum), false},
        {with(text, attribute, "\n"), false},
        {with(none, attribute, lower), true},
        {with(text, text.find("<Levels"), " "), true},
        {with(none, attribute, " Chksum=\"\""), true},
    };
    for (const auto& [file, mismatch] : rows) {
        for (const TextReading reading : {TextReading::QuickThenGeneral, TextReading::GeneralOnly}) {
            EXPECT_TRUE(bench.read(file, reading));
            EXPECT_EQ(bench.simulation->ChecksumMismatch, mismatch) << file.substr(0, 200);
        }
    }
    EXPECT_EQ(bench.host.boxTexts(), "");
}

TEST(Loading, WideEncodingsReadLikeUtf8) {
    LoadBench bench;
    for (const char* mark : {"", "\xFF\xFE"}) {
        EXPECT_FALSE(bench.read(mark + utf16Bytes(u"<Zeph zephSaveFileVersion=\"3.0.0\"><Items><Item ID=\"1\" "
                                                  u"Name=\"\u00e4\U0001F384\" Locked=\"?\"/></Items></Zeph>")));
        EXPECT_EQ(bench.simulation->Props[1].Name, "\xC3\xA4\xF0\x9F\x8E\x84");
    }
}

TEST(Loading, WhatIsNoXmlIsRefused) {
    LoadBench bench;
    const auto loads = [&](const std::string& before, const std::string& name, const std::string& behind) {
        bench.host.boxes.clear();
        const bool loaded = bench.read(before +
                                       "<Zeph zephSaveFileVersion=\"2.1.0\"><Items><Item ID=\"1\" Locked=\"True\" "
                                       "Comment=\"\" Name=\"" +
                                       name + "\"/></Items></Zeph>" + behind);
        EXPECT_EQ(!loaded, bench.host.boxTexts().ends_with("(002-Invalid XML)")) << bench.host.boxTexts();
        return loaded;
    };
    EXPECT_TRUE(loads("", "\xC3\xA4&#228;", "<!-- end -->"));
    EXPECT_TRUE(loads("<!DOCTYPE Zeph [<!ENTITY tree \"fir\">]>", "a &tree;", ""));
    EXPECT_EQ(bench.simulation->Props[1].Name, "a fir");
    for (const char* name : {"a & b", "&tree;", "a<b", "a\" Name=\"b", "\xFF", "\xED\xA0\x80", "\xEF\xBF\xBE", "\x01",
                             "&#1;", "&#xD800;", "a\" x:y=\""})
        EXPECT_FALSE(loads("", name, "")) << name;
    for (const char* behind : {"x", "<Zeph/>", "<![CDATA[]]>", "<!-- -- -->"})
        EXPECT_FALSE(loads("", "", behind)) << behind;
    for (const char* before : {"x", " <?xml version='1.0'?>"})
        EXPECT_FALSE(loads(before, "", "")) << before;
}
