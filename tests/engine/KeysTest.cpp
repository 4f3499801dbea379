#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <list>

#include "embedded/services/TAssertionFailure.h"
#include "tests/engine/TBareInstance.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedInstance.h"

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

TEST_P(KeysTest, AKeyPropertyThatIsNullFailsTheAssertion)
{
    const auto bare = boost::make_shared<TBareInstance>(Disk(0, {{"Id", "sda"}, {"Bus", 1u}}));
    EXPECT_THROW(Engine().buildPath(RulesWithout("Bus"), bare), TAssertionFailure);
    EXPECT_NE(std::string::npos, fLog.Take().find("px != 0"));
    EXPECT_EQ("Disk", Engine().buildPath(RulesWithout("Bus Id"), bare));
}

using TNames = std::list<std::string>;

// A class whose key names become invalid when it is destroyed.
class TPassingClass : public TWatchedClass {
  public:
    TPassingClass(boost::shared_ptr<ICIMClass> cls, boost::shared_ptr<TNames> names)
        : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "passing"), fNames(names)
    {}
    ~TPassingClass() override { std::fill(fNames->begin(), fNames->end(), "gone"); }

    void EnumerateKeyNames(const boost::function<bool(const std::string*)>& callback, TCallContext context) const override
    {
        const auto keepAndPassOn = [&](const std::string* name) { return callback(&fNames->emplace_back(*name)); };
        GetWatched()->EnumerateKeyNames(keepAndPassOn, context);
    }

  private:
    boost::shared_ptr<TNames> fNames;
};

// An instance that makes a new class for each call and keeps none.
class TInstanceOfPassingClass : public TWatchedInstance {
  public:
    explicit TInstanceOfPassingClass(boost::shared_ptr<ICIMInstance> instance)
        : TWatchedInstance(instance, boost::make_shared<TCallWatch>(), "passing", "passing")
    {}

    boost::shared_ptr<ICIMClass> GetClass(TCallContext context) const override
    {
        fNames.push_back(boost::make_shared<TNames>());
        return boost::make_shared<TPassingClass>(GetWatched()->GetClass(context), fNames.back());
    }

  private:
    mutable std::vector<boost::shared_ptr<TNames>> fNames;  // kept, so a name that is read too late shows as changed
};

TEST_P(KeysTest, TheClassIsHeldUntilItsKeyNamesAreRead)
{
    const auto disk = boost::make_shared<TInstanceOfPassingClass>(Disk(0, {{"Id", "sda"}, {"Bus", 1u}}));
    EXPECT_EQ("Disk.Bus=1,Id=\"sda\"", Engine().buildPath(RulesWithout(""), disk));
    EXPECT_EQ("Disk.Id=\"sda\"", Engine().buildPath(RulesWithout("Bus"), disk));
}

TEST_P(KeysTest, NullRulesFailTheAssertion)
{
    const auto disk = Disk(0, {{"Id", "sda"}, {"Bus", 1u}});
    EXPECT_THROW(Engine().buildPath(nullptr, disk), TAssertionFailure);
    EXPECT_THROW(Engine().buildPath(nullptr, PathTo("", 1, "sda")), TAssertionFailure);
}

}  // namespace
}  // namespace NORVZEL20
