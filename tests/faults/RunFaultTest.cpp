#include <gtest/gtest.h>

#include "tests/faults/TFaultyRun.h"

namespace NORVZEL20 {
namespace {

struct TCase {
    const char* name;
    std::size_t namespaces;
    bool excludesKeys;
};

/// Memory that runs out during a run.
class RunOutOfMemory : public testing::TestWithParam<TCase> {
  protected:
    std::string FailEach(const std::string& series, TFailingAllocator::EMode mode)
    {
        const TCase& param = GetParam();
        const TUntouchedRun expected = TFaultyRun::DoUntouched(param.namespaces, param.excludesKeys);
        EXPECT_FALSE(expected.records.empty());
        const auto make = [&] { return std::make_unique<TFaultyRun>(param.namespaces, param.excludesKeys, expected); };
        return FailEachAllocation(series + param.name, make, mode);
    }
};

TEST_P(RunOutOfMemory, OneFailedAllocationEndsItAndTheNextRunIsWhole)
{
    // Before the check of the operating systems, in it, up to the buffer for the specification, that buffer, all the rest.
    EXPECT_EQ("bad_alloc, status 3, bad_alloc, status 4, bad_alloc", FailEach("RunOnce", TFailingAllocator::EMode::kOnce));
}

TEST_P(RunOutOfMemory, ExhaustedMemoryEndsItAndTheNextRunIsWhole)
{
    // The check of the operating systems cannot even make its log entry.
    EXPECT_EQ("bad_alloc, status 4, bad_alloc", FailEach("RunFromThenOn", TFailingAllocator::EMode::kFromThenOn));
}

INSTANTIATE_TEST_SUITE_P(Faults, RunOutOfMemory,
                         testing::Values(TCase{"TwoNamespaces", 2, false}, TCase{"TwoNamespacesWithExcludedKeys", 2, true},
                                         TCase{"ThreeNamespaces", 3, false}, TCase{"ThreeNamespacesWithExcludedKeys", 3, true}),
                         [](const auto& test) { return std::string(test.param.name); });

TEST(DifferingNamespaces, AreRecordedInEveryWay)
{
    const TUntouchedRun run = TFaultyRun::DoUntouched(3, true);
    const std::vector<std::string> expected = {
        "class Disk",
        "1 Disk.Id=\"only in the reference, alas\"  {1, 2}",
        "tie",
        "2 Disk.Id=\"not in the reference, alas\"  {1, 2}",
        "tie",
        "4 Disk.Id=\"common\" Mirror {1, 2}",
        "tie",
        "4 Disk.Id=\"common\" Size {1, 2}",
        "tie",
        "4 Disk.Id=\"moved\" Mirror {1, 2}",
        "tie",
        "class Ssd",
        "4 Ssd.Id=\"solid\" Wear {1, 2}",
        "tie",
        "class Slot",
        "1 root/cimv2:Slot.BusOfTheEnclosure=\"a bus with a long name, number 0\",Number=10,ShelfOfTheEnclosure=0  {1, 2}",
        "tie",
        "2 Slot.Number=11  {1}",
        "tie",
        "2 Slot.Number=12  {2}",
        "tie",
        "4 Slot.Number=1 State {1, 2}",
        "tie",
        "4 Slot.Number=2 Peer {1, 2}",
        "tie",
    };
    EXPECT_EQ(expected, run.records);
    EXPECT_EQ(expected, run.secondRecords);
    EXPECT_NE("", run.aliases);
}

}  // namespace
}  // namespace NORVZEL20
