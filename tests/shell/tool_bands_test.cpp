#include "shell/tool_bands.h"
#include "tests/support/map_settings_store.h"
#include "tests/support/recording_host.h"

using Row = std::pair<const char*, const char*>;

TEST(ToolBands, TheFirstLayoutIsWrittenOnceAndReplacesADamagedOne) {
    MapSettingsStore store;
    CollectingFailures failures;
    SetInitialCoolbarRegistry(store, failures);
    EXPECT_EQ(store.get("CB Band1 Child Name"), "EditToolBar");
    EXPECT_EQ(store.get("CB Band2 Min Width"), "6250");
    EXPECT_EQ(store.get("CB Band3 New Row"), "True");

    ToolBandLayout moved = firstToolBandLayout();
    std::swap(moved.Bands[0], moved.Bands[2]);
    moved.Bands[1].Width = 9000;
    moved.Height = 1290;
    SaveCoolbar(moved, store);
    SetInitialCoolbarRegistry(store, failures);
    EXPECT_EQ(ZephInitializeFromRegistryCoolbar(store, failures), moved);
    EXPECT_TRUE(failures.reports.empty());

    for (const auto& [name, text] :
         {Row{"CB Band Qty", "2"}, Row{"CB Band Qty", "many"}, Row{"CB Height", "0"}, Row{"CB Height", ""},
          Row{"CB Band1 Child Name", "picToolBarButtonContainer"}, Row{"CB Band2 Child Name", "Other"},
          Row{"CB Band2 Width", "6249"}, Row{"CB Band3 Min Height", "-1"}, Row{"CB Band3 New Row", "perhaps"}}) {
        SaveCoolbar(moved, store);
        store.set(name, text);
        failures.reports.clear();
        EXPECT_EQ(ZephInitializeFromRegistryCoolbar(store, failures), firstToolBandLayout()) << name;
        EXPECT_EQ(failures.reports.size(), 1u) << name;
    }
}
