#include "shell/options_logic.h"
#include "tests/support/recording_host.h"

namespace {

// "Text=data" of each item.
std::string worded(const OptionItems& items) {
    std::string words;
    for (const OptionItem& item : items)
        words += (words.empty() ? "" : ", ") + item.Text + "=" + std::to_string(item.Data);
    return words;
}

}  // namespace

TEST(OptionsLogic, ListsAreWordedAsTheirSettingsAre) {
    EXPECT_EQ(worded(ZephOptionItems(&ZephSettings::AutoSave)),
              "Never=0, 1 Minute=1, 2 Minutes=2, 3 Minutes=3, 4 Minutes=4, 5 Minutes=5, 10 Minutes=10, 15 Minutes=15, "
              "20 Minutes=20, 25 Minutes=25, 30 Minutes=30, 35 Minutes=35, 40 Minutes=40, 45 Minutes=45, "
              "50 Minutes=50, 55 Minutes=55, 1 Hour=60, 2 Hours=120, 3 Hours=180, 4 Hours=240, 5 Hours=300, "
              "6 Hours=360");
    EXPECT_EQ(worded(ZephOptionItems(&ZephSettings::OnStartup)),
              "Do Nothing=0, Show Open File Dialog=1, Automatically Open Last File=2");
}

TEST(OptionsLogic, APortIsAWholeNumberOf16Bits) {
    for (const std::string text : {"", "0", "65536", "-1", "12a", "1.5", "99999999999", " ", "1", "65535", "00042"}) {
        const bool good = text == "1" || text == "65535" || text == "00042";
        RecordingHost host;
        ZephOptionsDraft draft = ZephOptionsDraftOf({}, {});
        draft.PortText = text;
        EXPECT_EQ(ZephAcceptOptions({}, host, draft), good) << text;
        EXPECT_EQ(draft.Settings.SimulationPort, good ? std::stoi(text) : 30303);
        EXPECT_EQ(draft.Link.ZephSimulationPort, draft.Settings.SimulationPort);
        EXPECT_EQ(host.boxTexts(), good ? ""
                                        : "Qen Visualizer-Port Error|The simulation port number must be between 1 and "
                                          "65,535 inclusive.");
    }
}

TEST(OptionsLogic, AnotherLinkIsToldOnlyOnceTheLinkIsOpen) {
    const std::pair<void (*)(ZephOptionsDraft&), bool> rows[] = {
        {[](ZephOptionsDraft& draft) { draft.Settings.BulbSize = 9; }, false},
        {[](ZephOptionsDraft& draft) { draft.PortText = "4000"; }, true},
        {[](ZephOptionsDraft& draft) { draft.Link.ZephUseTCP = true; }, true},
        {[](ZephOptionsDraft& draft) { draft.Link.ZephAdapterName = "Local"; }, true},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(&row - rows);
        for (const bool open : {false, true}) {
            RecordingHost host;
            const Connection inUse{"Stage", "192.168.1.20", 30303, false, open};
            ZephOptionsDraft draft = ZephOptionsDraftOf({}, inUse);
            row.first(draft);
            EXPECT_TRUE(ZephAcceptOptions(inUse, host, draft));
            EXPECT_EQ(draft.Settings.UseTCP, draft.Link.ZephUseTCP);
            EXPECT_EQ(draft.Settings.AdapterToUse, draft.Link.ZephAdapterName);
            EXPECT_EQ(host.boxTexts(), open && row.second
                                           ? "Qen Visualizer-Port Changed|These changes won't take effect "
                                             "until you restart Qen Visualizer."
                                           : "");
        }
    }
}
