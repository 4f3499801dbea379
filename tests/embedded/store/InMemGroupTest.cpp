#include <gtest/gtest.h>

#include <boost/smart_ptr/weak_ptr.hpp>
#include <string>
#include <vector>

#include "embedded/store/TInMemGroup.h"
#include "tests/embedded/store/CountedAllocations.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/support/HeapInUse.h"

namespace NORVZEL20 {
namespace {

class InMemGroupTest : public TInMemFixture {
  protected:
    InMemGroupTest() : fDisk(DeclareDisk()) {}

    std::vector<TInstancePointer> Make(std::size_t count)
    {
        std::vector<TInstancePointer> instances;
        instances.reserve(count);
        for (std::size_t number = 0; number < count; ++number) {
            instances.push_back(fDisk->AllocateInMemInstance());
        }
        return instances;
    }

    TClassPointer fDisk;
};

TEST_F(InMemGroupTest, ManyInstancesTakeFewAllocations)
{
    Make(1);
    const std::size_t before = CountedAllocations();
    const auto instances = Make(1600);
    // The vector, full groups of sixteen, and smaller ones at the beginning.
    EXPECT_GE(CountedAllocations() - before, 1 + 100u);
    EXPECT_LE(CountedAllocations() - before, 1 + 100u + 20u);
}

TEST_F(InMemGroupTest, AFewInstancesLeaveLittleRoomUnused)
{
    Make(1);
    const std::size_t size = TInMemInstance::GetSize(4);
    for (const std::size_t count : {1u, 2u, 5u, 17u, 100u}) {
        const auto cls = Declare("Disk" + std::to_string(count), nullptr, {{"Id", TType::kString, {"Key"}}});
        for (int number = 0; number < 3; ++number) {
            cls->AddPropertyDecl(Decl({"P" + std::to_string(number), TType::kUint8, {}}));
        }
        std::vector<TInstancePointer> instances;
        instances.reserve(count);
        const std::size_t before = HeapInUse();
        for (std::size_t number = 0; number < count; ++number) {
            instances.push_back(cls->AllocateInMemInstance());
        }
        EXPECT_LE(HeapInUse() - before, count * (size + size / 4 + 120)) << count;
    }
}

TEST_F(InMemGroupTest, EachInstanceHasItsOwnValuesAndTheirClass)
{
    const auto instances = Make(50);
    for (std::size_t number = 0; number < instances.size(); ++number) {
        instances[number]->FindProperty("Size")->SetValue(Uint64(number), kNoContext);
    }
    for (std::size_t number = 0; number < instances.size(); ++number) {
        EXPECT_EQ("Id=NULL Size=" + std::to_string(number) + " Label=NULL Tags=NULL", ValuesOf(*instances[number]));
        EXPECT_EQ(fDisk, instances[number]->GetInMemClass());
        instances[number]->FindProperty("Id")->SetValue(TCIMValue(std::to_string(number)), kNoContext);
        instances[number]->AddToNamespace(kNoContext);
        EXPECT_EQ(instances[number], fNamespace->GetInstance(instances[number]->GetReference(), kNoContext));
    }
}

TEST_F(InMemGroupTest, AllEndWhenTheLastPointerGoes)
{
    auto instances = Make(200);
    instances[198]->FindProperty("Label")->SetValue(TCIMValue("a label that is not short"), kNoContext);
    auto label = instances[198]->GetProperty("Label", kNoContext);
    const boost::weak_ptr<TInMemInstance> last = instances.back();
    const boost::weak_ptr<TInMemInstance> first = instances.front();
    instances.clear();
    EXPECT_TRUE(first.expired());
    EXPECT_FALSE(last.expired()) << "its neighbour is in use";
    EXPECT_EQ("a label that is not short", label->GetValue(kNoContext).ToText());
    label.reset();
    EXPECT_TRUE(last.expired());
}

TEST_F(InMemGroupTest, AnInstanceMadeAfterAChangeOfTheClassHasAllPropertiesBehindIt)
{
    auto instances = Make(100);
    fDisk->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    for (int number = 0; number < 20; ++number) {
        const auto instance = fDisk->AllocateInMemInstance();
        EXPECT_EQ(&instance->GetSlotProperty(0) + 4, &instance->GetSlotProperty(4));
        EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL Serial=NULL", ValuesOf(*instance));
        instances.push_back(instance);
    }
    EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL Serial=NULL", ValuesOf(*instances[99]));
}

TEST_F(InMemGroupTest, InstancesThatAreGivenUpTakeNoMemory)
{
    Make(1000);
    const std::size_t before = HeapInUse();
    for (int round = 0; round < 1000; ++round) {
        Make(3);
    }
    EXPECT_LE(HeapInUse(), before + 20000);
}

TEST_F(InMemGroupTest, AClassIsReleasedWithItsLastInstance)
{
    const boost::weak_ptr<TInMemClass> watched = fDisk;
    auto instances = Make(40);
    fDisk.reset();
    fNamespace.reset();
    EXPECT_FALSE(watched.expired());
    instances.resize(1);
    EXPECT_FALSE(watched.expired());
    instances.clear();
    EXPECT_TRUE(watched.expired());
}

}  // namespace
}  // namespace NORVZEL20
