#include "shell/options_logic.h"

#include "util/text.h"

#include <algorithm>
#include <span>

namespace {

constexpr std::string_view kNoAddress = "0.0.0.0";
constexpr std::int32_t kLeastPort = 1;
constexpr std::int32_t kLargestPort = 65535;
constexpr std::int32_t kMinutesPerHour = 60;

// How the numbers of a list are worded.
std::string plainNumber(std::int32_t value) {
    return std::to_string(value);
}
std::string percent(std::int32_t value) {
    return std::to_string(value) + " %";
}
std::string numberOrNone(std::int32_t value) {
    return value == 0 ? "(none)" : std::to_string(value);
}
std::string counted(std::int32_t value, std::string_view unit) {
    return std::to_string(value).append(" ").append(unit).append(value == 1 ? "" : "s");
}
std::string duration(std::int32_t minutes) {
    if (minutes == 0) return "Never";
    if (minutes % kMinutesPerHour == 0) return counted(minutes / kMinutesPerHour, "Hour");
    return counted(minutes, "Minute");
}

// A list of numbers: those of the setting's range, from least on where the list begins later, in steps.
struct NumberList {
    LongField Field;
    std::string (*Wording)(std::int32_t);
    std::int32_t Least;
    std::int32_t Step;
};
constexpr std::array kNumberLists{
    NumberList{&ZephSettings::BulbSize, plainNumber, 1, 1},
    NumberList{&ZephSettings::BulbSpacing, plainNumber, 0, 1},
    NumberList{&ZephSettings::FloodSize, plainNumber, 1, 1},
    NumberList{&ZephSettings::FloodOpacity, percent, 5, 5},
    NumberList{&ZephSettings::ZOrder, plainNumber, 1, 1},  // level 0 can be stored, and is none
    NumberList{&ZephSettings::ToolTipsNumAsgnChannels, numberOrNone, 0, 1},
    NumberList{&ZephSettings::ToolTipsNumAsgnFixtures, numberOrNone, 0, 1},
};

OptionItems numberItems(const NumberList& list) {
    const SettingRange range = settingRange(list.Field);
    OptionItems items;
    for (std::int32_t value = std::max(range.Min, list.Least); value <= range.Max; value += list.Step)
        items.push_back({list.Wording(value), value});
    return items;
}

OptionItems tableItems(std::span<const std::string_view> names, std::int32_t firstRow) {
    OptionItems items;
    for (const std::string_view name : names)
        items.push_back({std::string(name), firstRow + static_cast<std::int32_t>(items.size())});
    return items;
}

OptionItems bulbShapeItems() {
    OptionItems items;
    for (int row = 1; row <= kBulbShapes; ++row)
        items.push_back({std::string(ZephBulbType(row).Name), row});
    return items;
}

OptionItems autoSaveItems() {
    OptionItems items;
    const auto add = [&](std::int32_t first, std::int32_t last, std::int32_t step) {
        for (std::int32_t minutes = first; minutes <= last; minutes += step)
            items.push_back({duration(minutes), minutes});
    };
    add(0, 5, 1);
    add(10, 55, 5);
    add(kMinutesPerHour, 6 * kMinutesPerHour, kMinutesPerHour);
    return items;
}

bool sameLink(const Connection& left, const Connection& right) {
    return left.ZephAdapterName == right.ZephAdapterName && left.ZephAdapterIP == right.ZephAdapterIP &&
           left.ZephUseTCP == right.ZephUseTCP && left.ZephSimulationPort == right.ZephSimulationPort;
}

}  // namespace

ZephOptionsDraft ZephOptionsDraftOf(const ZephSettings& settings, const Connection& link) {
    return {settings, link, std::to_string(link.ZephSimulationPort)};
}

OptionItems ZephOptionItems(LongField field) {
    for (const NumberList& list : kNumberLists) {
        if (list.Field == field) return numberItems(list);
    }
    if (field == &ZephSettings::AutoSave) return autoSaveItems();
    if (field == &ZephSettings::OnStartup) return tableItems(kStartupActions, 0);
    if (field == &ZephSettings::FixtureTextLocation) return tableItems(kFixtureTextLocations, 0);
    if (field == &ZephSettings::DefaultChannelType) return tableItems(kChannelTypeNames, 1);
    if (field == &ZephSettings::BulbShape || field == &ZephSettings::KeshBulbShape) return bulbShapeItems();
    throw Failure("this number is not chosen from a list");
}

OptionItems ZephAssumeNewObjectItems() {
    return {{"Ask", 0}, {"Always", 1}};
}

OptionItems ZephAdapterItems(const ZephAdapters& adapters) {
    OptionItems items;
    for (int slot = 1; slot <= kAdapterSlots; ++slot) {
        if (!adapters[slot].Name.empty()) items.push_back({adapters[slot].Name, slot});
    }
    return items;
}

std::string ZephOptionText(LongField field, std::int32_t value) {
    for (const NumberList& list : kNumberLists) {
        if (list.Field == field) return list.Wording(value);
    }
    return field == &ZephSettings::AutoSave ? duration(value) : plainNumber(value);
}

std::string ZephLocalIPText(std::string_view ip) {
    return std::string("IP address: ").append(ip.empty() ? kNoAddress : ip);
}

bool ZephIsDeadAddress(std::string_view ip) {
    return ip.empty() || ip == kNoAddress;
}

bool IsValidDigitKey(char32_t character) {
    return character >= U'0' && character <= U'9';
}

bool ZephAcceptOptions(const Connection& inUse, Host& host, ZephOptionsDraft& draft) {
    const std::optional<std::int32_t> port = parseLong(draft.PortText);
    if (!port || *port < kLeastPort || *port > kLargestPort) {
        host.messageBox(boxTitle("-Port Error"), "The simulation port number must be between 1 and 65,535 inclusive.",
                        BoxIcon::Critical);
        return false;
    }
    draft.Link.ZephSimulationPort = *port;
    draft.Settings.SimulationPort = *port;
    draft.Settings.UseTCP = draft.Link.ZephUseTCP;
    draft.Settings.AdapterToUse = draft.Link.ZephAdapterName;
    if (inUse.ZephPortOpen && !sameLink(inUse, draft.Link)) {
        host.messageBox(boxTitle("-Port Changed"),
                        std::string("These changes won't take effect until you restart ").append(kProgramName) + ".",
                        BoxIcon::Information);
    }
    return true;
}

bool ZephResetOptions(Host& host, const std::function<void()>& resetAll) {
    const BoxAnswer answer = host.messageBox(boxTitle("-Reset Options to Defaults?"),
                                             "Are you sure you want to reset all options to defaults?\r\n"
                                             "Note: This operation will reset your entire environment\r\n"
                                             "including editor colors, recent files, toolbar locations, etc",
                                             BoxIcon::Question, BoxButtons::OkCancel);
    if (answer != BoxAnswer::Ok) return false;
    resetAll();
    host.messageBox(boxTitle("-Reset Options to Defaults"), "All options reset to defaults", BoxIcon::Information);
    return true;
}
