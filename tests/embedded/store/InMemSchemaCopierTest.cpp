#include "embedded/store/TSchemaCopier.h"

#include "embedded/store/TSchemaLimits.h"
#include "tests/embedded/store/InMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemSchemaCopierTest : public TInMemFixture {
  protected:
    InMemSchemaCopierTest()
    {
        ns->AllocateQualifierDecl("Vendor", TCIMValue::Null(TType::kString), ICIMQualifierDecl::kScopeClass,
                                  ICIMQualifierDecl::kFlavorDefault, none);
        device = Declare("Device", nullptr, {{"Id", TType::kString, {"Key"}}});
        device->AddQualifier(Qualifier("Vendor", TCIMValue("any")));
        disk = Declare("Disk", device, {{"Size", TType::kUint64, {"Big"}}});
        disk->AddPropertyDecl(Reference("Room", "Room"));
        const auto format = boost::make_shared<TInMemMethodDecl>("Format", TType::kUint32);
        format->AddParameter(boost::make_shared<TInMemParameter>("Label", TType::kString));
        disk->AddMethodDecl(format);
    }

    TClassPointer device, disk;
    boost::shared_ptr<TInMemNamespace> target = TInMemNamespace::Create("other");
    TSchemaCopier copier{target};
};

TEST_F(InMemSchemaCopierTest, AClassComesWithItsSuperclasses)
{
    const auto declared = copier.CopyClass(*disk);
    ASSERT_EQ(2U, declared.size());
    EXPECT_EQ("Device", declared[0]->GetName());
    const auto copy = target->FindClass("disk");
    EXPECT_EQ(copy, declared[1]);
    EXPECT_EQ("Id Size Room", PropertiesOf(*copy));
    EXPECT_EQ("Id Room", KeysOf(*copy));
    EXPECT_EQ("Big", QualifiersOf(*copy->FindPropertyDecl("Size")));
    EXPECT_EQ("Vendor", QualifiersOf(*copy));
    EXPECT_EQ("Room", copy->FindPropertyDecl("Room")->GetReferenceClass());
    EXPECT_EQ("Label", copy->GetMethods().Find("Format")->GetParameters().at(0)->GetName());
    EXPECT_NE(nullptr, target->FindQualifierDecl("Vendor"));
    EXPECT_EQ(target, copy->GetInMemNamespace());
    EXPECT_NE(disk->FindPropertyDecl("Size"), copy->FindPropertyDecl("Size"));
}

TEST_F(InMemSchemaCopierTest, WhatIsThereIsLeftAlone)
{
    target->AllocateInMemClass("DEVICE", nullptr)->AddToNamespace(none);
    const auto declared = copier.CopyClass(*disk);
    ASSERT_EQ(1U, declared.size());
    EXPECT_EQ("DEVICE", declared[0]->GetSuperInMemClass()->GetName());
    EXPECT_TRUE(copier.CopyClass(*disk).empty());
    EXPECT_TRUE(copier.CopyClass(*device).empty());
}

TEST_F(InMemSchemaCopierTest, WhatIsJoinedKeepsToTheLimits)
{
    const auto there = target->AllocateInMemClass("Disk", target->AllocateInMemClass("Thing", nullptr));
    there->GetSuperInMemClass()->AddToNamespace(none);
    there->AddToNamespace(none);
    for (std::size_t number = 0; number < TSchemaLimits::kMaxProperties; ++number) {
        there->AddPropertyDecl(Decl({"P" + std::to_string(number), TType::kUint8, {}}));
    }
    const auto size = disk->FindPropertyDecl("Size");
    EXPECT_EQ(31, StatusOf([&] { copier.CopyPropertyDecl(*size, *there); }));
    EXPECT_EQ(31, StatusOf([&] { copier.CopyPropertyDecl(*size, *there->GetSuperInMemClass()); }));
    const auto wide = Declare("Wide", disk);
    wide->AddPropertyDecl(Decl({"More", TType::kUint8, {}}));
    const auto below = ns->AllocateInMemClass("Below", wide);
    below->AddToNamespace(none);
    target->AllocateInMemClass("Wide", there)->AddToNamespace(none);
    EXPECT_EQ(0, StatusOf([&] { copier.CopyClass(*below); }));
    below->AddPropertyDecl(Decl({"Own", TType::kUint8, {}}));
    EXPECT_EQ(31, StatusOf([&] { copier.CopyPropertyDecl(*below->FindPropertyDecl("Own"), *target->FindClass("Below")); }));
    EXPECT_EQ(TSchemaLimits::kMaxProperties, target->FindClass("Below")->GetLayout().GetOrder().size());
}

TEST_F(InMemSchemaCopierTest, AConflictOfTypesDeclaresNoClass)
{
    const auto other = target->AllocateInMemClass("Device", nullptr);
    other->AddPropertyDecl(Decl({"Size", TType::kString, {}}));
    other->AddToNamespace(none);
    const auto fast = Declare("FastDisk", disk);
    EXPECT_EQ(13, StatusOf([&] { copier.CopyClass(*fast); }));
    EXPECT_EQ(1U, target->GetClasses().size());
}

TEST_F(InMemSchemaCopierTest, APropertyComesWithItsQualifiersAndInstancesGetANull)
{
    const auto cls = target->AllocateInMemClass("Disk", nullptr);
    cls->AddPropertyDecl(Decl({"Id", TType::kString, {"Key"}}));
    cls->AddToNamespace(none);
    const auto instance = Add(cls, {{"Id", "sda"}});
    const auto copy = copier.CopyPropertyDecl(*disk->FindPropertyDecl("Size"), *cls);
    ASSERT_NE(nullptr, copy);
    EXPECT_EQ("Big", QualifiersOf(*copy));
    EXPECT_EQ("Id=sda Size=NULL", ValuesOf(*instance));
    EXPECT_EQ(nullptr, copier.CopyPropertyDecl(*disk->FindPropertyDecl("Size"), *cls));
}

TEST_F(InMemSchemaCopierTest, NamesAreRespelledAndReferencesStayFound)
{
    copier.CopyClass(*disk);
    const auto room = target->AllocateInMemClass("room", nullptr);
    room->AddPropertyDecl(Decl({"Name", TType::kString, {"Key"}}));
    room->AddToNamespace(none);
    const auto hall = Add(room, {{"Name", "hall"}});
    const auto sda = Add(target->FindClass("Disk"), {{"Id", "sda"}, {"Room", TCIMValue(hall->GetReference())}});
    EXPECT_TRUE(copier.RespellClass("Room"));
    EXPECT_FALSE(copier.RespellClass("Room"));
    EXPECT_FALSE(copier.RespellClass("Cellar"));
    EXPECT_EQ("other:Disk.Id=\"sda\",Room=\"other:Room.Name=\\\"hall\\\"\"", sda->GetReference().GetPath());
    EXPECT_EQ(sda, target->FindInstance(sda->GetReference()));
    EXPECT_TRUE(copier.RespellProperty(*room, "NAME"));
    EXPECT_FALSE(copier.RespellProperty(*room, "NAME"));
    EXPECT_FALSE(copier.RespellProperty(*room, "Floor"));
    EXPECT_EQ("other:Room.NAME=\"hall\"", hall->GetReference().GetPath());
}

TEST_F(InMemSchemaCopierTest, AnInheritedNameIsRespelledByOverridingIt)
{
    copier.CopyClass(*disk);
    const auto copy = target->FindClass("Disk");
    const auto sda = Add(copy, {{"Id", "sda"}, {"Room", TCIMValue(Path("Room"))}, {"Size", std::uint64_t(5)}});
    EXPECT_TRUE(copier.RespellProperty(*copy, "ID"));
    EXPECT_FALSE(copier.RespellProperty(*copy, "ID"));
    EXPECT_EQ("Id", target->FindClass("Device")->FindPropertyDecl("id")->GetName());
    EXPECT_EQ("Key", QualifiersOf(*copy->FindPropertyDecl("id")));
    EXPECT_EQ("ID=sda Size=5 Room=Room", ValuesOf(*sda));
    EXPECT_EQ("other:Disk.ID=\"sda\",Room=\"Room\"", sda->GetReference().GetPath());
    EXPECT_EQ(sda, target->FindInstance(Path("Disk.Id=\"sda\",Room=\"Room\"")));
}

TEST_F(InMemSchemaCopierTest, AKeyOfSeveralReferencesStaysFoundToo)
{
    const auto room = target->AllocateInMemClass("room", nullptr);
    room->AddToNamespace(none);
    const auto door = target->AllocateInMemClass("Door", nullptr);
    door->AddPropertyDecl(Decl({"Between", TType::kArrayReference, {"Key"}}));
    door->AddToNamespace(none);
    TCIMReference path;
    path.SetClass(room);
    const auto instance = Add(door, {{"Between", TCIMValue(TType::kArrayReference, 1, {TCIMValue(path)})}});
    EXPECT_TRUE(copier.RespellClass("ROOM"));
    EXPECT_EQ(instance, target->FindInstance(instance->GetReference()));
}

TEST_F(InMemSchemaCopierTest, AStaticPropertyKeepsItsValueWhenItIsRespelled)
{
    device->AddPropertyDecl(Decl({"Version", TType::kString, {"Static"}}));
    copier.CopyClass(*disk);
    const auto copy = target->FindClass("Disk");
    copy->SetPropertyValue("Version", TCIMValue("1"), none);
    EXPECT_TRUE(copier.RespellProperty(*copy, "VERSION"));
    EXPECT_EQ("1", copy->GetProperty("Version", none)->GetValue(none).ToText());
}

}  // namespace
}  // namespace NORVZEL20
