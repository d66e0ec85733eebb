#include "shell/settings_registry.h"

#include "shell/settings_table.h"
#include "shell/settings_values.h"
#include "shell/tool_bands.h"
#include "util/text.h"

namespace {

constexpr std::string_view kModule = "SettingsRegistry";
constexpr std::string_view kShutDownTime = "ShutDownTime";
constexpr std::string_view kMaskName = "Channel Wizard Color Mask";
constexpr LongRule kMaskRule{16777215, true, 0, 16777215};
constexpr LongRule kRepeatRule{1, true, 1, 16};

// Runs one read. What fails there is reported under the caller's name and costs that value alone.
template <typename Read>
void readOn(FailureReport& failures, std::string_view procedure, Read&& read) noexcept {
    try {
        read();
    } catch (...) {
        reportCaughtFailure(failures, kModule, procedure, __LINE__);
    }
}

void writeLong(std::string_view name, std::int64_t value, SettingsStore& store) {
    fWriteValue("HKCU", {kSettingsKey, name, "D", std::to_string(value)}, store);
}

void writeText(std::string_view name, std::string_view value, SettingsStore& store) {
    fWriteValue("HKCU", {kSettingsKey, name, "S", value}, store);
}

std::string recentName(std::size_t entry0) {
    return "Recent File " + std::to_string(entry0 + 1);
}

std::string maskName(std::size_t mask0) {
    return std::string(kMaskName).append(std::to_string(mask0 + 1));
}

// Reads the value of one row into the field, which holds its default.
struct RowReader {
    const RegistryContext& context;
    const SettingRow& row;
    ZephSettings& settings;

    void operator()(LongField field) const {
        std::int32_t& value = settings.*field;
        const bool useDefault = row.Rule != SettingRule::LeastIfOutside;
        value = LoadZephLongRegValue(context.store, kSettingsKey, row.Name,
                                     {value, true, row.Min, row.Max, useDefault, row.Min});
    }
    void operator()(FlagField field) const {
        bool& value = settings.*field;
        value = LoadZephBoolRegValue(context.store, kSettingsKey, row.Name, value);
        if (row.Rule == SettingRule::StartsFalse) value = false;
    }
    void operator()(TextField field) const {
        const std::string text = LoadZephStringRegValue(context.store, kSettingsKey, row.Name, "");
        settings.*field = row.Rule == SettingRule::StoredPath ? context.paths.ExpandPath(text, kPathBase) : text;
    }
};

struct RowWriter {
    const RegistryContext& context;
    const SettingRow& row;
    const ZephSettings& settings;

    void operator()(LongField field) const { writeLong(row.Name, settings.*field, context.store); }
    void operator()(FlagField field) const {
        fWriteValue("HKCU", {kSettingsKey, row.Name, "B", settings.*field ? "True" : "False"}, context.store);
    }
    void operator()(TextField field) const {
        const std::string& text = settings.*field;
        writeText(row.Name, row.Rule == SettingRule::StoredPath ? context.paths.CollapsePath(text, kPathBase) : text,
                  context.store);
    }
};

// An empty entry is passed over, so that the list has no gap.
void readRecentFiles(const RegistryContext& context, ZephSettings& settings) {
    std::size_t count = 0;
    for (std::size_t entry0 = 0; entry0 < settings.RecentFiles.size(); ++entry0) {
        readOn(context.failures, "ZephReadRegistryDefaults", [&] {
            const std::string stored = LoadZephStringRegValue(context.store, kSettingsKey, recentName(entry0), "");
            if (!stored.empty()) settings.RecentFiles.at(count++) = context.paths.ExpandPath(stored, kPathBase);
        });
    }
}

// Both clocks count from the machine's start: after a restart of it the difference is negative or large.
bool closedJustNow(const RegistryContext& context) {
    bool justNow = false;
    readOn(context.failures, "ZephReadRegistryDefaults", [&] {
        if (LoadZephStringRegValue(context.store, kSettingsKey, kShutDownTime, "").empty()) return;
        const std::int64_t closedAt = LoadZephLongRegValue(context.store, kSettingsKey, kShutDownTime, {});
        const std::int64_t agoMs = context.clock.tickCount() - closedAt;
        justNow = agoMs >= 1 && agoMs < kRestartGuardMs;
    });
    return justNow;
}

}  // namespace

bool ZephReadRegistryDefaults(const RegistryContext& context, ZephSettings& settings, Connection& connection,
                              ZephAdapters& adapters) try {
    if (const std::string problem = context.store.problem(); !problem.empty()) {
        context.failures.ErrReport(problem, procedureName(kModule, __func__), 0);
    }
    if (closedJustNow(context)) return false;
    ZephSettings read;
    for (const SettingRow& row : kSettings) {
        readOn(context.failures, __func__, [&] { std::visit(RowReader{context, row, read}, row.Field); });
    }
    readRecentFiles(context, read);
    ReadChannelWizardSettings(context.store, context.failures, read);
    SetInitialCoolbarRegistry(context.store, context.failures);

    const AdapterChoice choice = ZephCheckAdapterAtStartup(read.AdapterToUse, context.lister, context.host, adapters);
    read.AdapterToUse = choice.ZephAdapterName;
    connection.ZephAdapterName = choice.ZephAdapterName;
    connection.ZephAdapterIP = choice.ZephAdapterIP;
    connection.ZephSimulationPort = read.SimulationPort;
    connection.ZephUseTCP = read.UseTCP;
    settings = std::move(read);
    return true;
}
ZEPH_GUARD(context.failures, kModule, true)

void ZephWriteClosingRegistry(const RegistryContext& context, const ZephSettings& settings,
                              bool writeShutDownTime) try {
    for (const SettingRow& row : kSettings)
        std::visit(RowWriter{context, row, settings}, row.Field);
    for (std::size_t entry0 = 0; entry0 < settings.RecentFiles.size(); ++entry0) {
        writeText(recentName(entry0), context.paths.CollapsePath(settings.RecentFiles.at(entry0), kPathBase),
                  context.store);
    }
    WriteChannelWizardSettings(settings, context.store);
    writeLong("VMJ", ZEPH_VERSION_MAJOR, context.store);
    writeLong("VMN", ZEPH_VERSION_MINOR, context.store);
    writeLong("REV", ZEPH_VERSION_REVISION, context.store);
    if (writeShutDownTime) writeLong(kShutDownTime, context.clock.tickCount(), context.store);
    context.store.flush();
}
ZEPH_GUARD(context.failures, kModule, )

void ZephDeleteZephRegistry(SettingsStore& store) {
    store.removeKey(kSettingsKey);
    store.flush();
}

void ReadChannelWizardSettings(const SettingsStore& store, FailureReport& failures, ZephSettings& settings) {
    for (std::size_t mask0 = 0; mask0 < settings.ChannelWizardColorMask.size(); ++mask0) {
        readOn(failures, __func__, [&] {
            settings.ChannelWizardColorMask.at(mask0) =
                LoadZephLongRegValue(store, kSettingsKey, maskName(mask0), kMaskRule);
        });
    }
    readOn(failures, __func__, [&] {
        settings.ChannelWizardRepeatingChannels =
            LoadZephLongRegValue(store, kSettingsKey, "Channel Wizard Repeating Channels", kRepeatRule);
    });
}

void WriteChannelWizardSettings(const ZephSettings& settings, SettingsStore& store) {
    for (std::size_t mask0 = 0; mask0 < settings.ChannelWizardColorMask.size(); ++mask0)
        writeLong(maskName(mask0), settings.ChannelWizardColorMask.at(mask0), store);
    writeLong("Channel Wizard Repeating Channels", settings.ChannelWizardRepeatingChannels, store);
}

void ZephWriteVisPid(std::int64_t handle, SettingsStore& store) {
    fWriteValue("HKCU", {kSharedIpcKey, "VisPid", "S", std::to_string(handle)}, store);
    store.flush();
}
