#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

/// Properties that stand behind their instance and in late blocks: each knows which one it is.
class InMemPropertyTest : public TInMemFixture {
  protected:
    static std::string NameOf(std::uint32_t number) { return "Property" + std::to_string(number); }

    InMemPropertyTest() : fClass(Declare("Wide", nullptr, {{"Property0", TType::kUint64, {"Key"}}})) {}

    void GrowTo(std::uint32_t count)
    {
        for (std::uint32_t number = fClass->GetLayout().GetSlotCount(); number < count; ++number) {
            fClass->AddPropertyDecl(Decl({NameOf(number), TType::kUint64, {}}));
        }
    }

    static boost::shared_ptr<ICIMProperty> Handle(const TInMemInstance& instance, std::uint32_t number)
    {
        return instance.GetProperty(NameOf(number), kNoContext);
    }

    /// Writes its number into each of `count` properties, marks two thirds of them, and returns all that they say then.
    static std::string Use(const TInMemInstance& instance, std::uint32_t count)
    {
        for (std::uint32_t number = 0; number < count; ++number) {
            Handle(instance, number)->SetValue(Uint64(number), kNoContext);
        }
        for (std::uint32_t number = 1; number < count; number += 3) {
            Handle(instance, number)->MarkChanged(Uint64(number + 1000));
            Handle(instance, number)->MarkChanged(Uint64(number + 2000));
        }
        for (std::uint32_t number = 2; number < count; number += 3) {
            Handle(instance, number)->MarkRemoved();
            Handle(instance, number)->MarkRemoved();
        }
        std::string text;
        for (std::uint32_t number = 0; number < count; ++number) {
            const auto handle = Handle(instance, number);
            const auto& property = dynamic_cast<const TInMemProperty&>(*handle);
            text += handle->GetPropertyDecl(kNoContext)->GetName(kNoContext) + "=" + handle->GetValue(kNoContext).ToText();
            text += property.IsChanged() ? " was " + property.GetEarlierValue()->ToText() : "";
            text += property.IsRemoved() ? " removed\n" : "\n";
        }
        return text;
    }

    static std::string Expected(std::uint32_t count)
    {
        std::string text;
        for (std::uint32_t number = 0; number < count; ++number) {
            const std::string digits = std::to_string(number);
            text += NameOf(number) + "=" + (number % 3 == 1 ? std::to_string(number + 2000) + " was " + digits : digits);
            text += number % 3 == 2 ? " removed\n" : "\n";
        }
        return text;
    }

    TClassPointer fClass;
};

TEST_F(InMemPropertyTest, EachOfSixPropertiesBehindTheInstanceKnowsItsPlace)
{
    GrowTo(6);
    EXPECT_EQ(Expected(6), Use(*fClass->AllocateInMemInstance(), 6));
}

TEST_F(InMemPropertyTest, PropertiesBeyondThoseBehindTheInstanceKnowTheirPlaces)
{
    const std::uint32_t behind = TInMemProperty::kMostBehindInstance;
    const std::uint32_t late = TInMemProperty::kMostInLateBlock;
    for (const std::uint32_t count : {behind, behind + 1, behind + late, behind + late + 1, behind + 3 * late + 5}) {
        GrowTo(count);
        EXPECT_EQ(Expected(count), Use(*fClass->AllocateInMemInstance(), count)) << count;
    }
}

TEST_F(InMemPropertyTest, AValueIsMovedIntoASlotBehindTheInstance)
{
    GrowTo(2);
    const auto instance = fClass->AllocateInMemInstance();
    TCIMValue value = Uint64(7);
    EXPECT_TRUE(instance->FillSlot(1, value));
    EXPECT_TRUE(value.IsNull());
    EXPECT_EQ(Uint64(7), instance->GetSlotValue(1));
    GrowTo(3);
    value = Uint64(8);
    EXPECT_FALSE(instance->FillSlot(2, value));
    EXPECT_EQ(Uint64(8), value) << "a value that finds no place stays";
    EXPECT_TRUE(instance->GetSlotValue(2).IsNull());
}

TEST_F(InMemPropertyTest, PropertiesThatComeLateKnowTheirPlaces)
{
    GrowTo(3);
    const auto instance = fClass->AllocateInMemInstance();
    EXPECT_EQ(Expected(3), Use(*instance, 3));
    GrowTo(5);
    const auto fourth = Handle(*instance, 4);
    GrowTo(100);
    const auto last = Handle(*instance, 99);
    const auto fresh = fClass->AllocateInMemInstance();
    EXPECT_EQ(Expected(100), Use(*fresh, 100));
    EXPECT_EQ(fourth, Handle(*instance, 4));
    EXPECT_EQ(last, Handle(*instance, 99));
    EXPECT_EQ("Property99", last->GetPropertyDecl(kNoContext)->GetName(kNoContext));
}

TEST_F(InMemPropertyTest, TheLastPropertyMayBeAskedForFirst)
{
    const auto instance = fClass->AllocateInMemInstance();
    GrowTo(300);
    Handle(*instance, 299)->SetValue(Uint64(7), kNoContext);
    EXPECT_EQ("7", Handle(*instance, 299)->GetValue(kNoContext).ToText());
    EXPECT_EQ(Expected(300), Use(*instance, 300));
}

TEST_F(InMemPropertyTest, AHandleKeepsItsInstanceWhereverThePropertyStands)
{
    GrowTo(200);
    std::vector<boost::shared_ptr<ICIMProperty>> handles;
    {
        const auto instance = fClass->AllocateInMemInstance();
        Use(*instance, 200);
        for (const std::uint32_t number : {0U, 127U, 128U, 199U}) {
            handles.push_back(Handle(*instance, number));
        }
    }
    std::string values;
    for (const auto& handle : handles) {
        values += handle->GetValue(kNoContext).ToText() + " ";
        handle->MarkChanged(Uint64(1));
        EXPECT_TRUE(dynamic_cast<const TInMemProperty&>(*handle).IsChanged());
    }
    EXPECT_EQ("0 2127 128 2199 ", values);
}

/// A key that changes and is marked while the instance is in the namespace: the key as added and the earlier value are two things.
TEST_F(InMemPropertyTest, AMarkedKeyKeepsItsFirstValueAndItsEarlierOne)
{
    const auto instance = Add(fClass, {{"Property0", Uint64(1)}});
    auto& key = *instance->FindProperty("Property0");
    key.SetValue(Uint64(2), kNoContext);
    key.MarkChanged(Uint64(3));
    key.MarkChanged(Uint64(4));
    key.MarkRemoved();
    EXPECT_EQ("root/cimv2:Wide.Property0=1", instance->GetReference().GetPath());
    EXPECT_EQ("2", key.GetEarlierValue()->ToText());
    EXPECT_EQ("4", key.GetValue().ToText());
    fNamespace->DeleteInstance(instance->GetReference(), kNoContext);
    EXPECT_EQ("root/cimv2:Wide.Property0=4", instance->GetReference().GetPath());
    EXPECT_EQ("2", key.GetEarlierValue()->ToText());
    EXPECT_TRUE(key.IsRemoved());
}

}  // namespace
}  // namespace NORVZEL20
