#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

using InMemClassTest = TDevicesFixture;

TEST_F(InMemClassTest, PseudoClassRootStandsAboveAllTopLevelClasses)
{
    EXPECT_EQ("Device Room", SubClassesOf(*Root(), false));
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
    EXPECT_EQ("<root>", Root()->GetName(kNoContext));
    EXPECT_EQ(nullptr, Root()->GetSuperClass(kNoContext));
    EXPECT_EQ(nullptr, fDevice->GetSuperClass(kNoContext));
    EXPECT_TRUE(fDevice->IsRootClass(kNoContext));
    EXPECT_FALSE(fDisk->IsRootClass(kNoContext));
    EXPECT_FALSE(Root()->IsRootClass(kNoContext));
}

TEST_F(InMemClassTest, EnumerationsStopWhenTheCallbackReturnsFalse)
{
    std::string seen;
    Root()->EnumerateSubClasses(
        [&seen](boost::shared_ptr<ICIMClass> cls) {
            seen += cls->GetName(TCallContext());
            return false;
        },
        true, kNoContext);
    EXPECT_EQ("Device", seen);
}

TEST_F(InMemClassTest, ClassesAreFoundInAnyLetterCaseAndKeepTheirSpelling)
{
    EXPECT_EQ("SolidState", fNamespace->GetClass("SOLIDSTATE", kNoContext)->GetName(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetClass("Tape", kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetClass("", kNoContext); }));
}

TEST_F(InMemClassTest, RelationsBetweenClasses)
{
    EXPECT_TRUE(fSolidState->IsSubclassOf(fDevice, kNoContext));
    EXPECT_TRUE(fDisk->IsSubclassOf(fDisk, kNoContext));
    EXPECT_TRUE(fDisk->IsSubclassOf(Root(), kNoContext));
    EXPECT_FALSE(fDisk->IsSubclassOf(fSolidState, kNoContext));
    EXPECT_FALSE(fDisk->IsSubclassOf(fRoom, kNoContext));
    EXPECT_EQ("Disk", fSolidState->GetSuperClass(kNoContext)->GetName(kNoContext));
    EXPECT_TRUE(*fDisk == *fNamespace->GetClass("DISK", kNoContext));
    EXPECT_TRUE(*fDisk < *fFan);
    EXPECT_FALSE(*fFan < *fDisk);
    EXPECT_EQ(fNamespace, fDisk->GetNamespace(kNoContext));
}

TEST_F(InMemClassTest, PropertiesAndKeysAreInherited)
{
    EXPECT_EQ("Id Size Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ("Id", KeysOf(*fSolidState));
    EXPECT_EQ("Size", fSolidState->GetPropertyDecl("SIZE", kNoContext)->GetName(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDisk->GetPropertyDecl("Wear", kNoContext); }));
}

TEST_F(InMemClassTest, QualifiersAreInheritedIfTheirFlavorSaysSo)
{
    fDevice->AddQualifier(Qualifier("Version", TCIMValue("2"), ICIMQualifierDecl::kFlavorOverridable), kNoContext);
    fDevice->AddQualifier(Qualifier("Vendor", TCIMValue("any")), kNoContext);
    fDevice->AddQualifier(Qualifier("Unit", TCIMValue("one")), kNoContext);
    fDisk->AddQualifier(Qualifier("UNIT", TCIMValue("two")), kNoContext);
    EXPECT_EQ("Version Vendor Unit", QualifiersOf(*fDevice));
    EXPECT_EQ("UNIT Vendor", QualifiersOf(*fDisk));
    EXPECT_EQ("two", fSolidState->GetQualifier("unit", kNoContext)->GetValue(kNoContext).ToText());
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDisk->GetQualifier("Version", kNoContext); }));
    bool found = true;
    EXPECT_EQ(nullptr, fDisk->GetQualifier("Version", found, kNoContext));
    EXPECT_FALSE(found);
    EXPECT_NE(nullptr, fDisk->GetQualifier("Vendor", found, kNoContext));
    EXPECT_TRUE(found);
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->AddQualifier(nullptr, kNoContext); }));
}

TEST_F(InMemClassTest, QualifiersAreMadeOfTheirDeclaration)
{
    const auto decl =
        fNamespace->AllocateQualifierDecl("MaxLen", TCIMValue::Null(TType::kUint32), ICIMQualifierDecl::kScopeProperty,
                                          ICIMQualifierDecl::kFlavorToSubclass, kNoContext);
    const auto qualifier = fDisk->AllocateQualifier(decl, TCIMValue(64U), kNoContext);
    EXPECT_EQ("MaxLen", qualifier->GetName(kNoContext));
    EXPECT_EQ(TCIMValue(64U), qualifier->GetValue(kNoContext));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorToSubclass, qualifier->GetFlavor(kNoContext));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorNone,
              fDisk->AllocateQualifier(decl, TCIMValue(64U), ICIMQualifierDecl::kFlavorNone, kNoContext)->GetFlavor(kNoContext));
    EXPECT_EQ(TType::kUint32, fDisk->AllocateQualifier(decl, TCIMValue(), kNoContext)->GetValue(kNoContext).GetType());
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDisk->AllocateQualifier(decl, TCIMValue("64"), kNoContext); }));
}

TEST_F(InMemClassTest, AssociationIsInheritedWhateverItsFlavorAndAbstractIsNot)
{
    const auto link = Declare("Link", nullptr);
    const auto cable = Declare("Cable", link);
    link->AddQualifier(Qualifier("Association", TCIMValue(true), ICIMQualifierDecl::kFlavorNone), kNoContext);
    link->AddQualifier(Qualifier("Abstract"), kNoContext);
    EXPECT_TRUE(cable->IsAssociation(kNoContext));
    EXPECT_FALSE(fDisk->IsAssociation(kNoContext));
    EXPECT_TRUE(link->IsAbstract(kNoContext));
    EXPECT_FALSE(cable->IsAbstract(kNoContext));
}

TEST_F(InMemClassTest, AssociationsAreFoundFromBothEndsAndFromSubclasses)
{
    const auto location = Allocate("Location", nullptr);
    location->AddQualifier(Qualifier("Association"));
    location->AddPropertyDecl(Reference("Thing", "Device"));
    location->AddPropertyDecl(Reference("Place", "Room"));
    location->AddToNamespace(kNoContext);
    const auto associated = [&](const TClassPointer& cls, const std::string& association, const std::string& result,
                                const std::string& role, const std::string& resultRole) {
        return NamesOf<ICIMClass>([&](const auto& callback) {
            cls->EnumerateAssociatedClasses(callback, association, result, role, resultRole, TCallContext());
        });
    };
    EXPECT_EQ("Room", associated(fSolidState, "", "", "", ""));
    EXPECT_EQ("Room", associated(fSolidState, "location", "room", "thing", "place"));
    EXPECT_EQ("Device", associated(fRoom, "", "", "", ""));
    EXPECT_EQ("", associated(fDisk, "", "", "Place", ""));
    EXPECT_EQ("", associated(fDisk, "", "", "", "Thing"));
    EXPECT_EQ("", associated(fDisk, "Room", "", "", ""));
    EXPECT_EQ("", associated(fDisk, "", "Fan", "", ""));
    const auto associations = [&](const TClassPointer& cls, const std::string& result, const std::string& role) {
        return NamesOf<ICIMClass>(
            [&](const auto& callback) { cls->EnumerateAssociationClasses(callback, result, role, TCallContext()); });
    };
    EXPECT_EQ("Location", associations(fDisk, "", ""));
    EXPECT_EQ("Location", associations(fRoom, "LOCATION", "PLACE"));
    EXPECT_EQ("", associations(fRoom, "", "Thing"));
    EXPECT_EQ("", associations(fRoom, "Disk", ""));
    EXPECT_EQ("", associations(location, "", ""));
}

TEST_F(InMemClassTest, AnAssociationClassCanBeNamed)
{
    const auto link = Declare("Link", nullptr);
    const auto associations = [&] {
        return NamesOf<ICIMClass>([&](const auto& callback) { fRoom->EnumerateAssociationClasses(callback, "", "", kNoContext); });
    };
    EXPECT_TRUE(fRoom->AddAssociationClass(link));
    EXPECT_FALSE(fRoom->AddAssociationClass(link));
    EXPECT_EQ("Link", associations());
    EXPECT_TRUE(fRoom->RemoveAssociationClass(link));
    EXPECT_FALSE(fRoom->RemoveAssociationClass(link));
    EXPECT_EQ("", associations());
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fRoom->AddAssociationClass(nullptr); }));
}

TEST_F(InMemClassTest, MethodsAreInheritedAndOverridden)
{
    const auto methods = [&](const TClassPointer& cls) {
        return NamesOf<ICIMMethodDecl>([&](const auto& callback) { cls->EnumerateMethodDecls(callback, kNoContext); });
    };
    const auto reset = fDevice->AllocateMethodDecl("Reset", TType::kUint32, kNoContext);
    reset->AddQualifier(Qualifier("Description", TCIMValue("starts anew")), kNoContext);
    EXPECT_TRUE(fDevice->AddMethodDecl(reset));
    EXPECT_FALSE(fDevice->AddMethodDecl(fDevice->AllocateMethodDecl("RESET", TType::kUint32, kNoContext)));
    EXPECT_TRUE(fDisk->AddMethodDecl(fDisk->AllocateMethodDecl("Format", TType::kBoolean, kNoContext)));
    const auto own = fDisk->AllocateMethodDecl("reset", TType::kUint32, kNoContext);
    EXPECT_TRUE(fDisk->AddMethodDecl(own));
    EXPECT_EQ("reset Format", methods(fSolidState));
    EXPECT_EQ("Description", QualifiersOf(*own));
    EXPECT_EQ(TType::kBoolean, fSolidState->GetMethodDecl("format", kNoContext)->GetType(kNoContext));
    EXPECT_TRUE(fDisk->RemoveMethodDecl(own));
    EXPECT_FALSE(fDisk->RemoveMethodDecl(own));
    EXPECT_EQ("Reset Format", methods(fSolidState));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDevice->GetMethodDecl("Format", kNoContext); }));
    TCallContext arguments;
    EXPECT_EQ(TZELStatusCode::kNotOffered, StatusOf([&] { fDisk->InvokeMethod("Reset", arguments, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDisk->InvokeMethod("Grow", arguments, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->AllocateMethodDecl("", TType::kUint32, kNoContext); }));
}

TEST_F(InMemClassTest, AStaticPropertyIsOneForClassSubclassesAndInstances)
{
    fDevice->AddPropertyDecl(Decl({"Count", TType::kUint32, {"Static"}}));
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    fDevice->SetPropertyValue("Count", TCIMValue(3U), kNoContext);
    EXPECT_EQ("Id=sda Count=3 Size=NULL", ValuesOf(*instance));
    instance->GetProperty("count", kNoContext)->SetValue(TCIMValue(4U), kNoContext);
    EXPECT_EQ(TCIMValue(4U), fSolidState->GetProperty("Count", kNoContext)->GetValue(kNoContext));
    EXPECT_EQ("Count", fSolidState->GetProperty("Count", kNoContext)->GetPropertyDecl(kNoContext)->GetName(kNoContext));
    int statics = 0;
    fSolidState->EnumerateStaticProperties([&statics](boost::shared_ptr<ICIMProperty>) { return ++statics > 0; }, kNoContext);
    EXPECT_EQ(1, statics);
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDevice->SetPropertyValue("Count", TCIMValue("4"), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDevice->SetPropertyValue("Id", TCIMValue("4"), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fDevice->GetProperty("Nothing", kNoContext); }));
}

TEST_F(InMemClassTest, DeclarationsHoldTypeDefaultAndReferenceClass)
{
    const auto size = fDisk->AllocatePropertyDecl("Size", TCIMValue(7U), kNoContext);
    EXPECT_EQ(TType::kUint32, size->GetType(kNoContext));
    EXPECT_EQ(TCIMValue(7U), size->GetDefaultValue(kNoContext));
    TCIMReference toRoom;
    toRoom.SetClass(fRoom);
    TInMemPropertyDecl place("Place", TCIMValue(toRoom));
    EXPECT_EQ("Room", place.GetReferenceClass());
    EXPECT_TRUE(place.GetDefaultValue().IsNull());
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->AllocatePropertyDecl("", TCIMValue(7U), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDisk->AllocatePropertyDecl("Size", TCIMValue(), kNoContext); }));
}

TEST_F(InMemClassTest, HandlesOutliveTheNamespace)
{
    fNamespace.reset();
    EXPECT_EQ("Id Size Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ("", SubClassesOf(*fSolidState, true));
    EXPECT_EQ(nullptr, fDisk->GetNamespace(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNamespaceGone,
              StatusOf([&] { fDisk->EnumerateInstances([](boost::shared_ptr<ICIMInstance>) { return true; }, true, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNamespaceGone, StatusOf([&] { fDisk->AddToNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNamespaceGone, StatusOf([&] { fDisk->RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNamespaceGone, StatusOf([&] { fDisk->Validate(kNoContext); }));
    EXPECT_EQ(18, StatusOf([&] {
                  fDisk->EnumerateAssociationClasses([](boost::shared_ptr<ICIMClass>) { return true; }, "", "", kNoContext);
              }));
    EXPECT_EQ(TZELStatusCode::kNamespaceGone, StatusOf([&] { fDisk->AllocateInstance(kNoContext)->AddToNamespace(kNoContext); }));
}

TEST_F(InMemClassTest, AssignmentTakesNothingOver)
{
    ICIMClass& target = *fDisk;
    EXPECT_EQ(&target, &(target = *fRoom));
    EXPECT_EQ("Id Size", PropertiesOf(*fDisk));
}

TEST_F(InMemClassTest, ALongLineOfSubclassesIsWalkedAndDestroyedWithoutRecursion)
{
    TClassPointer last = fRoom;
    for (int depth = 0; depth < 60000; ++depth) {
        last = Declare("C" + std::to_string(depth), last);
    }
    EXPECT_TRUE(last->IsSubclassOf(fRoom, kNoContext));
    EXPECT_EQ(60000U, fRoom->GetClassesBelow().size());
    last.reset();
    fNamespace.reset();
}

}  // namespace
}  // namespace NORVZEL20
