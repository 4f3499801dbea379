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
    EXPECT_EQ("Disk", stub.GetName(kNone));
    EXPECT_EQ(nullptr, stub.GetNamespace(kNone));
    EXPECT_EQ(nullptr, stub.GetSuperClass(kNone));
    EXPECT_FALSE(stub.IsAssociation(kNone));
    EXPECT_FALSE(stub.IsAbstract(kNone));
    EXPECT_TRUE(stub.IsRootClass(kNone));
    bool found = true;
    EXPECT_EQ(nullptr, stub.GetQualifier("Key", found, kNone));
    EXPECT_FALSE(found);
}

TEST(StubClassTest, EnumerationsNeverCallBack)
{
    TStubClass stub("Disk");
    int calls = 0;
    const auto count = [&calls](const auto&) { return ++calls > 0; };
    stub.EnumerateSubClasses(count, true, kNone);
    stub.EnumerateAssociatedClasses(count, "", "", "", "", kNone);
    stub.EnumerateAssociationClasses(count, "", "", kNone);
    stub.EnumerateKeyNames(count, kNone);
    stub.EnumeratePropertyDecls(count, kNone);
    stub.EnumerateStaticProperties(count, kNone);
    stub.EnumerateInstances(count, true, kNone);
    stub.EnumerateMethodDecls(count, kNone);
    stub.EnumerateQualifiers(count, kNone);
    EXPECT_EQ(0, calls);
}

TEST(StubClassTest, LookingUpAnElementFindsNothing)
{
    TStubClass stub("Disk");
    TCallContext parameters;
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetPropertyDecl("Id", kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetProperty("Id", kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.SetPropertyValue("Id", TCIMValue(1), kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetMethodDecl("Reset", kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.InvokeMethod("Reset", parameters, kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { stub.GetQualifier("Key", kNone); }));
}

TEST(StubClassTest, ChangesAreRefused)
{
    TStubClass stub("Disk");
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.Validate(kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddToNamespace(kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.RemoveFromNamespace(kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.ModifyClass(nullptr, kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocateInstance(kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocatePropertyDecl("Id", TCIMValue(1), kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocateMethodDecl("M", TCIMValue::TCIMType::kUint8, kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AllocateQualifier(nullptr, TCIMValue(1), kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported,
              StatusOf([&] { stub.AllocateQualifier(nullptr, TCIMValue(1), ICIMQualifierDecl::kFlavorNone, kNone); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { stub.AddQualifier(nullptr, kNone); }));
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
    EXPECT_TRUE(disk.IsSubclassOf(boost::make_shared<TStubClass>("disk"), kNone));
    EXPECT_FALSE(disk.IsSubclassOf(boost::make_shared<TStubClass>("Drive"), kNone));
    EXPECT_FALSE(disk.hasCollected());
}

}  // namespace
}  // namespace NORVZEL20
