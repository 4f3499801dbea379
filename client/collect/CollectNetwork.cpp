// Network adapters, their addresses, and routes.
//
// Addresses and routes have keys that do not name them, so a changed address shows as a change of its adapter. Speed and link are
// known only while the adapter is on; reading them fails otherwise.
#include <algorithm>
#include <map>
#include <system_error>
#include <tuple>

#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadNetwork.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kMegabit = 1'000'000;
constexpr std::uint64_t kInterfaceIsUp = 1;

std::string LastPart(const std::optional<std::string>& path)
{
    return path ? path->substr(path->rfind('/') + 1) : std::string();
}

void AddAdapter(TCollection& collection, const std::string& name)
{
    const std::string folder = "/sys/class/net/" + name + "/";
    TFacts facts("KALMO_NetworkAdapter");
    // Other addresses are random, or were chosen by somebody.
    const bool isPermanent = collection.ReadValue(folder + "addr_assign_type") == "0";
    facts.Key("DeviceID", name)
        .Text("PermanentAddress", isPermanent ? collection.ReadValue(folder + "address") : std::string())
        .Text("OperationalState", collection.ReadValue(folder + "operstate"))
        .Text("Master", LastPart(collection.GetRoot().ReadLink(folder + "master")))
        .Text("Driver", LastPart(collection.GetRoot().ReadLink(folder + "device/driver")));
    if (const std::optional<std::uint64_t> bytes = NumberIn(collection.ReadValue(folder + "mtu"))) {
        facts.Number("MaximumTransmissionUnit", *bytes);
    }
    const std::optional<std::uint64_t> speed = NumberIn(collection.ReadValue(folder + "speed"));
    if (speed && *speed > 0 && *speed <= UINT32_MAX) {
        facts.Number("Speed", *speed * kMegabit);
    }
    if (const std::string duplex = collection.ReadValue(folder + "duplex"); duplex == "full" || duplex == "half") {
        facts.Flag("FullDuplex", duplex == "full");
    }
    const std::string flags = collection.ReadValue(folder + "flags");
    if (const std::optional<std::uint64_t> bits = StartsWith(flags, "0x") ? NumberIn(flags.substr(2), 16) : std::nullopt) {
        facts.Flag("Enabled", (*bits & kInterfaceIsUp) != 0);
    }
    collection.Add(facts);
}

void AddEndpoints(TCollection& collection, const std::string& protocol, const std::vector<TInterfaceAddress>& addresses)
{
    std::map<std::string, std::vector<std::string>> byAdapter;
    for (const TInterfaceAddress& address : addresses) {
        byAdapter[address.interface].push_back(address.address);
    }
    for (auto& [adapter, list] : byAdapter) {
        std::sort(list.begin(), list.end());
        collection.Add(TFacts("KALMO_IPEndpoint").Key("Adapter", adapter).Key("Protocol", protocol).Texts("Addresses", list));
    }
}

void AddRoutes(TCollection& collection, const std::vector<TRoute>& routes)
{
    struct TWays {
        std::vector<std::string> nextHops;
        bool isRefused = true;
    };
    std::map<std::tuple<std::string, std::string, std::uint32_t>, TWays> all;
    for (const TRoute& route : routes) {
        TWays& ways = all[{route.network, route.interface, route.metric}];
        ways.isRefused &= route.isRefused;
        if (!route.nextHop.empty()) {
            ways.nextHops.push_back(route.nextHop);
        }
    }
    for (auto& [key, ways] : all) {
        std::sort(ways.nextHops.begin(), ways.nextHops.end());
        collection.Add(TFacts("KALMO_Route")
                           .Key("DestinationAddress", std::get<0>(key))
                           .Key("Adapter", std::get<1>(key))
                           .Number("Metric", std::get<2>(key))
                           .Texts("NextHops", ways.nextHops)
                           .Flag("Refused", ways.isRefused));
    }
}

std::vector<TInterfaceAddress> AddressesOf(TCollection& collection)
{
    try {
        return collection.GetCalls().Addresses();
    } catch (const std::system_error& error) {
        collection.LeaveOut("IPv4 addresses", error.code().message());
        return {};
    }
}

template <class T>
std::vector<T> ReadTable(TCollection& collection, const std::string& path, std::vector<T> (*read)(std::string_view, TReadFaults&))
{
    // A kernel without IPv6 has no such tables.
    const std::optional<std::string> text = collection.ReadIfThere(path);
    TReadFaults faults;
    std::vector<T> rows = read(text.value_or(std::string()), faults);
    collection.LeaveOutLines(path, faults);
    return rows;
}

}  // namespace

void CollectNetwork(TCollection& collection)
{
    const std::string folder = "/sys/class/net";
    const std::vector<TFolderEntry> adapters = collection.GetRoot().List(folder);
    if (adapters.empty()) {
        collection.LeaveOut(folder, "found no adapter, expected one");
    }
    for (const TFolderEntry& adapter : adapters) {
        if (adapter.kind != TFolderEntry::EKind::kFile) {  // bonding_masters is one
            AddAdapter(collection, adapter.name);
        }
    }
    AddEndpoints(collection, "IPv4", AddressesOf(collection));
    AddEndpoints(collection, "IPv6", ReadTable(collection, "/proc/net/if_inet6", &ReadAddresses6));
    AddRoutes(collection, ReadTable(collection, "/proc/net/route", &ReadRoutes4));
    AddRoutes(collection, ReadTable(collection, "/proc/net/ipv6_route", &ReadRoutes6));
}

}  // namespace NORVZEL20
