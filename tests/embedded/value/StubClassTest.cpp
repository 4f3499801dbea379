#include "embedded/value/TStubClass.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "host/ICIMNamespace.h"
#include "tests/support/NoContext.h"
#include "tests/support/StatusOf.h"

namespace NORVZEL20 {
namespace {

TEST(StubClassTest, HasANameAndNothingElse)
{
    const TStubClass stub("Disk");
    EXPECT_EQ("Disk", stub.GetName(kNoContext));
    EXPECT_EQ(nullptr, stub.GetNamespace(kNoContext));
    EXPECT_EQ(nullptr, stub.GetSuperClass(kNoContext));
    EXPECT_FALSE(stub.IsAssociation(kNoContext));
    EXPECT_FALSE(stub.IsAbstract(kNoContext));
    EXPECT_TRUE(stub.IsRootClass(kNoContext));
    bool found = true;
    EXPECT_EQ(nullptr, stub.GetQualifier("Key", found, kNoContext));
    EXPECT_FALSE(found);
}

TEST(StubClassTest, EnumerationsNeverCallBack)
{
    TStubClass stub("Disk");
    int calls = 0;
    const auto count = [&calls](const auto&) { return ++calls > 0; };
    stub.EnumerateSubClasses(count, true, kNoContext);
    stub.EnumerateAssociatedClasses(count, "", "", "", "", kNoContext);
    stub.EnumerateAssociationClasses(count, "", "", kNoContext);
    stub.EnumerateKeyNames(count, kNoContext);
    stub.EnumeratePropertyDecls(count, kNoContext);
    stub.EnumerateStaticProperties(count, kNoContext);
    stub.EnumerateInstances(count, true, kNoContext);
    stub.EnumerateMethodDecls(count, kNoContext);
    stub.EnumerateQualifiers(count, kNoContext);
    EXPECT_EQ(0, calls);
}

TEST(StubClassTest, LookingUpAnElementFindsNothing)
{
    TStubClass stub("Disk");
    TCallContext parameters;
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetPropertyDecl("Id", kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetProperty("Id", kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.SetPropertyValue("Id", TCIMValue(1), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetMethodDecl("Reset", kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.InvokeMethod("Reset", parameters, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetQualifier("Key", kNoContext); }));
}

TEST(StubClassTest, ChangesAreRefused)
{
    TStubClass stub("Disk");
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.Validate(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddToNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.ModifyClass(nullptr, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocateInstance(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocatePropertyDecl("Id", TCIMValue(1), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported,
              StatusOf([&] { stub.AllocateMethodDecl("M", TCIMValue::TCIMType::kUint8, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocateQualifier(nullptr, TCIMValue(1), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported,
              StatusOf([&] { stub.AllocateQualifier(nullptr, TCIMValue(1), ICIMQualifierDecl::kFlavorNone, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddQualifier(nullptr, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { static_cast<ICIMClass&>(stub) = stub; }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddChildClass(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveChildClass(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddInstance(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveInstance(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddAssociationClass(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveAssociationClass(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddPropertyDecl(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemovePropertyDecl(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddMethodDecl(nullptr); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveMethodDecl(nullptr); }));
}

TEST(StubClassTest, NamesDecideEqualityAndOrder)
{
    TStubClass disk("Disk");
    TStubClass same("DISK");
    TStubClass drive("Drive");
    EXPECT_TRUE(disk == same);
    EXPECT_FALSE(disk == drive);
    EXPECT_TRUE(disk < drive);
    EXPECT_FALSE(drive < disk);
    EXPECT_TRUE(disk.IsSubclassOf(boost::make_shared<TStubClass>("disk"), kNoContext));
    EXPECT_FALSE(disk.IsSubclassOf(boost::make_shared<TStubClass>("Drive"), kNoContext));
    EXPECT_FALSE(disk.hasCollected());
}

}  // namespace
}  // namespace NORVZEL20
