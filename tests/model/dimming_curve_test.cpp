#include "model/dimming_curve.h"
#include "tests/support/loading.h"
#include "util/whole_file.h"

#include <gtest/gtest.h>

namespace {

std::string curveFile(std::string_view body) {
    return "<ZephDimCurve zephSaveFileVersion=\"1.5.0\">" + std::string(body) + "</ZephDimCurve>";
}

}  // namespace

TEST(DimmingCurve, EveryChildSetsOneByteWhateverItsName) {
    CollectingFailures failures;
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    const std::string text = curveFile("<Other><Point ID=\"5\" Value=\"9\"/></Other><Dimming_Curve>"
                                       "<Point ID=\"0\" Value=\"255\"/><!-- a remark --><Odd ID=\"255\" Value=\"0\"/>"
                                       "<P ID=\"128\" Value=\"64\"/></Dimming_Curve>");
    EXPECT_TRUE(loadDimmingCurveText(text, failures, curve));
    EXPECT_EQ(curve[0], 255);
    EXPECT_EQ(curve[255], 0);
    EXPECT_EQ(curve[128], 64);
    EXPECT_EQ(curve[5], 5) << "the identity where the file says nothing";
    EXPECT_TRUE(failures.reports.empty());
}

TEST(DimmingCurve, FailuresAreReportedInTheGivenWords) {
    struct Case {
        const char* what;
        std::string text;
        const char* description;
    };
    const Case cases[] = {
        {"empty", "", "The Dimming Curve file is invalid or corrupted."},
        {"cut off", "<ZephDimCurve zephSaveFileVersion=\"1.5.0\"><Dimming_Curve>",
         "The Dimming Curve file is invalid or corrupted."},
        {"another root", "<Zeph zephSaveFileVersion=\"1.5.0\"/>",
         "This is not a valid Dimming Curve for this application."},
        {"another version", "<ZephDimCurve zephSaveFileVersion=\"3.0.0\"/>",
         "The File Version for the dimming curve is incompatible for this application."},
        {"no body", curveFile(""), "Could Not load the dimming curve's body."},
        {"value 256", curveFile("<Dimming_Curve><P ID=\"1\" Value=\"256\"/></Dimming_Curve>"),
         "Could Not load the dimming curve's body."},
        {"ID 256", curveFile("<Dimming_Curve><P ID=\"256\" Value=\"1\"/></Dimming_Curve>"),
         "Could Not load the dimming curve's body."},
        {"negative", curveFile("<Dimming_Curve><P ID=\"1\" Value=\"-1\"/></Dimming_Curve>"),
         "Could Not load the dimming curve's body."},
        {"no value", curveFile("<Dimming_Curve><P ID=\"1\"/></Dimming_Curve>"),
         "Could Not load the dimming curve's body."},
    };
    for (const Case& row : cases) {
        SCOPED_TRACE(row.what);
        LoadBench bench;
        ZephDimmingCurve curve;
        ASSERT_TRUE(replaceWholeFile(bench.path(), row.text));
        EXPECT_FALSE(ZephLoadDimmingCurveXML(bench.path(), bench.failures, curve));
        ASSERT_FALSE(bench.failures.reports.empty());
        EXPECT_EQ(bench.failures.reports.back().description, row.description);
        EXPECT_EQ(bench.failures.reports.back().procedure, "Zeph.modZephLoadSave.ZephLoadDimmingCurveXML");
    }
    LoadBench bench;
    ZephDimmingCurve curve;
    EXPECT_FALSE(ZephLoadDimmingCurveXML(bench.folderPath + "none.xml", bench.failures, curve));
    EXPECT_FALSE(ZephLoadDimmingCurveXML(bench.folderPath, bench.failures, curve)) << "a folder is no file";
    ASSERT_EQ(bench.failures.reports.size(), 2u);
    for (const auto& report : bench.failures.reports)
        EXPECT_EQ(report.description, "The Dimming Curve file is missing or invalid.");
}
