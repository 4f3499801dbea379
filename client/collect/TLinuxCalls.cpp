#include "client/collect/TLinuxCalls.h"

#include <arpa/inet.h>
#include <ifaddrs.h>
#include <netinet/in.h>
#include <sys/utsname.h>

#include <bitset>
#include <ctime>
#include <memory>

#include "client/collect/AskServiceManager.h"
#include "client/process/SystemError.h"

namespace NORVZEL20 {

std::int64_t TLinuxCalls::Now()
{
    return std::time(nullptr);
}

std::chrono::steady_clock::time_point TLinuxCalls::Tick()
{
    return std::chrono::steady_clock::now();
}

std::string TLinuxCalls::Machine()
{
    struct utsname names;
    return uname(&names) == 0 ? names.machine : std::string();
}

std::string TLinuxCalls::Release()
{
    struct utsname names;
    return uname(&names) == 0 ? names.release : std::string();
}

std::vector<TInterfaceAddress> TLinuxCalls::Addresses()
{
    ifaddrs* list = nullptr;
    ThrowIfFailed(getifaddrs(&list));
    const std::unique_ptr<ifaddrs, void (*)(ifaddrs*)> owner(list, &freeifaddrs);
    std::vector<TInterfaceAddress> addresses;
    for (const ifaddrs* entry = list; entry != nullptr; entry = entry->ifa_next) {
        if (entry->ifa_addr == nullptr || entry->ifa_netmask == nullptr || entry->ifa_addr->sa_family != AF_INET) {
            continue;
        }
        char text[INET_ADDRSTRLEN];
        const auto* const address = reinterpret_cast<const sockaddr_in*>(entry->ifa_addr);
        const auto* const mask = reinterpret_cast<const sockaddr_in*>(entry->ifa_netmask);
        if (inet_ntop(AF_INET, &address->sin_addr, text, sizeof text) != nullptr) {
            const std::size_t length = std::bitset<32>(mask->sin_addr.s_addr).count();
            addresses.push_back({entry->ifa_name, std::string(text) + "/" + std::to_string(length)});
        }
    }
    return addresses;
}

std::optional<std::vector<TUnitState>> TLinuxCalls::UnitStates(std::string& trouble)
{
    return AskServiceManager(std::string(), trouble);
}

}  // namespace NORVZEL20
