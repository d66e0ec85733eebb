#include "shell/edit_options.h"

OptionsOutcome ZephEditOptions(const RegistryContext& context, QWidget* parent, ZephSettings& settings,
                               Connection& connection, ZephAdapters& adapters) try {
    ZephLoadAdaptersAndReturnIP(connection.ZephAdapterName, context.lister, context.host, adapters);
    const auto resetAll = [&] {
        ZephDeleteZephRegistry(context.store);
        // The guard against a restart cannot hold: its time went with the others.
        static_cast<void>(ZephReadRegistryDefaults(context, settings, connection, adapters));
    };
    frmZephOptions dialog(ZephOptionsDraftOf(settings, connection), adapters, {context.host, resetAll}, parent);
    const bool accepted = dialog.exec() == QDialog::Accepted;
    if (dialog.wasReset()) return OptionsOutcome::Reset;
    if (!accepted) return OptionsOutcome::Kept;
    settings = dialog.draft().Settings;
    connection = dialog.draft().Link;
    ZephWriteClosingRegistry(context, settings, false);
    return OptionsOutcome::Stored;
}
ZEPH_GUARD(context.failures, "EditOptions", OptionsOutcome::Kept)
