#include <gtest/gtest.h>

#include <boost/smart_ptr/weak_ptr.hpp>
#include <iostream>

#include "tests/faults/LeakCheck.h"
#include "tests/longrun/TSmallComparison.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

/// A wrapper and its delta namespace own each other. If rules exclude keys, runs make wrappers, and the delta namespace outlives
/// its last user.
class TRetainedWrappersFixture : public testing::Test {
  protected:
    using TWeak = boost::weak_ptr<TDeltaNamespace>;

    /// Runs once on a delta namespace and releases it.
    TWeak RunAndLetGo() const
    {
        const auto delta = fComparison.MakeDelta();
        delta->FindDifferences();
        return delta;
    }

    /// As RunAndLetGo. Returns by how many bytes the memory in use has grown.
    std::size_t MeasureRetained(TWeak& delta) const
    {
        const std::size_t before = GetLiveWithoutSpares().bytes;
        delta = RunAndLetGo();
        return GetLiveWithoutSpares().bytes - before;
    }

    static void BreakTheCycle(const TWeak& delta) { TTestAccess::ForgetWrappers(*delta.lock()); }

    const TSmallComparison fComparison{3, true};
};
using RetainedWrappers = TRetainedWrappersFixture;

TEST_F(RetainedWrappers, KeepTheirDeltaNamespaceAndOneForEachClassAndNamespace)
{
    const TWeak delta = RunAndLetGo();
    ASSERT_FALSE(delta.expired());
    for (const auto& wrappers : TTestAccess::ClassCache(*delta.lock())) {
        ASSERT_EQ(1u, wrappers.size());
        EXPECT_EQ("Slot", wrappers.begin()->first);
    }
    BreakTheCycle(delta);
    EXPECT_TRUE(delta.expired());
}

TEST_F(RetainedWrappers, RetainTheSameAmountWithEachDeltaNamespace)
{
    BreakTheCycle(RunAndLetGo());
    const std::size_t before = GetLiveWithoutSpares().bytes;
    std::vector<TWeak> deltas(10);
    const std::size_t whole = GetLiveWithoutSpares().bytes;
    const std::size_t retained = MeasureRetained(deltas[0]);
    EXPECT_GT(retained, 0u);
    for (std::size_t index = 1; index < deltas.size(); ++index) {
        EXPECT_EQ(retained, MeasureRetained(deltas[index]));
    }
    EXPECT_EQ(whole + deltas.size() * retained, GetLiveWithoutSpares().bytes);
    for (const TWeak& delta : deltas) {
        BreakTheCycle(delta);
    }
    deltas = std::vector<TWeak>();
    EXPECT_EQ(before, GetLiveWithoutSpares().bytes);
    std::cout << "rules that exclude keys: " << retained << " bytes stay with each delta namespace\n";
    RecordProperty("BytesRetained", std::to_string(retained));
}

TEST_F(RetainedWrappers, AnotherRunRetainsItsRecordsButNoMoreWrappers)
{
    const auto delta = fComparison.MakeDelta();
    delta->FindDifferences();
    const auto cache = TTestAccess::ClassCache(*delta);
    delta->FindDifferences();
    EXPECT_EQ(cache, TTestAccess::ClassCache(*delta));
    TTestAccess::ForgetWrappers(*delta);
}

}  // namespace
}  // namespace NORVZEL20
