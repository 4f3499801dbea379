#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

using InMemClassTest = TDevicesFixture;

TEST_F(InMemClassTest, PseudoClassRootStandsAboveAllTopLevelClasses)
{
    EXPECT_EQ("Device Room", SubClassesOf(*Root(), false));
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
    EXPECT_EQ("<root>", Root()->GetName(none));
    EXPECT_EQ(nullptr, Root()->GetSuperClass(none));
    EXPECT_EQ(nullptr, device->GetSuperClass(none));
    EXPECT_TRUE(device->IsRootClass(none));
    EXPECT_FALSE(disk->IsRootClass(none));
    EXPECT_FALSE(Root()->IsRootClass(none));
}

TEST_F(InMemClassTest, EnumerationsStopWhereTheCallbackSaysSo)
{
    std::string seen;
    Root()->EnumerateSubClasses(
        [&seen](boost::shared_ptr<ICIMClass> cls) {
            seen += cls->GetName(TCallContext());
            return false;
        },
        true, none);
    EXPECT_EQ("Device", seen);
}

TEST_F(InMemClassTest, ClassesAreFoundInAnyLetterCaseAndKeepTheirSpelling)
{
    EXPECT_EQ("SolidState", ns->GetClass("SOLIDSTATE", none)->GetName(none));
    EXPECT_EQ(15, StatusOf([&] { ns->GetClass("Tape", none); }));
    EXPECT_EQ(15, StatusOf([&] { ns->GetClass("", none); }));
}

TEST_F(InMemClassTest, RelationsBetweenClasses)
{
    EXPECT_TRUE(solidState->IsSubclassOf(device, none));
    EXPECT_TRUE(disk->IsSubclassOf(disk, none));
    EXPECT_TRUE(disk->IsSubclassOf(Root(), none));
    EXPECT_FALSE(disk->IsSubclassOf(solidState, none));
    EXPECT_FALSE(disk->IsSubclassOf(room, none));
    EXPECT_EQ("Disk", solidState->GetSuperClass(none)->GetName(none));
    EXPECT_TRUE(*disk == *ns->GetClass("DISK", none));
    EXPECT_TRUE(*disk < *fan);
    EXPECT_FALSE(*fan < *disk);
    EXPECT_EQ(ns, disk->GetNamespace(none));
}

TEST_F(InMemClassTest, PropertiesAndKeysAreInherited)
{
    EXPECT_EQ("Id Size Wear", PropertiesOf(*solidState));
    EXPECT_EQ("Id", KeysOf(*solidState));
    EXPECT_EQ("Size", solidState->GetPropertyDecl("SIZE", none)->GetName(none));
    EXPECT_EQ(15, StatusOf([&] { disk->GetPropertyDecl("Wear", none); }));
}

TEST_F(InMemClassTest, QualifiersReachSubclassesWhereTheirFlavorSaysSo)
{
    device->AddQualifier(Qualifier("Version", TCIMValue("2"), ICIMQualifierDecl::kFlavorOverridable), none);
    device->AddQualifier(Qualifier("Vendor", TCIMValue("any")), none);
    device->AddQualifier(Qualifier("Unit", TCIMValue("one")), none);
    disk->AddQualifier(Qualifier("UNIT", TCIMValue("two")), none);
    EXPECT_EQ("Version Vendor Unit", QualifiersOf(*device));
    EXPECT_EQ("UNIT Vendor", QualifiersOf(*disk));
    EXPECT_EQ("two", solidState->GetQualifier("unit", none)->GetValue(none).ToText());
    EXPECT_EQ(15, StatusOf([&] { disk->GetQualifier("Version", none); }));
    bool found = true;
    EXPECT_EQ(nullptr, disk->GetQualifier("Version", found, none));
    EXPECT_FALSE(found);
    EXPECT_NE(nullptr, disk->GetQualifier("Vendor", found, none));
    EXPECT_TRUE(found);
    EXPECT_EQ(5, StatusOf([&] { disk->AddQualifier(nullptr, none); }));
}

TEST_F(InMemClassTest, QualifiersAreMadeOfTheirDeclaration)
{
    const auto decl = ns->AllocateQualifierDecl("MaxLen", TCIMValue::Null(TType::kUint32), ICIMQualifierDecl::kScopeProperty,
                                                ICIMQualifierDecl::kFlavorToSubclass, none);
    const auto qualifier = disk->AllocateQualifier(decl, TCIMValue(64U), none);
    EXPECT_EQ("MaxLen", qualifier->GetName(none));
    EXPECT_EQ(TCIMValue(64U), qualifier->GetValue(none));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorToSubclass, qualifier->GetFlavor(none));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorNone,
              disk->AllocateQualifier(decl, TCIMValue(64U), ICIMQualifierDecl::kFlavorNone, none)->GetFlavor(none));
    EXPECT_EQ(TType::kUint32, disk->AllocateQualifier(decl, TCIMValue(), none)->GetValue(none).GetType());
    EXPECT_EQ(13, StatusOf([&] { disk->AllocateQualifier(decl, TCIMValue("64"), none); }));
}

TEST_F(InMemClassTest, AssociationIsInheritedWhateverItsFlavorAndAbstractIsNot)
{
    const auto link = Declare("Link", nullptr);
    const auto cable = Declare("Cable", link);
    link->AddQualifier(Qualifier("Association", TCIMValue(true), ICIMQualifierDecl::kFlavorNone), none);
    link->AddQualifier(Qualifier("Abstract"), none);
    EXPECT_TRUE(cable->IsAssociation(none));
    EXPECT_FALSE(disk->IsAssociation(none));
    EXPECT_TRUE(link->IsAbstract(none));
    EXPECT_FALSE(cable->IsAbstract(none));
}

TEST_F(InMemClassTest, AssociationsAreFoundFromBothEndsAndFromSubclasses)
{
    const auto location = Allocate("Location", nullptr);
    location->AddQualifier(Qualifier("Association"));
    location->AddPropertyDecl(Reference("Thing", "Device"));
    location->AddPropertyDecl(Reference("Place", "Room"));
    location->AddToNamespace(none);
    const auto associated = [&](const TClassPointer& cls, const std::string& association, const std::string& result,
                                const std::string& role, const std::string& resultRole) {
        return NamesOf<ICIMClass>([&](const auto& callback) {
            cls->EnumerateAssociatedClasses(callback, association, result, role, resultRole, TCallContext());
        });
    };
    EXPECT_EQ("Room", associated(solidState, "", "", "", ""));
    EXPECT_EQ("Room", associated(solidState, "location", "room", "thing", "place"));
    EXPECT_EQ("Device", associated(room, "", "", "", ""));
    EXPECT_EQ("", associated(disk, "", "", "Place", ""));
    EXPECT_EQ("", associated(disk, "", "", "", "Thing"));
    EXPECT_EQ("", associated(disk, "Room", "", "", ""));
    EXPECT_EQ("", associated(disk, "", "Fan", "", ""));
    const auto associations = [&](const TClassPointer& cls, const std::string& result, const std::string& role) {
        return NamesOf<ICIMClass>(
            [&](const auto& callback) { cls->EnumerateAssociationClasses(callback, result, role, TCallContext()); });
    };
    EXPECT_EQ("Location", associations(disk, "", ""));
    EXPECT_EQ("Location", associations(room, "LOCATION", "PLACE"));
    EXPECT_EQ("", associations(room, "", "Thing"));
    EXPECT_EQ("", associations(room, "Disk", ""));
    EXPECT_EQ("", associations(location, "", ""));
}

TEST_F(InMemClassTest, AnAssociationClassCanBeNamed)
{
    const auto link = Declare("Link", nullptr);
    const auto associations = [&] {
        return NamesOf<ICIMClass>([&](const auto& callback) { room->EnumerateAssociationClasses(callback, "", "", none); });
    };
    EXPECT_TRUE(room->AddAssociationClass(link));
    EXPECT_FALSE(room->AddAssociationClass(link));
    EXPECT_EQ("Link", associations());
    EXPECT_TRUE(room->RemoveAssociationClass(link));
    EXPECT_FALSE(room->RemoveAssociationClass(link));
    EXPECT_EQ("", associations());
    EXPECT_EQ(5, StatusOf([&] { room->AddAssociationClass(nullptr); }));
}

TEST_F(InMemClassTest, MethodsAreInheritedAndOverridden)
{
    const auto methods = [&](const TClassPointer& cls) {
        return NamesOf<ICIMMethodDecl>([&](const auto& callback) { cls->EnumerateMethodDecls(callback, none); });
    };
    const auto reset = device->AllocateMethodDecl("Reset", TType::kUint32, none);
    reset->AddQualifier(Qualifier("Description", TCIMValue("starts anew")), none);
    EXPECT_TRUE(device->AddMethodDecl(reset));
    EXPECT_FALSE(device->AddMethodDecl(device->AllocateMethodDecl("RESET", TType::kUint32, none)));
    EXPECT_TRUE(disk->AddMethodDecl(disk->AllocateMethodDecl("Format", TType::kBoolean, none)));
    const auto own = disk->AllocateMethodDecl("reset", TType::kUint32, none);
    EXPECT_TRUE(disk->AddMethodDecl(own));
    EXPECT_EQ("reset Format", methods(solidState));
    EXPECT_EQ("Description", QualifiersOf(*own));
    EXPECT_EQ(TType::kBoolean, solidState->GetMethodDecl("format", none)->GetType(none));
    EXPECT_TRUE(disk->RemoveMethodDecl(own));
    EXPECT_FALSE(disk->RemoveMethodDecl(own));
    EXPECT_EQ("Reset Format", methods(solidState));
    EXPECT_EQ(15, StatusOf([&] { device->GetMethodDecl("Format", none); }));
    TCallContext arguments;
    EXPECT_EQ(1, StatusOf([&] { disk->InvokeMethod("Reset", arguments, none); }));
    EXPECT_EQ(15, StatusOf([&] { disk->InvokeMethod("Grow", arguments, none); }));
    EXPECT_EQ(5, StatusOf([&] { disk->AllocateMethodDecl("", TType::kUint32, none); }));
}

TEST_F(InMemClassTest, AStaticPropertyIsOneForClassSubclassesAndInstances)
{
    device->AddPropertyDecl(Decl({"Count", TType::kUint32, {"Static"}}));
    const auto instance = Add(disk, {{"Id", "sda"}});
    device->SetPropertyValue("Count", TCIMValue(3U), none);
    EXPECT_EQ("Id=sda Count=3 Size=NULL", ValuesOf(*instance));
    instance->GetProperty("count", none)->SetValue(TCIMValue(4U), none);
    EXPECT_EQ(TCIMValue(4U), solidState->GetProperty("Count", none)->GetValue(none));
    EXPECT_EQ("Count", solidState->GetProperty("Count", none)->GetPropertyDecl(none)->GetName(none));
    int statics = 0;
    solidState->EnumerateStaticProperties([&statics](boost::shared_ptr<ICIMProperty>) { return ++statics > 0; }, none);
    EXPECT_EQ(1, statics);
    EXPECT_EQ(13, StatusOf([&] { device->SetPropertyValue("Count", TCIMValue("4"), none); }));
    EXPECT_EQ(15, StatusOf([&] { device->SetPropertyValue("Id", TCIMValue("4"), none); }));
    EXPECT_EQ(15, StatusOf([&] { device->GetProperty("Nothing", none); }));
}

TEST_F(InMemClassTest, DeclarationsTellTypeDefaultAndReferenceClass)
{
    const auto size = disk->AllocatePropertyDecl("Size", TCIMValue(7U), none);
    EXPECT_EQ(TType::kUint32, size->GetType(none));
    EXPECT_EQ(TCIMValue(7U), size->GetDefaultValue(none));
    TCIMReference toRoom;
    toRoom.SetClass(room);
    TInMemPropertyDecl place("Place", TCIMValue(toRoom));
    EXPECT_EQ("Room", place.GetReferenceClass());
    EXPECT_TRUE(place.GetDefaultValue().IsNull());
    EXPECT_EQ(5, StatusOf([&] { disk->AllocatePropertyDecl("", TCIMValue(7U), none); }));
    EXPECT_EQ(13, StatusOf([&] { disk->AllocatePropertyDecl("Size", TCIMValue(), none); }));
}

TEST_F(InMemClassTest, HandlesOutliveTheNamespace)
{
    ns.reset();
    EXPECT_EQ("Id Size Wear", PropertiesOf(*solidState));
    EXPECT_EQ("", SubClassesOf(*solidState, true));
    EXPECT_EQ(nullptr, disk->GetNamespace(none));
    EXPECT_EQ(18, StatusOf([&] { disk->EnumerateInstances([](boost::shared_ptr<ICIMInstance>) { return true; }, true, none); }));
    EXPECT_EQ(18, StatusOf([&] { disk->AddToNamespace(none); }));
    EXPECT_EQ(18, StatusOf([&] { disk->RemoveFromNamespace(none); }));
    EXPECT_EQ(18, StatusOf([&] { disk->Validate(none); }));
    EXPECT_EQ(
        18, StatusOf([&] { disk->EnumerateAssociationClasses([](boost::shared_ptr<ICIMClass>) { return true; }, "", "", none); }));
    EXPECT_EQ(18, StatusOf([&] { disk->AllocateInstance(none)->AddToNamespace(none); }));
}

TEST_F(InMemClassTest, AssignmentTakesNothingOver)
{
    ICIMClass& target = *disk;
    EXPECT_EQ(&target, &(target = *room));
    EXPECT_EQ("Id Size", PropertiesOf(*disk));
}

TEST_F(InMemClassTest, ALongLineOfSubclassesIsWalkedAndDestroyedWithoutRecursion)
{
    TClassPointer last = room;
    for (int depth = 0; depth < 60000; ++depth) {
        last = Declare("C" + std::to_string(depth), last);
    }
    EXPECT_TRUE(last->IsSubclassOf(room, none));
    EXPECT_EQ(60000U, room->GetClassesBelow().size());
    last.reset();
    ns.reset();
}

}  // namespace
}  // namespace NORVZEL20
