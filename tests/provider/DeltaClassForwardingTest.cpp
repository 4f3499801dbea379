#include <boost/smart_ptr/make_shared.hpp>

#include "provider/TDeltaClass.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/TTestAccess.h"
#include "tests/support/plain/TPlainQualifier.h"

namespace NORVZEL20 {
namespace {

// Calls the wrapper of Base in the compared namespace 1. The wrapped class records the calls that reach it.
class DeltaClassForwardingTest : public TDeltaFixture {
  protected:
    DeltaClassForwardingTest() : fBase(Delta().GetClass("Base", At(1))) { Watch().Forget(); }

    // The only call that reached the wrapped class, without the name of the class.
    std::string Call()
    {
        const std::string text = Watch().TakeText();
        const std::string start = "ns1:Base.";
        return text.compare(0, start.size(), start) == 0 ? text.substr(start.size()) : text;
    }

    template <class T>
    static bool Take(boost::shared_ptr<T>)
    {
        return true;
    }

    boost::shared_ptr<ICIMClass> fBase;
};

TEST_F(DeltaClassForwardingTest, QuestionsAboutTheClass)
{
    fBase->Validate(At(1));
    EXPECT_EQ("Validate() {nsIndex=1}\n", Call());
    EXPECT_EQ("Base", fBase->GetName(At(1)));
    EXPECT_EQ("GetName() {nsIndex=1}\n", Call());
    EXPECT_EQ(fComparison.Namespace(1).GetNamespace(), fBase->GetNamespace(At(1)));
    EXPECT_EQ("GetNamespace() {nsIndex=1}\n", Call());
    EXPECT_FALSE(fBase->IsAssociation(At(1)));
    EXPECT_EQ("IsAssociation() {nsIndex=1}\n", Call());
    EXPECT_FALSE(fBase->IsAbstract(At(1)));
    EXPECT_EQ("IsAbstract() {nsIndex=1}\n", Call());
    EXPECT_TRUE(fBase->IsRootClass(At(1)));
    EXPECT_EQ("IsRootClass() {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, KeyNamesArePassedDirectly)
{
    const std::string* name = nullptr;
    fBase->EnumerateKeyNames([&](const std::string* each) { return name = each, true; }, At(1));
    EXPECT_EQ("EnumerateKeyNames() {nsIndex=1}\n", Call());
    const auto base = fComparison.Namespace(1).GetNamespace()->GetClass("Base", kNoContext);
    EXPECT_EQ(&base->GetPropertyDecl("Id", kNoContext)->GetName(kNoContext), name);
}

TEST_F(DeltaClassForwardingTest, DeclarationsOfProperties)
{
    EXPECT_EQ("Id", fBase->GetPropertyDecl("Id", At(1))->GetName(kNoContext));
    EXPECT_EQ("GetPropertyDecl(\"Id\") {nsIndex=1}\n", Call());
    fBase->EnumeratePropertyDecls(&Take<ICIMPropertyDecl>, At(1));
    EXPECT_EQ("EnumeratePropertyDecls() {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, StaticProperties)
{
    EXPECT_EQ(31, StatusOf([&] { fBase->GetProperty("Id", At(1)); }));
    EXPECT_EQ("GetProperty(\"Id\") {nsIndex=1}\n", Call());
    EXPECT_EQ(31, StatusOf([&] { fBase->SetPropertyValue("Id", TCIMValue(5), At(1)); }));
    EXPECT_EQ("SetPropertyValue(\"Id\", 5) {nsIndex=1}\n", Call());
    fBase->EnumerateStaticProperties(&Take<ICIMProperty>, At(1));
    EXPECT_EQ("EnumerateStaticProperties() {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, InstancesWithTheFlagUntouched)
{
    fBase->EnumerateInstances(&Take<ICIMInstance>, false, At(1));
    EXPECT_EQ("EnumerateInstances(false) {nsIndex=1}\n", Call());
    fBase->EnumerateInstances(&Take<ICIMInstance>, true, At(1));
    EXPECT_EQ("EnumerateInstances(true) {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, DeclarationsOfMethods)
{
    EXPECT_EQ(15, StatusOf([&] { fBase->GetMethodDecl("Run", At(1)); }));
    EXPECT_EQ("GetMethodDecl(\"Run\") {nsIndex=1}\n", Call());
    fBase->EnumerateMethodDecls(&Take<ICIMMethodDecl>, At(1));
    EXPECT_EQ("EnumerateMethodDecls() {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, QualifiersThroughEitherBase)
{
    const auto note = boost::make_shared<TPlainQualifier>("Note", TCIMValue("x"), ICIMQualifierDecl::kFlavorDefault);
    ICIMNamedElement& named = *fBase;
    named.AddQualifier(note, At(1));
    EXPECT_EQ("AddQualifier() {nsIndex=1}\n", Call());
    EXPECT_EQ(note, fBase->GetQualifier("Note", At(1)));
    EXPECT_EQ("GetQualifier(\"Note\") {nsIndex=1}\n", Call());
    EXPECT_EQ(note, named.GetQualifier("Note", At(1)));
    EXPECT_EQ("GetQualifier(\"Note\") {nsIndex=1}\n", Call());
    int seen = 0;
    fBase->EnumerateQualifiers([&](boost::shared_ptr<ICIMQualifier>) { return ++seen, true; }, At(1));
    EXPECT_EQ(1, seen);
    EXPECT_EQ("EnumerateQualifiers() {nsIndex=1}\n", Call());
}

TEST_F(DeltaClassForwardingTest, ElementsThatAreAddedAndRemoved)
{
    EXPECT_TRUE(fBase->AddChildClass(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext)));
    EXPECT_EQ("AddChildClass(Sub)\n", Call());
    EXPECT_TRUE(fBase->RemoveChildClass(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext)));
    EXPECT_EQ("RemoveChildClass(Sub)\n", Call());
    EXPECT_FALSE(fBase->RemoveChildClass(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext)));
    EXPECT_EQ("RemoveChildClass(Sub)\n", Call());
    EXPECT_TRUE(fBase->AddAssociationClass(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext)));
    EXPECT_EQ("AddAssociationClass(Sub)\n", Call());
    EXPECT_FALSE(fBase->RemoveAssociationClass(fComparison.Namespace(1).GetNamespace()->GetClass("Sub", kNoContext)));
    EXPECT_EQ("RemoveAssociationClass(Sub)\n", Call());
    EXPECT_FALSE(fBase->RemovePropertyDecl(nullptr));
    EXPECT_EQ("RemovePropertyDecl()\n", Call());
    EXPECT_TRUE(fBase->AddMethodDecl(nullptr));
    EXPECT_EQ("AddMethodDecl()\n", Call());
    EXPECT_FALSE(fBase->RemoveMethodDecl(nullptr));
    EXPECT_EQ("RemoveMethodDecl()\n", Call());
}

TEST_F(DeltaClassForwardingTest, ADeclarationAddedLandsInTheWrappedClass)
{
    const auto base = fComparison.Namespace(1).GetNamespace()->GetClass("Base", kNoContext);
    EXPECT_TRUE(fBase->AddPropertyDecl(base->AllocatePropertyDecl("Late", TCIMValue("x"), kNoContext)));
    EXPECT_EQ("AddPropertyDecl()\n", Call());
    EXPECT_EQ("Late", base->GetPropertyDecl("Late", kNoContext)->GetName(kNoContext));
}

TEST_F(DeltaClassForwardingTest, AnInstanceAddedLandsInTheWrappedClass)
{
    const auto base = fComparison.Namespace(1).GetNamespace()->GetClass("Base", kNoContext);
    const auto instance = base->AllocateInstance(kNoContext);
    int count = 0;
    const auto increment = [&](boost::shared_ptr<ICIMInstance>) { return ++count, true; };
    EXPECT_TRUE(fBase->AddInstance(instance));
    EXPECT_EQ("AddInstance()\n", Call());
    base->EnumerateInstances(increment, false, kNoContext);
    EXPECT_EQ(1, count);
    EXPECT_TRUE(fBase->RemoveInstance(instance));
    EXPECT_EQ("RemoveInstance()\n", Call());
    EXPECT_FALSE(fBase->RemoveInstance(instance));
    base->EnumerateInstances(increment, false, kNoContext);
    EXPECT_EQ(1, count);
}

TEST_F(DeltaClassForwardingTest, ErrorsOfTheWrappedClassPassThrough)
{
    Watch().FailCallsOf("ns1:Base.", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ(18, StatusOf([&] { fBase->GetName(At(1)); }));
    EXPECT_EQ(18, StatusOf([&] { fBase->Validate(At(1)); }));
    EXPECT_EQ(18, StatusOf([&] { fBase->AddInstance(nullptr); }));
    EXPECT_EQ(18, StatusOf([&] { fBase->EnumerateSubClasses(&Take<ICIMClass>, false, At(1)); }));
}

}  // namespace
}  // namespace NORVZEL20
