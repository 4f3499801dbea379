#include "engine/TCompareInstances.h"
#include "engine/TMasterInstance.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/Dump.h"

namespace NORVZEL20 {
namespace {

using TMissing = std::map<std::string, std::vector<int>>;
using TDifferences = std::map<std::string, std::map<std::string, std::vector<int>>>;

std::string Text(const std::vector<int>& indices)
{
    std::string text;
    for (const int index : indices) {
        text += " " + std::to_string(index);
    }
    return text + "\n";
}

std::string Text(const TMissing& missing)
{
    std::string text;
    for (const auto& [key, indices] : missing) {
        text += key + Text(indices);
    }
    return text;
}

std::string Text(const TDifferences& differences)
{
    std::string text;
    for (const auto& [key, properties] : differences) {
        for (const auto& [name, indices] : properties) {
            text += key + " " + name + Text(indices);
        }
    }
    return text;
}

class InstanceComparisonTest : public TEngineFixture {
  protected:
    explicit InstanceComparisonTest(std::size_t namespaceCount = 2) : TEngineFixture(EHost::kPlain, namespaceCount) {}

    std::string Compare(boost::shared_ptr<ICIMInstance> master, boost::shared_ptr<ICIMInstance> other, unsigned int index = 1)
    {
        Engine().compare(fRules, master, other, "k", fProperties, fDifferences, index);
        return Text(fDifferences);
    }

    // The result for one property with these values in the two instances.
    std::string Compare(const std::string& name, const TCIMValue& master, const TCIMValue& other)
    {
        fDifferences.clear();
        fProperties = {name};
        return Compare(Disk(0, {{name, master}}), Disk(1, {{name, other}}));
    }

    boost::shared_ptr<TEngine::TDiffClassRules> fRules = RulesWithout("");
    std::vector<std::string> fProperties{"Size", "Tags"};
    TDifferences fDifferences;
};

TEST_F(InstanceComparisonTest, EqualInstancesLeaveNoTrace)
{
    fRules = RulesWithout("Bus");
    EXPECT_EQ("", Compare(Disk(0, {{"Id", "a"}, {"Size", 1u}}), Disk(1, {{"Id", "a"}, {"Size", 1u}})));
    EXPECT_EQ("", DumpAliases(fComparison.Delta()));
    EXPECT_EQ(0u, Watch().CountOf("GetReference"));
}

TEST_F(InstanceComparisonTest, ADifferenceStandsUnderKeyAndProperty)
{
    EXPECT_EQ("k Size 1\n", Compare(Disk(0, {{"Size", 1u}}), Disk(1, {{"Size", 2u}})));
}

TEST_F(InstanceComparisonTest, OnlyListedPropertiesCount)
{
    EXPECT_EQ("", Compare(Disk(0, {{"Id", "a"}, {"Bus", 1u}}), Disk(1, {{"Id", "b"}, {"Bus", 2u}})));
    fProperties.clear();
    EXPECT_EQ("", Compare(Disk(0, {{"Size", 1u}}), Disk(1, {{"Size", 2u}})));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(InstanceComparisonTest, WithTwoNamespacesTheMasterTakesTheOthersValue)
{
    const auto master = Disk(0, {{"Size", 1u}});
    const auto other = Disk(1, {{"Size", 2u}});
    Compare(master, other);
    EXPECT_EQ("2", master->GetProperty("Size", fNone)->GetValue(fNone).ToText());
    EXPECT_EQ("2", other->GetProperty("Size", fNone)->GetValue(fNone).ToText());
    EXPECT_EQ(1u, Watch().CountOf("MarkChanged(2)"));
    EXPECT_EQ(0u, Watch().CountOf("SetValue"));
}

TEST_F(InstanceComparisonTest, WithTwoNamespacesTheMasterTakesANullToo)
{
    const auto master = Disk(0, {{"Size", 1u}});
    EXPECT_EQ("k Size 1\n", Compare(master, Disk(1, {})));
    EXPECT_TRUE(master->GetProperty("Size", fNone)->GetValue(fNone).IsNull());
}

TEST_F(InstanceComparisonTest, ValuesAreEqualAsTheHostSays)
{
    EXPECT_EQ("", Compare("Size", TCIMValue(1u), TCIMValue(1u)));
    EXPECT_EQ("k Size 1\n", Compare("Size", TCIMValue(1u), TCIMValue(1)));
    EXPECT_EQ("k Id 1\n", Compare("Id", TCIMValue("a"), TCIMValue("A")));
    EXPECT_EQ("k Id 1\n", Compare("Id", TCIMValue(""), TCIMValue()));
    EXPECT_EQ("k Id 1\n", Compare("Id", TCIMValue(), TCIMValue("")));
    EXPECT_EQ("", Compare("Id", TCIMValue(), TCIMValue()));
}

TEST_F(InstanceComparisonTest, ArraysAreEqualElementByElement)
{
    const auto array = [](const std::vector<TCIMValue>& elements) {
        return TCIMValue(TCIMValue::TCIMType(TCIMValue::TCIMType::kArrayString), static_cast<unsigned int>(elements.size()),
                         elements);
    };
    EXPECT_EQ("", Compare("Tags", array({"a", "b"}), array({"a", "b"})));
    EXPECT_EQ("k Tags 1\n", Compare("Tags", array({"a", "b"}), array({"b", "a"})));
    EXPECT_EQ("k Tags 1\n", Compare("Tags", array({"a"}), array({"a", "b"})));
    EXPECT_EQ("k Tags 1\n", Compare("Tags", array({}), TCIMValue()));
}

TEST_F(InstanceComparisonTest, TheMastersValueIsTheOneThatIsAskedWhetherItIsEqual)
{
    const TCIMValue there(TCIMValue::TCIMType(TCIMValue::TCIMType::kArrayString), 2, {"a", "b"});
    const TCIMValue back(TCIMValue::TCIMType(TCIMValue::TCIMType::kArrayString), 2, {"b", "a"});
    EXPECT_EQ("", Compare("Tags", there.AsBag(), back));
    EXPECT_EQ("k Tags 1\n", Compare("Tags", there, back.AsBag()));
}

TEST_F(InstanceComparisonTest, ReferencesAreEqualWhereTheirPathsAre)
{
    EXPECT_EQ("", Compare("Owner", PathTo("root/cimv2", 1, "a"), PathTo("root/cimv2", 1, "a")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", PathTo("root/cimv2", 1, "a"), PathTo("root/cimv2", 1, "b")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", PathTo("root/cimv2", 1, "a"), PathTo("", 1, "a")));
}

TEST_F(InstanceComparisonTest, ExcludedKeysDoNotCountInReferences)
{
    fRules = RulesWithout("Bus");
    EXPECT_EQ("", Compare("Owner", PathTo("root/cimv2", 1, "a"), PathTo("root/other", 2, "a")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", PathTo("root/cimv2", 1, "a"), PathTo("root/cimv2", 1, "b")));
}

TEST_F(InstanceComparisonTest, ANullReferenceDiffersFromOneThatIsThere)
{
    const TCIMValue null = TCIMValue::Null(TCIMValue::TCIMType::kReference);
    EXPECT_EQ("k Owner 1\n", Compare("Owner", null, PathTo("", 1, "a")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", PathTo("", 1, "a"), null));
    EXPECT_EQ("", Compare("Owner", null, null));
}

TEST_F(InstanceComparisonTest, NullsAreEqualWhateverTheirTypes)
{
    const TCIMValue reference = TCIMValue::Null(TCIMValue::TCIMType::kReference);
    const TCIMValue text = TCIMValue::Null(TCIMValue::TCIMType::kString);
    for (const TCIMValue& other : {TCIMValue(), text}) {
        EXPECT_EQ("", Compare("Owner", reference, other));
        EXPECT_EQ("", Compare("Owner", other, reference));
    }
    EXPECT_EQ("", Compare("Id", text, TCIMValue()));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", PathTo("", 1, "a"), TCIMValue()));
}

TEST_F(InstanceComparisonTest, AChangeThatFailsLeavesItsEntryAndEndsTheComparison)
{
    fRules = RulesWithout("Bus");
    fProperties = {"Size", "Id"};
    const auto master = Disk(0, {{"Id", "a"}, {"Bus", 1u}, {"Size", 1u}});
    const auto other = Disk(1, {{"Id", "b"}, {"Bus", 2u}, {"Size", 2u}});
    Watch().FailCallsOf("ns0:Disk.Bus=1,Id=\"a\".Size.MarkChanged(2)", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", OutcomeOf([&] { Compare(master, other); }));
    EXPECT_EQ("k Size 1\n", Text(fDifferences));
    EXPECT_EQ("1", master->GetProperty("Size", fNone)->GetValue(fNone).ToText());
    EXPECT_EQ("", DumpAliases(fComparison.Delta()));
}

TEST_F(InstanceComparisonTest, AReferenceAgainstAnotherTypeIsAnErrorOfTheHost)
{
    EXPECT_EQ("status 13", OutcomeOf([&] { Compare("Owner", PathTo("", 1, "a"), TCIMValue("text")); }));
}

TEST_F(InstanceComparisonTest, AnotherTypeAgainstAReferenceDiffers)
{
    EXPECT_EQ("k Owner 1\n", Compare("Owner", TCIMValue("text"), PathTo("", 1, "a")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", TCIMValue("Disk.Bus=1,Id=\"a\""), PathTo("", 1, "a")));
    EXPECT_EQ("k Owner 1\n", Compare("Owner", TCIMValue(), PathTo("", 1, "a")));
    fRules = RulesWithout("Bus");
    EXPECT_EQ("k Owner 1\n", Compare("Owner", TCIMValue("text"), PathTo("", 1, "a")));
}

TEST_F(InstanceComparisonTest, BothPathsAreKeptAsAliasesWhereKeysAreExcluded)
{
    fRules = RulesWithout("Bus");
    Compare(Disk(0, {{"Id", "a"}, {"Bus", 1u}, {"Size", 1u}}), Disk(1, {{"Id", "a"}, {"Bus", 2u}, {"Size", 2u}}));
    EXPECT_EQ("0:Disk k -> root/cimv2:Disk.Bus=1,Id=\"a\"\n"
              "1:Disk k -> root/cimv2:Disk.Bus=2,Id=\"a\"\n",
              DumpAliases(fComparison.Delta()));
}

TEST_F(InstanceComparisonTest, APropertyThatIsNotThereIsAnErrorOfTheHost)
{
    fProperties = {"Size", "Nowhere", "Tags"};
    EXPECT_EQ("status 15", OutcomeOf([&] { Compare(Disk(0, {{"Size", 1u}}), Disk(1, {{"Size", 2u}})); }));
    EXPECT_EQ("k Size 1\n", Text(fDifferences));
}

class ThreeNamespacesTest : public InstanceComparisonTest {
  protected:
    ThreeNamespacesTest() : InstanceComparisonTest(3) {}
};

TEST_F(ThreeNamespacesTest, TheMasterIsLeftAsItIs)
{
    const auto master = Disk(0, {{"Size", 1u}});
    EXPECT_EQ("", Compare(master, Disk(1, {{"Size", 1u}}), 1));
    EXPECT_EQ("k Size 2\n", Compare(master, Disk(2, {{"Size", 2u}}), 2));
    EXPECT_EQ("1", master->GetProperty("Size", fNone)->GetValue(fNone).ToText());
    EXPECT_EQ(0u, Watch().CountOf("MarkChanged") + Watch().CountOf("SetValue"));
}

TEST_F(ThreeNamespacesTest, IndicesAreAppendedForEachInstance)
{
    const auto master = Disk(0, {{"Size", 1u}});
    Compare(master, Disk(1, {{"Size", 2u}}), 1);
    Compare(master, Disk(1, {{"Size", 3u}}), 1);
    EXPECT_EQ("k Size 1 1 2\n", Compare(master, Disk(2, {{"Size", 2u}}), 2));
}

class CompareInstancesTest : public ThreeNamespacesTest {
  protected:
    // The result of one more instance in the namespace at that position.
    std::string Take(std::size_t index, const TNamespaceBuilder::TValues& values)
    {
        TEngine::TCompareInstances take(&Engine(), fRules, &fMasters, &fMissing, &fDifferences, static_cast<unsigned int>(index),
                                        &fProperties);
        TEngine::TCompareInstances copy(take);
        const auto instance = Disk(index, values);
        EXPECT_TRUE(copy(instance));
        return "missing:" + Text(fMissing) + "different:" + Text(fDifferences);
    }

    void AddMaster(const TNamespaceBuilder::TValues& values)
    {
        std::vector<boost::shared_ptr<ICIMInstance>> disks{Disk(0, values)};
        Engine().buildInstanceMap(fRules, disks, fMasters);
    }

    std::map<std::string, TEngine::TMasterInstance> fMasters;
    TMissing fMissing;
};

TEST_F(CompareInstancesTest, AKnownKeyIsMarkedAndCompared)
{
    AddMaster({{"Bus", 1u}, {"Id", "a"}, {"Size", 1u}});
    EXPECT_EQ("missing:different:Disk.Bus=1,Id=\"a\" Size 2\n", Take(2, {{"Bus", 1u}, {"Id", "a"}, {"Size", 2u}}));
    EXPECT_EQ(1, fMasters.begin()->second.found);
}

TEST_F(CompareInstancesTest, AnUnknownKeyIsMissing)
{
    AddMaster({{"Bus", 1u}, {"Id", "a"}});
    Take(1, {{"Bus", 1u}, {"Id", "b"}});
    EXPECT_EQ("missing:Disk.Bus=1,Id=\"b\" 1 2\ndifferent:", Take(2, {{"Bus", 1u}, {"Id", "b"}}));
    EXPECT_EQ(0, fMasters.begin()->second.found);
    EXPECT_EQ("", DumpAliases(fComparison.Delta()));
}

TEST_F(CompareInstancesTest, TwoInstancesWithOneKeyCountTwice)
{
    Take(1, {{"Bus", 1u}, {"Id", "b"}});
    EXPECT_EQ("missing:Disk.Bus=1,Id=\"b\" 1 1\ndifferent:", Take(1, {{"Bus", 1u}, {"Id", "b"}}));
}

TEST_F(CompareInstancesTest, AnUnknownKeyGetsAnAliasWhereKeysAreExcluded)
{
    fRules = RulesWithout("Bus");
    EXPECT_EQ("missing:Disk.Id=\"b\" 2\ndifferent:", Take(2, {{"Bus", 7u}, {"Id", "b"}}));
    EXPECT_EQ("2:Disk Disk.Id=\"b\" -> root/cimv2:Disk.Bus=7,Id=\"b\"\n", DumpAliases(fComparison.Delta()));
}

TEST_F(CompareInstancesTest, TheFirstAliasOfAKeyStays)
{
    fRules = RulesWithout("Bus");
    Take(2, {{"Bus", 7u}, {"Id", "b"}});
    Take(2, {{"Bus", 8u}, {"Id", "b"}});
    EXPECT_EQ("2:Disk Disk.Id=\"b\" -> root/cimv2:Disk.Bus=7,Id=\"b\"\n", DumpAliases(fComparison.Delta()));
}

}  // namespace
}  // namespace NORVZEL20
