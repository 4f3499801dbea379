#pragma once

#include <chrono>
#include <cstdint>
#include <optional>
#include <string>
#include <vector>

#include "client/collect/TUnitState.h"
#include "client/collect/read/TInterfaceAddress.h"

namespace NORVZEL20 {

/// What is known of a running system beside its files. Tests replace it.
class ISystemCalls {
  public:
    virtual ~ISystemCalls() = default;

    /// Seconds since 1970-01-01 00:00 UTC.
    virtual std::int64_t Now() = 0;
    /// A clock that never goes back, for the limit on time.
    virtual std::chrono::steady_clock::time_point Tick() = 0;
    /// What the kernel calls the machine, such as x86_64.
    virtual std::string Machine() = 0;
    /// The release of the kernel, such as 6.1.0-25-amd64.
    virtual std::string Release() = 0;
    /// The IPv4 addresses of all interfaces. Errors: std::system_error.
    virtual std::vector<TInterfaceAddress> Addresses() = 0;
    /// The units that the service manager has loaded; nothing, with the reason in `trouble`, if it cannot be asked.
    virtual std::optional<std::vector<TUnitState>> UnitStates(std::string& trouble) = 0;
};

}  // namespace NORVZEL20
