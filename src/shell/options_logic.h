// What the options dialog works on and by: the draft, the lists of its boxes, the checks of OK, the question of a
// reset. No windows here.
#pragma once

#include "link/communications.h"
#include "model/settings.h"
#include "shell/settings_table.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

// The tab with the port, 0-based as LastOptsTab is.
inline constexpr int kCommunicationsTab = 5;

// What the dialog edits: copies of the settings and of how the program is connected.
struct ZephOptionsDraft {
    ZephSettings Settings;
    Connection Link;
    std::string PortText;  // as it was typed
};

ZephOptionsDraft ZephOptionsDraftOf(const ZephSettings& settings, const Connection& link);

struct OptionItem {
    std::string Text;
    std::int32_t Data;  // the value of the setting
};
using OptionItems = std::vector<OptionItem>;

// The list from which a number is chosen. Throws Failure for a number that is not chosen from a list.
OptionItems ZephOptionItems(LongField field);
// "Ask" and "Always": 0 and 1, the flag AssumeNewObject.
OptionItems ZephAssumeNewObjectItems();
// The used slots of the table, each with its slot number.
OptionItems ZephAdapterItems(const ZephAdapters& adapters);

// How a number that its list does not hold is shown, in the list's own words.
std::string ZephOptionText(LongField field, std::int32_t value);

// "IP address: " and the address, "0.0.0.0" for none.
std::string ZephLocalIPText(std::string_view ip);
// No traffic can arrive at this address.
bool ZephIsDeadAddress(std::string_view ip);

// The port's field takes this character: a digit.
bool IsValidDigitKey(char32_t character);

// OK: turns the typed port into the number, and takes adapter, address, transport and port over into the settings.
// Returns false, after a message, for a port outside 1..65535; nothing is changed then. Where the link was opened in
// this run and is to be another, says that it takes a restart.
[[nodiscard]] bool ZephAcceptOptions(const Connection& inUse, Host& host, ZephOptionsDraft& draft);

// Reset: asks, runs the reset and tells that it is done. Returns false if the user thought better of it.
bool ZephResetOptions(Host& host, const std::function<void()>& resetAll);
