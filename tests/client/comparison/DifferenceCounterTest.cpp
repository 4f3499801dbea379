#include "client/comparison/TDifferenceCounter.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

TDifference Difference(TDifference::EKind kind, const std::string& instance)
{
    TDifference difference;
    difference.kind = kind;
    difference.className = "Disk";
    difference.instance = "Disk.Id=\"" + instance + "\"";
    difference.inventories = {1};
    return difference;
}

TEST(DifferenceCounter, CountsKindsAndInstances)
{
    TDifferenceCounter counter;
    EXPECT_EQ(0u, counter.GetCounts().GetTotal());
    counter.Add(Difference(TDifference::kOnlyInReference, "a"));
    TDifference several = Difference(TDifference::kOnlyInOthers, "b");
    several.sharing = {0, 3};
    counter.Add(several);
    counter.Add(Difference(TDifference::kOnlyInOthers, "c"));
    for (const char* const instance : {"d", "d", "e", "f", "f"}) {
        counter.Add(Difference(TDifference::kChanged, instance));
    }
    EXPECT_EQ(1u, counter.GetCounts().onlyInReference);
    EXPECT_EQ(2u, counter.GetCounts().onlyInOthers);
    EXPECT_EQ(4u, counter.GetCounts().instancesOnlyInOthers);
    EXPECT_EQ(5u, counter.GetCounts().changedValues);
    EXPECT_EQ(3u, counter.GetCounts().changedInstances);
}

}  // namespace
}  // namespace NORVZEL20
