#include <boost/smart_ptr/bad_weak_ptr.hpp>
#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>

#include "host/TZELException.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

// Exceptions of a host's own: one with a status, and one without.
struct TOwnStatus : TZELException {
    using TZELException::TZELException;
};
struct TOwnError : std::out_of_range {
    using std::out_of_range::out_of_range;
};

// Throws in every operation that the delta namespace passes on.
class TFailingNamespace : public TWatchedNamespace {
  public:
    explicit TFailingNamespace(std::function<void()> fail)
        : TWatchedNamespace(MakeNamespace(EHost::kPlain, "failing"), boost::make_shared<TCallWatch>(), "failing"), fFail(fail)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string&, TCallContext) override { return fFail(), nullptr; }
    boost::shared_ptr<ICIMQualifierDecl> GetQualifierDecl(const std::string&, TCallContext) const override
    {
        return fFail(), nullptr;
    }
    void EnumerateQualifierDecls(const boost::function<bool(boost::shared_ptr<ICIMQualifierDecl>)>&, TCallContext) const override
    {
        fFail();
    }
    boost::shared_ptr<ICIMInstance> GetInstance(const TCIMReference&, TCallContext) const override { return fFail(), nullptr; }
    void DeleteInstance(const TCIMReference&, TCallContext) override { fFail(); }
    void ModifyInstance(const TCIMReference&, TCallContext, TCallContext) override { fFail(); }
    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>&, std::string&, std::string&,
                      TCallContext) override
    {
        fFail();
    }

  private:
    std::function<void()> fFail;
};

// The exception that the call throws, and its text.
std::string Thrown(const std::function<void()>& call)
{
    try {
        call();
    } catch (const TOwnStatus& failure) {
        return "own status " + std::to_string(failure.GetStatusCode().GetStatus());
    } catch (const TOwnError& failure) {
        return "own error " + std::string(failure.what());
    } catch (const std::exception& failure) {
        return "another exception: " + std::string(failure.what());
    }
    return "nothing";
}

// The delta namespace of the fixture with one more compared namespace. Either that one or the store fails.
class PassedFailuresTest : public TDeltaFixture {
  protected:
    PassedFailuresTest()
        : fWithStatus(boost::make_shared<TFailingNamespace>([] { throw TOwnStatus(TZELStatusCode::kNotFound); })),
          fWithError(boost::make_shared<TFailingNamespace>([] { throw TOwnError("at home"); }))
    {}

    // The same failure of each request that goes to a compared namespace.
    void ExpectOfCompared(const std::string& expected, unsigned short index)
    {
        EXPECT_EQ(expected, Thrown([&] { Delta().GetClass("Base", At(index)); }));
        EXPECT_EQ(expected, Thrown([&] { Delta().GetQualifierDecl("Key", At(index)); }));
        const auto callback = [](boost::shared_ptr<ICIMQualifierDecl>) { return true; };
        EXPECT_EQ(expected, Thrown([&] { Delta().EnumerateQualifierDecls(callback, At(index)); }));
    }

    // The same failure of each request on instances.
    void ExpectOfStore(const std::string& expected)
    {
        const auto callback = [](boost::shared_ptr<ICIMInstance>) { return true; };
        std::string text;
        EXPECT_EQ(expected, Thrown([&] { Delta().GetInstance(TCIMReference(), kNoContext); }));
        EXPECT_EQ(expected, Thrown([&] { Delta().DeleteInstance(TCIMReference(), kNoContext); }));
        EXPECT_EQ(expected, Thrown([&] { Delta().ModifyInstance(TCIMReference(), kNoContext, kNoContext); }));
        EXPECT_EQ(expected, Thrown([&] { Delta().ExecuteQuery(callback, text, text, kNoContext); }));
    }

    const boost::shared_ptr<ICIMNamespace> fWithStatus;
    const boost::shared_ptr<ICIMNamespace> fWithError;
};

TEST_F(PassedFailuresTest, OfAComparedNamespace)
{
    Delta().AddNamespaceToCompareList(fWithStatus);
    Delta().AddNamespaceToCompareList(fWithError);
    ExpectOfCompared("own status 15", 3);
    ExpectOfCompared("own error at home", 4);
    EXPECT_TRUE(TTestAccess::ClassCache(Delta())[3].empty());
}

TEST_F(PassedFailuresTest, OfTheStore)
{
    TTestAccess::SetStore(Delta(), fWithStatus);
    ExpectOfStore("own status 15");
    TTestAccess::SetStore(Delta(), fWithError);
    ExpectOfStore("own error at home");
    EXPECT_EQ("own error at home", Thrown([&] { Delta().GetClass("Base", At(1)); }));
}

TEST_F(PassedFailuresTest, OfANamespaceDuringARun)
{
    const auto delta = MakeDeltaNamespace(EHost::kPlain);
    delta->AddNamespaceToCompareList(fWithStatus);
    EXPECT_EQ("own status 15", Thrown([&] { delta->FindDifferences(); }));
    const auto other = MakeDeltaNamespace(EHost::kPlain);
    other->AddNamespaceToCompareList(fWithError);
    EXPECT_EQ("own error at home", Thrown([&] { other->FindDifferences(); }));
}

TEST_F(PassedFailuresTest, WithoutAnOwnerTheComparedNamespaceIsAskedBeforeTheWrapperFails)
{
    TDeltaNamespace onStack{boost::shared_ptr<const ICIMNamespace>()};
    TTestAccess::SetStore(onStack, TTestAccess::Store(Delta()));
    onStack.AddNamespaceToCompareList(fComparison.Watched(0));
    EXPECT_THROW(onStack.GetClass("Base", At(0)), boost::bad_weak_ptr);
    EXPECT_EQ("store.GetClass(\"Base\") {nsIndex=0}\n"
              "ns0.GetClass(\"Base\") {nsIndex=0}\n",
              Watch().TakeText());
    EXPECT_TRUE(TTestAccess::ClassCache(onStack)[0].empty());
}

// Calls from the last owner's deleter: the namespace's weak pointer to itself has expired.
TEST_F(PassedFailuresTest, WithoutAnOwnerAnyMoreNothingRunsOrIsWrapped)
{
    const auto store = TTestAccess::Store(Delta());
    const auto compared = fComparison.Watched(0);
    const auto letGo = [&](TDeltaNamespace* delta) {
        EXPECT_THROW(delta->FindDifferences(), boost::bad_weak_ptr);
        EXPECT_EQ("", Watch().TakeText());
        EXPECT_THROW(delta->GetClass("Base", At(0)), boost::bad_weak_ptr);
        delete delta;
    };
    boost::shared_ptr<TDeltaNamespace> delta(new TDeltaNamespace{boost::shared_ptr<const ICIMNamespace>()}, letGo);
    TTestAccess::SetStore(*delta, store);
    delta->AddNamespaceToCompareList(compared);
    Watch().Forget();
    delta.reset();
    EXPECT_EQ("store.GetClass(\"Base\") {nsIndex=0}\n"
              "ns0.GetClass(\"Base\") {nsIndex=0}\n",
              Watch().TakeText());
}

}  // namespace
}  // namespace NORVZEL20
