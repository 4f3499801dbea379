// A whole run when memory runs out, once for each allocation that it makes. A failed run leaves the records that it had written, no
// more and no fewer, and the next run is complete (TFaultyRun).

#include <gtest/gtest.h>

#include <numeric>

#include "tests/faults/TFaultyRun.h"

namespace NORVZEL20 {
namespace {

using EMode = TFailingAllocator::EMode;

std::vector<std::size_t> NumbersUpTo(std::size_t last)
{
    std::vector<std::size_t> numbers(last + 1);
    std::iota(numbers.begin(), numbers.end(), 0);
    return numbers;
}

/// Runs out of memory during a run.
class TRunOutOfMemoryFixture : public testing::TestWithParam<TDiffering> {
  protected:
    /// Returns the outcomes. Checks that runs left every number of records, from none to all.
    std::string FailEach(EMode mode)
    {
        const TDiffering& differing = GetParam();
        const TUntouchedRun expected = RunUntouched(differing);
        EXPECT_EQ(differing.flaw == EFlaw::kUnknownProperty, expected.records.empty());
        std::vector<std::size_t> left;
        left.reserve(expected.records.size() + 1);
        const auto make = [&] { return std::make_unique<TFaultyRun>(differing, expected, left); };
        const std::string series = mode == EMode::kOnce ? "RunOnce" : "RunFromThenOn";
        const std::string outcomes = FailEachAllocation(series + differing.GetName(), make, mode, expected.outcome);
        EXPECT_EQ(NumbersUpTo(expected.records.size()), left);
        return outcomes;
    }
};
using RunOutOfMemory = TRunOutOfMemoryFixture;

// Before the check of the operating systems; in it; up to the buffer for the specification; that buffer; all the rest.
const char kOutcomes[] = "bad_alloc, status 3, bad_alloc, status 4, bad_alloc";

/// The embedded host names the property that an instance lacks. If there is no memory for that text, its refusal is still the
/// refusal, with its status.
std::string OutcomesOf(const TDiffering& differing)
{
    const bool isNamed = differing.host == EHost::kInmem && differing.flaw == EFlaw::kNoUplinkOfSlots;
    return isNamed ? std::string(kOutcomes) + ", status 15" : kOutcomes;
}

TEST_P(RunOutOfMemory, OneFailedAllocationEndsItAndTheNextRunIsWhole)
{
    EXPECT_EQ(OutcomesOf(GetParam()), FailEach(EMode::kOnce));
}

TEST_P(RunOutOfMemory, ExhaustedMemoryEndsItAndTheNextRunIsWhole)
{
    EXPECT_EQ(OutcomesOf(GetParam()), FailEach(EMode::kFromThenOn));
}

std::string NameOf(const testing::TestParamInfo<TDiffering>& test)
{
    return test.param.GetName();
}

INSTANTIATE_TEST_SUITE_P(Faults, RunOutOfMemory, testing::ValuesIn(TDiffering::All()), NameOf);

INSTANTIATE_TEST_SUITE_P(FaultsOfFlawed, RunOutOfMemory,
                         testing::Values(TDiffering{EHost::kInmem, 3, true, EFlaw::kNoSlots},
                                         TDiffering{EHost::kPlain, 2, false, EFlaw::kNoSlots},
                                         TDiffering{EHost::kPlain, 3, true, EFlaw::kNoUplinkOfSlots},
                                         TDiffering{EHost::kPlain, 3, false, EFlaw::kUnknownProperty},
                                         TDiffering{EHost::kInmem, 2, true, EFlaw::kNoUplinkOfSlots},
                                         TDiffering{EHost::kInmem, 2, true, EFlaw::kUnknownProperty}),
                         NameOf);

struct TFlawed {
    EFlaw flaw;
    const char* outcome;
    const char* log;
};

TEST(DifferingNamespaces, WithAFlawEndARunWithItsStatus)
{
    const TFlawed flaws[] = {
        {EFlaw::kNone, "", ""},
        {EFlaw::kNoSlots, "status 37", "0|TCIMDiffEngine: Schema do not match. (Couldn't find class Slot in namespace 2)\n|"},
        {EFlaw::kNoUplinkOfSlots, "status 15", ""},
        {EFlaw::kUnknownProperty, "status 9",
         "0|Diff-XML Parser line 5:Invalid property \"a property that nothing has\" specified on line 5\n|"
         "0|TDiffXMLParser: Threw exception in EndElementParse error on line 5|"},
    };
    for (const TFlawed& flawed : flaws) {
        const TUntouchedRun run = RunUntouched({EHost::kInmem, 3, true, flawed.flaw});
        EXPECT_EQ(flawed.outcome, run.outcome);
        EXPECT_EQ(flawed.log, run.log);
    }
}

TEST(DifferingNamespaces, AreRecordedInEveryWay)
{
    const TUntouchedRun run = RunUntouched({EHost::kInmem, 3, true});
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
        "4 Disk.Id=\"lone\" Mirror {1, 2}",
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
        "4 Slot.Number=1 Uplink {1, 2}",
        "tie",
    };
    EXPECT_EQ(expected, run.records);
    EXPECT_NE("", run.aliases);
}

}  // namespace
}  // namespace NORVZEL20
