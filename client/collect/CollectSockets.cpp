// Sockets that wait for connections or packets, and the programs that have them.
//
// The kernel lists sockets with the number of their inode; the descriptors of a process are links that name the same number. Only
// root may look at the descriptors of others.
//
// The kernel hands out ports of a range to programs that ask for any port, so a port of that range may be another one after each
// start. It also may be configured, as those of tunnels and databases often are. A socket in the range is taken for configured if
//
// - it is bound to one address, not to all of them,
// - its port is open by IPv4 and by IPv6, which no chance does,
// - its port is one that the kernel was told not to hand out, or
// - the kernel itself has it.
//
// The others are left out, and the inventory says so.
#include <algorithm>
#include <map>
#include <set>
#include <tuple>

#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadNetwork.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

using TProgramNames = std::map<std::uint64_t, std::set<std::string>>;  // by inode
constexpr std::uint64_t kNoInode = 0;                                  // the kernel's own socket, such as that of a tunnel

// What the kernel has if nobody sets it.
constexpr std::uint64_t kFirstHandedOut = 32768;
constexpr std::uint64_t kLastHandedOut = 60999;

using TSocketKey = std::tuple<std::string, std::string, std::uint16_t>;

struct TSocketUsers {
    std::set<std::string> programs;
    std::string userId;
    bool isKnown = true;
};

// The inode of "socket:[12345]".
std::optional<std::uint64_t> InodeIn(const std::string& link)
{
    const std::string begin = "socket:[";
    return StartsWith(link, begin) && EndsWith(link, "]")
               ? NumberIn(std::string_view(link).substr(begin.size(), link.size() - begin.size() - 1))
               : std::nullopt;
}

// Fills in the names of the programs that have the sockets of `programs`.
void FindPrograms(TCollection& collection, TProgramNames& programs)
{
    const TSystemRoot& root = collection.GetRoot();
    for (const TFolderEntry& process : root.List("/proc")) {
        if (process.name.find_first_not_of("0123456789") != std::string::npos) {
            continue;
        }
        collection.CheckTime();
        const std::string folder = "/proc/" + process.name;
        for (const TFolderEntry& descriptor : root.List(folder + "/fd")) {
            const std::optional<std::uint64_t> inode =
                InodeIn(root.ReadLink(folder + "/fd/" + descriptor.name).value_or(std::string()));
            const auto found = inode ? programs.find(*inode) : programs.end();
            if (found != programs.end()) {
                found->second.insert(collection.ReadValue(folder + "/comm"));
            }
        }
    }
}

// Which ports the kernel hands out.
class THandedOutPorts {
  public:
    explicit THandedOutPorts(const TCollection& collection)
    {
        const std::string range = collection.ReadValue("/proc/sys/net/ipv4/ip_local_port_range");
        const std::vector<std::string_view> numbers = SplitAtBlanks(range);
        if (numbers.size() == 2) {
            fFirst = NumberIn(numbers[0]).value_or(kFirstHandedOut);
            fLast = NumberIn(numbers[1]).value_or(kLastHandedOut);
        }
        const std::string reserved = collection.ReadValue("/proc/sys/net/ipv4/ip_local_reserved_ports");
        for (const std::string_view part : SplitAt(reserved, ',')) {
            const std::size_t dash = part.find('-');
            const std::uint64_t first = NumberIn(part.substr(0, dash)).value_or(0);
            fReserved.emplace_back(first, dash == std::string_view::npos ? first : NumberIn(part.substr(dash + 1)).value_or(first));
        }
    }

    bool Has(std::uint64_t port) const
    {
        return port >= fFirst && port <= fLast && std::none_of(fReserved.begin(), fReserved.end(), [port](const auto& range) {
                   return port >= range.first && port <= range.second;
               });
    }

    std::string GetText() const { return std::to_string(fFirst) + " to " + std::to_string(fLast); }

  private:
    std::uint64_t fFirst = kFirstHandedOut;
    std::uint64_t fLast = kLastHandedOut;
    std::vector<std::pair<std::uint64_t, std::uint64_t>> fReserved;  // first and last
};

// Leaves out the sockets whose ports may be chance.
void DropChance(TCollection& collection, std::vector<std::pair<std::string, TSocket>>& sockets)
{
    const THandedOutPorts handedOut(collection);
    std::set<std::pair<std::string, std::uint16_t>> open;
    for (const auto& [protocol, socket] : sockets) {
        open.emplace(protocol, socket.port);
    }
    const auto isChance = [&](const std::pair<std::string, TSocket>& entry) {
        const auto& [protocol, socket] = entry;
        const std::string other = EndsWith(protocol, "6") ? protocol.substr(0, protocol.size() - 1) : protocol + "6";
        return handedOut.Has(socket.port) && socket.inode != kNoInode && (socket.address == "0.0.0.0" || socket.address == "::") &&
               open.count({other, socket.port}) == 0;
    };
    const auto end = std::remove_if(sockets.begin(), sockets.end(), isChance);
    if (end != sockets.end()) {
        collection.LeaveOut("sockets of all addresses with ports from " + handedOut.GetText(),
                            "the kernel hands out these ports, so they may differ after each start");
        sockets.erase(end, sockets.end());
    }
}

std::vector<std::pair<std::string, TSocket>> ReadAllSockets(TCollection& collection)
{
    std::vector<std::pair<std::string, TSocket>> sockets;
    for (const std::string protocol : {"tcp", "tcp6", "udp", "udp6"}) {
        const std::string path = "/proc/net/" + protocol;
        const std::optional<std::string> text = collection.ReadIfThere(path);
        TReadFaults faults;
        for (const TSocket& socket : ReadSockets(text.value_or(std::string()), faults)) {
            sockets.emplace_back(protocol, socket);
        }
        collection.LeaveOutLines(path, faults);
    }
    DropChance(collection, sockets);
    return sockets;
}

}  // namespace

void CollectSockets(TCollection& collection)
{
    const std::vector<std::pair<std::string, TSocket>> sockets = ReadAllSockets(collection);
    if (!collection.GetRoot().Look("/proc/net/tcp")) {
        collection.LeaveOut("/proc/net", "it lists no sockets");
    }
    TProgramNames programs;
    for (const auto& [protocol, socket] : sockets) {
        programs[socket.inode];
    }
    FindPrograms(collection, programs);
    // Several sockets may share an address and a port.
    std::map<TSocketKey, TSocketUsers> users;
    for (const auto& [protocol, socket] : sockets) {
        TSocketUsers& user = users[{protocol, socket.address, socket.port}];
        const std::set<std::string>& names = programs[socket.inode];
        user.programs.insert(names.begin(), names.end());
        user.userId = socket.userId;
        user.isKnown &= !names.empty() || socket.inode == kNoInode;
    }
    for (const auto& [key, user] : users) {
        TFacts facts("KALMO_ListeningSocket");
        facts.Key("Protocol", std::get<0>(key))
            .Key("Address", std::get<1>(key))
            .Number("Port", std::get<2>(key))
            .Text("UserID", user.userId);
        if (user.isKnown) {
            facts.Texts("Programs", {user.programs.begin(), user.programs.end()});
        } else {
            collection.LeaveOut(std::get<0>(key) + " " + std::get<1>(key) + " port " + std::to_string(std::get<2>(key)),
                                "its program cannot be known, or only root may know it");
        }
        collection.Add(facts);
    }
}

}  // namespace NORVZEL20
