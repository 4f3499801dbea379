#include <boost/smart_ptr/make_shared.hpp>
#include <boost/smart_ptr/weak_ptr.hpp>

#include "provider/TDeltaClass.h"
#include "tests/provider/TAnsweringClass.h"
#include "tests/provider/TDeltaFixture.h"
#include "tests/support/NoContext.h"
#include "tests/support/plain/TPlainNamespace.h"
#include "tests/support/plain/TPlainQualifier.h"

namespace NORVZEL20 {
namespace {

// A wrapper of a class whose answers the test chooses, and one element of each kind to pass to it.
class DeltaClassAnswersTest : public TDeltaFixture {
  protected:
    DeltaClassAnswersTest()
        : fClass(boost::make_shared<TAnsweringClass>("Odd", fPlain, nullptr)), fWrapper(fComparison.GetDelta(), fClass)
    {
        TNamespaceBuilder(fInmem).Class("Disk", "", {TNamespaceBuilder::Key("Id")});
        fElement = fInmem->GetClass("Disk", kNoContext);
        fInstance = fElement->AllocateInstance(kNoContext);
        fPropertyDecl = fElement->GetPropertyDecl("Id", kNoContext);
        fMethodDecl = fElement->AllocateMethodDecl("Run", TCIMValue::TCIMType::kUint32, kNoContext);
        fClass->SetProperty(fInstance->GetProperty("Id", kNoContext));
        fClass->SetMethodDecl(fMethodDecl);
    }

    // The operation that was called on the wrapped class, whether it got this object, and its result.
    template <class T>
    std::string Give(bool (ICIMClass::*operation)(boost::shared_ptr<T>), boost::shared_ptr<T> element)
    {
        const bool answer = (static_cast<ICIMClass&>(fWrapper).*operation)(element);
        const std::string argument = fClass->GetArgument() == element.get() ? "" : " of another object";
        return fClass->GetOperation() + argument + (answer ? " yes\n" : " no\n");
    }

    // All element-level changes, one after the other.
    std::string GiveAll()
    {
        return Give(&ICIMClass::AddChildClass, fElement) + Give(&ICIMClass::RemoveChildClass, fElement) +
               Give(&ICIMClass::AddInstance, fInstance) + Give(&ICIMClass::RemoveInstance, fInstance) +
               Give(&ICIMClass::AddAssociationClass, fElement) + Give(&ICIMClass::RemoveAssociationClass, fElement) +
               Give(&ICIMClass::AddPropertyDecl, fPropertyDecl) + Give(&ICIMClass::RemovePropertyDecl, fPropertyDecl) +
               Give(&ICIMClass::AddMethodDecl, fMethodDecl) + Give(&ICIMClass::RemoveMethodDecl, fMethodDecl);
    }

    // The operations to which the wrapper returns true.
    std::string Affirmed()
    {
        const auto other = boost::make_shared<TDeltaClass>(fComparison.GetDelta(), fElement);
        return std::string(fWrapper.IsAssociation(At(1)) ? "IsAssociation " : "") +
               (fWrapper.IsAbstract(At(1)) ? "IsAbstract " : "") + (fWrapper.IsRootClass(At(1)) ? "IsRootClass " : "") +
               (fWrapper.IsSubclassOf(other, At(1)) ? "IsSubclassOf " : "");
    }

    // The enumeration that was called on the wrapped class, and whether it got the caller's own callback.
    template <class TCallback, class TEnumerate>
    std::string Enumerate(const TCallback& callback, const TEnumerate& enumerate)
    {
        enumerate(callback);
        return fClass->GetOperation() + (fClass->GetArgument() == &callback ? "\n" : " with another callback\n");
    }

    const boost::shared_ptr<TPlainNamespace> fPlain = TPlainNamespace::Create("root/cimv2");
    const boost::shared_ptr<ICIMNamespace> fInmem = MakeNamespace(EHost::kInmem, "root/cimv2");
    const boost::shared_ptr<TAnsweringClass> fClass;
    TDeltaClass fWrapper;
    boost::shared_ptr<ICIMClass> fElement;
    boost::shared_ptr<ICIMInstance> fInstance;
    boost::shared_ptr<ICIMPropertyDecl> fPropertyDecl;
    boost::shared_ptr<ICIMMethodDecl> fMethodDecl;
};

const std::vector<std::string> kChanges = {"AddChildClass",       "RemoveChildClass",       "AddInstance",     "RemoveInstance",
                                           "AddAssociationClass", "RemoveAssociationClass", "AddPropertyDecl", "RemovePropertyDecl",
                                           "AddMethodDecl",       "RemoveMethodDecl"};

TEST_F(DeltaClassAnswersTest, EachChangeReachesTheClassWithItsElementAndTheAnswerComesBack)
{
    for (const std::string& affirmed : kChanges) {
        std::string expected;
        for (const std::string& change : kChanges) {
            expected += change + (change == affirmed ? " yes\n" : " no\n");
        }
        fClass->SetTrue(affirmed);
        EXPECT_EQ(expected, GiveAll());
    }
}

TEST_F(DeltaClassAnswersTest, QuestionsAreAnsweredAsTheClassDoes)
{
    EXPECT_EQ("", Affirmed());
    for (const std::string question : {"IsAssociation", "IsAbstract", "IsRootClass", "IsSubclassOf"}) {
        fClass->SetTrue(question);
        EXPECT_EQ(question + " ", Affirmed());
    }
}

TEST_F(DeltaClassAnswersTest, WhatTheClassGivesOutIsHandedOn)
{
    EXPECT_EQ(fInstance->GetProperty("Id", kNoContext), fWrapper.GetProperty("Id", At(1)));
    EXPECT_EQ(fMethodDecl, fWrapper.GetMethodDecl("Run", At(1)));
}

TEST_F(DeltaClassAnswersTest, ElementsOfAnEnumerationReachTheCaller)
{
    boost::shared_ptr<ICIMProperty> property;
    fWrapper.EnumerateStaticProperties([&](boost::shared_ptr<ICIMProperty> each) { return property = each, true; }, At(1));
    EXPECT_EQ(fInstance->GetProperty("Id", kNoContext), property);
    boost::shared_ptr<ICIMMethodDecl> decl;
    fWrapper.EnumerateMethodDecls([&](boost::shared_ptr<ICIMMethodDecl> each) { return decl = each, true; }, At(1));
    EXPECT_EQ(fMethodDecl, decl);
}

TEST_F(DeltaClassAnswersTest, WhatIsNotWrappedIsEnumeratedWithTheCallersOwnCallback)
{
    const boost::function<bool(const std::string*)> name = [](const std::string*) { return true; };
    const boost::function<bool(boost::shared_ptr<ICIMPropertyDecl>)> decl = [](boost::shared_ptr<ICIMPropertyDecl>) {
        return true;
    };
    const boost::function<bool(boost::shared_ptr<ICIMProperty>)> property = [](boost::shared_ptr<ICIMProperty>) { return true; };
    const boost::function<bool(boost::shared_ptr<ICIMInstance>)> instance = [](boost::shared_ptr<ICIMInstance>) { return true; };
    const boost::function<bool(boost::shared_ptr<ICIMMethodDecl>)> method = [](boost::shared_ptr<ICIMMethodDecl>) { return true; };
    const boost::function<bool(boost::shared_ptr<ICIMQualifier>)> qualifier = [](boost::shared_ptr<ICIMQualifier>) { return true; };
    EXPECT_EQ("EnumerateKeyNames\n", Enumerate(name, [&](auto& callback) { fWrapper.EnumerateKeyNames(callback, At(1)); }));
    EXPECT_EQ("EnumeratePropertyDecls\n",
              Enumerate(decl, [&](auto& callback) { fWrapper.EnumeratePropertyDecls(callback, At(1)); }));
    EXPECT_EQ("EnumerateStaticProperties\n",
              Enumerate(property, [&](auto& callback) { fWrapper.EnumerateStaticProperties(callback, At(1)); }));
    EXPECT_EQ("EnumerateInstances\n",
              Enumerate(instance, [&](auto& callback) { fWrapper.EnumerateInstances(callback, false, At(1)); }));
    EXPECT_EQ("EnumerateMethodDecls\n", Enumerate(method, [&](auto& callback) { fWrapper.EnumerateMethodDecls(callback, At(1)); }));
    EXPECT_EQ("EnumerateQualifiers\n",
              Enumerate(qualifier, [&](auto& callback) { fWrapper.EnumerateQualifiers(callback, At(1)); }));
}

TEST_F(DeltaClassAnswersTest, AQualifierThatIsAddedIsTheCallersOwn)
{
    const auto note = boost::make_shared<TPlainQualifier>("Note", TCIMValue("x"), ICIMQualifierDecl::kFlavorDefault);
    fWrapper.AddQualifier(note, At(1));
    EXPECT_EQ("AddQualifier", fClass->GetOperation());
    EXPECT_EQ(static_cast<ICIMQualifier*>(note.get()), fClass->GetArgument());
}

TEST_F(DeltaClassAnswersTest, AWrapperIsComparedWithAnyClassByName)
{
    const TDeltaClass base(fComparison.GetDelta(), fComparison.Watched(1)->GetClass("Base", kNoContext));
    const auto sameName = fComparison.Watched(0)->GetClass("Base", kNoContext);
    const auto laterName = fComparison.Watched(0)->GetClass("Sub", kNoContext);
    Watch().Forget();
    EXPECT_TRUE(base == *sameName);
    EXPECT_EQ("ns1:Base.GetName() {}\nns0:Base.GetName() {}\n", Watch().TakeText());
    EXPECT_FALSE(base == *laterName);
    EXPECT_FALSE(base < *sameName);
    Watch().Forget();
    EXPECT_TRUE(base < *laterName);
    EXPECT_EQ("ns1:Base.GetName() {}\nns0:Sub.GetName() {}\n", Watch().TakeText());
}

TEST_F(DeltaClassAnswersTest, TheClassGoesWithItsWrapper)
{
    auto cls = boost::make_shared<TAnsweringClass>("Odd", fPlain, nullptr);
    const boost::weak_ptr<ICIMClass> weak = cls;
    auto wrapper = boost::make_shared<TDeltaClass>(fComparison.GetDelta(), cls);
    cls.reset();
    EXPECT_FALSE(weak.expired());
    wrapper.reset();
    EXPECT_TRUE(weak.expired());
}

}  // namespace
}  // namespace NORVZEL20
