#include <cstdio>
#include <vector>

#include "host/TAddToVectorCallback.h"
#include "tests/embedded/store/CountedAllocations.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/support/HeapInUse.h"

namespace NORVZEL20 {
namespace {

class InMemMemoryTest : public TInMemFixture {
  protected:
    /// Package: 13 properties, eight of them texts of 15 to 40 characters.
    TClassPointer DeclarePackage()
    {
        auto cls = Allocate("Package", nullptr, {{"Name", TType::kString, {"Key"}}, {"Version", TType::kString, {"Key"}}});
        for (const char* name : {"Vendor", "Section", "Home", "Summary", "Source", "License"}) {
            cls->AddPropertyDecl(Decl({name, TType::kString, {}}));
        }
        for (const char* name : {"Size", "InstalledSize"}) {
            cls->AddPropertyDecl(Decl({name, TType::kUint64, {}}));
        }
        cls->AddPropertyDecl(Decl({"Priority", TType::kUint16, {}}));
        cls->AddPropertyDecl(Decl({"Essential", TType::kBoolean, {}}));
        cls->AddPropertyDecl(Decl({"Architecture", TType::kString, {}}));
        cls->AddToNamespace(kNoContext);
        return cls;
    }

    static TInstancePointer AddPackage(const TClassPointer& cls, int number)
    {
        const auto instance = cls->AllocateInMemInstance();
        const std::string text = "package number " + std::to_string(number);  // 16 to 20 characters
        for (std::uint32_t slot = 0; slot < 8; ++slot) {
            instance->SetSlot(slot, TCIMValue(text + std::string(slot * 3, 'x')));
        }
        instance->SetSlot(8, Uint64(number));
        instance->SetSlot(9, Uint64(number * 3));
        instance->SetSlot(10, TCIMValue(static_cast<unsigned short>(5)));
        instance->SetSlot(11, TCIMValue(false));
        instance->SetSlot(12, TCIMValue("amd64"));
        instance->AddToNamespace(TCallContext());
        return instance;
    }
};

TEST_F(InMemMemoryTest, AnInstanceOfThirteenPropertiesTakesAtMostNineHundredBytes)
{
    constexpr int kCount = 100000;
    const auto cls = DeclarePackage();
    const std::size_t before = HeapInUse();
    for (int number = 0; number < kCount; ++number) {
        AddPackage(cls, number);
    }
    const std::size_t each = (HeapInUse() - before) / kCount;
    RecordProperty("BytesPerInstance", static_cast<int>(each));
    std::printf("%zu bytes per instance\n", each);
    EXPECT_GT(each, 500U);
    EXPECT_LE(each, 900U);
}

/// A comparison changes a few values of nearly every instance, and what they were before is kept.
TEST_F(InMemMemoryTest, ThreeChangedValuesOfAnInstanceTakeAtMostAHundredAndFiftyBytes)
{
    constexpr int kCount = 1000;
    const auto cls = DeclarePackage();
    std::vector<TInstancePointer> instances;
    for (int number = 0; number < kCount; ++number) {
        instances.push_back(AddPackage(cls, number));
    }
    const std::size_t before = HeapInUse();
    for (const TInstancePointer& instance : instances) {
        instance->GetSlotProperty(8).MarkChanged(Uint64(1));
        instance->GetSlotProperty(9).MarkChanged(Uint64(2));
        instance->GetSlotProperty(11).MarkChanged(TCIMValue(true));
    }
    const std::size_t each = (HeapInUse() - before) / kCount;
    EXPECT_GE(each, 3 * sizeof(TCIMValue));
    EXPECT_LE(each, 150U);
    EXPECT_EQ("27", instances[9]->GetSlotProperty(9).GetEarlierValue()->ToText());
}

TEST_F(InMemMemoryTest, ReadingAPropertyAllocatesNothing)
{
    const auto cls = DeclarePackage();
    AddPackage(cls, 1);
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, kNoContext);
    ASSERT_EQ(1u, instances.size());
    const std::string name = "architecture";
    const std::size_t before = CountedAllocations();
    const auto property = instances[0]->GetProperty(name, kNoContext);
    const TCIMValue value = property->GetValue(kNoContext);
    EXPECT_EQ(before, CountedAllocations());
    EXPECT_EQ("amd64", value.GetString());
}

TEST_F(InMemMemoryTest, AnInstanceIsOneAllocation)
{
    const auto cls = DeclarePackage();
    const std::size_t before = CountedAllocations();
    const auto instance = cls->AllocateInMemInstance();
    EXPECT_EQ(before + 1, CountedAllocations());
}

/// Names of up to 15 bytes take no allocation of their own; a longer one is read into one, which the path takes over.
TEST_F(InMemMemoryTest, ReadingAPathAllocatesEachNameOnce)
{
    const auto allocationsOf = [](const std::string& text) {
        const std::size_t before = CountedAllocations();
        const TCIMReference path = TCIMReference::Parse(text);
        EXPECT_EQ(2u, path.GetKeyCount());
        return CountedAllocations() - before;
    };
    // The memory of a path that has ended serves the next one, which the first path here has no share in.
    allocationsOf("Disk.A=1,B=2");
    EXPECT_EQ(allocationsOf("Disk.A=1,B=2") + 2, allocationsOf("Disk.CreationClassName=1,SystemCreationClassName=2"));
}

}  // namespace
}  // namespace NORVZEL20
