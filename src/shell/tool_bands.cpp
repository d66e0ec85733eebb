#include "shell/tool_bands.h"

#include "shell/settings_table.h"
#include "shell/settings_values.h"

namespace {

constexpr std::string_view kModule = "ToolBands";
constexpr std::string_view kBandCount = "CB Band Qty";
constexpr std::string_view kHeight = "CB Height";

// band0: 0-based.
std::string bandValue(std::size_t band0, std::string_view field) {
    return ("CB Band" + std::to_string(band0 + 1) + " ").append(field);
}

std::int32_t loadLength(const SettingsStore& store, std::string_view name, std::int32_t least) {
    require(!LoadZephStringRegValue(store, kSettingsKey, name, "").empty(), "the layout of the tool bands has a gap");
    const std::int32_t length = LoadZephLongRegValue(store, kSettingsKey, name, {});
    require(length >= least, "a tool band is narrower than its bar");
    return length;
}

ToolBand loadBand(const SettingsStore& store, std::size_t band0) {
    ToolBand band;
    band.ChildName = LoadZephStringRegValue(store, kSettingsKey, bandValue(band0, "Child Name"), "");
    band.MinWidth = loadLength(store, bandValue(band0, "Min Width"), 0);
    band.Width = loadLength(store, bandValue(band0, "Width"), band.MinWidth);
    band.MinHeight = loadLength(store, bandValue(band0, "Min Height"), 0);
    band.NewRow = LoadZephBoolRegValue(store, kSettingsKey, bandValue(band0, "New Row"), false);
    return band;
}

// The bands may stand in another order, but each bar stands in one.
void requireEveryBar(const ToolBandLayout& layout) {
    for (const ToolBand& first : firstToolBandLayout().Bands) {
        const auto own = std::ranges::count(layout.Bands, first.ChildName, &ToolBand::ChildName);
        require(own == 1, "the layout of the tool bands does not hold each bar once");
    }
}

void write(std::string_view name, std::string_view kind, std::string_view value, SettingsStore& store) {
    fWriteValue("HKCU", {kSettingsKey, name, kind, value}, store);
}

}  // namespace

ToolBandLayout firstToolBandLayout() {
    return {870,
            {{{"EditToolBar", 7485, 7485, 390, false},
              {"picToolBarButtonContainer", 6250, 6250, 390, false},
              {"DrawToolBar", 5985, 5985, 390, true}}}};
}

void SetInitialCoolbarRegistry(SettingsStore& store, FailureReport& failures) try {
    if (LoadZephStringRegValue(store, kSettingsKey, kBandCount, "").empty()) SaveCoolbar(firstToolBandLayout(), store);
}
ZEPH_GUARD(failures, kModule, )

ToolBandLayout ZephInitializeFromRegistryCoolbar(const SettingsStore& store, FailureReport& failures) try {
    require(LoadZephLongRegValue(store, kSettingsKey, kBandCount, {}) == kToolBands,
            "the layout of the tool bands has another number of bands");
    ToolBandLayout layout;
    layout.Height = loadLength(store, kHeight, 1);
    for (std::size_t band0 = 0; band0 < kToolBands; ++band0)
        layout.Bands.at(band0) = loadBand(store, band0);
    requireEveryBar(layout);
    return layout;
}
ZEPH_GUARD(failures, kModule, firstToolBandLayout())

void SaveCoolbar(const ToolBandLayout& layout, SettingsStore& store) {
    write(kHeight, "D", std::to_string(layout.Height), store);
    write(kBandCount, "D", std::to_string(kToolBands), store);
    for (std::size_t band0 = 0; band0 < kToolBands; ++band0) {
        const ToolBand& band = layout.Bands.at(band0);
        write(bandValue(band0, "Child Name"), "S", band.ChildName, store);
        write(bandValue(band0, "Width"), "D", std::to_string(band.Width), store);
        write(bandValue(band0, "Min Width"), "D", std::to_string(band.MinWidth), store);
        write(bandValue(band0, "Min Height"), "D", std::to_string(band.MinHeight), store);
        write(bandValue(band0, "New Row"), "B", band.NewRow ? "True" : "False", store);
    }
}
