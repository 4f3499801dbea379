#pragma once

#include <system_error>

#include "client/collect/ISystemCalls.h"

namespace NORVZEL20 {

/// The calls of a system that a test makes.
class TMadeCalls : public ISystemCalls {
  public:
    std::int64_t Now() override { return fNow; }
    std::chrono::steady_clock::time_point Tick() override { return fTick += fTickLength; }
    std::string Machine() override { return "x86_64"; }
    std::string Release() override { return "6.1.0-25-amd64"; }
    std::vector<TInterfaceAddress> Addresses() override
    {
        if (fHasNoAddresses) {
            throw std::system_error(EPERM, std::generic_category());
        }
        return fAddresses;
    }
    std::optional<std::vector<TUnitState>> UnitStates(std::string& trouble) override
    {
        trouble = fUnits ? "" : "the service manager does not answer";
        return fUnits;
    }

    std::int64_t fNow = 1'800'000'000;
    std::chrono::steady_clock::time_point fTick{};
    std::chrono::steady_clock::duration fTickLength{};  ///< how far the clock goes each time that somebody looks
    bool fHasNoAddresses = false;
    std::vector<TInterfaceAddress> fAddresses;
    std::optional<std::vector<TUnitState>> fUnits;
};

}  // namespace NORVZEL20
