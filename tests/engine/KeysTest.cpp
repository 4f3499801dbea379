#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/TAssertionFailure.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/TWatchedInstance.h"

namespace NORVZEL20 {
namespace {

class KeysTest : public TEngineFixture, public testing::WithParamInterface<EHost> {
  protected:
    KeysTest() : TEngineFixture(GetParam()) {}
};

INSTANTIATE_TEST_SUITE_P(Hosts, KeysTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(KeysTest, AnInstancesKeyIsItsPathWithoutANamespace)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_EQ("root/cimv2:Disk.Bus=1,Id=\"sda\"", disk->GetReference(fNone).GetPath());
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout(""), disk));
}

TEST_P(KeysTest, ExcludedKeysAreLeftOut)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_EQ("Disk.Id=\"sda\"", Engine().buildPath(RulesWithout("Bus"), disk));
    EXPECT_EQ("Disk.Bus=1", Engine().buildPath(RulesWithout("Id"), disk));
}

TEST_P(KeysTest, WithAllKeysExcludedTheClassIsLeft)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    const auto other = Disk(0, {{"Id", "sdb"}, {"Bus", 2u}});
    EXPECT_EQ("Disk", Engine().buildPath(RulesWithout("Bus Id"), disk));
    EXPECT_EQ("Disk", Engine().buildPath(RulesWithout("Bus Id"), other));
    EXPECT_EQ("Disk", Engine().buildPath(RulesWithout("Bus Id"), PathTo("root/cimv2", 1, "sda")));
}

TEST_P(KeysTest, ExcludingWhatIsNoKeyHasNoEffect)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout("Size Nothing"), disk));
}

TEST_P(KeysTest, LetterCaseOfExcludedKeysCounts)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout("bus ID"), disk));
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout("bus ID"), PathTo("root/cimv2", 1, "sda")));
}

TEST_P(KeysTest, APathIsTakenAsItIsWhereNoKeyIsExcluded)
{
    EXPECT_EQ("root/cimv2:Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout(""), PathTo("root/cimv2", 1, "sda")));
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout(""), PathTo("", 1, "sda")));
}

TEST_P(KeysTest, APathIsRebuiltWithoutNamespaceWhereKeysAreExcluded)
{
    EXPECT_EQ("Disk.Id=\"sda\"", Engine().buildPath(RulesWithout("Bus"), PathTo("root/other", 1, "sda")));
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout("Nothing"), PathTo("root/other", 1, "sda")));
}

TEST_P(KeysTest, ExcludedKeysAreNotEvenRead)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    Engine().buildPath(RulesWithout("Bus"), disk);
    EXPECT_EQ(0u, Watch().CountOf("GetProperty(\"Bus\")"));
    EXPECT_EQ(1u, Watch().CountOf("GetProperty(\"Id\") {}"));
}

TEST_P(KeysTest, KeysAreReadInTheClassesOrder)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    Engine().buildPath(RulesWithout(""), disk);
    EXPECT_EQ("ns0:Disk.Bus=1,Id=\"sda\".GetClass() {}\n"
              "ns0:Disk.EnumerateKeyNames() {}\n"
              "ns0:Disk.Bus=1,Id=\"sda\".GetClass() {}\n"
              "ns0:Disk.Bus=1,Id=\"sda\".GetProperty(\"Bus\") {}\n"
              "ns0:Disk.Bus=1,Id=\"sda\".Bus.GetValue() {}\n"
              "ns0:Disk.Bus=1,Id=\"sda\".GetProperty(\"Id\") {}\n"
              "ns0:Disk.Bus=1,Id=\"sda\".Id.GetValue() {}\n",
              Watch().TakeText());
}

TEST_P(KeysTest, ErrorsOfTheHostPassThrough)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    Watch().FailCallsOf("ns0:Disk.EnumerateKeyNames", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", OutcomeOf([&] { Engine().buildPath(RulesWithout(""), disk); }));
}

// An instance that lacks all its properties.
class TBareInstance : public TWatchedInstance {
  public:
    explicit TBareInstance(boost::shared_ptr<ICIMInstance> instance)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "bare", "bare")
    {}

    boost::shared_ptr<ICIMProperty> GetProperty(const std::string&, TCallContext) const override { return nullptr; }
};

TEST_P(KeysTest, AKeyPropertyThatIsNullFailsTheAssertion)
{
    const auto bare = boost::make_shared<TBareInstance>(Disk(0, {{"Id", "sda"}, {"Bus", 1u}}));
    EXPECT_THROW(Engine().buildPath(RulesWithout("Bus"), bare), TAssertionFailure);
    EXPECT_NE(std::string::npos, fLog.Take().find("px != 0"));
    EXPECT_EQ("Disk", Engine().buildPath(RulesWithout("Bus Id"), bare));
}

TEST_P(KeysTest, NullRulesFailTheAssertion)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_THROW(Engine().buildPath(nullptr, disk), TAssertionFailure);
    EXPECT_THROW(Engine().buildPath(nullptr, PathTo("", 1, "sda")), TAssertionFailure);
}

}  // namespace
}  // namespace NORVZEL20
