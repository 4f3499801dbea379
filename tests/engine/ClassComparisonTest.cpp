#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/services/TAssertionFailure.h"
#include "tests/engine/TEngineFixture.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

// The comparison of one class, without a walk from "<root>". Disk > Ssd, and Card beside them; everything of each is compared.
class ClassComparisonTest : public TEngineFixture, public testing::WithParamInterface<EHost> {
  protected:
    ClassComparisonTest() : TEngineFixture(GetParam())
    {
        for (std::size_t index = 0; index < fNamespaces.size(); ++index) {
            fComparison.Namespace(index).Class("Ssd", "Disk", {}).Class("Card", "", {TNamespaceBuilder::Key("Id")});
        }
        const auto everything = boost::make_shared<TEngine::TDiffClassRules>(
            TEngine::INCLUDE, std::map<std::string, TEngine::propType>(), std::vector<std::string>());
        for (const std::string name : {"Disk", "Ssd", "Card"}) {
            TTestAccess::Ruleset(Engine()).addToRuleset(name, everything, true);
        }
    }

    std::string RecordsOf(const std::string& name)
    {
        const auto cls = fNamespaces[0]->GetClass(name, fNone);
        Watch().Forget();
        Engine().compare(cls);
        return fComparison.Records();
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, ClassComparisonTest, testing::Values(EHost::kPlain, EHost::kInmem),
                         testing::PrintToStringParamName());

TEST_P(ClassComparisonTest, AClassIsComparedWithItsSubclassesAndNothingElse)
{
    fComparison.Namespace(0).Instance("Disk", {{"Bus", 0u}, {"Id", "sda"}}).Instance("Card", {{"Id", "x"}});
    fComparison.Namespace(0).Instance("Ssd", {{"Bus", 0u}, {"Id", "nvme"}});
    EXPECT_EQ("Disk\n  1 Disk.Bus=0,Id=\"sda\" [1]\n"
              "Ssd\n  1 Ssd.Bus=0,Id=\"nvme\" [1]\n",
              RecordsOf("Disk"));
    EXPECT_EQ(0u, Watch().CountOf("<root>") + Watch().CountOf("Card"));
}

TEST_P(ClassComparisonTest, ASubclassIsComparedWithoutItsSuperclass)
{
    fComparison.Namespace(0).Instance("Disk", {{"Bus", 0u}, {"Id", "sda"}}).Instance("Ssd", {{"Bus", 0u}, {"Id", "nvme"}});
    EXPECT_EQ("Ssd\n  1 Ssd.Bus=0,Id=\"nvme\" [1]\n", RecordsOf("Ssd"));
    EXPECT_EQ(0u, Watch().CountOf("ns0:Disk."));
}

TEST_P(ClassComparisonTest, EachCallComparesAgain)
{
    fComparison.Namespace(0).Instance("Card", {{"Id", "x"}});
    const std::string once = RecordsOf("Card");
    EXPECT_EQ("Card\n  1 Card.Id=\"x\" [1]\n", once);
    EXPECT_EQ(once + once, RecordsOf("Card"));
}

TEST_P(ClassComparisonTest, ANullClassFailsTheAssertion)
{
    EXPECT_THROW(Engine().compare(nullptr), TAssertionFailure);
    EXPECT_EQ(0u, fLog.Take().find("0|Assertion failed: px != 0"));
    EXPECT_EQ("", fComparison.Records());
}

}  // namespace
}  // namespace NORVZEL20
