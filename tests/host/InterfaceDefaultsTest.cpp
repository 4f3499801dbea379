#include <gtest/gtest.h>

#include "tests/support/TComparisonRun.h"
#include "tests/support/plain/TPlainQualifier.h"

namespace NORVZEL20 {
namespace {

class InterfaceDefaultsTest : public testing::TestWithParam<EHost> {
  protected:
    InterfaceDefaultsTest() : fBuilder(MakeNamespace(GetParam(), "root/cimv2"))
    {
        fBuilder.Class("Disk", "", {TNamespaceBuilder::Key("Id")});
        fDisk = fBuilder.GetNamespace()->GetClass("Disk", TCallContext());
    }

    TNamespaceBuilder fBuilder;
    boost::shared_ptr<ICIMClass> fDisk;
};

TEST_P(InterfaceDefaultsTest, QualifierOperationsAreTheSameThroughEitherBase)
{
    const TCallContext none;
    ICIMNamedElement& named = *fDisk;
    named.AddQualifier(
        boost::shared_ptr<ICIMQualifier>(new TPlainQualifier("Note", TCIMValue("x"), ICIMQualifierDecl::kFlavorDefault)), none);
    EXPECT_EQ("x", fDisk->GetQualifier("Note", none)->GetValue(none).ToText());
    EXPECT_EQ(fDisk->GetQualifier("Note", none).get(), named.GetQualifier("Note", none).get());
}

INSTANTIATE_TEST_SUITE_P(Hosts, InterfaceDefaultsTest, testing::Values(EHost::kPlain, EHost::kInmem),
                         testing::PrintToStringParamName());

TEST(CollectedTest, AClassThatDoesNotOverrideItHasNeverCollected)
{
    TNamespaceBuilder builder(MakeNamespace(EHost::kPlain, "root/cimv2"));
    const auto disk = builder.Class("Disk", "", {}).GetNamespace()->GetClass("Disk", TCallContext());
    EXPECT_FALSE(disk->hasCollected());
    disk->SetCollected();
    EXPECT_FALSE(disk->hasCollected());
}

}  // namespace
}  // namespace NORVZEL20
