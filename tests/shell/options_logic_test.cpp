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

const Connection kLink{"Stage", "192.168.1.20", 30303, false, true};

}  // namespace

TEST(OptionsLogic, ListsAreWordedAsTheirSettingsAre) {
    EXPECT_EQ(worded(ZephOptionItems(&ZephSettings::AutoSave)),
              "Never=0, 1 Minute=1, 2 Minutes=2, 3 Minutes=3, 4 Minutes=4, 5 Minutes=5, 10 Minutes=10, 15 Minutes=15, "
              "20 Minutes=20, 25 Minutes=25, 30 Minutes=30, 35 Minutes=35, 40 Minutes=40, 45 Minutes=45, "
              "50 Minutes=50, 55 Minutes=55, 1 Hour=60, 2 Hours=120, 3 Hours=180, 4 Hours=240, 5 Hours=300, "
              "6 Hours=360");
    EXPECT_EQ(worded(ZephOptionItems(&ZephSettings::OnStartup)),
              "Do Nothing=0, Show Open File Dialog=1, Automatically Open Last File=2");
    EXPECT_EQ(worded(ZephOptionItems(&ZephSettings::DefaultChannelType)), "Normal=1, RGB=2");
    EXPECT_EQ(worded(ZephAssumeNewObjectItems()), "Ask=0, Always=1");
    EXPECT_EQ(worded(ZephAdapterItems(ZephAdapters{})), "");
    struct Case {
        LongField field;
        const char* first;
        const char* last;
        std::size_t count;
    };
    for (const Case& each :
         {Case{&ZephSettings::BulbSize, "1=1", "16=16", 16}, Case{&ZephSettings::BulbSpacing, "0=0", "64=64", 65},
          Case{&ZephSettings::FloodSize, "1=1", "64=64", 64},
          Case{&ZephSettings::FloodOpacity, "5 %=5", "100 %=100", 20}, Case{&ZephSettings::ZOrder, "1=1", "16=16", 16},
          Case{&ZephSettings::ToolTipsNumAsgnChannels, "(none)=0", "16=16", 17},
          Case{&ZephSettings::ToolTipsNumAsgnFixtures, "(none)=0", "64=64", 65},
          Case{&ZephSettings::BulbShape, "Round=1", "Pixel Bulb=11", 11},
          Case{&ZephSettings::KeshBulbShape, "Round=1", "Pixel Bulb=11", 11},
          Case{&ZephSettings::FixtureTextLocation, "None=0", "Pixel Num ONLY=7", 8}}) {
        const OptionItems items = ZephOptionItems(each.field);
        EXPECT_EQ(items.size(), each.count) << each.last;
        EXPECT_THAT(worded(items), testing::StartsWith(each.first));
        EXPECT_THAT(worded(items), testing::EndsWith(each.last));
    }
    EXPECT_THROW(ZephOptionItems(&ZephSettings::Left), Failure);
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
    struct Case {
        const char* what;
        void (*change)(ZephOptionsDraft&);
        bool told;
    };
    for (const Case& each :
         {Case{"nothing", [](ZephOptionsDraft&) {}, false},
          Case{"a setting", [](ZephOptionsDraft& draft) { draft.Settings.BulbSize = 9; }, false},
          Case{"the port", [](ZephOptionsDraft& draft) { draft.PortText = "4000"; }, true},
          Case{"the transport", [](ZephOptionsDraft& draft) { draft.Link.ZephUseTCP = true; }, true},
          Case{"the adapter", [](ZephOptionsDraft& draft) { draft.Link.ZephAdapterName = "Local"; }, true},
          Case{"its address", [](ZephOptionsDraft& draft) { draft.Link.ZephAdapterIP = "10.0.0.1"; }, true}}) {
        for (const bool open : {false, true}) {
            RecordingHost host;
            Connection inUse = kLink;
            inUse.ZephPortOpen = open;
            ZephOptionsDraft draft = ZephOptionsDraftOf({}, inUse);
            each.change(draft);
            EXPECT_TRUE(ZephAcceptOptions(inUse, host, draft));
            EXPECT_EQ(draft.Settings.UseTCP, draft.Link.ZephUseTCP);
            EXPECT_EQ(draft.Settings.AdapterToUse, draft.Link.ZephAdapterName);
            EXPECT_EQ(host.boxTexts(), open && each.told ? "Qen Visualizer-Port Changed|These changes won't take "
                                                           "effect until you restart Qen Visualizer."
                                                         : "")
                << each.what;
        }
    }
}
