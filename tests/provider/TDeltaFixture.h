#pragma once

#include <gtest/gtest.h>

#include <functional>

#include "tests/support/StatusOf.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {

/// A delta namespace over three compared namespaces of the plain host, all watched. Each namespace has Base (key Id) > Sub.
///
/// Only a run writes to the core log, so each test ends with a check that the log is empty.
class TDeltaFixture : public testing::Test {
  protected:
    TDeltaFixture();

    void TearDown() override { EXPECT_EQ("", fLog.Take()); }

    /// A call context with this value of "nsIndex".
    static TCallContext At(unsigned short index);

    TCallWatch& Watch() { return fComparison.GetWatch(); }
    TDeltaNamespace& Delta() { return fComparison.Delta(); }

    TCapturingLogger fLog;
    TComparisonRun fComparison;
};

/// Whether the call fails the host's assertion "px != 0".
bool FailsOnNull(const std::function<void()>& call);

}  // namespace NORVZEL20
