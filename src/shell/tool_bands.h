// The layout of the tool bands, as it is kept with the settings: which bar stands in which band, and how wide.
// Lengths in twips. Called by start-up, a reset of the options, and the main window.
#pragma once

#include "util/failure.h"
#include "util/settings_store.h"

#include <array>
#include <cstdint>
#include <string>

struct ToolBand {
    std::string ChildName;  // objectName of the bar
    std::int32_t Width = 0;
    std::int32_t MinWidth = 0;
    std::int32_t MinHeight = 0;
    bool NewRow = false;  // begins a row

    bool operator==(const ToolBand&) const = default;
};

inline constexpr std::size_t kToolBands = 3;

struct ToolBandLayout {
    std::int32_t Height = 0;  // of all rows together
    std::array<ToolBand, kToolBands> Bands;

    bool operator==(const ToolBandLayout&) const = default;
};

// The layout of a first start.
ToolBandLayout firstToolBandLayout();

// Writes the first layout where none is stored.
void SetInitialCoolbarRegistry(SettingsStore& store, FailureReport& failures);

// The stored layout. Where it is damaged, where a bar is missing or stands twice, that is reported and the first
// layout returned: a bar that is nowhere could not be brought back by the user.
ToolBandLayout ZephInitializeFromRegistryCoolbar(const SettingsStore& store, FailureReport& failures);

void SaveCoolbar(const ToolBandLayout& layout, SettingsStore& store);
