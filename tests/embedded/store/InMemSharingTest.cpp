#include <string>

#include "embedded/store/TInMemInstance.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/support/HeapInUse.h"

namespace NORVZEL20 {
namespace {

/// Instances that are made one after the other hold what they have in common once.
class InMemSharingTest : public TInMemFixture {
  protected:
    static constexpr const char* kLongText = "a text that needs memory of its own";

    static TInstancePointer AddDisk(const TClassPointer& cls, const std::string& id, const char* property, const TCIMValue& value)
    {
        return Add(cls, {{"Id", TCIMValue(id)}, {property, value}});
    }

    static const TCIMValue& ValueOf(const TInstancePointer& instance, const char* property)
    {
        return instance->FindProperty(property)->GetValue();
    }

    static TCIMReference PathTo(const TInstancePointer& instance) { return instance->GetReference(kNoContext); }

    /// Difference { Number uint64 generated key; Instance string; Places uint16[] } and DifferenceOfDisk { Disk ref; Difference
    /// ref }
    void DeclareRecords()
    {
        fDifference = Declare("Difference", nullptr,
                              {{"Number", TType::kUint64, {"Key", "Generated"}},
                               {"Type", TType::kUint8, {}},
                               {"Instance", TType::kString, {}},
                               {"Property", TType::kString, {}},
                               {"Places", TType::kArrayUint16, {}}});
        fTie = Allocate("DifferenceOfDisk", nullptr);
        fTie->AddPropertyDecl(Reference("Disk", "Disk"));
        fTie->AddPropertyDecl(Reference("Difference", "Difference"));
        fTie->AddToNamespace(kNoContext);
    }

    /// As a comparison makes it: everything anew for each record.
    void AddRecord(const TInstancePointer& disk, const std::string& instance, const std::string& property)
    {
        const TCIMValue place(static_cast<unsigned short>(1));
        const auto difference = Add(fDifference, {{"Type", TCIMValue(static_cast<unsigned char>(4))},
                                                  {"Instance", TCIMValue(instance)},
                                                  {"Property", TCIMValue(property)},
                                                  {"Places", TCIMValue(TType::kArrayUint16, 1, {place})}});
        Add(fTie, {{"Disk", TCIMValue(PathTo(disk))}, {"Difference", TCIMValue(PathTo(difference))}});
    }

    TClassPointer fDifference;
    TClassPointer fTie;
};

TEST_F(InMemSharingTest, EqualTextIsThereOnce)
{
    const auto cls = DeclareDisk();
    const auto one = AddDisk(cls, "a", "Label", TCIMValue(kLongText));
    const auto other = AddDisk(cls, "b", "Label", TCIMValue(kLongText));
    EXPECT_EQ(ValueOf(one, "Label").GetString().data(), ValueOf(other, "Label").GetString().data());
    EXPECT_EQ(kLongText, ValueOf(other, "Label").GetString());
}

TEST_F(InMemSharingTest, EqualArrayIsThereOnce)
{
    const auto cls = DeclareDisk();
    const auto one = AddDisk(cls, "a", "Tags", Texts({"x", kLongText}));
    const auto between = AddDisk(cls, "b", "Tags", Texts({"y"}));
    const auto other = AddDisk(cls, "c", "Tags", Texts({"x", kLongText}));
    EXPECT_EQ(&ValueOf(one, "Tags").GetElements(), &ValueOf(other, "Tags").GetElements());
}

TEST_F(InMemSharingTest, EqualReferenceIsThereOnce)
{
    const auto disk = AddDisk(DeclareDisk(), "a", "Label", TCIMValue(kLongText));
    DeclareRecords();
    const auto tie = [&](std::uint64_t number) {
        TCIMReference path(fNamespace, {{"Number", Uint64(number)}});
        path.SetClass(fDifference);
        return Add(fTie, {{"Disk", TCIMValue(PathTo(disk))}, {"Difference", TCIMValue(path)}});
    };
    const TCIMReference one = ValueOf(tie(1), "Disk");
    const TCIMReference other = ValueOf(tie(2), "Disk");
    EXPECT_EQ(one.FindKeyValue("Id"), other.FindKeyValue("Id"));
}

TEST_F(InMemSharingTest, ReferencesToInstancesOfOneClassShareTheirNamespace)
{
    DeclareRecords();
    const auto tie = [&](std::uint64_t number) {
        TCIMReference path(fNamespace, {{"Number", Uint64(number)}});
        path.SetClass(fDifference);
        return Add(fTie, {{"Disk", TCIMValue(path)}, {"Difference", TCIMValue(path)}});
    };
    const TCIMReference one = ValueOf(tie(1), "Difference");
    TCIMReference other = ValueOf(tie(2), "Difference");
    EXPECT_EQ(&one.GetNamespaceName(), &other.GetNamespaceName());
    EXPECT_EQ("root/cimv2:Difference.Number=1", one.GetPath());
    EXPECT_EQ("root/cimv2:Difference.Number=2", other.GetPath());
    other.SetNamespaceName("elsewhere");
    EXPECT_EQ("root/cimv2:Difference.Number=1", one.GetPath());
    EXPECT_EQ("elsewhere:Difference.Number=2", other.GetPath());
}

TEST_F(InMemSharingTest, WhatOnlyMeansTheSameStaysAsWritten)
{
    const auto cls = DeclareDisk();
    const auto one = AddDisk(cls, "a", "Tags", Texts({"x", "y"}));
    const auto other = AddDisk(cls, "b", "Tags", Texts({"y", "x"}));
    ASSERT_TRUE(ValueOf(one, "Tags") == ValueOf(other, "Tags")) << "a bag";
    EXPECT_EQ("Id=b Size=NULL Label=NULL Tags={\"y\", \"x\"}", ValuesOf(*other));

    DeclareRecords();
    const auto tie = [&](const char* ns, std::uint64_t number) {
        TCIMReference disk(nullptr, {{"Id", TCIMValue("a")}});
        disk.SetClass(cls);
        disk.SetNamespaceName(ns);
        return Add(fTie,
                   {{"Disk", TCIMValue(disk)}, {"Difference", TCIMValue(Path("Difference.Number=" + std::to_string(number)))}});
    };
    tie("root/other", 1);
    const TCIMReference path = ValueOf(tie("Root/Other", 2), "Disk");
    EXPECT_EQ("Root/Other", path.GetNamespaceName());
}

TEST_F(InMemSharingTest, AChangeOfOneLeavesTheOther)
{
    const auto cls = DeclareDisk();
    const auto one = AddDisk(cls, "a", "Label", TCIMValue(kLongText));
    const auto other = AddDisk(cls, "b", "Label", TCIMValue(kLongText));
    one->GetProperty("Label", kNoContext)->SetValue(TCIMValue("another text of some length"), kNoContext);
    EXPECT_EQ(kLongText, ValueOf(other, "Label").GetString());
    cls->RemoveInstance(one);
    EXPECT_EQ(kLongText, ValueOf(AddDisk(cls, "c", "Label", TCIMValue(kLongText)), "Label").GetString());
}

TEST_F(InMemSharingTest, ARecordOfADifferenceTakesAtMostSixHundredBytes)
{
    constexpr int kCount = 30000;
    const auto disk = AddDisk(DeclareDisk(), "a", "Label", TCIMValue(kLongText));
    DeclareRecords();
    const std::size_t before = HeapInUse();
    for (int number = 0; number < kCount; ++number) {
        // Three properties of each instance differ.
        AddRecord(disk, "Disk.Id=\"the number of the disk is " + std::to_string(number / 3) + "\"",
                  "APropertyOfSomeLength" + std::to_string(number % 3));
    }
    const std::size_t each = (HeapInUse() - before) / kCount;
    RecordProperty("BytesPerRecord", static_cast<int>(each));
    EXPECT_GT(each, 300U);
    EXPECT_LE(each, 600U);
}

}  // namespace
}  // namespace NORVZEL20
