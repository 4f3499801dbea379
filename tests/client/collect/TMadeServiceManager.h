#pragma once

#include <gtest/gtest.h>
#include <poll.h>
#include <sys/socket.h>
#include <sys/un.h>
#include <systemd/sd-bus.h>
#include <unistd.h>

#include <array>
#include <atomic>
#include <cstring>
#include <string>
#include <thread>
#include <vector>

#include "tests/client/TOutputFolder.h"

namespace NORVZEL20 {

/// Takes the place of a bus with systemd on it, for one visitor.
class TMadeServiceManager {
  public:
    using TRow = std::array<const char*, 5>;  ///< name, description, load state, active state, sub state

    explicit TMadeServiceManager(std::vector<TRow> units)
        : fUnits(std::move(units)), fSocket(socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0))
    {
        sockaddr_un place{};
        place.sun_family = AF_UNIX;
        std::strncpy(place.sun_path, (fFolder / "bus").c_str(), sizeof place.sun_path - 1);
        EXPECT_EQ(0, bind(fSocket, reinterpret_cast<const sockaddr*>(&place), sizeof place));
        EXPECT_EQ(0, listen(fSocket, 1));
        fThread = std::thread([this] { Serve(); });
    }
    ~TMadeServiceManager()
    {
        fDone = true;
        shutdown(fSocket, SHUT_RDWR);
        fThread.join();
        close(fSocket);
    }

    std::string GetAddress() const { return "unix:path=" + fFolder / "bus"; }

  private:
    void Serve()
    {
        const int visitor = accept(fSocket, nullptr, nullptr);
        sd_bus* bus = nullptr;
        sd_id128_t id{};
        id.bytes[0] = 1;
        if (visitor < 0 || sd_bus_new(&bus) < 0 || sd_bus_set_fd(bus, visitor, visitor) < 0 || sd_bus_set_server(bus, 1, id) < 0 ||
            sd_bus_add_filter(bus, nullptr, &Answer, this) < 0 || sd_bus_start(bus) < 0) {
            ADD_FAILURE() << "the made service manager cannot serve";
            return;
        }
        while (!fDone) {
            const int result = sd_bus_process(bus, nullptr);
            if (result < 0) {
                break;  // the visitor has gone
            }
            if (result == 0) {
                sd_bus_wait(bus, 10'000);
            }
        }
        sd_bus_close_unref(bus);
    }

    static int Answer(sd_bus_message* call, void* self, sd_bus_error* /*error*/)
    {
        if (sd_bus_message_is_method_call(call, "org.freedesktop.DBus", "Hello") > 0) {
            return sd_bus_reply_method_return(call, "s", ":1.1");
        }
        if (sd_bus_message_is_method_call(call, "org.freedesktop.systemd1.Manager", "ListUnits") > 0) {
            return static_cast<TMadeServiceManager*>(self)->ListUnits(call);
        }
        return 0;
    }

    int ListUnits(sd_bus_message* call) const
    {
        sd_bus_message* reply = nullptr;
        int result = sd_bus_message_new_method_return(call, &reply);
        result = result < 0 ? result : sd_bus_message_open_container(reply, 'a', "(ssssssouso)");
        for (const TRow& unit : fUnits) {
            result = result < 0 ? result
                                : sd_bus_message_append(reply, "(ssssssouso)", unit[0], unit[1], unit[2], unit[3], unit[4], "",
                                                        "/u", 0, "", "/");
        }
        result = result < 0 ? result : sd_bus_message_close_container(reply);
        result = result < 0 ? result : sd_bus_send(nullptr, reply, nullptr);
        sd_bus_message_unref(reply);
        return result < 0 ? result : 1;
    }

    const std::vector<TRow> fUnits;
    TOutputFolder fFolder;
    const int fSocket;
    std::atomic<bool> fDone{false};
    std::thread fThread;
};

}  // namespace NORVZEL20
