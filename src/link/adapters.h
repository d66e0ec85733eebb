// The machine's network adapters: names for the user to choose from, addresses to receive on.
#pragma once

#include "util/host.h"
#include "util/one_based.h"

#include <functional>
#include <string>
#include <string_view>
#include <vector>

struct ZephAdapter {
    std::string Name;       // empty = free slot
    std::string IpAddress;  // dotted decimal; "0.0.0.0" = not connected

    bool operator==(const ZephAdapter&) const = default;
};

// Slot 1 is always "Local" with 127.0.0.1; 2..32 in the order in which the system lists them.
inline constexpr int kAdapterSlots = 32;
using ZephAdapters = OneBased<ZephAdapter, kAdapterSlots>;

// Lists the adapters of a machine, without the loopback. The real one is listSystemAdapters.
using AdapterLister = std::function<std::vector<ZephAdapter>()>;

// Each adapter of this machine with its first IPv4 address, "0.0.0.0" where it has none.
std::vector<ZephAdapter> listSystemAdapters();

// Rebuilds the table and returns the address for the name, compared exactly; the first slot's for an unknown or empty
// name, so that a machine whose adapter is gone still receives from itself. Shows an information box where the machine
// has more adapters than slots.
std::string ZephLoadAdaptersAndReturnIP(std::string_view adapterName, const AdapterLister& lister, Host& host,
                                        ZephAdapters& adapters);

// The adapter in use.
struct AdapterChoice {
    std::string ZephAdapterName;
    std::string ZephAdapterIP;
};

// The start-up check: turns the stored name (empty = none yet) into a choice, and warns of an adapter that is gone or
// not connected.
AdapterChoice ZephCheckAdapterAtStartup(std::string_view storedName, const AdapterLister& lister, Host& host,
                                        ZephAdapters& adapters);
