#include <gmock/gmock.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "engine/TMasterInstance.h"
#include "tests/engine/TEngineFixture.h"

namespace NORVZEL20 {
namespace {

using testing::ElementsAre;
constexpr auto INCLUDE = TEngine::INCLUDE;
constexpr auto EXCLUDE = TEngine::EXCLUDE;

class PropertyListTest : public TEngineFixture {
  protected:
    std::vector<std::string> List(TEngine::propType def, const std::map<std::string, TEngine::propType>& properties)
    {
        const auto rules = boost::make_shared<TEngine::TDiffClassRules>(def, properties, std::vector<std::string>());
        const auto disk = fNamespaces[0]->GetClass("Disk", fNone);
        Watch().Forget();
        return Engine().buildPropList(rules, disk);
    }
};

TEST_F(PropertyListTest, ByDefaultExcludedTheIncludedOnesAreListedInOrderOfName)
{
    EXPECT_THAT(List(EXCLUDE, {{"Size", INCLUDE}, {"Bus", INCLUDE}, {"Id", EXCLUDE}}), ElementsAre("Bus", "Size"));
    EXPECT_TRUE(List(EXCLUDE, {}).empty());
    EXPECT_TRUE(List(EXCLUDE, {{"Size", EXCLUDE}}).empty());
}

TEST_F(PropertyListTest, ByDefaultExcludedTheClassIsNotAsked)
{
    EXPECT_THAT(List(EXCLUDE, {{"Nowhere", INCLUDE}, {"DateTimeOfCollection", INCLUDE}}),
                ElementsAre("DateTimeOfCollection", "Nowhere"));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(PropertyListTest, ByDefaultIncludedAllButTheCollectionTimeAreListedInTheClassesOrder)
{
    EXPECT_THAT(List(INCLUDE, {}), ElementsAre("Bus", "Id", "Size", "Owner", "Tags"));
    EXPECT_THAT(List(INCLUDE, {{"DateTimeOfCollection", INCLUDE}}), ElementsAre("Bus", "Id", "Size", "Owner", "Tags"));
}

TEST_F(PropertyListTest, ExcludedOnesAreTakenOut)
{
    EXPECT_THAT(List(INCLUDE, {{"Size", EXCLUDE}, {"Bus", EXCLUDE}, {"Id", INCLUDE}, {"tags", EXCLUDE}, {"Nowhere", EXCLUDE}}),
                ElementsAre("Id", "Owner", "Tags"));
}

TEST_F(PropertyListTest, EveryOccurrenceIsTakenOut)
{
    const auto disk = fComparison.Namespace(0).GetNamespace()->GetClass("Disk", fNone);
    disk->AddPropertyDecl(disk->AllocatePropertyDecl("Size", TCIMValue(1u), fNone));
    EXPECT_THAT(List(INCLUDE, {}), ElementsAre("Bus", "Id", "Size", "Owner", "Tags", "Size"));
    EXPECT_THAT(List(INCLUDE, {{"Size", EXCLUDE}}), ElementsAre("Bus", "Id", "Owner", "Tags"));
}

TEST_F(PropertyListTest, OnlyDeclarationsAndTheirNamesAreAskedFor)
{
    List(INCLUDE, {});
    EXPECT_EQ(1u, Watch().CountOf("ns0:Disk.EnumeratePropertyDecls() {}"));
    EXPECT_EQ(Watch().GetCount(), 1 + Watch().CountOf(".Decl.GetName() {}"));
}

class InstanceMapTest : public TEngineFixture {
  protected:
    std::map<std::string, TEngine::TMasterInstance> fMap;
};

TEST_F(InstanceMapTest, InstancesStandUnderTheirKeysNotYetFound)
{
    std::vector<boost::shared_ptr<ICIMInstance>> disks{Disk(0, {{"Id", "b"}, {"Bus", 1u}}), Disk(0, {{"Id", "a"}, {"Bus", 2u}})};
    Engine().buildInstanceMap(RulesWithout("Bus"), disks, fMap);
    ASSERT_EQ(2u, fMap.size());
    EXPECT_EQ(disks[1], fMap["Disk.Id=\"a\""].instance);
    EXPECT_EQ(disks[0], fMap["Disk.Id=\"b\""].instance);
    EXPECT_EQ(0, fMap["Disk.Id=\"b\""].found);
}

TEST_F(InstanceMapTest, TheFirstOfSeveralWithTheSameKeyStays)
{
    std::vector<boost::shared_ptr<ICIMInstance>> disks{Disk(0, {{"Id", "a"}, {"Bus", 1u}}), Disk(0, {{"Id", "a"}, {"Bus", 1u}})};
    Engine().buildInstanceMap(RulesWithout(""), disks, fMap);
    ASSERT_EQ(1u, fMap.size());
    EXPECT_EQ(disks[0], fMap.begin()->second.instance);
    EXPECT_EQ("", fLog.Take());
}

TEST_F(InstanceMapTest, WhatIsInTheMapStays)
{
    std::vector<boost::shared_ptr<ICIMInstance>> first{Disk(0, {{"Id", "a"}, {"Bus", 1u}})};
    std::vector<boost::shared_ptr<ICIMInstance>> second{Disk(0, {{"Id", "a"}, {"Bus", 1u}}), Disk(0, {{"Id", "b"}, {"Bus", 1u}})};
    Engine().buildInstanceMap(RulesWithout(""), first, fMap);
    fMap.begin()->second.found = 1;
    Engine().buildInstanceMap(RulesWithout(""), second, fMap);
    ASSERT_EQ(2u, fMap.size());
    EXPECT_EQ(first[0], fMap.begin()->second.instance);
    EXPECT_EQ(1, fMap.begin()->second.found);
}

}  // namespace
}  // namespace NORVZEL20
