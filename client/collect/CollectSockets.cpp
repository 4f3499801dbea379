// Sockets that wait for connections or packets, and the programs that have them.
//
// The kernel lists sockets with the number of their inode; the descriptors of a process are links that name the same number. Only
// root may look at the descriptors of others. A UDP socket with a port from the range of those that the kernel hands out is one
// that a program opened to ask something, not to serve, so it is left out.
#include <map>
#include <set>
#include <tuple>

#include "client/collect/CollectKinds.h"
#include "client/collect/read/ReadNetwork.h"
#include "client/collect/read/TextPieces.h"

namespace NORVZEL20 {

namespace {

using TProgramNames = std::map<std::uint64_t, std::set<std::string>>;  // by inode
constexpr std::uint64_t kNoInode = 0;                                  // the kernel's own socket, such as that of a tunnel

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

// What the kernel has if nobody sets it.
constexpr std::uint64_t kFirstHandedOut = 32768;
constexpr std::uint64_t kLastHandedOut = 60999;

std::pair<std::uint64_t, std::uint64_t> HandedOutPorts(const TCollection& collection)
{
    const std::string text = collection.ReadValue("/proc/sys/net/ipv4/ip_local_port_range");
    const std::vector<std::string_view> numbers = SplitAtBlanks(text);
    const std::optional<std::uint64_t> first = numbers.size() == 2 ? NumberIn(numbers[0]) : std::nullopt;
    const std::optional<std::uint64_t> last = numbers.size() == 2 ? NumberIn(numbers[1]) : std::nullopt;
    return {first.value_or(kFirstHandedOut), last.value_or(kLastHandedOut)};
}

std::vector<std::pair<std::string, TSocket>> ReadAllSockets(TCollection& collection)
{
    const std::pair<std::uint64_t, std::uint64_t> handedOut = HandedOutPorts(collection);
    std::vector<std::pair<std::string, TSocket>> sockets;
    for (const std::string protocol : {"tcp", "tcp6", "udp", "udp6"}) {
        const std::string path = "/proc/net/" + protocol;
        const std::optional<std::string> text = collection.ReadIfThere(path);
        TReadFaults faults;
        for (const TSocket& socket : ReadSockets(text.value_or(std::string()), faults)) {
            const bool isHandedOut = socket.port >= handedOut.first && socket.port <= handedOut.second;
            if (protocol[0] == 't' || !isHandedOut || socket.inode == kNoInode) {
                sockets.emplace_back(protocol, socket);
            }
        }
        collection.LeaveOutLines(path, faults);
    }
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
