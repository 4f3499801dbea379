#include <gtest/gtest.h>

#include <algorithm>
#include <random>
#include <string>
#include <vector>

#include "tests/embedded/store/CountedAllocations.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

enum class EOrder { kOfKeys, kShuffled };

std::ostream& operator<<(std::ostream& out, EOrder order)
{
    return out << (order == EOrder::kOfKeys ? "OfKeys" : "Shuffled");
}

// Counts the allocations of whole runs over two namespaces of the embedded host. A longer run less a shorter one gives those of
// each further pair of instances.
class WalkAllocationsTest : public testing::TestWithParam<EOrder> {
  protected:
    static constexpr unsigned int kPairs = 500;

    // With `isOneMissing`, the first namespace lacks an instance, so the second one is enumerated twice.
    double OfEachPair(bool isOneMissing)
    {
        const std::size_t ofLong = OfRun(2 * kPairs, isOneMissing);
        const std::size_t ofShort = OfRun(kPairs, isOneMissing);
        return static_cast<double>(ofLong - ofShort) / kPairs;
    }

    void UseKey(const std::string& name) { fKey = name; }

  private:
    boost::shared_ptr<ICIMNamespace> MakeDisks(unsigned int disks, unsigned int seed)
    {
        const auto ns = MakeNamespace(EHost::kInmem, "root/cimv2");
        TNamespaceBuilder builder(ns);
        builder.OperatingSystem();
        builder.Class("Disk", "",
                      {TNamespaceBuilder::Key(fKey), TNamespaceBuilder::Property("Size", TCIMValue::TCIMType::kUint32)});
        std::vector<unsigned int> numbers(disks);
        for (unsigned int number = 0; number < disks; ++number) {
            numbers[number] = 10000 + number;
        }
        if (GetParam() == EOrder::kShuffled) {
            std::mt19937 random(seed);
            std::shuffle(numbers.begin(), numbers.end(), random);
        }
        for (const unsigned int number : numbers) {
            builder.Instance("Disk", {{fKey, "a disk with a long name " + std::to_string(number)}, {"Size", number}});
        }
        return ns;
    }

    std::size_t OfRun(unsigned int disks, bool isOneMissing)
    {
        const auto delta = MakeDeltaNamespace(EHost::kInmem);
        delta->SetSpecFileName(fRules.GetPath());
        const auto other = MakeDisks(disks, 2);
        if (isOneMissing) {
            TNamespaceBuilder(other).Instance("Disk", {{fKey, "another disk"}, {"Size", 1u}});
        }
        delta->AddNamespaceToCompareList(MakeDisks(disks, 1));
        delta->AddNamespaceToCompareList(other);
        const std::size_t before = CountedAllocations();
        delta->FindDifferences();
        return CountedAllocations() - before;
    }

    std::string fKey = "Id";
    TCapturingLogger fLog;
    TScratchFile fRules{"<DifftoolSpec><class name=\"Disk\" default=\"include\"/></DifftoolSpec>"};
};

INSTANTIATE_TEST_SUITE_P(Orders, WalkAllocationsTest, testing::Values(EOrder::kOfKeys, EOrder::kShuffled),
                         testing::PrintToStringParamName());

constexpr double kSpare = 0.1;  // for what grows with the logarithm

// For each of the two keys the names of the class's keys and a text, and an entry of the map. Values are compared in their places.
TEST_P(WalkAllocationsTest, APairOfEqualInstancesNeedsFive)
{
    EXPECT_GE(5 + kSpare, OfEachPair(false));
}

// The names of the class's keys and the text. An instance that was matched has no entry in a map then.
TEST_P(WalkAllocationsTest, AnInstanceThatIsReadAgainNeedsTwo)
{
    EXPECT_GE(2 + kSpare, OfEachPair(true) - OfEachPair(false));
}

// A text of more than 15 characters is not held in the string itself.
TEST_P(WalkAllocationsTest, ALongNameOfAKeyNeedsNoMore)
{
    UseKey("DeviceCreationClassName");
    EXPECT_GE(5 + kSpare, OfEachPair(false));
}

}  // namespace
}  // namespace NORVZEL20
