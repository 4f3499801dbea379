#include "embedded/store/TSchemaCopier.h"

#include "embedded/store/TSchemaLimits.h"
#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemSchemaCopierTest : public TInMemFixture {
  protected:
    InMemSchemaCopierTest()
    {
        fNamespace->AllocateQualifierDecl("Vendor", TCIMValue::Null(TType::kString), ICIMQualifierDecl::kScopeClass,
                                          ICIMQualifierDecl::kFlavorDefault, kNoContext);
        fDevice = Declare("Device", nullptr, {{"Id", TType::kString, {"Key"}}});
        fDevice->AddQualifier(Qualifier("Vendor", TCIMValue("any")));
        fDisk = Declare("Disk", fDevice, {{"Size", TType::kUint64, {"Big"}}});
        fDisk->AddPropertyDecl(Reference("Room", "Room"));
        const auto format = boost::make_shared<TInMemMethodDecl>("Format", TType::kUint32);
        format->AddParameter(boost::make_shared<TInMemParameter>("Label", TType::kString));
        fDisk->AddMethodDecl(format);
    }

    TClassPointer fDevice, fDisk;
    boost::shared_ptr<TInMemNamespace> fTarget = TInMemNamespace::Create("other");
    TSchemaCopier fCopier{fTarget};
};

TEST_F(InMemSchemaCopierTest, AClassComesWithItsSuperclasses)
{
    const auto declared = fCopier.CopyClass(*fDisk);
    ASSERT_EQ(2U, declared.size());
    EXPECT_EQ("Device", declared[0]->GetName());
    const auto copy = fTarget->FindClass("disk");
    EXPECT_EQ(copy, declared[1]);
    EXPECT_EQ("Id Size Room", PropertiesOf(*copy));
    EXPECT_EQ("Id Room", KeysOf(*copy));
    EXPECT_EQ("Big", QualifiersOf(*copy->FindPropertyDecl("Size")));
    EXPECT_EQ("Vendor", QualifiersOf(*copy));
    EXPECT_EQ("Room", copy->FindPropertyDecl("Room")->GetReferenceClass());
    EXPECT_EQ("Label", copy->GetMethods().Find("Format")->GetParameters().at(0)->GetName());
    EXPECT_NE(nullptr, fTarget->FindQualifierDecl("Vendor"));
    EXPECT_EQ(fTarget, copy->GetInMemNamespace());
    EXPECT_NE(fDisk->FindPropertyDecl("Size"), copy->FindPropertyDecl("Size"));
}

TEST_F(InMemSchemaCopierTest, WhatIsThereIsLeftAlone)
{
    fTarget->AllocateInMemClass("DEVICE", nullptr)->AddToNamespace(kNoContext);
    const auto declared = fCopier.CopyClass(*fDisk);
    ASSERT_EQ(1U, declared.size());
    EXPECT_EQ("DEVICE", declared[0]->GetSuperInMemClass()->GetName());
    EXPECT_TRUE(fCopier.CopyClass(*fDisk).empty());
    EXPECT_TRUE(fCopier.CopyClass(*fDevice).empty());
}

TEST_F(InMemSchemaCopierTest, WhatIsJoinedKeepsToTheLimits)
{
    const auto there = fTarget->AllocateInMemClass("Disk", fTarget->AllocateInMemClass("Thing", nullptr));
    there->GetSuperInMemClass()->AddToNamespace(kNoContext);
    there->AddToNamespace(kNoContext);
    for (std::size_t number = 0; number < TSchemaLimits::kMaxProperties; ++number) {
        there->AddPropertyDecl(Decl({"P" + std::to_string(number), TType::kUint8, {}}));
    }
    const auto size = fDisk->FindPropertyDecl("Size");
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { fCopier.CopyPropertyDecl(*size, *there); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { fCopier.CopyPropertyDecl(*size, *there->GetSuperInMemClass()); }));
    const auto wide = Declare("Wide", fDisk);
    wide->AddPropertyDecl(Decl({"More", TType::kUint8, {}}));
    const auto below = fNamespace->AllocateInMemClass("Below", wide);
    below->AddToNamespace(kNoContext);
    fTarget->AllocateInMemClass("Wide", there)->AddToNamespace(kNoContext);
    EXPECT_EQ(TZELStatusCode::kSuccess, StatusOf([&] { fCopier.CopyClass(*below); }));
    below->AddPropertyDecl(Decl({"Own", TType::kUint8, {}}));
    EXPECT_EQ(TZELStatusCode::kNotSupported,
              StatusOf([&] { fCopier.CopyPropertyDecl(*below->FindPropertyDecl("Own"), *fTarget->FindClass("Below")); }));
    EXPECT_EQ(TSchemaLimits::kMaxProperties, fTarget->FindClass("Below")->GetLayout().GetOrder().size());
}

TEST_F(InMemSchemaCopierTest, AConflictOfTypesDeclaresNoClass)
{
    const auto other = fTarget->AllocateInMemClass("Device", nullptr);
    other->AddPropertyDecl(Decl({"Size", TType::kString, {}}));
    other->AddToNamespace(kNoContext);
    const auto fast = Declare("FastDisk", fDisk);
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fCopier.CopyClass(*fast); }));
    EXPECT_EQ(1U, fTarget->GetClasses().size());
}

TEST_F(InMemSchemaCopierTest, APropertyComesWithItsQualifiersAndInstancesGetANull)
{
    const auto cls = fTarget->AllocateInMemClass("Disk", nullptr);
    cls->AddPropertyDecl(Decl({"Id", TType::kString, {"Key"}}));
    cls->AddToNamespace(kNoContext);
    const auto instance = Add(cls, {{"Id", "sda"}});
    const auto copy = fCopier.CopyPropertyDecl(*fDisk->FindPropertyDecl("Size"), *cls);
    ASSERT_NE(nullptr, copy);
    EXPECT_EQ("Big", QualifiersOf(*copy));
    EXPECT_EQ("Id=sda Size=NULL", ValuesOf(*instance));
    EXPECT_EQ(nullptr, fCopier.CopyPropertyDecl(*fDisk->FindPropertyDecl("Size"), *cls));
}

/// Its default is the value of the other inventory.
TEST_F(InMemSchemaCopierTest, AStaticPropertyThatIsDeclaredLateIsNull)
{
    const auto firmware = boost::make_shared<TInMemPropertyDecl>("Firmware", TCIMValue("old"));
    firmware->AddQualifier(Qualifier("Static"));
    fDisk->AddPropertyDecl(firmware);
    const auto there = fTarget->AllocateInMemClass("Disk", nullptr);
    there->AddToNamespace(kNoContext);
    fCopier.CopyPropertyDecl(*firmware, *there);
    EXPECT_EQ(TCIMValue("old"), firmware->GetStaticProperty().GetValue());
    EXPECT_EQ(TCIMValue("old"), there->FindPropertyDecl("Firmware")->GetDefaultValue());
    EXPECT_TRUE(there->FindPropertyDecl("Firmware")->GetStaticProperty().GetValue().IsNull());
}

TEST_F(InMemSchemaCopierTest, NamesAreRespelledAndReferencesStayFound)
{
    fCopier.CopyClass(*fDisk);
    const auto room = fTarget->AllocateInMemClass("room", nullptr);
    room->AddPropertyDecl(Decl({"Name", TType::kString, {"Key"}}));
    room->AddToNamespace(kNoContext);
    const auto hall = Add(room, {{"Name", "hall"}});
    const auto sda = Add(fTarget->FindClass("Disk"), {{"Id", "sda"}, {"Room", TCIMValue(hall->GetReference())}});
    EXPECT_TRUE(fCopier.RespellClass("Room"));
    EXPECT_FALSE(fCopier.RespellClass("Room"));
    EXPECT_FALSE(fCopier.RespellClass("Cellar"));
    EXPECT_EQ("other:Disk.Id=\"sda\",Room=\"other:Room.Name=\\\"hall\\\"\"", sda->GetReference().GetPath());
    EXPECT_EQ(sda, fTarget->FindInstance(sda->GetReference()));
    EXPECT_TRUE(fCopier.RespellProperty(*room, "NAME"));
    EXPECT_FALSE(fCopier.RespellProperty(*room, "NAME"));
    EXPECT_FALSE(fCopier.RespellProperty(*room, "Floor"));
    EXPECT_EQ("other:Room.NAME=\"hall\"", hall->GetReference().GetPath());
}

TEST_F(InMemSchemaCopierTest, AnInheritedNameIsRespelledByOverridingIt)
{
    fCopier.CopyClass(*fDisk);
    const auto copy = fTarget->FindClass("Disk");
    const auto sda = Add(copy, {{"Id", "sda"}, {"Room", TCIMValue(Path("Room"))}, {"Size", Uint64(5)}});
    EXPECT_TRUE(fCopier.RespellProperty(*copy, "ID"));
    EXPECT_FALSE(fCopier.RespellProperty(*copy, "ID"));
    EXPECT_EQ("Id", fTarget->FindClass("Device")->FindPropertyDecl("id")->GetName());
    EXPECT_EQ("Key", QualifiersOf(*copy->FindPropertyDecl("id")));
    EXPECT_EQ("ID=sda Size=5 Room=Room", ValuesOf(*sda));
    EXPECT_EQ("other:Disk.ID=\"sda\",Room=\"Room\"", sda->GetReference().GetPath());
    EXPECT_EQ(sda, fTarget->FindInstance(Path("Disk.Id=\"sda\",Room=\"Room\"")));
}

TEST_F(InMemSchemaCopierTest, AKeyOfSeveralReferencesStaysFoundToo)
{
    const auto room = fTarget->AllocateInMemClass("room", nullptr);
    room->AddToNamespace(kNoContext);
    const auto door = fTarget->AllocateInMemClass("Door", nullptr);
    door->AddPropertyDecl(Decl({"Between", TType::kArrayReference, {"Key"}}));
    door->AddToNamespace(kNoContext);
    TCIMReference path;
    path.SetClass(room);
    const auto instance = Add(door, {{"Between", TCIMValue(TType::kArrayReference, 1, {TCIMValue(path)})}});
    EXPECT_TRUE(fCopier.RespellClass("ROOM"));
    EXPECT_EQ(instance, fTarget->FindInstance(instance->GetReference()));
}

TEST_F(InMemSchemaCopierTest, AStaticPropertyKeepsItsValueWhenItIsRespelled)
{
    fDevice->AddPropertyDecl(Decl({"Version", TType::kString, {"Static"}}));
    fCopier.CopyClass(*fDisk);
    const auto copy = fTarget->FindClass("Disk");
    copy->SetPropertyValue("Version", TCIMValue("1"), kNoContext);
    EXPECT_TRUE(fCopier.RespellProperty(*copy, "VERSION"));
    EXPECT_EQ("1", copy->GetProperty("Version", kNoContext)->GetValue(kNoContext).ToText());
}

}  // namespace
}  // namespace NORVZEL20
