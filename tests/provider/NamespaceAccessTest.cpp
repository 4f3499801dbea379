#include <boost/smart_ptr/bad_weak_ptr.hpp>
#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>
#include <typeinfo>

#include "host/TZELException.h"
#include "provider/TDeltaClass.h"
#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

class NamespaceAccessTest : public TDeltaFixture {
  protected:
    std::size_t CacheSize(std::size_t index) { return TTestAccess::ClassCache(Delta())[index].size(); }
};

TEST_F(NamespaceAccessTest, ClassesOfTheStoreAreAnsweredByItWithoutAnIndex)
{
    const auto cls = Delta().GetClass("KALMO_Delta", kNoContext);
    EXPECT_EQ("store.GetClass(\"KALMO_Delta\") {}\n", Watch().TakeText());
    EXPECT_EQ("KALMO_Delta", cls->GetName(kNoContext));
    EXPECT_EQ(nullptr, boost::dynamic_pointer_cast<TDeltaClass>(cls));
    EXPECT_EQ(0u, CacheSize(0) + CacheSize(1) + CacheSize(2));
}

TEST_F(NamespaceAccessTest, AClassOfTheStoreIsTheStoresOwnObject)
{
    const auto store = TNamespaceBuilder(MakeNamespace(EHost::kPlain, "root/cimv2")).DeltaSchema().GetNamespace();
    TTestAccess::SetStore(Delta(), store);
    EXPECT_EQ(store->GetClass("KALMO_Delta", kNoContext), Delta().GetClass("KALMO_Delta", At(1)));
}

TEST_F(NamespaceAccessTest, TheStoreIsAskedFirstWhateverTheIndex)
{
    fComparison.Namespace(1).Class("KALMO_Delta", "", {});
    Delta().GetClass("KALMO_Delta", At(9));
    EXPECT_EQ("store.GetClass(\"KALMO_Delta\") {nsIndex=9}\n", Watch().TakeText());
}

TEST_F(NamespaceAccessTest, OtherClassesComeWrappedFromTheNamespaceThatTheIndexNames)
{
    const auto cls = Delta().GetClass("Sub", At(1));
    EXPECT_EQ("store.GetClass(\"Sub\") {nsIndex=1}\n"
              "ns1.GetClass(\"Sub\") {nsIndex=1}\n",
              Watch().TakeText());
    const auto wrapper = boost::dynamic_pointer_cast<TDeltaClass>(cls);
    ASSERT_NE(nullptr, wrapper);
    EXPECT_EQ(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext),
              TWatchedClass::Unwatched(TTestAccess::WrappedClass(*wrapper)));
}

TEST_F(NamespaceAccessTest, StoreAndComparedNamespaceBothGetTheWholeContext)
{
    TCallContext context = At(2);
    context["locale"] = TCIMValue("en");
    Delta().GetClass("Base", context);
    EXPECT_EQ("store.GetClass(\"Base\") {locale=\"en\", nsIndex=2}\n"
              "ns2.GetClass(\"Base\") {locale=\"en\", nsIndex=2}\n",
              Watch().TakeText());
}

TEST_F(NamespaceAccessTest, AWrapperIsMadeOnceForEachPosition)
{
    const auto first = Delta().GetClass("Base", At(1));
    Watch().Forget();
    EXPECT_EQ(first, Delta().GetClass("Base", At(1)));
    EXPECT_EQ("store.GetClass(\"Base\") {nsIndex=1}\n", Watch().TakeText());
    EXPECT_NE(first, Delta().GetClass("Base", At(0)));
    EXPECT_EQ(1u, CacheSize(0));
    EXPECT_EQ(1u, CacheSize(1));
    EXPECT_EQ(0u, CacheSize(2));
}

TEST_F(NamespaceAccessTest, AClassUnknownEverywhereFailsAsTheComparedNamespaceDoes)
{
    EXPECT_EQ(15, StatusOf([&] { Delta().GetClass("Nowhere", At(1)); }));
    EXPECT_EQ("store.GetClass(\"Nowhere\") {nsIndex=1}\n"
              "ns1.GetClass(\"Nowhere\") {nsIndex=1}\n",
              Watch().TakeText());
    EXPECT_EQ(0u, CacheSize(1));
}

TEST_F(NamespaceAccessTest, AFailureOfTheComparedNamespaceKeepsItsStatus)
{
    Watch().FailCallsOf("ns1.GetClass", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ(18, StatusOf([&] { Delta().GetClass("Base", At(1)); }));
    EXPECT_EQ(0u, CacheSize(1));
    Watch().StopFailing();
    EXPECT_NE(nullptr, Delta().GetClass("Base", At(1)));
}

TEST_F(NamespaceAccessTest, AnUnknownClassNeedsAnIndex)
{
    EXPECT_EQ(38, StatusOf([&] { Delta().GetClass("Base", kNoContext); }));
    EXPECT_EQ("store.GetClass(\"Base\") {}\n", Watch().TakeText());
}

TEST_F(NamespaceAccessTest, AnIndexOutOfRangeIsPrintedAndRefused)
{
    testing::internal::CaptureStdout();
    EXPECT_EQ(15, StatusOf([&] { Delta().GetClass("Base", At(3)); }));
    EXPECT_EQ("Bad nsIndex, nsIndex=3\n", testing::internal::GetCapturedStdout());
}

// A namespace whose failures and answers the test chooses.
class TOddNamespace : public TWatchedNamespace {
  public:
    TOddNamespace(boost::shared_ptr<ICIMNamespace> ns, std::function<boost::shared_ptr<ICIMClass>()> answer)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "odd"), fAnswer(answer)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string&, TCallContext) override { return fAnswer(); }

  private:
    std::function<boost::shared_ptr<ICIMClass>()> fAnswer;
};

struct TSpecialException : TZELException {
    using TZELException::TZELException;
};

class OddNamespaceTest : public NamespaceAccessTest {
  protected:
    boost::shared_ptr<ICIMNamespace> Odd(std::function<boost::shared_ptr<ICIMClass>()> answer)
    {
        return boost::make_shared<TOddNamespace>(MakeNamespace(EHost::kPlain, "root/cimv2"), answer);
    }
};

TEST_F(OddNamespaceTest, AnotherStatusOfTheStoreIsThrownAnew)
{
    TTestAccess::SetStore(Delta(),
                          Odd([]() -> boost::shared_ptr<ICIMClass> { throw TSpecialException(TZELStatusCode::kNamespaceGone); }));
    try {
        Delta().GetClass("Base", At(1));
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
        EXPECT_EQ(typeid(TZELException), typeid(error));
    }
    EXPECT_EQ("", Watch().TakeText());
    EXPECT_EQ("", fLog.Take());
}

TEST_F(OddNamespaceTest, OtherExceptionsOfTheStorePassThrough)
{
    TTestAccess::SetStore(Delta(), Odd([]() -> boost::shared_ptr<ICIMClass> { throw std::out_of_range("own"); }));
    EXPECT_THROW(Delta().GetClass("Base", At(1)), std::out_of_range);
}

TEST_F(OddNamespaceTest, ANullOfTheStoreIsReturnedAsItIs)
{
    TTestAccess::SetStore(Delta(), Odd([] { return nullptr; }));
    EXPECT_EQ(nullptr, Delta().GetClass("Base", At(1)));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(OddNamespaceTest, ANullOfAComparedNamespaceIsWrapped)
{
    Delta().AddNamespaceToCompareList(Odd([] { return nullptr; }));
    const auto cls = Delta().GetClass("Base", At(3));
    ASSERT_NE(nullptr, cls);
    EXPECT_EQ(cls, Delta().GetClass("Base", At(3)));
    EXPECT_TRUE(FailsOnNull([&] { cls->GetName(kNoContext); }));
}

TEST_F(OddNamespaceTest, ExceptionsOfAComparedNamespacePassUnchanged)
{
    Delta().AddNamespaceToCompareList(
        Odd([]() -> boost::shared_ptr<ICIMClass> { throw TSpecialException(TZELStatusCode::kNotFound); }));
    EXPECT_THROW(Delta().GetClass("Base", At(3)), TSpecialException);
}

TEST(UnownedNamespaceTest, ANamespaceThatNobodyOwnsCannotWrap)
{
    TDeltaNamespace delta;
    TNamespaceBuilder builder(MakeNamespace(EHost::kPlain, "root/cimv2"));
    delta.AddNamespaceToCompareList(builder.Class("Base", "", {}).GetNamespace());
    TCallContext context;
    context["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    EXPECT_THROW(delta.GetClass("Base", context), boost::bad_weak_ptr);
    EXPECT_EQ("KALMO_Delta", delta.GetClass("KALMO_Delta", context)->GetName(kNoContext));
}

/// A prepared comparison of namespaces of which the first declares a class Disk.
class OneDiskTest : public testing::Test {
  protected:
    OneDiskTest()
    {
        fComparison.Namespace(0).Class("Disk", "", {TNamespaceBuilder::Key("Id")});
        fComparison.Prepare();
        fFirst["nsIndex"] = TCIMValue(static_cast<unsigned short>(0));
    }

    TComparisonRun fComparison{EHost::kInmem};
    TCallContext fFirst;
};

TEST_F(OneDiskTest, TheRootIsThatOfTheStoreWhateverTheIndex)
{
    for (const TCallContext& each : {TCallContext(), fFirst}) {
        const auto root = fComparison.Delta().GetClass("<root>", each);
        EXPECT_EQ(nullptr, boost::dynamic_pointer_cast<TDeltaClass>(root));
        std::string names;
        const auto collect = [&names](boost::shared_ptr<ICIMClass> cls) { return names += cls->GetName(kNoContext) + " ", true; };
        root->EnumerateSubClasses(collect, false, each);
        EXPECT_EQ("KALMO_DeltaClass KALMO_Delta KALMO_DeltaClassAssocToDelta ", names);
    }
}

TEST_F(OneDiskTest, TwoSpellingsGiveTwoWrappersOfOneClass)
{
    const auto declared = fComparison.Delta().GetClass("Disk", fFirst);
    const auto shouted = fComparison.Delta().GetClass("DISK", fFirst);
    EXPECT_NE(declared, shouted);
    EXPECT_EQ("Disk", shouted->GetName(kNoContext));
    EXPECT_EQ(2u, TTestAccess::ClassCache(fComparison.Delta())[0].size());
}

}  // namespace
}  // namespace NORVZEL20
