#include "link/adapters.h"

#include <QHostAddress>
#include <QNetworkInterface>

namespace {

constexpr std::string_view kNotConnected = "0.0.0.0";

std::string firstIPv4(const QNetworkInterface& adapter) {
    for (const QNetworkAddressEntry& entry : adapter.addressEntries()) {
        if (entry.ip().protocol() == QAbstractSocket::IPv4Protocol) return entry.ip().toString().toStdString();
    }
    return std::string(kNotConnected);
}

}  // namespace

std::vector<ZephAdapter> listSystemAdapters() {
    std::vector<ZephAdapter> adapters;
    for (const QNetworkInterface& adapter : QNetworkInterface::allInterfaces()) {
        if (adapter.flags().testFlag(QNetworkInterface::IsLoopBack)) continue;  // slot 1 stands for it
        adapters.push_back({adapter.humanReadableName().toStdString(), firstIPv4(adapter)});
    }
    return adapters;
}

std::string ZephLoadAdaptersAndReturnIP(std::string_view adapterName, const AdapterLister& lister, Host& host,
                                        ZephAdapters& adapters) {
    adapters.fill({});
    adapters[1] = {"Local", "127.0.0.1"};
    int slot = 1;
    for (ZephAdapter& adapter : lister()) {
        if (slot == kAdapterSlots) {
            host.messageBox(boxTitle("-Error"),
                            "Your system has more than 32 network adapters.  Only the first 32 will be used.",
                            BoxIcon::Information);
            break;
        }
        adapters[++slot] = std::move(adapter);
    }
    host.pumpEvents();  // listing can take the system a while
    if (!adapterName.empty()) {
        for (const ZephAdapter& adapter : adapters) {
            if (adapter.Name == adapterName) return adapter.IpAddress;
        }
    }
    return adapters[1].IpAddress;
}

AdapterChoice ZephCheckAdapterAtStartup(std::string_view storedName, const AdapterLister& lister, Host& host,
                                        ZephAdapters& adapters) {
    const std::string title = boxTitle("-Port Error");
    AdapterChoice choice{std::string(storedName), ZephLoadAdaptersAndReturnIP(storedName, lister, host, adapters)};
    const bool firstSlotUsable = !adapters[1].Name.empty();
    if (storedName.empty() && firstSlotUsable) {
        choice = {adapters[1].Name, adapters[1].IpAddress};
    } else if (storedName.empty()) {
        host.messageBox(boxTitle(""), "There are no network adapters on this machine!", BoxIcon::None);
    } else if (choice.ZephAdapterIP.empty() && firstSlotUsable) {
        choice = {adapters[1].Name, adapters[1].IpAddress};
        host.messageBox(title,
                        "The previously assigned network adapter no longer exists on this system.\r\n"
                        "Qen Visualizer found another adapter and will attempt to use it instead. \r\n"
                        "Please check the settings page to make any needed changes.",
                        BoxIcon::Warning);
    } else if (choice.ZephAdapterIP.empty()) {
        host.messageBox(title,
                        "The network adapter assigned no longer exists on this system,\r\n"
                        " and there are no other adapters to use.",
                        BoxIcon::Critical);
    }
    if (choice.ZephAdapterIP == kNotConnected) {
        host.messageBox(
            title,
            "Your network adapter is present, however it doesn't appear to be connected to your network.\r\n"
            "Check your connections.\r\n",
            BoxIcon::Warning);
    }
    return choice;
}
