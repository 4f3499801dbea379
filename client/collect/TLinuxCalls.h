#pragma once

#include "client/collect/ISystemCalls.h"

namespace NORVZEL20 {

/// The calls of the running system.
class TLinuxCalls : public ISystemCalls {
  public:
    std::int64_t Now() override;
    std::chrono::steady_clock::time_point Tick() override;
    std::string Machine() override;
    std::string Release() override;
    std::vector<TInterfaceAddress> Addresses() override;
    std::optional<std::vector<TUnitState>> UnitStates(std::string& trouble) override;
};

}  // namespace NORVZEL20
