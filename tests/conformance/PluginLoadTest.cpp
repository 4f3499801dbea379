#include <gtest/gtest.h>

#include "embedded/services/TProviderLibrary.h"
#include "host/ICIMNamespace.h"
#include "host/TNamespaceProviderManager.h"
#include "host/TZELException.h"

namespace NORVZEL20 {
namespace {

using TNames = std::vector<std::string>;

/// The status that `call` throws, or kSuccess (0) if it throws nothing.
template <class TCall>
int StatusOf(const TCall& call)
{
    try {
        call();
    } catch (const TZELException& error) {
        return error.GetStatusCode().GetStatus();
    }
    return 0;
}

class PluginLoadTest : public testing::Test {
  protected:
    static boost::shared_ptr<TNamespaceProviderManager> Manager() { return TNamespaceProviderManager::GetInstance(); }

    static boost::shared_ptr<INamespaceProvider> LoadProvider()
    {
        TProviderLibrary::Load(CIMDELTA_PLUGIN);
        return Manager()->FindProvider("delta");
    }

    static boost::shared_ptr<ICIMNamespace> Allocate(bool flag, const std::string& name)
    {
        return LoadProvider()->AllocateNamespace(TCallContext(), flag, name);
    }
};

TEST_F(PluginLoadTest, LoadingRegistersTheProviderOnceAndNothingElse)
{
    ASSERT_EQ(TNames({"inmem"}), Manager()->GetProviderNames());
    EXPECT_EQ(TNames({"delta"}), TProviderLibrary::Load(CIMDELTA_PLUGIN).GetProviderNames());
    EXPECT_EQ(TNames({"inmem", "delta"}), Manager()->GetProviderNames());
    EXPECT_EQ(TNames(), TProviderLibrary::Load(CIMDELTA_PLUGIN).GetProviderNames());
}

TEST_F(PluginLoadTest, TheProviderDescribesItself)
{
    const boost::shared_ptr<INamespaceProvider> provider = LoadProvider();
    EXPECT_EQ("delta", provider->GetName(TCallContext()));
    EXPECT_EQ(1, provider->GetType(TCallContext()));
    EXPECT_FALSE(provider->IsIndicationsSupported(TCallContext()));
}

TEST_F(PluginLoadTest, NamespacesAreIndependentWhateverTheArguments)
{
    const boost::shared_ptr<ICIMNamespace> one = Allocate(false, "root/cimv2");
    const boost::shared_ptr<ICIMNamespace> other = Allocate(true, "");
    EXPECT_NE(one, other);
    EXPECT_NE(one->GetClass("KALMO_Delta", TCallContext()), other->GetClass("KALMO_Delta", TCallContext()));
    EXPECT_EQ("delta", one->GetNamespaceProvider(TCallContext())->GetName(TCallContext()));
}

TEST_F(PluginLoadTest, TheDeltaSchemaIsThereAndClosed)
{
    const boost::shared_ptr<ICIMNamespace> ns = Allocate(false, "root/cimv2");
    for (const char* name : {"KALMO_DeltaClass", "KALMO_Delta", "KALMO_DeltaClassAssocToDelta"}) {
        EXPECT_EQ(name, ns->GetClass(name, TCallContext())->GetName(TCallContext()));
    }
    EXPECT_EQ(31, StatusOf([&] { ns->AllocateClass("X", boost::shared_ptr<ICIMClass>(), TCallContext()); }));
    EXPECT_EQ(38, StatusOf([&] { ns->GetClass("KALMO_OperatingSystem", TCallContext()); }));
}

}  // namespace
}  // namespace NORVZEL20
