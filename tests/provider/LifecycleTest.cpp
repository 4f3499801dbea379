#include <boost/smart_ptr/make_shared.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>

#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/plain/TPlainClass.h"
#include "tests/support/plain/TPlainNamespace.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

boost::shared_ptr<TDeltaNamespace> WithoutStore()
{
    return boost::make_shared<TDeltaNamespace>(boost::shared_ptr<const ICIMNamespace>());
}

TEST(LifecycleTest, AFreshNamespaceHasNothingToCompareAndNoSpecification)
{
    const auto delta = MakeDeltaNamespace(EHost::kInmem);
    EXPECT_EQ(0, delta->NumContainers());
    EXPECT_EQ("", TTestAccess::SpecFileName(*delta));
    EXPECT_TRUE(TTestAccess::ClassCache(*delta).empty());
    EXPECT_TRUE(TTestAccess::CompareList(*delta).empty());
    EXPECT_NE(nullptr, TTestAccess::Store(*delta));
}

TEST(LifecycleTest, TheSpecificationsNameIsKeptUnchecked)
{
    const auto delta = WithoutStore();
    for (const std::string name : {"/nonexistent/rules.xml", "a|fVMWareEnable", ""}) {
        delta->SetSpecFileName(name);
        EXPECT_EQ(name, TTestAccess::SpecFileName(*delta));
    }
}

TEST(LifecycleTest, NamespacesAreKeptInOrderEachWithItsOwnWrappers)
{
    const auto delta = WithoutStore();
    const auto first = MakeNamespace(EHost::kPlain, "first");
    const auto second = MakeNamespace(EHost::kPlain, "second");
    delta->AddNamespaceToCompareList(first);
    delta->AddNamespaceToCompareList(second);
    delta->AddNamespaceToCompareList(nullptr);
    EXPECT_EQ((std::vector<boost::shared_ptr<ICIMNamespace>>{first, second, nullptr}), TTestAccess::CompareList(*delta));
    EXPECT_EQ(3u, TTestAccess::ClassCache(*delta).size());
    EXPECT_EQ(3, delta->NumContainers());
}

TEST(LifecycleTest, TheSameNamespaceTwiceCountsTwice)
{
    const auto delta = MakeDeltaNamespace(EHost::kPlain);
    TNamespaceBuilder builder(MakeNamespace(EHost::kPlain, "root/cimv2"));
    builder.Class("Disk", "", {});
    delta->AddNamespaceToCompareList(builder.GetNamespace());
    delta->AddNamespaceToCompareList(builder.GetNamespace());
    EXPECT_EQ(2, delta->NumContainers());
    TCallContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(1));
    delta->GetClass("Disk", context);
    EXPECT_EQ(0u, TTestAccess::ClassCache(*delta)[0].size());
    EXPECT_EQ(1u, TTestAccess::ClassCache(*delta)[1].size());
    TTestAccess::ForgetWrappers(*delta);
}

TEST(LifecycleTest, TheNumberIsCutToSixteenBits)
{
    const auto delta = WithoutStore();
    for (int i = 0; i < 65535; ++i) {
        delta->AddNamespaceToCompareList(nullptr);
    }
    EXPECT_EQ(65535, delta->NumContainers());
    delta->AddNamespaceToCompareList(nullptr);
    EXPECT_EQ(0, delta->NumContainers());
    delta->AddNamespaceToCompareList(nullptr);
    EXPECT_EQ(1, delta->NumContainers());
}

TEST(LifecycleTest, WithoutAStoreEveryDelegatedOperationFailsTheAssertion)
{
    const auto delta = boost::make_shared<TDeltaNamespace>(MakeNamespace(EHost::kPlain, "root/cimv2"));
    EXPECT_EQ(nullptr, TTestAccess::Store(*delta));
    EXPECT_EQ(0, delta->NumContainers());
    EXPECT_EQ("", TTestAccess::SpecFileName(*delta));
    std::string text;
    EXPECT_TRUE(FailsOnNull([&] { delta->GetClass("KALMO_Delta", kNoContext); }));
    EXPECT_TRUE(FailsOnNull([&] { delta->GetInstance(TCIMReference(), kNoContext); }));
    EXPECT_TRUE(FailsOnNull([&] { delta->DeleteInstance(TCIMReference(), kNoContext); }));
    EXPECT_TRUE(FailsOnNull([&] { delta->ModifyInstance(TCIMReference(), kNoContext, kNoContext); }));
    EXPECT_TRUE(
        FailsOnNull([&] { delta->ExecuteQuery([](boost::shared_ptr<ICIMInstance>) { return true; }, text, text, kNoContext); }));
}

TEST(LifecycleTest, ANullComparedNamespaceFailsTheAssertionWhenItIsAsked)
{
    const auto delta = MakeDeltaNamespace(EHost::kPlain);
    delta->AddNamespaceToCompareList(nullptr);
    TCallContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    EXPECT_TRUE(FailsOnNull([&] { delta->GetClass("Disk", context); }));
    EXPECT_TRUE(FailsOnNull([&] { delta->GetQualifierDecl("Key", context); }));
    EXPECT_TRUE(
        FailsOnNull([&] { delta->EnumerateQualifierDecls([](boost::shared_ptr<ICIMQualifierDecl>) { return true; }, context); }));
}

TEST(LifecycleTest, DestructionReleasesStoreAndComparedNamespaces)
{
    auto delta = MakeDeltaNamespace(EHost::kInmem);
    auto compared = MakeNamespace(EHost::kInmem, "root/cimv2");
    const boost::weak_ptr<ICIMNamespace> store = TTestAccess::Store(*delta);
    const boost::weak_ptr<ICIMNamespace> weakCompared = compared;
    delta->AddNamespaceToCompareList(compared);
    compared.reset();
    EXPECT_FALSE(weakCompared.expired());
    delta.reset();
    EXPECT_TRUE(store.expired());
    EXPECT_TRUE(weakCompared.expired());
}

// A namespace that records its destruction.
class TMortalNamespace : public TWatchedNamespace {
  public:
    TMortalNamespace(const std::string& name, std::string& ends)
        : TWatchedNamespace(MakeNamespace(EHost::kPlain, name), boost::make_shared<TCallWatch>(), name), fName(name), fEnds(ends)
    {}
    ~TMortalNamespace() override { fEnds += fName + " "; }

  private:
    std::string fName;
    std::string& fEnds;
};

// A class that records its destruction.
class TMortalClass : public TPlainClass {
  public:
    TMortalClass(const std::string& name, std::string& ends) : TPlainClass(name, nullptr, nullptr), fEnds(ends) {}
    ~TMortalClass() override { fEnds += "class "; }

  private:
    std::string& fEnds;
};

TEST(LifecycleTest, TheStoreIsReleasedFirstThenTheComparedNamespacesThenTheWrappers)
{
    std::string ends;
    auto delta = WithoutStore();
    delta->AddNamespaceToCompareList(boost::make_shared<TMortalNamespace>("compared", ends));
    TTestAccess::SetStore(*delta, boost::make_shared<TMortalNamespace>("store", ends));
    // A wrapper that does not hold the namespace, unlike those that the namespace makes.
    TTestAccess::PutWrapper(*delta, 0, "Disk",
                            boost::make_shared<TDeltaClass>(nullptr, boost::make_shared<TMortalClass>("Disk", ends)));
    delta.reset();
    EXPECT_EQ("store compared class ", ends);
}

// What a namespace has: its specification, the number of namespaces, the number of maps of wrappers, and whether it has a store.
std::string StateOf(const TDeltaNamespace& ns)
{
    return TTestAccess::SpecFileName(ns) + " " + std::to_string(TTestAccess::CompareList(ns).size()) + " " +
           std::to_string(TTestAccess::ClassCache(ns).size()) + (TTestAccess::Store(ns) ? " store" : "");
}

TEST(LifecycleTest, AssignmentCopiesNothing)
{
    const auto full = MakeDeltaNamespace(EHost::kPlain);
    full->SetSpecFileName("rules.xml");
    full->AddNamespaceToCompareList(MakeNamespace(EHost::kPlain, "compared"));
    const auto bare = WithoutStore();
    bare->SetSpecFileName("own.xml");
    ASSERT_EQ("rules.xml 1 1 store", StateOf(*full));
    ASSERT_EQ("own.xml 0 0", StateOf(*bare));

    ICIMNamespace& target = *bare;
    EXPECT_EQ(&target, &(target = static_cast<ICIMNamespace&>(*full)));
    EXPECT_EQ("own.xml 0 0", StateOf(*bare));
    EXPECT_EQ(bare.get(), &(*bare = static_cast<const TDeltaNamespace&>(*full)));
    EXPECT_EQ("own.xml 0 0", StateOf(*bare));
    *full = static_cast<const TDeltaNamespace&>(*bare);
    EXPECT_EQ("rules.xml 1 1 store", StateOf(*full));
}

TEST(LifecycleTest, InitializeDoesNothing)
{
    const auto delta = WithoutStore();
    delta->Initialize();
    EXPECT_EQ(0, delta->NumContainers());
    EXPECT_EQ(nullptr, TTestAccess::Store(*delta));
}

}  // namespace
}  // namespace NORVZEL20
