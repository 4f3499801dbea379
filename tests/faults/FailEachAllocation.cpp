#include "tests/faults/FailEachAllocation.h"

#include <gtest/gtest.h>

#include <iostream>
#include <new>

#include "host/TZELException.h"
#include "tests/faults/LeakCheck.h"

namespace NORVZEL20 {

namespace {

using TMake = std::function<std::unique_ptr<IFaultyAction>()>;

struct TAttempt {
    bool hasFailed = false;
    std::string outcome;
};

/// Runs the action; its `number`-th allocation fails (0: none does).
TAttempt Attempt(const TMake& make, std::size_t number, TFailingAllocator::EMode mode)
{
    const auto action = make();
    IFaultyAction& acting = *action;
    const std::function<void()> act = [&acting] { acting.Act(); };
    TFailingAllocator::Fail(number, mode);
    const std::string outcome = OutcomeOf(act);
    TFailingAllocator::Stop();
    const bool hasFailed = TFailingAllocator::HasFailed();
    action->Verify(outcome);
    return {hasFailed, outcome};
}

void WarmUp(const TMake& make, const std::string& untouched)
{
    for (int i = 0; i < 2; ++i) {
        const TAttempt attempt = Attempt(make, 0, TFailingAllocator::EMode::kOnce);
        EXPECT_EQ(untouched, attempt.outcome);
    }
}

}  // namespace

std::string OutcomeOf(const std::function<void()>& call)
{
    try {
        call();
    } catch (const std::bad_alloc&) {
        TFailingAllocator::Stop();
        return "bad_alloc";
    } catch (const TZELException& error) {
        TFailingAllocator::Stop();
        return "status " + std::to_string(error.GetStatusCode().GetStatus());
    } catch (const std::exception& error) {
        TFailingAllocator::Stop();
        ADD_FAILURE() << error.what();
        return "another exception";
    }
    TFailingAllocator::Stop();
    return "";
}

std::string FailEachAllocation(const std::string& name, const TMake& make, TFailingAllocator::EMode mode,
                               const std::string& untouched)
{
    WarmUp(make, untouched);
    std::string outcomes;
    std::string last = "none yet";
    std::size_t number = 1;
    while (!testing::Test::HasFailure()) {
        SCOPED_TRACE(name + ": allocation " + std::to_string(number));
        TAttempt attempt;
        ExpectNothingLeft([&] { attempt = Attempt(make, number, mode); });
        if (!attempt.hasFailed) {
            EXPECT_EQ(untouched, attempt.outcome);
            break;
        }
        if (attempt.outcome != last) {
            last = attempt.outcome;
            outcomes += (number == 1 ? "" : ", ") + last;
        }
        ++number;
    }
    EXPECT_GT(number, 1u);
    std::cout << name << ": " << number - 1 << " allocations failed\n";
    testing::Test::RecordProperty(name, std::to_string(number - 1));
    return outcomes;
}

}  // namespace NORVZEL20
