// The kernel's tables of the network. Addresses are in hexadecimal digits: one number of 32 bits (IPv4) or four (IPv6), each in the
// byte order of the machine, except in the tables ipv6_route and if_inet6, where the bytes stand in their order.
//
//   route        interface destination gateway flags references use metric mask ...
//   ipv6_route   destination length source length gateway metric references use flags interface
//   if_inet6     address interface-number length scope flags interface
//   tcp, udp     number: address:port peer:port state queues timer retransmissions user timeout inode ...
#include "client/collect/read/ReadNetwork.h"

#include <arpa/inet.h>

#include <algorithm>
#include <array>

#include "client/collect/read/TTextLines.h"
#include "client/collect/read/TextPieces.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

constexpr std::size_t kDigits4 = 8;
constexpr std::size_t kDigits6 = 32;
constexpr std::uint64_t kAddressBits6 = 128;
constexpr std::string_view kMulticast6 = "ff";

constexpr std::string_view kNoInterface = "*";  // of IPv4; of IPv6 it is lo
constexpr std::uint64_t kRouteIsUp = 0x1;
constexpr std::uint64_t kRouteRefuses = 0x200;
constexpr std::uint64_t kRouteIsCached = 0x01000000;
constexpr std::uint64_t kRouteIsLocal = 0x80000000;

constexpr std::uint64_t kTemporaryAddress = 0x01;
constexpr std::uint64_t kScopeLink = 0x20;

std::string AddressText(int family, const void* bytes)
{
    char text[INET6_ADDRSTRLEN];
    return inet_ntop(family, bytes, text, sizeof text) == nullptr ? std::string() : text;
}

// An address of numbers in the byte order of this machine; empty if it is none.
std::string AddressOfNumbers(std::string_view digits)
{
    std::array<std::uint32_t, 4> numbers{};
    if (digits.size() != kDigits4 && digits.size() != kDigits6) {
        return std::string();
    }
    for (std::size_t i = 0; i * kDigits4 < digits.size(); ++i) {
        const std::optional<std::uint64_t> number = NumberIn(digits.substr(i * kDigits4, kDigits4), 16);
        if (!number) {
            return std::string();
        }
        numbers[i] = static_cast<std::uint32_t>(*number);
    }
    return AddressText(digits.size() == kDigits4 ? AF_INET : AF_INET6, numbers.data());
}

// An IPv6 address of bytes in their order; empty if it is none.
std::string AddressOfBytes(std::string_view digits)
{
    std::array<unsigned char, kDigits6 / 2> bytes{};
    if (digits.size() != kDigits6) {
        return std::string();
    }
    for (std::size_t i = 0; i < bytes.size(); ++i) {
        const std::optional<std::uint64_t> byte = NumberIn(digits.substr(2 * i, 2), 16);
        if (!byte) {
            return std::string();
        }
        bytes[i] = static_cast<unsigned char>(*byte);
    }
    return AddressText(AF_INET6, bytes.data());
}

std::size_t BitsOf(std::uint64_t number)
{
    std::size_t count = 0;
    for (; number != 0; number &= number - 1) {
        ++count;
    }
    return count;
}

// A row of a table. What is missing in it, or is not as expected, makes it a bad one.
class TTableRow {
  public:
    TTableRow(std::string_view line, std::size_t fewest)
        : fLine(line), fFields(SplitAtBlanks(line)), fIsGood(fFields.size() >= fewest)
    {
        fFields.resize(std::max(fewest, fFields.size()));
    }

    std::string_view Field(std::size_t index) const { return fFields[index]; }

    std::uint64_t Number(std::string_view text, std::uint64_t most, int base = 16)
    {
        const std::uint64_t number = NumberIn(text, base).value_or(UINT64_MAX);
        fIsGood &= number <= most;
        return fIsGood ? number : 0;
    }

    std::string Address(std::string_view digits, std::string (*read)(std::string_view))
    {
        std::string address = read(digits);
        fIsGood &= !address.empty();
        return address;
    }

    // Notes a bad row.
    bool IsGood(std::size_t line, const char* expected, TReadFaults& faults) const
    {
        if (!fIsGood) {
            faults.Add(line, "found " + Quoted(Trimmed(fLine)) + ", expected " + expected);
        }
        return fIsGood;
    }

  private:
    std::string_view fLine;
    std::vector<std::string_view> fFields;
    bool fIsGood;
};

std::string UnlessZero(const std::string& address)
{
    return address == "0.0.0.0" || address == "::" ? std::string() : address;
}

// The table of IPv6 ends with a route that refuses everything and is no setting. Routes that refuse are not "up" there.
bool IsSet(std::uint64_t flags, std::uint64_t metric)
{
    return (flags & kRouteRefuses) != 0 ? metric != UINT32_MAX : (flags & kRouteIsUp) != 0;
}

}  // namespace

std::vector<TRoute> ReadRoutes4(std::string_view text, TReadFaults& faults)
{
    std::vector<TRoute> routes;
    TTextLines lines(text);
    lines.Next();  // the heading
    while (lines.Next()) {
        TTableRow row(lines.GetLine(), 8);
        const std::string network = row.Address(row.Field(1), &AddressOfNumbers);
        const std::string gateway = row.Address(row.Field(2), &AddressOfNumbers);
        const std::uint64_t flags = row.Number(row.Field(3), UINT32_MAX);
        const std::uint64_t metric = row.Number(row.Field(6), UINT32_MAX, 10);
        const std::uint64_t mask = row.Number(row.Field(7), UINT32_MAX);
        if (row.IsGood(lines.GetNumber(), "a route", faults) && (flags & kRouteIsUp) != 0) {
            routes.push_back({network + "/" + std::to_string(BitsOf(mask)), std::string(row.Field(0)),
                              static_cast<std::uint32_t>(metric), UnlessZero(gateway),
                              (flags & kRouteRefuses) != 0 || row.Field(0) == kNoInterface});
        }
    }
    return routes;
}

std::vector<TRoute> ReadRoutes6(std::string_view text, TReadFaults& faults)
{
    constexpr std::uint64_t kNotForOthers = kRouteIsCached | kRouteIsLocal;
    std::vector<TRoute> routes;
    TTextLines lines(text);
    while (lines.Next()) {
        TTableRow row(lines.GetLine(), 10);
        const std::string network = row.Address(row.Field(0), &AddressOfBytes);
        const std::uint64_t length = row.Number(row.Field(1), kAddressBits6);
        const std::string gateway = row.Address(row.Field(4), &AddressOfBytes);
        const std::uint64_t metric = row.Number(row.Field(5), UINT32_MAX);
        const std::uint64_t flags = row.Number(row.Field(8), UINT32_MAX);
        if (row.IsGood(lines.GetNumber(), "a route", faults) && (flags & kNotForOthers) == 0 &&
            !StartsWith(row.Field(0), kMulticast6) && IsSet(flags, metric)) {
            routes.push_back({network + "/" + std::to_string(length), std::string(row.Field(9)), static_cast<std::uint32_t>(metric),
                              UnlessZero(gateway), (flags & kRouteRefuses) != 0});
        }
    }
    return routes;
}

std::vector<TInterfaceAddress> ReadAddresses6(std::string_view text, TReadFaults& faults)
{
    std::vector<TInterfaceAddress> addresses;
    TTextLines lines(text);
    while (lines.Next()) {
        TTableRow row(lines.GetLine(), 6);
        const std::string address = row.Address(row.Field(0), &AddressOfBytes);
        const std::uint64_t length = row.Number(row.Field(2), kAddressBits6);
        const std::uint64_t scope = row.Number(row.Field(3), UINT32_MAX);
        const std::uint64_t flags = row.Number(row.Field(4), UINT32_MAX);
        if (row.IsGood(lines.GetNumber(), "an address", faults) && scope != kScopeLink && (flags & kTemporaryAddress) == 0) {
            addresses.push_back({std::string(row.Field(5)), address + "/" + std::to_string(length)});
        }
    }
    return addresses;
}

std::vector<TSocket> ReadSockets(std::string_view text, TReadFaults& faults)
{
    constexpr std::string_view kListening = "0A";  // of TCP
    constexpr std::string_view kNoPeer = "07";     // of UDP
    std::vector<TSocket> sockets;
    TTextLines lines(text);
    lines.Next();  // the heading
    while (lines.Next()) {
        TTableRow row(lines.GetLine(), 10);
        const std::string_view place = row.Field(1);
        const std::size_t colon = std::min(place.find(':'), place.size());
        const std::string address = row.Address(place.substr(0, colon), &AddressOfNumbers);
        const std::uint64_t port = row.Number(place.substr(std::min(colon + 1, place.size())), UINT16_MAX);
        const std::uint64_t inode = row.Number(row.Field(9), UINT64_MAX - 1, 10);
        if (row.IsGood(lines.GetNumber(), "a socket", faults) && (row.Field(3) == kListening || row.Field(3) == kNoPeer)) {
            sockets.push_back({address, static_cast<std::uint16_t>(port), std::string(row.Field(7)), inode});
        }
    }
    return sockets;
}

}  // namespace NORVZEL20
