#pragma once

#include <functional>
#include <memory>
#include <string>

#include "tests/faults/TFailingAllocator.h"

namespace NORVZEL20 {

/// Something to do while memory runs out. Each allocation that fails gets a new object.
class IFaultyAction {
  public:
    virtual ~IFaultyAction() = default;
    /// Does it. Only allocations in here fail.
    virtual void Act() = 0;
    /// Checks what Act left behind, and that later calls work. `outcome` is what OutcomeOf returned for Act.
    virtual void Verify(const std::string& outcome) = 0;
};

/// How a call ended: "" for a return, "bad_alloc", "status 37" for a TZELException with kSchemaMismatch (37), "another exception".
std::string OutcomeOf(const std::function<void()>& call);

/// Repeats the action with the first, second, ... allocation failing, until a run makes fewer allocations than that. Verifies after
/// each run, and checks that no memory and no file is left. The last run must end with the outcome `untouched`.
///
/// Returns the outcomes in order, equal neighbours once: "bad_alloc, status 4, bad_alloc". A failure that nobody noticed is "".
/// Prints how many allocations failed and records it under `name`.
std::string FailEachAllocation(const std::string& name, const std::function<std::unique_ptr<IFaultyAction>()>& make,
                               TFailingAllocator::EMode mode = TFailingAllocator::EMode::kOnce, const std::string& untouched = "");

}  // namespace NORVZEL20
