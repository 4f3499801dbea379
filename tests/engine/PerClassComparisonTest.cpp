#include "tests/engine/TPerClassFixture.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {
namespace {

class PerClassComparisonTest : public TPerClassFixture, public testing::WithParamInterface<EHost> {
  protected:
    PerClassComparisonTest() : TPerClassFixture(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(Hosts, PerClassComparisonTest, testing::Values(EHost::kPlain, EHost::kInmem),
                         testing::PrintToStringParamName());

TEST_P(PerClassComparisonTest, RecordsComeByKindThenInOrderOfKeyAndProperty)
{
    Disk(0, "sdd", 1);
    Disk(0, "sda", 1);
    Disk(0, "sdb", 1);
    Disk(0, "sdc", 1);
    Disk(1, "sdf", 1);
    Disk(1, "sde", 1);
    Disk(1, "sdc", 3);
    Disk(1, "sdb", 2);
    Namespace(1).Instance("Disk", {{"Bus", 9u}, {"Id", "x"}});
    EXPECT_EQ("Disk\n"
              "  1 Disk.Bus=0,Id=\"sda\" [1]\n"
              "  1 Disk.Bus=0,Id=\"sdd\" [1]\n"
              "  2 Disk.Bus=0,Id=\"sde\" [1]\n"
              "  2 Disk.Bus=0,Id=\"sdf\" [1]\n"
              "  2 Disk.Bus=9,Id=\"x\" [1]\n"
              "  4 Disk.Bus=0,Id=\"sdb\" Size [1]\n"
              "  4 Disk.Bus=0,Id=\"sdc\" Size [1]\n",
              RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, SeveralPropertiesOfAnInstanceAreSeparateRecordsInOrderOfName)
{
    Namespace(0).Instance("Disk", {{"Bus", 0u}, {"Id", "a"}, {"Size", 1u}, {"Label", "x"}});
    Namespace(1).Instance("Disk", {{"Bus", 0u}, {"Id", "a"}, {"Size", 2u}, {"Label", "y"}});
    EXPECT_EQ("Disk\n"
              "  4 Disk.Bus=0,Id=\"a\" Label [1]\n"
              "  4 Disk.Bus=0,Id=\"a\" Size [1]\n",
              RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, InstancesThatAgreeGiveNoRecord)
{
    for (const std::size_t index : {0u, 1u, 2u}) {
        Disk(index, "sda", 1);
    }
    EXPECT_EQ("", RecordsAfterRun());
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("KALMO_Delta"));
}

TEST_P(PerClassComparisonTest, EmptyNamespacesAgree)
{
    Namespace(2);
    EXPECT_EQ("", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, AnAbsentInstanceListsTheNamespacesWithoutIt)
{
    Disk(0, "sda", 1);
    Disk(2, "sda", 1);
    Namespace(3);
    EXPECT_EQ("Disk\n  1 Disk.Bus=0,Id=\"sda\" [1 3]\n", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, AnInstanceFoundOnlyElsewhereListsTheNamespacesWithIt)
{
    Namespace(3);
    Disk(2, "sda", 1);
    Disk(3, "sda", 2);
    EXPECT_EQ("Disk\n  2 Disk.Bus=0,Id=\"sda\" [2 3]\n", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, ADifferentValueListsTheNamespacesThatDifferFromTheReference)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    Disk(2, "sda", 1);
    Disk(3, "sda", 3);
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" Size [1 3]\n", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, FoundMarksAreResetForEachNamespace)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 1);
    Namespace(2);
    Disk(3, "sda", 1);
    EXPECT_EQ("Disk\n  1 Disk.Bus=0,Id=\"sda\" [2]\n", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, ASingleNamespaceGivesNoRecord)
{
    Disk(0, "sda", 1);
    EXPECT_EQ("", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, WithTheMarkerNothingIsCompared)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    fComparison.Delta().SetSpecFileName(fComparison.GetRulesPath() + "|fVMWareEnable");
    EXPECT_EQ("", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, AnEmptySpecificationComparesNothing)
{
    Disk(0, "sda", 1);
    Disk(1, "sdb", 2);
    Rules("");
    EXPECT_EQ("", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, ExcludedPropertiesDoNotCount)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    Rules("<class name=\"Disk\" default=\"include\"><excludelist><value>Size</value></excludelist></class>");
    EXPECT_EQ("", RecordsAfterRun());
}

TEST_P(PerClassComparisonTest, OnlyIncludedPropertiesCount)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    Disk(1, "sdb", 2);
    Rules("<class name=\"Disk\"><includelist><value>Label</value></includelist></class>");
    EXPECT_EQ("Disk\n  2 Disk.Bus=0,Id=\"sdb\" [1]\n", RecordsAfterRun());
}

class ExcludedKeysTest : public PerClassComparisonTest {
  protected:
    ExcludedKeysTest() { Rules("<class name=\"Disk\" excludekeys=\"Bus\"><includelist><value>Size</value></includelist></class>"); }
};

INSTANTIATE_TEST_SUITE_P(Hosts, ExcludedKeysTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(ExcludedKeysTest, InstancesMatchWithoutThem)
{
    Disk(0, "sda", 1, 3);
    Disk(1, "sda", 1, 4);
    Disk(2, "sda", 2, 5);
    EXPECT_EQ("Disk\n  4 Disk.Id=\"sda\" Size [2]\n", RecordsAfterRun());
    EXPECT_EQ("0:Disk Disk.Id=\"sda\" -> root/cimv2:Disk.Bus=3,Id=\"sda\"\n"
              "2:Disk Disk.Id=\"sda\" -> root/cimv2:Disk.Bus=5,Id=\"sda\"\n",
              DumpAliases(fComparison.Delta()));
}

TEST_P(ExcludedKeysTest, AnAbsentInstanceIsNamedByItsFullPath)
{
    Disk(0, "sda", 1, 3);
    Namespace(2);
    EXPECT_EQ("Disk\n  1 root/cimv2:Disk.Bus=3,Id=\"sda\" [1 2]\n", RecordsAfterRun());
    EXPECT_EQ("0:Disk Disk.Id=\"sda\" -> root/cimv2:Disk.Bus=3,Id=\"sda\"\n", DumpAliases(fComparison.Delta()));
}

TEST_P(ExcludedKeysTest, AnInstanceFoundOnlyElsewhereIsNamedByItsKey)
{
    Namespace(0);
    Disk(1, "sda", 1, 3);
    Disk(2, "sda", 1, 4);
    EXPECT_EQ("Disk\n  2 Disk.Id=\"sda\" [1 2]\n", RecordsAfterRun());
    EXPECT_EQ("1:Disk Disk.Id=\"sda\" -> root/cimv2:Disk.Bus=3,Id=\"sda\"\n"
              "2:Disk Disk.Id=\"sda\" -> root/cimv2:Disk.Bus=4,Id=\"sda\"\n",
              DumpAliases(fComparison.Delta()));
}

TEST_P(ExcludedKeysTest, SeveralInstancesOfOneKeyCountSeveralTimes)
{
    Disk(0, "sda", 1, 3);
    Disk(0, "sda", 7, 4);
    Disk(1, "sda", 2, 5);
    Disk(1, "sda", 3, 6);
    Disk(1, "sdb", 3, 5);
    Disk(1, "sdb", 3, 6);
    Disk(2, "sda", 1, 6);
    EXPECT_EQ("Disk\n"
              "  2 Disk.Id=\"sdb\" [1 1]\n"
              "  4 Disk.Id=\"sda\" Size [1 1]\n",
              RecordsAfterRun());
}

TEST_P(ExcludedKeysTest, ARunWritesNothingToStandardOutput)
{
    Disk(0, "sda", 1, 3);
    Disk(0, "sdb", 1, 3);
    Disk(1, "sdb", 2, 4);
    Disk(1, "sdc", 1, 4);
    testing::internal::CaptureStdout();
    const std::string records = RecordsAfterRun();
    Rules("<class/>");
    const std::string status = fComparison.Run();
    EXPECT_EQ("", testing::internal::GetCapturedStdout());
    EXPECT_EQ("Disk\n"
              "  1 root/cimv2:Disk.Bus=3,Id=\"sda\" [1]\n"
              "  2 Disk.Id=\"sdc\" [1]\n"
              "  4 Disk.Id=\"sdb\" Size [1]\n",
              records);
    EXPECT_EQ("status 9\n", status);
}

// Instances with the same keys, which a store that checks keys refuses.
class SameKeysTest : public TPerClassFixture {
  protected:
    SameKeysTest() : TPerClassFixture(EHost::kPlain) {}
};

TEST_F(SameKeysTest, OnlyTheFirstOfTheReferenceIsCompared)
{
    Disk(0, "sda", 1);
    Disk(0, "sda", 2);
    Disk(1, "sda", 1);
    Disk(2, "sda", 2);
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" Size [2]\n", RecordsAfterRun());
}

TEST_F(SameKeysTest, EachOfAnotherNamespaceIsCompared)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    Disk(1, "sda", 1);
    Disk(1, "sda", 3);
    Disk(2, "sda", 1);
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" Size [1 1]\n", RecordsAfterRun());
}

}  // namespace
}  // namespace NORVZEL20
