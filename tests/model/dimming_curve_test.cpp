#include "model/dimming_curve.h"
#include "tests/support/loading.h"

TEST(DimmingCurve, EveryChildSetsOneByteWhateverItsName) {
    CollectingFailures failures;
    ZephDimmingCurve curve = ZephCreateDummyDimmingCurve();
    EXPECT_TRUE(loadDimmingCurveText("<ZephDimCurve zephSaveFileVersion=\"1.5.0\"><Other><Point ID=\"5\" Value=\"9\"/>"
                                     "</Other><Dimming_Curve><Point ID=\"0\" Value=\"255\"/><!-- a remark -->"
                                     "<Odd ID=\"255\" Value=\"0\"/></Dimming_Curve></ZephDimCurve>",
                                     failures, curve));
    EXPECT_EQ(curve[0], 255);
    EXPECT_EQ(curve[255], 0);
    EXPECT_EQ(curve[5], 5) << "the identity where the file says nothing";
}

TEST(DimmingCurve, FailuresAreReportedInTheGivenWords) {
    const std::string head = "<ZephDimCurve zephSaveFileVersion=\"1.5.0\"";
    const std::string open = head + "><Dimming_Curve>";
    const std::string close = "</Dimming_Curve></ZephDimCurve>";
    const std::string noBody = "Could Not load the dimming curve's body.";
    const std::pair<std::string, std::string> cases[] = {
        {open, "The Dimming Curve file is invalid or corrupted."},
        {"<Zeph zephSaveFileVersion=\"1.5.0\"/>", "This is not a valid Dimming Curve for this application."},
        {"<ZephDimCurve zephSaveFileVersion=\"3.0.0\"/>",
         "The File Version for the dimming curve is incompatible for this application."},
        {head + "/>", noBody},
        {open + "<P ID=\"1\" Value=\"256\"/>" + close, noBody},
        {open + "<P ID=\"256\" Value=\"1\"/>" + close, noBody},
        {open + "<P ID=\"1\"/>" + close, noBody},
    };
    LoadBench bench;
    ZephDimmingCurve curve;
    for (const auto& [text, description] : cases) {
        bench.folder.write("curve.xml", text.c_str());
        EXPECT_FALSE(ZephLoadDimmingCurveXML(bench.folder.path("curve.xml"), bench.failures, curve)) << text;
        EXPECT_EQ(bench.failures.reports.back().description, description) << text;
        EXPECT_EQ(bench.failures.reports.back().procedure, "Zeph.modZephLoadSave.ZephLoadDimmingCurveXML");
    }
    for (const char* name : {"none.xml", ""}) {  // a folder is no file
        EXPECT_FALSE(ZephLoadDimmingCurveXML(bench.folder.path(name), bench.failures, curve));
        EXPECT_EQ(bench.failures.reports.back().description, "The Dimming Curve file is missing or invalid.");
    }
}
