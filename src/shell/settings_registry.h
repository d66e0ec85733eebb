// The settings of a run: read from the store once at start-up, written back whole at the end and by the options
// dialog. Called by start-up, the closing window, the options command and the channel wizard.
#pragma once

#include "link/communications.h"
#include "model/settings.h"
#include "util/clock.h"
#include "util/paths.h"
#include "util/settings_store.h"

#include <cstdint>

// What reading and writing the settings need of their surroundings.
struct RegistryContext {
    SettingsStore& store;
    const Clock& clock;
    const ZephPathService& paths;
    FailureReport& failures;
    Host& host;
    AdapterLister lister;
};

// A program that was closed this short a time ago is not started again: a second click on its icon was not meant.
inline constexpr std::int32_t kRestartGuardMs = 5000;

// Reads every setting, the channel wizard's included, puts the first layout of the tool bands into an empty store, and
// checks the network adapter; connection gets adapter, address, port and transport. What is absent or outside its
// range reads as its default; what cannot be read at all does so too and is reported; nothing is left half read.
// Returns false where the program was closed less than kRestartGuardMs ago: it is then to end without a word, and
// nothing was changed.
[[nodiscard]] bool ZephReadRegistryDefaults(const RegistryContext& context, ZephSettings& settings,
                                            Connection& connection, ZephAdapters& adapters);

// Writes every setting and the program's version. writeShutDownTime: also the time, which holds off a restart; for the
// end of the program only.
void ZephWriteClosingRegistry(const RegistryContext& context, const ZephSettings& settings, bool writeShutDownTime);

// Removes the settings with everything that is kept beside them: window, recent files, tool bands.
void ZephDeleteZephRegistry(SettingsStore& store);

// The channel wizard's colours and count. Written when that wizard closes, and with all the others.
void ReadChannelWizardSettings(const SettingsStore& store, FailureReport& failures, ZephSettings& settings);
void WriteChannelWizardSettings(const ZephSettings& settings, SettingsStore& store);

// Tells the sequencing program which window to look for: its handle, or 0 when it closes.
void ZephWriteVisPid(std::int64_t handle, SettingsStore& store);
