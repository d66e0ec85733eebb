#include "shell/tool_bands.h"
#include "tests/support/map_settings_store.h"
#include "tests/support/recording_host.h"

TEST(ToolBands, TheFirstLayoutIsWrittenOnce) {
    MapSettingsStore store;
    CollectingFailures failures;
    SetInitialCoolbarRegistry(store, failures);
    EXPECT_EQ(store.get("CB Height"), "870");
    EXPECT_EQ(store.get("CB Band Qty"), "3");
    EXPECT_EQ(store.get("CB Band1 Child Name"), "EditToolBar");
    EXPECT_EQ(store.get("CB Band1 Width"), "7485");
    EXPECT_EQ(store.get("CB Band2 Child Name"), "picToolBarButtonContainer");
    EXPECT_EQ(store.get("CB Band2 Min Width"), "6250");
    EXPECT_EQ(store.get("CB Band2 New Row"), "False");
    EXPECT_EQ(store.get("CB Band3 Child Name"), "DrawToolBar");
    EXPECT_EQ(store.get("CB Band3 Min Height"), "390");
    EXPECT_EQ(store.get("CB Band3 New Row"), "True");

    ToolBandLayout moved = firstToolBandLayout();
    std::swap(moved.Bands[0], moved.Bands[2]);
    moved.Bands[1].Width = 9000;
    moved.Height = 1290;
    SaveCoolbar(moved, store);
    SetInitialCoolbarRegistry(store, failures);
    EXPECT_EQ(ZephInitializeFromRegistryCoolbar(store, failures), moved);
    EXPECT_TRUE(failures.reports.empty());
}

TEST(ToolBands, ADamagedLayoutIsReportedAndReplaced) {
    struct Case {
        const char* name;
        const char* text;
    };
    for (const Case& damage :
         {Case{"CB Band Qty", "2"}, Case{"CB Band Qty", "many"}, Case{"CB Height", "0"}, Case{"CB Height", ""},
          Case{"CB Band1 Child Name", "DrawToolBar"}, Case{"CB Band2 Child Name", "Other"},
          Case{"CB Band2 Width", "6249"}, Case{"CB Band3 Min Height", "-1"}, Case{"CB Band3 New Row", "perhaps"}}) {
        MapSettingsStore store;
        CollectingFailures failures;
        SetInitialCoolbarRegistry(store, failures);
        store.set("CB Band1 Width", "8000");
        store.set(damage.name, damage.text);
        EXPECT_EQ(ZephInitializeFromRegistryCoolbar(store, failures), firstToolBandLayout()) << damage.name;
        EXPECT_EQ(failures.reports.size(), 1u) << damage.name;
    }
}
