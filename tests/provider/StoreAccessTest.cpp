#include <boost/smart_ptr/make_shared.hpp>

#include "provider/TDeltaNamespaceProvider.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

class StoreAccessTest : public TDeltaFixture {
  protected:
    StoreAccessTest()
    {
        TNamespaceBuilder(TTestAccess::Store(Delta())).Instance("KALMO_DeltaClass", {{"ClassName", "Disk"}});
        Watch().Forget();
        fPath.SetClassName("KALMO_DeltaClass");
        fPath.AddKeyValue("DeltaClassID", TCIMValue(1ULL));
    }

    TCIMReference fPath;
};

TEST_F(StoreAccessTest, TheProviderIsTheOneOfThisLibrary)
{
    EXPECT_EQ(TDeltaNamespaceProvider::GetInstance(), Delta().GetNamespaceProvider(kNoContext));
    EXPECT_EQ(TDeltaNamespaceProvider::GetInstance(), Delta().GetNamespaceProvider(At(9)));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(StoreAccessTest, InstancesComeFromTheStore)
{
    const auto instance = Delta().GetInstance(fPath, At(2));
    EXPECT_EQ("Disk", instance->GetProperty("ClassName", kNoContext)->GetValue(kNoContext).ToText());
    EXPECT_EQ(0u, Watch().GetText().find("store.GetInstance(KALMO_DeltaClass.DeltaClassID=1) {nsIndex=2}\n"));
}

TEST_F(StoreAccessTest, InstancesAreDeletedFromTheStore)
{
    Delta().DeleteInstance(fPath, At(1));
    EXPECT_EQ("store.DeleteInstance(KALMO_DeltaClass.DeltaClassID=1) {nsIndex=1}\n", Watch().TakeText());
    EXPECT_EQ(15, StatusOf([&] { Delta().GetInstance(fPath, kNoContext); }));
}

TEST_F(StoreAccessTest, InstancesAreModifiedInTheStore)
{
    TCallContext properties;
    properties["ClassName"] = TCIMValue("Card");
    Delta().ModifyInstance(fPath, properties, At(1));
    EXPECT_EQ("store.ModifyInstance(KALMO_DeltaClass.DeltaClassID=1, {ClassName=\"Card\"}) {nsIndex=1}\n", Watch().TakeText());
    EXPECT_EQ("Card", Delta().GetInstance(fPath, kNoContext)->GetProperty("ClassName", kNoContext)->GetValue(kNoContext).ToText());
}

TEST_F(StoreAccessTest, QueriesGoToTheStoreAsTheyAre)
{
    std::string language = "a language";
    std::string query = "select * from nothing";
    const auto callback = [](boost::shared_ptr<ICIMInstance>) { return true; };
    EXPECT_EQ(31, StatusOf([&] { Delta().ExecuteQuery(callback, language, query, At(1)); }));
    EXPECT_EQ("store.ExecuteQuery(\"a language\", \"select * from nothing\") {nsIndex=1}\n", Watch().TakeText());
}

// Records the arguments of a query.
class TQueriedNamespace : public TWatchedNamespace {
  public:
    TQueriedNamespace() : TWatchedNamespace(MakeNamespace(EHost::kPlain, "queried"), boost::make_shared<TCallWatch>(), "queried") {}

    void ExecuteQuery(const boost::function<bool(boost::shared_ptr<ICIMInstance>)>& callback, std::string& language,
                      std::string& query, TCallContext) override
    {
        fObjects = {&callback, &language, &query};
        language = "another language";
        query = "another query";
    }

    std::vector<const void*> fObjects;
};

TEST_F(StoreAccessTest, TheStoreQueriesWithTheCallersOwnObjects)
{
    const auto store = boost::make_shared<TQueriedNamespace>();
    TTestAccess::SetStore(Delta(), store);
    std::string language = "a language";
    std::string query = "select * from nothing";
    const boost::function<bool(boost::shared_ptr<ICIMInstance>)> callback = [](boost::shared_ptr<ICIMInstance>) { return true; };
    Delta().ExecuteQuery(callback, language, query, At(1));
    EXPECT_EQ((std::vector<const void*>{&callback, &language, &query}), store->fObjects);
    EXPECT_EQ("another language, another query", language + ", " + query);
}

TEST_F(StoreAccessTest, ClearInstancesClearsNothing)
{
    Delta().ClearInstances();
    EXPECT_EQ("", Watch().TakeText());
    EXPECT_NE(nullptr, Delta().GetInstance(fPath, kNoContext));
}

class QualifierAccessTest : public TDeltaFixture {
  protected:
    static bool Take(boost::shared_ptr<ICIMQualifierDecl>) { return true; }
};

TEST_F(QualifierAccessTest, ADeclarationComesFromTheNamespaceThatTheIndexNames)
{
    const auto decl = Delta().GetQualifierDecl("Key", At(1));
    EXPECT_EQ("ns1.GetQualifierDecl(\"Key\") {nsIndex=1}\n", Watch().TakeText());
    EXPECT_EQ(fComparison.Namespace(1).GetNamespace()->GetQualifierDecl("Key", kNoContext), decl);
    EXPECT_EQ(15, StatusOf([&] { Delta().GetQualifierDecl("Nowhere", At(1)); }));
}

TEST_F(QualifierAccessTest, DeclarationsAreEnumeratedWithTheCallersCallback)
{
    std::string names;
    const auto collect = [&](boost::shared_ptr<ICIMQualifierDecl> decl) { return names += decl->GetName(kNoContext), true; };
    Delta().EnumerateQualifierDecls(collect, At(2));
    EXPECT_EQ("Key", names);
    EXPECT_EQ("ns2.EnumerateQualifierDecls() {nsIndex=2}\n", Watch().TakeText());
}

TEST_F(QualifierAccessTest, WithoutAnIndexNoNamespaceIsTouched)
{
    EXPECT_EQ(38, StatusOf([&] { Delta().GetQualifierDecl("Key", kNoContext); }));
    EXPECT_EQ(38, StatusOf([&] { Delta().EnumerateQualifierDecls(&Take, kNoContext); }));
    EXPECT_EQ("", Watch().TakeText());
}

TEST_F(QualifierAccessTest, AnIndexOutOfRangeIsPrintedAndRefused)
{
    testing::internal::CaptureStdout();
    EXPECT_EQ(15, StatusOf([&] { Delta().GetQualifierDecl("Key", At(3)); }));
    EXPECT_EQ(15, StatusOf([&] { Delta().EnumerateQualifierDecls(&Take, At(4)); }));
    EXPECT_EQ("Bad nsIndex, nsIndex=3\nBad nsIndex, nsIndex=4\n", testing::internal::GetCapturedStdout());
    EXPECT_EQ("", Watch().TakeText());
}

}  // namespace
}  // namespace NORVZEL20
