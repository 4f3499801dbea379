#pragma once

#include <gtest/gtest.h>

#include <functional>
#include <string>

#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// A delta namespace over three compared ones of the plain host, everything watched. Each holds Base (key Id) > Sub.
///
/// Nothing but a run writes to the core log, whatever the status it fails with: each test ends with a look at it.
class TDeltaFixture : public testing::Test {
  protected:
    TDeltaFixture();

    void TearDown() override { EXPECT_EQ("", fLog.Take()); }

    /// A call context with that "nsIndex".
    static TCallContext At(unsigned short index);

    TCallWatch& Watch() { return fComparison.GetWatch(); }
    TDeltaNamespace& Delta() { return fComparison.Delta(); }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
};

/// The status that the call throws, or 0 where it throws nothing.
int StatusOf(const std::function<void()>& call);
/// Whether the call fails the host's assertion "px != 0".
bool FailsOnNull(const std::function<void()>& call);

}  // namespace NORVZEL20
