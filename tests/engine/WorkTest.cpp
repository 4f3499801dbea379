#include "tests/engine/TPerClassFixture.h"

namespace NORVZEL20 {
namespace {

// Counts the calls of the engine on the host.
class WorkTest : public TPerClassFixture {
  protected:
    WorkTest() : TPerClassFixture(EHost::kPlain) {}

    // Adds that many disks to each namespace and runs. The sizes in the other namespaces differ by `change`.
    TCallWatch& Run(std::size_t namespaces, unsigned int disks, unsigned int change)
    {
        for (std::size_t index = 0; index < namespaces; ++index) {
            for (unsigned int number = 0; number < disks; ++number) {
                Disk(index, std::to_string(number), 5 + (index == 0 ? 0 : change));
            }
        }
        EXPECT_EQ("", fComparison.Run());
        return fComparison.GetWatch();
    }
};

constexpr unsigned int kDisks = 60;
constexpr std::size_t kKeys = 2;
constexpr std::size_t kProperties = 4;

TEST_F(WorkTest, EqualInstancesAreReadOnceForTheirKeyAndOnceForEachProperty)
{
    const std::size_t perPair = 2 * kKeys + 2 * kProperties;
    EXPECT_EQ(kDisks * perPair + 3, Run(2, kDisks, 0).CountOf(".GetValue() {}"));  // 3: OSType, once and for each namespace
}

TEST_F(WorkTest, DifferentInstancesOfTwoNamespacesAreReadForTheirKeyOnceMore)
{
    const std::size_t perPair = 3 * kKeys + 2 * kProperties;
    EXPECT_EQ(kDisks * perPair + 3, Run(2, kDisks, 1).CountOf(".GetValue() {}"));
}

TEST_F(WorkTest, EachFurtherNamespaceCostsItsOwnReadsAndTheMastersProperties)
{
    const std::size_t perDisk = kKeys + 3 * (kKeys + 2 * kProperties);
    EXPECT_EQ(kDisks * perDisk + 5, Run(4, kDisks, 1).CountOf(".GetValue() {}"));
}

TEST_F(WorkTest, EachClassIsEnumeratedOnceInEachNamespace)
{
    Run(3, kDisks, 1);
    for (const std::string ns : {"ns0", "ns1", "ns2"}) {
        EXPECT_EQ(1u, fComparison.GetWatch().CountOf(ns + ":Disk.EnumerateInstances(false) {}"));
    }
}

}  // namespace
}  // namespace NORVZEL20
