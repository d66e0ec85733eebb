// The way from the menu to the options dialog and back: opens it over the settings, stores what was accepted.
#pragma once

#include "shell/dialogs/options_dialog.h"
#include "shell/settings_registry.h"

enum class OptionsOutcome {
    Kept,    // nothing was changed
    Stored,  // settings and connection hold what was entered, and so does the store
    Reset,   // settings, connection and the stored tool bands are as at a first start
};

// Lists the network adapters anew, shows the dialog and waits for it. adapters: rebuilt. The socket itself is left as
// it is: another port or transport takes a restart.
OptionsOutcome ZephEditOptions(const RegistryContext& context, QWidget* parent, ZephSettings& settings,
                               Connection& connection, ZephAdapters& adapters);
