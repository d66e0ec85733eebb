#include "model/editor_loader.h"
#include "model/editor_writer.h"
#include "tests/support/limit_document.h"
#include "tests/support/loading.h"
#include "util/whole_file.h"

#include <gtest/gtest.h>

#include <pugixml.hpp>

namespace {

const std::string kEmptyFile = "<Zeph zephSaveFileVersion=\"3.0.0\"></Zeph>";

// A document whose survival shows that a refused file left it alone.
void openSomething(LoadBench& bench) {
    bench.simulation->FixtureCount = 1;
    bench.simulation->Fixtures[1].Name = "Open";
}

}  // namespace

TEST(Loading, RefusalsAreToldInTheGivenWords) {
    struct Case {
        const char* what;
        const char* text;  // nullptr: no file
        const char* title;
        const char* message;  // %1 = the file
        bool keepsDocument;
    };
    const Case cases[] = {
        {"missing", nullptr, "Qen Visualizer-Editor Load Error",
         "Error:  The editor file '%1' is missing.\r\n(005-File Not Found)", true},
        {"empty", "", "Qen Visualizer-Invalid Editor File",
         "Error:  The editor file '%1' is invalid or corrupted.\r\n(002-Invalid XML)", true},
        {"cut off in the body", "<Zeph zephSaveFileVersion=\"3.0.0\"><Levels Dimmed=\"1\">",
         "Qen Visualizer-Invalid Editor File",
         "Error:  The editor file '%1' is invalid or corrupted.\r\n(002-Invalid XML)", true},
        {"an unknown encoding", "<?xml version=\"1.0\" encoding=\"EBCDIC\"?><Zeph zephSaveFileVersion=\"3.0.0\"/>",
         "Qen Visualizer-Invalid Editor File",
         "Error:  The editor file '%1' is invalid or corrupted.\r\n(002-Invalid XML)", true},
        {"another root", "<zeph zephSaveFileVersion=\"3.0.0\"/>", "Qen Visualizer-Not a valid file",
         "Error:  This file  '%1' is not a valid editor file for this application.\r\n(003-Invalid Root)", true},
        {"a later version", "<Zeph zephSaveFileVersion=\"3.0.1\"/>", "Qen Visualizer-Not a valid file",
         "Error:  The File Version is incompatible for this application.\r\nPlease contact support for an upgrade.",
         false},
        {"an earlier version", "<Zeph zephSaveFileVersion=\"1.5.0\"/>", "Qen Visualizer-Not a valid file",
         "Error:  The File Version is incompatible for this application.\r\nPlease contact support for an upgrade.",
         false},
        {"no version", "<Zeph/>", "Qen Visualizer-Not a valid file",
         "Error:  The File Version is incompatible for this application.\r\nPlease contact support for an upgrade.",
         false},
        {"an unknown group", "<Zeph zephSaveFileVersion=\"3.0.0\"><Odd/></Zeph>", "Qen Visualizer-Not a valid file",
         "There were one or more errors encountered loading your simulation.", false},
    };
    for (const Case& row : cases) {
        SCOPED_TRACE(row.what);
        LoadBench bench;
        openSomething(bench);
        if (row.text) {
            ASSERT_TRUE(replaceWholeFile(bench.path(), row.text));
        }
        std::string message = row.message;
        if (const std::size_t at = message.find("%1"); at != std::string::npos) message.replace(at, 2, bench.path());
        EXPECT_FALSE(ZephLoadVisualizerXML(false, bench.context, *bench.simulation));
        EXPECT_TRUE(bench.host.boxes.empty());
        EXPECT_EQ(bench.simulation->FixtureCount == 1, row.keepsDocument);
        EXPECT_FALSE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
        ASSERT_EQ(bench.host.boxes.size(), 1u);
        EXPECT_EQ(bench.host.boxes[0].title, row.title);
        EXPECT_EQ(bench.host.boxes[0].text, message);
        EXPECT_EQ(bench.host.boxes[0].icon, BoxIcon::Critical);
    }
}

TEST(Loading, AFolderUnderTheNameIsABadLoad) {
    LoadBench bench;
    bench.simulation->FileName = "";
    EXPECT_FALSE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
    ASSERT_EQ(bench.host.boxes.size(), 1u);
    EXPECT_EQ(bench.host.boxes[0].text,
              "Error:  The editor file '" + bench.folderPath + "' is missing or invalid.\r\n(001-Bad Load)");
}

TEST(Loading, ReplacesEverythingThatWasOpen) {
    LoadBench bench;
    buildTypicalDocument(*bench.simulation);
    bench.name("empty.zee");
    bench.simulation->ChecksumMismatch = bench.simulation->FileUpgraded = bench.simulation->SimulationDirty = true;
    ASSERT_TRUE(replaceWholeFile(bench.path(), kEmptyFile));
    EXPECT_TRUE(ZephLoadVisualizerXML(true, bench.context, *bench.simulation));
    const auto blank = std::make_unique<ZephSimulation>();
    NoWatcher nobody;
    ZephGlobalReset(false, *blank, nobody);
    blank->FilePath = bench.simulation->FilePath;
    blank->FileName = bench.simulation->FileName;
    blank->zephSaveFileVersion = "3.0.0";
    EXPECT_TRUE(*bench.simulation == *blank);
    EXPECT_EQ(widthPixels(bench.simulation->Background), 1) << "no background, so one pixel";
    EXPECT_EQ(bench.watcher.selections, 1);
    EXPECT_EQ(bench.watcher.clipboards, 1);
}

TEST(Loading, EachVersionHasItsBodyAndOldOnesCountAsUpgraded) {
    for (const char* version : {"1.5.2", "2.0.0", "2.0.1", "2.1.0", "3.0.0"}) {
        SCOPED_TRACE(version);
        const bool old = std::string_view(version) != "3.0.0";
        LoadBench bench;
        // Without the export fields a prop is whole in version 2 and damaged in version 3.
        const std::string text = std::string("<Zeph zephSaveFileVersion=\"") + version +
                                 "\"><Items><Item ID=\"1\" Name=\"P\" Locked=\"True\" Comment=\"\"/></Items></Zeph>";
        EXPECT_EQ(loadEditorText(text, TextReading::QuickThenGeneral, true, bench.context, *bench.simulation), old);
        EXPECT_EQ(bench.simulation->FileUpgraded, old);
        EXPECT_EQ(bench.simulation->PropCount, 1);
    }
}

TEST(Loading, TheLedDefaultOutlivesTheLoadThatSetIt) {
    const std::string fixture =
        " Name=\"F\" BulbSize=\"1\" BulbSpacing=\"1\" Comment=\"\" BulbShape=\"1\" ZOrder=\"1\" "
        "AssignedItem=\"0\" Locked=\"False\"";
    const std::string channel = "<AssignedChannels><Channel ID=\"1\" Name=\"c\" DeviceType=\"1\" Network=\"0\" "
                                "Controller=\"1\" Channel=\"1\" Color=\"0\"/></AssignedChannels>";
    const auto file = [&](const char* version, const char* led) {
        return std::string("<Zeph zephSaveFileVersion=\"") + version + "\"><DrawObjects><DrawObject ID=\"1\"" +
               fixture + led + ">" + channel + "</DrawObject></DrawObjects></Zeph>";
    };
    LoadBench bench;
    const auto ledAfter = [&](const std::string& text) {
        EXPECT_TRUE(loadEditorText(text, TextReading::QuickThenGeneral, true, bench.context, *bench.simulation));
        return bench.simulation->Fixtures[1].Channels[1].LED;
    };
    EXPECT_FALSE(ledAfter(file("3.0.0", " LED=\"True\""))) << "version 3 does not look at it";
    EXPECT_TRUE(ledAfter(file("2.1.0", " LED=\"True\"")));
    EXPECT_TRUE(ledAfter(file("2.1.0", "")));
    EXPECT_TRUE(ledAfter(file("3.0.0", "")));
    EXPECT_FALSE(ledAfter(file("2.0.0", " LED=\"False\"")));
    EXPECT_FALSE(ledAfter(file("3.0.0", "")));
}

TEST(Loading, TheChecksumOnlyRaisesItsFlag) {
    LoadBench bench;
    buildTypicalDocument(*bench.simulation);
    std::string text = editorText(*bench.simulation, bench.paths, "now");
    AddHash(false, text);
    const std::size_t attribute = text.find(" Chksum=\"");
    const std::string checksum = text.substr(attribute, 42);
    std::string moved = text;
    moved.erase(attribute, checksum.size()).insert(moved.find("<Zeph") + 5, checksum);
    std::string lower = text;
    for (std::size_t at = attribute + 9; at < attribute + 41; ++at)
        lower[at] = static_cast<char>(std::tolower(lower[at]));
    std::string spaced = text;
    spaced.insert(attribute, 1, '\n');
    std::string touched = text;
    touched.insert(touched.find("<Levels"), 1, ' ');
    std::string none = text;
    none.erase(attribute, checksum.size());
    std::string unchecked = text;
    unchecked.replace(attribute, checksum.size(), " Chksum=\"\"");

    struct Case {
        const char* what;
        const std::string& text;
        bool mismatch;
    };
    for (const Case& row :
         {Case{"as written", text, false}, Case{"moved", moved, false}, Case{"lower case", lower, true},
          Case{"spaced", spaced, false}, Case{"touched", touched, true}, Case{"none", none, false},
          Case{"empty", unchecked, true}}) {
        for (const TextReading reading : {TextReading::QuickThenGeneral, TextReading::GeneralOnly}) {
            SCOPED_TRACE(row.what);
            EXPECT_TRUE(loadEditorText(row.text, reading, true, bench.context, *bench.simulation));
            EXPECT_EQ(bench.simulation->ChecksumMismatch, row.mismatch);
            EXPECT_TRUE(bench.host.boxes.empty());
        }
    }
}

TEST(Loading, WideEncodingsReadLikeUtf8) {
    LoadBench bench;
    const std::u16string wide = u"<Zeph zephSaveFileVersion=\"3.0.0\"><Items><Item ID=\"1\" Name=\"\u00e4\U0001F384\" "
                                u"Locked=\"?\"/></Items></Zeph>";
    for (const bool marked : {false, true}) {
        std::string bytes = marked ? std::string("\xFF\xFE") : std::string();
        for (const char16_t unit : wide) {
            bytes.push_back(static_cast<char>(unit & 0xFF));
            bytes.push_back(static_cast<char>(unit >> 8));
        }
        EXPECT_FALSE(loadEditorText(bytes, TextReading::QuickThenGeneral, false, bench.context, *bench.simulation));
        EXPECT_EQ(bench.simulation->Props[1].Name, "\xC3\xA4\xF0\x9F\x8E\x84");
    }
}

TEST(Loading, WhatIsNoXmlIsRefused) {
    LoadBench bench;
    const auto loads = [&](std::string_view before, std::string_view name, std::string_view behind) {
        const std::string text =
            std::string(before)
                .append(
                    "<Zeph zephSaveFileVersion=\"2.1.0\"><Items><Item ID=\"1\" Locked=\"True\" Comment=\"\" Name=\"")
                .append(name)
                .append("\"/></Items></Zeph>")
                .append(behind);
        const bool loaded = loadEditorText(text, TextReading::QuickThenGeneral, true, bench.context, *bench.simulation);
        EXPECT_EQ(loaded, bench.host.boxes.empty());
        for (const auto& box : bench.host.boxes)
            EXPECT_NE(box.text.find("(002-Invalid XML)"), std::string::npos) << box.text;
        bench.host.boxes.clear();
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
    EXPECT_FALSE(loads("x", "", ""));
    EXPECT_FALSE(loads(" <?xml version='1.0'?>", "", ""));
}

TEST(Loading, AStoredDocumentIsReadIntoTheRecordsAsTheyStand) {
    LoadBench bench;
    buildTypicalDocument(*bench.simulation);
    const DocumentSnapshot stored = takeSnapshot(*bench.simulation, bench.paths, {});
    const auto before = std::make_unique<ZephSimulation>(*bench.simulation);
    before->zephSaveFileVersion = "3.0.0";
    ZephGlobalReset(true, *bench.simulation, bench.watcher);
    bench.simulation->FileUpgraded = true;
    EXPECT_TRUE(ZephLoadVisualizerXML(stored, true, bench.context, *bench.simulation));
    EXPECT_TRUE(*bench.simulation == *before);
    EXPECT_EQ(bench.watcher.clipboards, 0) << "emptying the records was the caller's, and so is the clipboard";
    EXPECT_FALSE(ZephLoadVisualizerXML(DocumentSnapshot(), true, bench.context, *bench.simulation));
    EXPECT_EQ(bench.host.boxes.at(0).title, "Qen Visualizer-Editor Load Error");
}
