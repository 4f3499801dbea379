#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// What the file of a systemd unit says, as far as an inventory needs it.
struct TUnitFile {
    std::string description;
    std::string type;         ///< of a service: simple, oneshot, dbus ...
    bool hasBusName = false;  ///< of a service: it has a name on the bus; then the type is dbus unless the file says another
    std::string activated;    ///< the unit that a timer, path or socket starts, if the file names one
    std::vector<std::string> schedules;  ///< of a timer: OnCalendar=daily
    std::vector<std::string> aliases;    ///< other names by which it may be enabled
    std::string defaultInstance;         ///< of a template: "tty1"
    bool isInstalled = false;            ///< the file says by which units it may be enabled
    bool isInstalledByOthers = false;    ///< the file names others that are enabled in its place
};

}  // namespace NORVZEL20
