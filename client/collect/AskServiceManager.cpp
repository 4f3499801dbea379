// Asking systemd over D-Bus: one call, ListUnits, which everybody may make. Its answer is an array of structures of ten:
//
//   name | description | load state | active state | sub state | unit that it follows | object | number, type and object of a job
//
// The system's bus leads to systemd. Where no bus runs, systemd itself answers root at a socket of its own.
#include "client/collect/AskServiceManager.h"

#include <systemd/sd-bus.h>
#include <unistd.h>

#include <memory>
#include <system_error>

namespace NORVZEL20 {

namespace {

constexpr std::uint64_t kMicrosecondsToWait = 5'000'000;  // for each answer
constexpr std::size_t kMostUnits = 50'000;
constexpr char kOwnSocket[] = "unix:path=/run/systemd/private";

struct TCloseBus {
    void operator()(sd_bus* bus) const { sd_bus_close_unref(bus); }
};
struct TEndMessage {
    void operator()(sd_bus_message* message) const { sd_bus_message_unref(message); }
};
using TBus = std::unique_ptr<sd_bus, TCloseBus>;
using TMessage = std::unique_ptr<sd_bus_message, TEndMessage>;

// `isBus` says whether a bus is at the address, rather than systemd itself. Null, with the error, if nothing is.
TBus OpenBus(const char* address, bool isBus, int& error)
{
    sd_bus* opened = nullptr;
    if ((error = sd_bus_new(&opened)) < 0) {
        return nullptr;
    }
    TBus bus(opened);
    if ((error = sd_bus_set_address(opened, address)) < 0 || (error = sd_bus_set_bus_client(opened, isBus ? 1 : 0)) < 0 ||
        (error = sd_bus_set_method_call_timeout(opened, kMicrosecondsToWait)) < 0 || (error = sd_bus_start(opened)) < 0) {
        return nullptr;
    }
    return bus;
}

TBus OpenSystemBus(int& error)
{
    sd_bus* opened = nullptr;
    error = sd_bus_open_system(&opened);
    TBus bus(error < 0 ? nullptr : opened);
    if (bus) {
        sd_bus_set_method_call_timeout(bus.get(), kMicrosecondsToWait);
        return bus;
    }
    return geteuid() == 0 ? OpenBus(kOwnSocket, false, error) : nullptr;
}

// Returns a negative error, or 0 at the end of the list.
int ReadUnits(sd_bus_message* reply, std::vector<TUnitState>& units)
{
    int result = sd_bus_message_enter_container(reply, 'a', "(ssssssouso)");
    while (result >= 0) {
        const char* texts[7] = {};
        const char* jobType = nullptr;
        const char* job = nullptr;
        std::uint32_t jobNumber = 0;
        result = sd_bus_message_read(reply, "(ssssssouso)", &texts[0], &texts[1], &texts[2], &texts[3], &texts[4], &texts[5],
                                     &texts[6], &jobNumber, &jobType, &job);
        if (result == 0 || units.size() == kMostUnits) {
            return 0;
        }
        if (result > 0 && std::string(texts[2]) != "not-found") {
            units.push_back({texts[0], texts[1], texts[3], texts[4]});
        }
    }
    return result;
}

}  // namespace

std::optional<std::vector<TUnitState>> AskServiceManager(const std::string& address, std::string& trouble)
{
    int error = 0;
    const TBus bus = address.empty() ? OpenSystemBus(error) : OpenBus(address.c_str(), true, error);
    sd_bus_message* answer = nullptr;
    if (bus) {
        error = sd_bus_call_method(bus.get(), "org.freedesktop.systemd1", "/org/freedesktop/systemd1",
                                   "org.freedesktop.systemd1.Manager", "ListUnits", nullptr, &answer, nullptr);
    }
    const TMessage reply(answer);
    std::vector<TUnitState> units;
    if (error >= 0) {
        error = ReadUnits(reply.get(), units);
    }
    if (error < 0) {
        trouble = "systemd does not answer: " + std::generic_category().message(-error);
        return std::nullopt;
    }
    return units;
}

}  // namespace NORVZEL20
