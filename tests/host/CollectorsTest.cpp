#include <gmock/gmock.h>

#include <type_traits>

#include "host/TAddKeyBindingsToMapCallback.h"
#include "host/TAddKeyNamesToVectorCallback.h"
#include "host/TAddToVectorCallback.h"
#include "tests/support/TComparisonRun.h"

namespace NORVZEL20 {
namespace {

using testing::ElementsAre;
using EType = TCIMValue::TCIMType::ECIMType;

class CollectorsTest : public testing::TestWithParam<EHost> {
  protected:
    CollectorsTest() : fBuilder(MakeNamespace(GetParam(), "root/cimv2"))
    {
        fBuilder.Class("Base", "",
                       {TNamespaceBuilder::Key("Id"), TNamespaceBuilder::Key("Kind"), TNamespaceBuilder::Property("Size")});
        fBuilder.Class("Sub1", "Base", {}).Class("Sub2", "Base", {});
        fBuilder.Instance("Base", {{"Id", "a"}, {"Kind", "k"}}).Instance("Base", {{"Id", "b"}, {"Kind", "k"}});
        fBase = fBuilder.GetNamespace()->GetClass("Base", fNone);
    }

    const TCallContext fNone;
    TNamespaceBuilder fBuilder;
    boost::shared_ptr<ICIMClass> fBase;
};

TEST_P(CollectorsTest, ClassesAreCollectedInOrder)
{
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    fBase->EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(&classes), false, fNone);
    ASSERT_EQ(2u, classes.size());
    EXPECT_EQ("Sub1", classes[0]->GetName(fNone));
    EXPECT_EQ("Sub2", classes[1]->GetName(fNone));
}

TEST_P(CollectorsTest, InstancesAreCollectedInOrder)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    fBase->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, fNone);
    ASSERT_EQ(2u, instances.size());
    EXPECT_EQ("a", instances[0]->GetProperty("Id", fNone)->GetValue(fNone).ToText());
    EXPECT_EQ("b", instances[1]->GetProperty("Id", fNone)->GetValue(fNone).ToText());
}

TEST_P(CollectorsTest, PropertiesAndTheirDeclarationsAreCollectedInOrder)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    fBase->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, fNone);
    std::vector<boost::shared_ptr<ICIMProperty>> properties;
    instances[0]->EnumerateProperties(TAddToVectorCallback<ICIMProperty>(&properties), fNone);
    std::vector<boost::shared_ptr<ICIMPropertyDecl>> decls;
    fBase->EnumeratePropertyDecls(TAddToVectorCallback<ICIMPropertyDecl>(&decls), fNone);

    ASSERT_EQ(3u, decls.size());
    ASSERT_EQ(3u, properties.size());
    const std::vector<std::string> names{decls[0]->GetName(fNone), decls[1]->GetName(fNone), decls[2]->GetName(fNone)};
    EXPECT_THAT(names, ElementsAre("Id", "Kind", "Size"));
    EXPECT_EQ("Size", properties[2]->GetPropertyDecl(fNone)->GetName(fNone));
}

TEST_P(CollectorsTest, CollectedKeyNamesAreTheClassesOwnStrings)
{
    std::vector<const std::string*> first;
    std::vector<const std::string*> second;
    fBase->EnumerateKeyNames(TAddKeyNamesToVectorCallback(&first), fNone);
    fBase->EnumerateKeyNames(TAddKeyNamesToVectorCallback(&second), fNone);
    ASSERT_EQ(2u, first.size());
    EXPECT_EQ("Id", *first[0]);
    EXPECT_EQ("Kind", *first[1]);
    EXPECT_EQ(first, second);
}

TEST_P(CollectorsTest, EnumerationStopsAtTheFirstFalse)
{
    int seen = 0;
    const auto stop = [&](const auto&) { return ++seen, false; };
    fBase->EnumerateSubClasses(boost::function<bool(boost::shared_ptr<ICIMClass>)>(stop), false, fNone);
    EXPECT_EQ(1, seen);
    fBase->EnumerateInstances(boost::function<bool(boost::shared_ptr<ICIMInstance>)>(stop), false, fNone);
    EXPECT_EQ(2, seen);
    fBase->EnumeratePropertyDecls(boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)>(stop), fNone);
    EXPECT_EQ(3, seen);
    fBase->EnumerateKeyNames(boost::function<bool(const std::string*)>(stop), fNone);
    EXPECT_EQ(4, seen);
}

TEST_P(CollectorsTest, EnumerationOfPropertiesAndBindingsStopsAtTheFirstFalse)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    fBase->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, fNone);
    int seen = 0;
    const auto stop = [&](const auto&) { return ++seen, false; };
    instances[0]->EnumerateProperties(boost::function<bool(boost::shared_ptr<ICIMProperty>)>(stop), fNone);
    EXPECT_EQ(1, seen);
    instances[0]->GetReference(fNone).EnumerateKeyBindings(boost::function<bool(std::pair<std::string, TCIMValue>)>(stop));
    EXPECT_EQ(2, seen);
}

INSTANTIATE_TEST_SUITE_P(Hosts, CollectorsTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST(VectorCollectorTest, RepeatedElementsAreKept)
{
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    TAddToVectorCallback<ICIMClass> collect(&classes);
    EXPECT_TRUE(collect(nullptr));
    EXPECT_TRUE(collect(nullptr));
    EXPECT_EQ(2u, classes.size());
}

TEST(KeyNameCollectorTest, PointersAreNotCopied)
{
    const std::string name = "Id";
    std::vector<const std::string*> names;
    EXPECT_TRUE(TAddKeyNamesToVectorCallback(&names)(&name));
    EXPECT_THAT(names, ElementsAre(&name));
}

TEST(BindingCollectorTest, TheFirstValueOfANameStays)
{
    std::map<std::string, TCIMValue> bindings;
    TAddKeyBindingsToMapCallback collect(&bindings);
    EXPECT_TRUE(collect(std::make_pair(std::string("Name"), TCIMValue("a"))));
    EXPECT_TRUE(collect(std::make_pair(std::string("Name"), TCIMValue("b"))));
    ASSERT_EQ(1u, bindings.size());
    EXPECT_EQ("a", bindings["Name"].ToText());
}

TEST(CollectorTypesTest, EachIsAPredicateOfItsElement)
{
    using TClasses = TAddToVectorCallback<ICIMClass>;
    EXPECT_TRUE((std::is_same_v<TClasses::argument_type, boost::shared_ptr<ICIMClass>>));
    EXPECT_TRUE((std::is_same_v<TClasses::result_type, bool>));
    EXPECT_TRUE((std::is_same_v<TAddKeyNamesToVectorCallback::argument_type, const std::string*>));
    EXPECT_TRUE((std::is_same_v<TAddKeyBindingsToMapCallback::argument_type, std::pair<std::string, TCIMValue>>));
}

}  // namespace
}  // namespace NORVZEL20
