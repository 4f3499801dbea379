#pragma once

#include <functional>
#include <memory>
#include <string>

#include "tests/faults/TFailingAllocator.h"

namespace NORVZEL20 {

/// Something to be done while memory runs out, made anew for each allocation that fails.
class IFaultyAction {
  public:
    virtual ~IFaultyAction() = default;
    /// What is done. Nothing else is made to fail.
    virtual void Act() = 0;
    /// Checks what Act left, and that what follows works. `outcome` is as OutcomeOf tells it.
    virtual void Verify(const std::string& outcome) = 0;
};

/// How a call ended: "" for a return, "bad_alloc", "status 37" for a TZELException, "another exception".
std::string OutcomeOf(const std::function<void()>& call);

/// Does the action again and again with the first, second, ... allocation failing, until it passes untouched; after each it
/// verifies, and checks that nothing is left. Untouched, it must come to `untouched`.
///
/// Returns the outcomes, equal ones in a row once: "bad_alloc, status 4, bad_alloc". A failure that goes unnoticed is "". The
/// number of allocations that failed is printed and recorded under `name`.
std::string FailEachAllocation(const std::string& name, const std::function<std::unique_ptr<IFaultyAction>()>& make,
                               TFailingAllocator::EMode mode = TFailingAllocator::EMode::kOnce, const std::string& untouched = "");

}  // namespace NORVZEL20
