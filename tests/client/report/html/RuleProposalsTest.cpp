#include "client/report/html/TRuleProposals.h"

#include "client/comparison/TComparison.h"
#include "client/inventory/TInventoryLoader.h"
#include "tests/client/Documents.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"
#include "tests/client/TFakeConsole.h"

namespace NORVZEL20 {
namespace {

class RuleProposalsTest : public TClientFixture {};

TEST_F(RuleProposalsTest, FindingsOfOnePropertyHaveOneProposal)
{
    const std::string text = Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint64")));
    TFakeConsole console;
    std::vector<TInventory> inventories =
        TInventoryLoader(console).Load(SourcesOf({Scratch("a.xml", text), Scratch("b.xml", text)}));
    const TComparisonReport report = TComparison(inventories, console).Run(std::nullopt, false);
    TRuleProposals proposals(report);
    const TRuleProposals::TProposal& size = proposals.LeaveOutProperty("Disk", "Size.Used");
    EXPECT_NE(std::string::npos, size.xml.find("<value>Size</value>")) << size.xml;
    EXPECT_EQ(&size, &proposals.LeaveOutProperty("Disk", "Size.Free"));
    EXPECT_NE(&size, &proposals.LeaveOutProperty("Disk", "Id"));
    EXPECT_EQ(&proposals.LeaveOutClass("Disk"), &proposals.LeaveOutClass("Disk"));
}

}  // namespace
}  // namespace NORVZEL20
