#include <gmock/gmock.h>

#include "host/TNamespacePopulator.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TOSSpecific.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using testing::UnorderedElementsAre;

boost::shared_ptr<TDeltaNamespace> Allocate(const TCallContext& context, bool flag, const std::string& name)
{
    const auto ns = TDeltaNamespaceProvider::GetInstance()->AllocateNamespace(context, flag, name);
    return boost::dynamic_pointer_cast<TDeltaNamespace>(ns);
}

TEST(ProviderTest, LoadingTheLibraryRegistersDeltaAndNothingElse)
{
    EXPECT_THAT(TNamespaceProviderManager::GetInstance()->GetProviderNames(), UnorderedElementsAre("inmem", "delta"));
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("delta");
    EXPECT_EQ(TDeltaNamespaceProvider::GetInstance(), provider);
}

TEST(ProviderTest, TellsItsNameAndKind)
{
    const auto provider = TDeltaNamespaceProvider::GetInstance();
    EXPECT_EQ("delta", provider->GetName(kNoContext));
    EXPECT_EQ(&provider->GetName(kNoContext), &provider->GetName(kNoContext));
    EXPECT_EQ(1, provider->GetType(kNoContext));
    EXPECT_FALSE(provider->IsIndicationsSupported(kNoContext));
}

TEST(ProviderTest, ThereIsOneProvider)
{
    EXPECT_NE(nullptr, TDeltaNamespaceProvider::GetInstance());
    EXPECT_EQ(TDeltaNamespaceProvider::GetInstance().get(), TDeltaNamespaceProvider::GetInstance().get());
}

TEST(ProviderTest, InitializeSucceedsWhateverTheManagerAnswers)
{
    const auto again = TNamespaceProviderManager::GetInstance()->RegisterProvider(TDeltaNamespaceProvider::GetInstance());
    ASSERT_NE(TZELStatusCode::kSuccess, again.GetStatus());
    EXPECT_EQ(TZELStatusCode::kSuccess, TDeltaNamespaceProvider::Initialize().GetStatus());
    EXPECT_THAT(TNamespaceProviderManager::GetInstance()->GetProviderNames(), UnorderedElementsAre("inmem", "delta"));
}

TEST(ProviderTest, EachNamespaceIsIndependent)
{
    const auto first = Allocate(kNoContext, false, "root/delta");
    const auto second = Allocate(kNoContext, false, "root/delta");
    ASSERT_TRUE(first && second);
    EXPECT_NE(first, second);
    EXPECT_NE(TTestAccess::Store(*first), TTestAccess::Store(*second));
    first->SetSpecFileName("rules.xml");
    first->AddNamespaceToCompareList(second);
    EXPECT_EQ("", TTestAccess::SpecFileName(*second));
    EXPECT_EQ(0, second->NumContainers());
}

TEST(ProviderTest, ArgumentsMakeNoDifference)
{
    TCallContext context;
    context["nsIndex"] = TCIMValue("no number");
    for (const bool flag : {false, true}) {
        for (const std::string name : {"", "root/cimv2", "any \xFF text"}) {
            const auto ns = Allocate(context, flag, name);
            ASSERT_TRUE(ns);
            EXPECT_EQ(0, ns->NumContainers());
            EXPECT_EQ("KALMO_Delta", ns->GetClass("KALMO_Delta", kNoContext)->GetName(kNoContext));
        }
    }
}

TEST(ProviderTest, TheHostLoadsTheSchemaIntoNamespacesOfInmemAlone)
{
    TCapturingLogger log;
    const std::string schema = TOSSpecific::GetZELRootPath() + "/data/deltaclasses.properties.xml";
    for (const boost::shared_ptr<ICIMNamespace>& ns : {boost::shared_ptr<ICIMNamespace>(), MakeNamespace(EHost::kPlain, "plain")}) {
        EXPECT_EQ(31, StatusOf([&] { TNamespacePopulator::PopulateFromXMLFile(ns, schema); }));
        EXPECT_EQ("0|" + schema + ": the namespace is not one of the provider \"inmem\"; load into one of those|", log.Take());
        EXPECT_EQ(11, StatusOf([&] { TNamespacePopulator::PopulateFromXMLFile(ns, schema + ".missing"); }));
        EXPECT_NE("", log.Take());
    }
}

TEST(ProviderTest, TheSchemaDeclaresWhatRecordsAreMadeOf)
{
    const auto ns = Allocate(kNoContext, false, "");
    const std::vector<std::pair<std::string, std::vector<std::string>>> classes = {
        {"KALMO_DeltaClass", {"ClassName"}},
        {"KALMO_Delta", {"Type", "InstanceName", "Property", "NamespaceIndices"}},
        {"KALMO_DeltaClassAssocToDelta", {"Class", "Delta"}}};
    for (const auto& [className, properties] : classes) {
        for (const auto& property : properties) {
            EXPECT_EQ(property, ns->GetClass(className, kNoContext)->GetPropertyDecl(property, kNoContext)->GetName(kNoContext));
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
