#include "host/TZELException.h"
#include "tests/engine/TPerClassFixture.h"
#include "tests/support/plain/TPlainInstance.h"
#include "tests/support/plain/TPlainProperty.h"

namespace NORVZEL20 {
namespace {

// With exactly two namespaces, the reference takes over the values and instances of the other one.
class TwoNamespacesTest : public TPerClassFixture, public testing::WithParamInterface<EHost> {
  protected:
    TwoNamespacesTest() : TPerClassFixture(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(Hosts, TwoNamespacesTest, testing::Values(EHost::kPlain, EHost::kInmem),
                         testing::PrintToStringParamName());

TEST_P(TwoNamespacesTest, TheReferenceTakesOverValues)
{
    Disk(0, "sda", 1);
    Disk(1, "sda", 2);
    EXPECT_EQ("Disk\n  4 Disk.Bus=0,Id=\"sda\" Size [1]\n", RecordsAfterRun());
    EXPECT_EQ("Disk.Bus=0,Id=\"sda\" Bus=0 Id=\"sda\" Size=2 Label=NULL\n", Disks(0));
    EXPECT_EQ(Disks(1), Disks(0));
}

TEST_P(TwoNamespacesTest, TheReferenceGetsCopiesOfInstancesItLacked)
{
    Disk(0, "sda", 1);
    Disk(1, "sdb", 2);
    Disk(1, "sda", 1);
    Namespace(1).Instance("Disk", {{"Bus", 0u}, {"Id", "sdc"}, {"Label", "x"}});
    RecordsAfterRun();
    EXPECT_EQ("Disk.Bus=0,Id=\"sda\" Bus=0 Id=\"sda\" Size=1 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdb\" Bus=0 Id=\"sdb\" Size=2 Label=NULL\n"
              "Disk.Bus=0,Id=\"sdc\" Bus=0 Id=\"sdc\" Size=NULL Label=\"x\"\n",
              Disks(0));
}

TEST_P(TwoNamespacesTest, NullsAreNotCopied)
{
    Namespace(0);
    Disk(1, "sda", 1);
    RecordsAfterRun();
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("ns0:new Disk.GetProperty(\"Label\")"));
    EXPECT_EQ(1u, fComparison.GetWatch().CountOf("ns0:new Disk.Size.SetValue(1) {}"));
}

TEST_P(TwoNamespacesTest, WhatTheOtherLacksStaysAndIsMarked)
{
    Disk(0, "sda", 1);
    Namespace(1);
    RecordsAfterRun();
    EXPECT_EQ("Disk.Bus=0,Id=\"sda\" Bus=0 Id=\"sda\" Size=1 Label=NULL\n", Disks(0));
    EXPECT_EQ(3u, fComparison.GetWatch().CountOf(".MarkRemoved()"));
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("Label.MarkRemoved()"));
}

TEST_P(TwoNamespacesTest, WhatTheOtherLacksIsMarkedWhereKeysAreExcludedToo)
{
    Rules("<class name=\"Disk\" default=\"include\" excludekeys=\"Bus\"/>");
    Disk(0, "sda", 1, 3);
    Namespace(1);
    EXPECT_EQ("Disk\n  1 root/cimv2:Disk.Bus=3,Id=\"sda\" [1]\n", RecordsAfterRun());
    EXPECT_EQ(3u, fComparison.GetWatch().CountOf(".MarkRemoved()"));
}

TEST_P(TwoNamespacesTest, ASecondRunFindsOnlyWhatTheOtherLacks)
{
    Disk(0, "sda", 1);
    Disk(0, "sdb", 1);
    Disk(1, "sda", 2);
    Disk(1, "sdc", 2);
    const std::string first = RecordsAfterRun();
    EXPECT_EQ(first + "Disk\n  1 Disk.Bus=0,Id=\"sdb\" [1]\n", RecordsAfterRun());
}

TEST_P(TwoNamespacesTest, AnExcludedKeyIsBroughtInLineLikeAnyProperty)
{
    Rules("<class name=\"Disk\" default=\"include\" excludekeys=\"Bus\"/>");
    Disk(0, "sda", 1, 3);
    Disk(1, "sda", 1, 4);
    EXPECT_EQ("Disk\n  4 Disk.Id=\"sda\" Bus [1]\n", RecordsAfterRun());
    EXPECT_EQ("Disk.Bus=3,Id=\"sda\" Bus=4 Id=\"sda\" Size=1 Label=NULL\n", Disks(0));
}

TEST_P(TwoNamespacesTest, OfSeveralWithOneKeyTheFirstIsCopied)
{
    Rules("<class name=\"Disk\" default=\"include\" excludekeys=\"Bus\"/>");
    Namespace(0);
    Disk(1, "sda", 1, 3);
    Disk(1, "sda", 2, 4);
    EXPECT_EQ("Disk\n  2 Disk.Id=\"sda\" [1 1]\n", RecordsAfterRun());
    EXPECT_EQ("Disk.Bus=3,Id=\"sda\" Bus=3 Id=\"sda\" Size=1 Label=NULL\n", Disks(0));
}

TEST_P(TwoNamespacesTest, ALaterInstanceIsComparedWithWhatTheFirstOneLeft)
{
    Rules("<class name=\"Disk\" excludekeys=\"Bus\"><includelist><value>Size</value></includelist></class>");
    Disk(0, "sda", 1, 3);
    Disk(1, "sda", 2, 4);
    Disk(1, "sda", 2, 5);
    EXPECT_EQ("Disk\n  4 Disk.Id=\"sda\" Size [1]\n", RecordsAfterRun());
}

TEST_P(TwoNamespacesTest, APropertyThatTheReferenceLacksEndsTheCopy)
{
    fComparison.Namespace(0).Class("Card", "", {TNamespaceBuilder::Key("Id")});
    fComparison.Namespace(1)
        .Class("Card", "", {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Property("Speed")})
        .Instance("Card", {{"Id", "a"}, {"Speed", "fast"}});
    Rules("<class name=\"Card\" default=\"include\"/>");
    EXPECT_EQ("Card\n  2 Card.Id=\"a\" [1]\nstatus 15\n", RecordsAfterRun());
}

TEST_P(TwoNamespacesTest, WithThreeTheReferenceIsLeftAsItIs)
{
    Disk(0, "sda", 1);
    Disk(0, "sdb", 1);
    Disk(1, "sda", 2);
    Disk(1, "sdc", 2);
    Namespace(2);
    const std::string before = Disks(0);
    RecordsAfterRun();
    EXPECT_EQ(before, Disks(0));
    EXPECT_EQ(0u, fComparison.GetWatch().CountOf("Mark") + fComparison.GetWatch().CountOf("ns0:new"));
}

using TDiskProperties = std::vector<TNamespaceBuilder::TProperty>;

// The text of what a run throws if the two namespaces declare Disk like this and the second one has an instance for each bay.
std::string RefusalOf(const TDiskProperties& reference, const TDiskProperties& other, const std::vector<TCIMValue>& bays)
{
    TComparisonRun comparison(EHost::kInmem);
    comparison.Namespace(0).Class("Disk", "", reference);
    comparison.Namespace(1).Class("Disk", "", other);
    for (const TCIMValue& bay : bays) {
        comparison.Namespace(1).Instance("Disk", {{"Id", "sda"}, {"Bay", bay}});
    }
    comparison.Rules("<DifftoolSpec version=\"1.0\"><class name=\"Disk\" default=\"include\"/></DifftoolSpec>");
    comparison.Prepare();
    try {
        comparison.Delta().FindDifferences();
    } catch (const TZELException& refusal) {
        return refusal.what();
    }
    return "";
}

TEST(CopyingTest, WhatTheStoreRefusesReachesTheCallerWithItsText)
{
    const auto id = TNamespaceBuilder::Key("Id");
    const auto bay = TNamespaceBuilder::Property("Bay", TCIMValue::TCIMType::kUint32);
    const auto keyBay = TNamespaceBuilder::Key("Bay", TCIMValue::TCIMType::kUint32);
    EXPECT_EQ("Already exists: instance Disk.Id=\"sda\"", RefusalOf({id, bay}, {id, keyBay}, {TCIMValue(1u), TCIMValue(2u)}));
    EXPECT_EQ("Key without a value: key Bay of instance Disk.Bay=NULL,Id=\"sda\"",
              RefusalOf({id, keyBay}, {id, bay}, {TCIMValue::Null(TCIMValue::TCIMType::kUint32)}));
    EXPECT_EQ("Type mismatch: property Bay of instance Disk.Id=\"sda\" is string, not uint32",
              RefusalOf({id, TNamespaceBuilder::Property("Bay", TCIMValue::TCIMType::kString)}, {id, bay}, {TCIMValue(1u)}));
    EXPECT_EQ("Not found: property Bay of instance Disk.Id=\"sda\"", RefusalOf({id}, {id, bay}, {TCIMValue(1u)}));
    EXPECT_EQ("", RefusalOf({id}, {id, bay}, {TCIMValue::Null(TCIMValue::TCIMType::kUint32)}));
}

}  // namespace
}  // namespace NORVZEL20
