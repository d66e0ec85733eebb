#include "model/dimming_curve.h"
#include "tests/support/loading.h"

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
    const std::string invalid = "The Dimming Curve file is invalid or corrupted.";
    const std::string noBody = "Could Not load the dimming curve's body.";
    const auto body = [](const char* attributes) {
        return curveFile("<Dimming_Curve><P " + std::string(attributes) + "/></Dimming_Curve>");
    };
    const std::pair<std::string, std::string> cases[] = {
        {"", invalid},
        {"<ZephDimCurve zephSaveFileVersion=\"1.5.0\"><Dimming_Curve>", invalid},
        {"<Zeph zephSaveFileVersion=\"1.5.0\"/>", "This is not a valid Dimming Curve for this application."},
        {"<ZephDimCurve zephSaveFileVersion=\"3.0.0\"/>",
         "The File Version for the dimming curve is incompatible for this application."},
        {curveFile(""), noBody},
        {body("ID=\"1\" Value=\"256\""), noBody},
        {body("ID=\"256\" Value=\"1\""), noBody},
        {body("ID=\"1\" Value=\"-1\""), noBody},
        {body("ID=\"1\""), noBody},
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
