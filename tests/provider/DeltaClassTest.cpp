#include <boost/function/function_base.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>

#include "provider/TCallbackWrapClass.h"
#include "provider/TDeltaClass.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedClass.h"

namespace NORVZEL20 {
namespace {

using TClassCallback = boost::function<bool(boost::shared_ptr<ICIMClass>)>;

// Base > Sub, and here also Base > Twin, in each compared namespace.
class DeltaClassTest : public TDeltaFixture {
  protected:
    DeltaClassTest()
    {
        for (std::size_t index = 0; index < 3; ++index) {
            fComparison.Namespace(index).Class("Twin", "Base", {}).Instance("Base", {{"Id", "a"}});
        }
    }

    boost::shared_ptr<TDeltaClass> Wrapper(const std::string& name, unsigned short index)
    {
        const auto wrapper = boost::dynamic_pointer_cast<TDeltaClass>(Delta().GetClass(name, At(index)));
        Watch().Forget();
        return wrapper;
    }

    // Collects the classes of an enumeration.
    TClassCallback Collect(bool answer = true)
    {
        return [this, answer](boost::shared_ptr<ICIMClass> cls) { return fClasses.push_back(cls), answer; };
    }

    std::vector<boost::shared_ptr<ICIMClass>> fClasses;
};

TEST_F(DeltaClassTest, TheSuperclassIsAWrapperOfTheSameNamespace)
{
    const auto sub = Wrapper("Sub", 1);
    const auto base = sub->GetSuperClass(At(1));
    EXPECT_EQ("ns1:Sub.GetSuperClass() {nsIndex=1}\n"
              "ns1:Base.GetName() {nsIndex=1}\n"
              "store.GetClass(\"Base\") {nsIndex=1}\n"
              "ns1.GetClass(\"Base\") {nsIndex=1}\n",
              Watch().TakeText());
    EXPECT_EQ(Delta().GetClass("Base", At(1)), base);
}

TEST_F(DeltaClassTest, TheSuperclassNeedsTheIndex)
{
    const auto sub = Wrapper("Sub", 1);
    EXPECT_EQ(38, StatusOf([&] { sub->GetSuperClass(kNoContext); }));
}

TEST_F(DeltaClassTest, TheSuperclassOfATopLevelClassFailsTheAssertion)
{
    const auto base = Wrapper("Base", 1);
    EXPECT_TRUE(FailsOnNull([&] { base->GetSuperClass(At(1)); }));
}

// The compared namespace has KALMO_Delta too, above and below other classes.
TEST_F(DeltaClassTest, AClassThatTheStoreHasTooIsTheStores)
{
    fComparison.Namespace(1).Class("KALMO_Delta", "Base", {}).Class("Special", "KALMO_Delta", {});
    const auto own = TWatchedClass::Unwatched(Delta().GetClass("KALMO_Delta", kNoContext));
    const auto special = Wrapper("Special", 1);
    const auto above = special->GetSuperClass(At(1));
    EXPECT_EQ("ns1:Special.GetSuperClass() {nsIndex=1}\n"
              "ns1:KALMO_Delta.GetName() {nsIndex=1}\n"
              "store.GetClass(\"KALMO_Delta\") {nsIndex=1}\n",
              Watch().TakeText());
    EXPECT_EQ(own, TWatchedClass::Unwatched(above));
    EXPECT_EQ(own, TWatchedClass::Unwatched(special->GetSuperClass(kNoContext))) << "needs no index";
    Wrapper("Base", 1)->EnumerateSubClasses(Collect(), false, At(1));
    ASSERT_EQ(3u, fClasses.size());
    EXPECT_EQ(own, TWatchedClass::Unwatched(fClasses[2]));
}

TEST_F(DeltaClassTest, SubclassesAreWrappers)
{
    Wrapper("Base", 1)->EnumerateSubClasses(Collect(), false, At(1));
    EXPECT_EQ("ns1:Base.EnumerateSubClasses(false) {nsIndex=1}\n"
              "ns1:Sub.GetName() {nsIndex=1}\n"
              "store.GetClass(\"Sub\") {nsIndex=1}\n"
              "ns1.GetClass(\"Sub\") {nsIndex=1}\n"
              "ns1:Twin.GetName() {nsIndex=1}\n"
              "store.GetClass(\"Twin\") {nsIndex=1}\n"
              "ns1.GetClass(\"Twin\") {nsIndex=1}\n",
              Watch().TakeText());
    ASSERT_EQ(2u, fClasses.size());
    EXPECT_EQ(Delta().GetClass("Sub", At(1)), fClasses[0]);
    EXPECT_EQ(Delta().GetClass("Twin", At(1)), fClasses[1]);
}

TEST_F(DeltaClassTest, TheEnumerationEndsWhenTheCallbackSaysSo)
{
    Wrapper("Base", 1)->EnumerateSubClasses(Collect(false), true, At(1));
    EXPECT_EQ(1u, fClasses.size());
    EXPECT_EQ(1u, Watch().CountOf("EnumerateSubClasses(true) {nsIndex=1}"));
}

TEST_F(DeltaClassTest, AssociatedClassesAreWrappersAndTheTextsPassThrough)
{
    Wrapper("Base", 2)->EnumerateAssociatedClasses(Collect(), "a", "b", "c", "d", At(2));
    EXPECT_EQ(1u, Watch().CountOf("ns2:Base.EnumerateAssociatedClasses(\"a\", \"b\", \"c\", \"d\") {nsIndex=2}"));
    ASSERT_EQ(2u, fClasses.size());
    EXPECT_EQ(Delta().GetClass("Sub", At(2)), fClasses[0]);
}

TEST_F(DeltaClassTest, AssociationClassesAreWrappersAndTheTextsPassThrough)
{
    Wrapper("Base", 2)->EnumerateAssociationClasses(Collect(), "a", "b", At(2));
    EXPECT_EQ(1u, Watch().CountOf("ns2:Base.EnumerateAssociationClasses(\"a\", \"b\") {nsIndex=2}"));
    ASSERT_EQ(2u, fClasses.size());
    EXPECT_EQ(Delta().GetClass("Twin", At(2)), fClasses[1]);
}

TEST_F(DeltaClassTest, AnEmptyCallbackCannotBeCalled)
{
    const auto base = Wrapper("Base", 1);
    EXPECT_THROW(base->EnumerateSubClasses(TClassCallback(), false, At(1)), boost::bad_function_call);
    EXPECT_EQ("ns1:Base.EnumerateSubClasses(false) {nsIndex=1}\n"
              "ns1:Sub.GetName() {nsIndex=1}\n"
              "store.GetClass(\"Sub\") {nsIndex=1}\n"
              "ns1.GetClass(\"Sub\") {nsIndex=1}\n",
              Watch().TakeText());
}

TEST_F(DeltaClassTest, TheWrappingCallbackAsksWithItsOwnCopyOfTheContext)
{
    TCallContext context = At(2);
    const TClassCallback collect = Collect(false);
    const TCallbackWrapClass wrap(fComparison.GetDelta(), &collect, context);
    context.clear();
    const TClassCallback copy = wrap;
    EXPECT_FALSE(copy(fComparison.Watched(0)->GetClass("Sub", kNoContext)));
    ASSERT_EQ(1u, fClasses.size());
    EXPECT_EQ(Delta().GetClass("Sub", At(2)), fClasses[0]);
}

TEST_F(DeltaClassTest, ANullClassFailsTheAssertionOfTheWrappingCallback)
{
    const TClassCallback collect = Collect();
    const TCallbackWrapClass wrap(fComparison.GetDelta(), &collect, At(2));
    EXPECT_TRUE(FailsOnNull([&] { wrap(nullptr); }));
    EXPECT_TRUE(fClasses.empty());
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(DeltaClassTest, AncestryIsAskedOfTheWrappedClasses)
{
    const auto base = Wrapper("Base", 1);
    const auto sub = Wrapper("Sub", 1);
    EXPECT_TRUE(sub->IsSubclassOf(base, At(1)));
    EXPECT_EQ("ns1:Sub.IsSubclassOf(Base) {nsIndex=1}\n", Watch().TakeText());
    EXPECT_FALSE(base->IsSubclassOf(sub, At(1)));
}

TEST_F(DeltaClassTest, AncestryOfAClassThatIsNoWrapperFailsTheAssertion)
{
    const auto sub = Wrapper("Sub", 1);
    const auto raw = fComparison.Namespace(1).GetNamespace()->GetClass("Base", kNoContext);
    EXPECT_TRUE(FailsOnNull([&] { sub->IsSubclassOf(raw, At(1)); }));
}

TEST_F(DeltaClassTest, AncestryOfANullClassFailsTheAssertion)
{
    const auto sub = Wrapper("Sub", 1);
    EXPECT_TRUE(FailsOnNull([&] { sub->IsSubclassOf(nullptr, At(1)); }));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(DeltaClassTest, WrappersCompareByNameAlone)
{
    const auto base0 = Wrapper("Base", 0);
    const auto base1 = Wrapper("Base", 1);
    const auto sub = Wrapper("Sub", 0);
    EXPECT_TRUE(*base0 == *base1);
    EXPECT_EQ("ns0:Base.GetName() {}\nns1:Base.GetName() {}\n", Watch().TakeText());
    EXPECT_FALSE(*base0 < *base1);
    EXPECT_FALSE(*base1 < *base0);
    EXPECT_FALSE(*base0 == *sub);
    EXPECT_TRUE(*base0 < *sub);
    EXPECT_FALSE(*sub < *base0);
}

TEST_F(DeltaClassTest, APrefixStandsBeforeTheLongerName)
{
    fComparison.Namespace(0).Class("Bas", "", {}).Class("base", "", {});
    EXPECT_TRUE(*Wrapper("Bas", 0) < *Wrapper("Base", 0));
    EXPECT_FALSE(*Wrapper("Base", 0) < *Wrapper("Bas", 0));
    EXPECT_FALSE(*Wrapper("Base", 0) == *Wrapper("base", 0));
    EXPECT_TRUE(*Wrapper("Base", 0) < *Wrapper("base", 0));
}

TEST_F(DeltaClassTest, MethodsAreNotRun)
{
    TCallContext parameters = At(5);
    EXPECT_TRUE(Wrapper("Base", 1)->InvokeMethod("Run", parameters, At(1)).IsNull());
    EXPECT_EQ(1u, parameters.size());
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(DeltaClassTest, AssignmentCopiesNothing)
{
    const auto sub = Wrapper("Sub", 1);
    TCIMReference path;
    path.SetClassName("Own");
    sub->AddObjectPathAlias("own", path);
    // Another wrapper, without a namespace, with an alias.
    TDeltaClass other(nullptr, fComparison.Watched(0)->GetClass("Twin", kNoContext));
    other.AddObjectPathAlias("other", path);

    ICIMClass& target = *sub;
    EXPECT_EQ(&target, &(target = static_cast<const ICIMClass&>(other)));
    EXPECT_EQ(sub.get(), &(*sub = static_cast<const TDeltaClass&>(other)));
    EXPECT_EQ("Sub", sub->GetName(kNoContext));
    EXPECT_EQ(Delta().GetClass("Base", At(1)), sub->GetSuperClass(At(1)));
    EXPECT_EQ("1:Sub own -> Own\n", DumpAliases(Delta()));
}

TEST_F(DeltaClassTest, AWrapperKnowsItsOwner)
{
    const auto base = Wrapper("Base", 1);
    EXPECT_EQ(base, base->shared_from_this());
}

TEST_F(DeltaClassTest, ClearInstancesLeavesTheInstances)
{
    Wrapper("Base", 1)->ClearInstances();
    EXPECT_EQ("", Watch().TakeText());
    EXPECT_EQ("Base.Id=\"a\" Id=\"a\"\n", DumpInstances(fComparison.Namespace(1).GetNamespace(), "Base"));
}

TEST_F(DeltaClassTest, CollectedIsTheInterfacesOwnAnswer)
{
    const auto base = Wrapper("Base", 1);
    base->SetCollected();
    EXPECT_FALSE(base->hasCollected());
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(DeltaClassTest, TheFirstPathOfAnAliasStays)
{
    const auto base = Wrapper("Base", 1);
    EXPECT_TRUE(TTestAccess::Aliases(*base).empty());
    TCIMReference first;
    first.SetClassName("First");
    TCIMReference second;
    second.SetClassName("Second");
    base->AddObjectPathAlias("k", first);
    base->AddObjectPathAlias("k", second);
    base->AddObjectPathAlias("l", second);
    EXPECT_EQ("1:Base k -> First\n1:Base l -> Second\n", DumpAliases(Delta()));
}

TEST_F(DeltaClassTest, AWrapperHoldsNamespaceAndClass)
{
    boost::weak_ptr<TDeltaNamespace> delta;
    boost::weak_ptr<ICIMClass> wrapper;
    {
        const auto owner = MakeDeltaNamespace(EHost::kPlain);
        owner->AddNamespaceToCompareList(fComparison.Watched(0));
        wrapper = owner->GetClass("Base", At(0));
        delta = owner;
    }
    ASSERT_FALSE(delta.expired());
    TTestAccess::ForgetWrappers(*delta.lock());
    EXPECT_TRUE(wrapper.expired());
    EXPECT_TRUE(delta.expired());
}

}  // namespace
}  // namespace NORVZEL20
