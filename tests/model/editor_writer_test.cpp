// How each element and attribute is spelled stands in the files of editor_files.
#include "display.h"
#include "model/editor_elements.h"
#include "model/editor_writer.h"
#include "tests/support/limit_document.h"
#include "tests/support/loading.h"

namespace {

struct WriteBench : LoadBench {
    bool save() { return ZephSaveVisualizerXML("today", context, *simulation); }
    std::string written() const { return folder.read(simulation->FileName); }
};

}  // namespace

TEST(Writing, WhatIsWrittenIsReadBackWhole) {
    for (const bool limit : {false, true}) {
        WriteBench bench;
        limit ? buildLimitDocument(*bench.simulation) : buildDisplay(*bench.simulation);
        bench.simulation->Fixtures[1].Comment = "\xC3\xA4 & \xF0\x9F\x8E\x84\r\n\"<\x01'\xEF\xBF\xBF\xEF\xBC\x81\t\x1F";
        EXPECT_TRUE(bench.save());
        std::string whole = editorText(*bench.simulation, bench.paths, "today");
        AddHash(false, whole);
        EXPECT_TRUE(bench.written() == whole) << "a save is made in pieces, and they must fit";
        for (std::size_t at = whole.find('\n'); at != std::string::npos; at = whole.find('\n', at + 1))
            ASSERT_EQ(whole[at - 1], '\r');
        const auto written = std::make_unique<ZephSimulation>(*bench.simulation);
        written->zephSaveFileVersion = "3.0.0";
        // No document can hold U+0001, U+001F and U+FFFF.
        written->Fixtures[1].Comment = "\xC3\xA4 & \xF0\x9F\x8E\x84\r\n\"<'\xEF\xBC\x81\t";
        written->SimulationOpen = false;  // that it is open is for whoever asked for the load to say
        EXPECT_TRUE(bench.load());
        EXPECT_TRUE(*bench.simulation == *written);
        EXPECT_EQ(bench.host.boxTexts(), "");
    }
}

TEST(Writing, AMismatchOutlivesEverySave) {
    WriteBench bench;
    EXPECT_TRUE(bench.save());
    std::string text = bench.written();
    text.insert(text.find("<Items"), 1, ' ');
    bench.folder.write("display.zee", text.c_str());
    for (int round = 1; round <= 2; ++round)
        EXPECT_TRUE(bench.load() && bench.simulation->ChecksumMismatch && bench.save());
    bench.simulation->ChecksumMismatch = false;
    EXPECT_TRUE(bench.save() && bench.load());
    EXPECT_FALSE(bench.simulation->ChecksumMismatch);
}

TEST(Writing, AFailureIsToldOrReportedAndHarmsNothing) {
    WriteBench bench;
    bench.name("no-such-folder/display.zee");
    EXPECT_FALSE(bench.save());
    EXPECT_EQ(bench.host.boxTexts(), "Qen Visualizer-Save Error|There was a problem saving the editor data to disk.  "
                                     "Please try again.");
    bench.name("display.zee");
    bench.folder.write("display.zee", "old");
    bench.simulation->FixtureCount = kMaxFixtures + 1;  // no document has this; the writer must not walk past the end
    EXPECT_FALSE(bench.save());
    EXPECT_EQ(bench.failures.reports.at(0).procedure, "Zeph.modZephLoadSave.ZephSaveVisualizerXML");
    EXPECT_EQ(bench.written(), "old");
}
