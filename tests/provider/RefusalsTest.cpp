#include "provider/TDeltaClass.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using TClassCallback = boost::function<bool(boost::shared_ptr<ICIMClass>)>;
using TProviderCallback = boost::function<bool(boost::shared_ptr<IProvider>)>;
using TInstanceCallback = boost::function<bool(boost::shared_ptr<ICIMInstance>)>;

class RefusalsTest : public TDeltaFixture {
  protected:
    // Refused operations read no argument, change nothing and call nothing.
    void ExpectRefused(int status, const std::function<void()>& call)
    {
        EXPECT_EQ(status, StatusOf(call));
        EXPECT_EQ("", Watch().TakeText());
        EXPECT_EQ("", fLog.Take());
    }
};

TEST_F(RefusalsTest, TheNamespaceRefusesToBeChangedOrWalked)
{
    for (const TCallContext& context : {TCallContext(), At(0), At(9)}) {
        ExpectRefused(31, [&] { Delta().SetUpcallNamespace(nullptr, context); });
        ExpectRefused(31, [&] { Delta().AddUnderlyingNamespace(nullptr, context); });
        ExpectRefused(31, [&] { Delta().AllocateClass("Disk", nullptr, context); });
        ExpectRefused(31, [&] { Delta().EnumerateRootClasses(TClassCallback(), context); });
        ExpectRefused(31, [&] { Delta().EnumerateProviders(TProviderCallback(), context); });
        ExpectRefused(31, [&] {
            Delta().AllocateQualifierDecl("Key", TCIMValue(), ICIMQualifierDecl::kScopeNone, ICIMQualifierDecl::kFlavorNone,
                                          context);
        });
    }
    EXPECT_TRUE(TTestAccess::ClassCache(Delta())[0].empty());
}

TEST_F(RefusalsTest, SubscriptionsAreNotOffered)
{
    ExpectRefused(1, [&] { Delta().Subscribe(nullptr, TInstanceCallback(), TCallContext()); });
    ExpectRefused(1, [&] { Delta().Subscribe(nullptr, TInstanceCallback(), At(0)); });
}

TEST_F(RefusalsTest, AWrapperRefusesNewElementsAndItsOwnChange)
{
    const auto wrapper = Delta().GetClass("Base", At(1));
    Watch().Forget();
    const ICIMNamedElement& named = *wrapper;
    ExpectRefused(31, [&] { wrapper->AddToNamespace(At(1)); });
    ExpectRefused(31, [&] { wrapper->RemoveFromNamespace(At(1)); });
    ExpectRefused(31, [&] { wrapper->ModifyClass(nullptr, At(1)); });
    ExpectRefused(31, [&] { named.AllocateQualifier(nullptr, TCIMValue(), At(1)); });
    ExpectRefused(31, [&] { named.AllocateQualifier(nullptr, TCIMValue(), ICIMQualifierDecl::kFlavorNone, At(1)); });
    ExpectRefused(31, [&] { wrapper->AllocatePropertyDecl("Size", TCIMValue(), At(1)); });
    ExpectRefused(31, [&] { wrapper->AllocateInstance(At(1)); });
    ExpectRefused(31, [&] { wrapper->AllocateMethodDecl("Run", TCIMValue::TCIMType::kNone, At(1)); });
}

TEST_F(RefusalsTest, AWrapperDoesNotSayWhetherAQualifierIsThere)
{
    const auto wrapper = Delta().GetClass("Base", At(1));
    Watch().Forget();
    for (const bool before : {false, true}) {
        bool found = before;
        ExpectRefused(1, [&] { wrapper->GetQualifier("Key", found, At(1)); });
        EXPECT_EQ(before, found);
    }
}

}  // namespace
}  // namespace NORVZEL20
