#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

using InMemClassChangeTest = TDevicesFixture;

TEST_F(InMemClassChangeTest, APropertyThatComesLateReachesAllBelow)
{
    EXPECT_TRUE(fDevice->AddPropertyDecl(Decl({"Serial", TType::kString, {"Key"}})));
    EXPECT_EQ("Id Serial Size Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ("Id Serial", KeysOf(*fSolidState));
    EXPECT_EQ("Id Serial", PropertiesOf(*fDevice));
}

TEST_F(InMemClassChangeTest, PropertiesThatComeLateComeInTheOrderOfThoseThatComeEarly)
{
    const auto tape = Declare("Tape", fFan, {{"Serial", TType::kString, {}}, {"Length", TType::kUint32, {}}});
    const auto reel = Declare("Reel", tape, {{"Width", TType::kUint8, {}}});
    fDisk->AddPropertyDecl(Decl({"Blocks", TType::kUint64, {}}));
    fDevice->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    fDevice->AddPropertyDecl(Decl({"Weight", TType::kUint32, {"Key"}}));
    fFan->AddPropertyDecl(Decl({"Blades", TType::kUint8, {}}));
    EXPECT_EQ("Id Serial Weight Speed Blades Length Width", PropertiesOf(*reel));
    EXPECT_EQ("Id Serial Weight Size Blocks Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ("Id Weight", KeysOf(*reel));
    EXPECT_EQ("Id Weight", KeysOf(*fSolidState));
    EXPECT_EQ(tape, boost::dynamic_pointer_cast<TInMemPropertyDecl>(reel->GetPropertyDecl("Serial", kNoContext))->GetOwner());
    EXPECT_EQ("Id=r1 Serial=NULL Weight=NULL Speed=NULL Blades=NULL Length=NULL Width=7",
              ValuesOf(*Allocate(reel, {{"Id", "r1"}, {"Width", TCIMValue(static_cast<std::uint8_t>(7))}})));
}

TEST_F(InMemClassChangeTest, ASubclassThatIsDeclaredLateHasWhatItsSuperclassGotMeanwhile)
{
    const auto tape = Allocate("Tape", fDevice, {{"Length", TType::kUint32, {}}});
    fDevice->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    tape->AddToNamespace(kNoContext);
    EXPECT_EQ("Id Serial Length", PropertiesOf(*tape));
}

TEST_F(InMemClassChangeTest, ASubclassThatIsDeclaredLateHasNotWhatItsSuperclassLostMeanwhile)
{
    const auto tape = Allocate("Tape", fDisk, {{"Length", TType::kUint32, {}}, {"SIZE", TType::kUint64, {}}});
    const auto reel = Allocate("Reel", fDisk, {{"Width", TType::kUint32, {}}});
    fDisk->RemovePropertyDecl(fDisk->GetPropertyDecl("Size", kNoContext));
    tape->AddToNamespace(kNoContext);
    reel->AddToNamespace(kNoContext);
    EXPECT_EQ("Id Length SIZE", PropertiesOf(*tape));
    EXPECT_EQ("Id Width", PropertiesOf(*reel));
    EXPECT_EQ(nullptr, reel->FindPropertyDecl("Size"));
}

TEST_F(InMemClassChangeTest, AMethodOfASubclassThatIsDeclaredLateOverridesOneThatIsNewAbove)
{
    const auto tape = Allocate("Tape", fDevice);
    tape->AddMethodDecl(tape->AllocateMethodDecl("Reset", TType::kUint32, kNoContext));
    fDevice->AddMethodDecl(fDevice->AllocateMethodDecl("Reset", TType::kUint32, kNoContext));
    tape->AddToNamespace(kNoContext);
    EXPECT_EQ("Reset", NamesOf<ICIMMethodDecl>([&](const auto& callback) { tape->EnumerateMethodDecls(callback, kNoContext); }));
}

TEST_F(InMemClassChangeTest, AnOverrideKeepsItsPlaceAndInheritsTheKey)
{
    const auto tape = Allocate("Tape", fDevice, {{"Length", TType::kUint32, {}}, {"ID", TType::kString, {"Upper"}}});
    tape->AddToNamespace(kNoContext);
    EXPECT_EQ("ID Length", PropertiesOf(*tape));
    EXPECT_EQ("ID", KeysOf(*tape));
    EXPECT_EQ("Upper Key", QualifiersOf(*tape->GetPropertyDecl("id", kNoContext)));
    EXPECT_EQ("Key", QualifiersOf(*fDevice->GetPropertyDecl("id", kNoContext)));
}

TEST_F(InMemClassChangeTest, AnOverrideOfAnotherTypeIsRefusedFromAboveAndBelow)
{
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDisk->AddPropertyDecl(Decl({"Id", TType::kUint32, {}})); }));
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDevice->AddPropertyDecl(Decl({"wear", TType::kString, {}})); }));
    EXPECT_EQ("Id", PropertiesOf(*fDevice));
    EXPECT_EQ("Id Size", PropertiesOf(*fDisk));
}

TEST_F(InMemClassChangeTest, ASuperclassThatGotAnotherTypeMeanwhileKeepsAClassOut)
{
    const auto tape = Allocate("Tape", fDevice, {{"Length", TType::kUint32, {}}});
    fDevice->AddPropertyDecl(Decl({"Length", TType::kUint64, {}}));
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { tape->Validate(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { tape->AddToNamespace(kNoContext); }));
    EXPECT_EQ("Disk Fan", SubClassesOf(*fDevice, false));
}

TEST_F(InMemClassChangeTest, ADeclarationBelongsToOneClassAndStandsThereOnce)
{
    const auto decl = Decl({"Serial", TType::kString, {}});
    EXPECT_TRUE(fDisk->AddPropertyDecl(decl));
    EXPECT_FALSE(fDisk->AddPropertyDecl(Decl({"SERIAL", TType::kString, {}})));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fFan->AddPropertyDecl(decl); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fFan->AddPropertyDecl(nullptr); }));
}

TEST_F(InMemClassChangeTest, ARemovedPropertyGoesFromAllBelowAndMayComeBack)
{
    const auto size = fDisk->GetPropertyDecl("Size", kNoContext);
    const auto instance = Add(fSolidState, {{"Id", "sda"}, {"Size", Uint64(5)}});
    EXPECT_FALSE(fSolidState->RemovePropertyDecl(size));
    EXPECT_TRUE(fDisk->RemovePropertyDecl(size));
    EXPECT_FALSE(fDisk->RemovePropertyDecl(size));
    EXPECT_EQ("Id Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ("Id=sda Wear=NULL", ValuesOf(*instance));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { instance->GetProperty("Size", kNoContext); }));
    EXPECT_TRUE(fDisk->AddPropertyDecl(Decl({"Size", TType::kString, {}})));
    EXPECT_EQ("Id=sda Size=NULL Wear=NULL", ValuesOf(*instance));
}

TEST_F(InMemClassChangeTest, RemovingAnOverrideBringsBackWhatItOverrode)
{
    const auto own = Decl({"Id", TType::kString, {"Upper"}});
    fDisk->AddPropertyDecl(own);
    EXPECT_EQ("Upper Key", QualifiersOf(*fSolidState->GetPropertyDecl("Id", kNoContext)));
    Add(fDisk, {{"Id", "sda"}});
    EXPECT_TRUE(fDisk->RemovePropertyDecl(own));
    EXPECT_EQ("Key", QualifiersOf(*fSolidState->GetPropertyDecl("Id", kNoContext)));
}

TEST_F(InMemClassChangeTest, AKeyOfAClassWithInstancesStays)
{
    const auto key = fDevice->GetPropertyDecl("Id", kNoContext);
    Add(fFan, {{"Id", "fan0"}});
    EXPECT_EQ(TZELStatusCode::kClassInUse, StatusOf([&] { fDevice->RemovePropertyDecl(key); }));
    EXPECT_EQ("Id", KeysOf(*fFan));
}

// Without the key, the two instances would have the same path.
TEST_F(InMemClassChangeTest, AKeyThatAnOverrideMadeStaysWhileThereAreInstances)
{
    const auto label = Decl({"Label", TType::kString, {}});
    const auto own = Decl({"Label", TType::kString, {"Key"}});
    fDevice->AddPropertyDecl(label);
    fDisk->AddPropertyDecl(own);
    Add(fSolidState, {{"Id", "sda"}, {"Label", "one"}});
    Add(fSolidState, {{"Id", "sda"}, {"Label", "two"}});
    EXPECT_EQ(TZELStatusCode::kClassInUse, StatusOf([&] { fDisk->RemovePropertyDecl(own); }));
    EXPECT_EQ("Id Label", KeysOf(*fSolidState));
    fNamespace->ClearInstances();
    Add(fFan, {{"Id", "fan0"}, {"Label", "none of its keys"}});
    EXPECT_TRUE(fDisk->RemovePropertyDecl(own));
    EXPECT_EQ("Id", KeysOf(*fSolidState));
}

TEST_F(InMemClassChangeTest, AnOverrideThatRepeatsTheKeyMayGo)
{
    const auto own = Decl({"Id", TType::kString, {"Key"}});
    fDisk->AddPropertyDecl(own);
    Add(fDisk, {{"Id", "sda"}});
    EXPECT_EQ(TZELStatusCode::kSuccess, StatusOf([&] { own->AddQualifier(Qualifier("Key", TCIMValue(false)), kNoContext); }));
    EXPECT_TRUE(fDisk->RemovePropertyDecl(own));
    EXPECT_EQ("Id", KeysOf(*fDisk));
}

TEST_F(InMemClassChangeTest, AKeyCannotBeRevokedWhileThereAreInstances)
{
    const auto id = fDevice->GetPropertyDecl("Id", kNoContext);
    Add(fFan, {{"Id", "fan0"}});
    EXPECT_EQ(TZELStatusCode::kClassInUse, StatusOf([&] { id->AddQualifier(Qualifier("KEY", TCIMValue(false)), kNoContext); }));
    EXPECT_EQ("Id", KeysOf(*fFan));
    EXPECT_EQ("Key", QualifiersOf(*id));
    EXPECT_EQ(TZELStatusCode::kSuccess, StatusOf([&] { id->AddQualifier(Qualifier("Key"), kNoContext); }));
    fNamespace->ClearInstances();
    EXPECT_EQ(TZELStatusCode::kSuccess, StatusOf([&] { id->AddQualifier(Qualifier("Key", TCIMValue(false)), kNoContext); }));
    EXPECT_EQ("", KeysOf(*fFan));
}

TEST_F(InMemClassChangeTest, AKeyThatComesLateLeavesInstancesToBeFound)
{
    const auto instance = Add(fRoom, {{"Name", "hall"}});
    fRoom->AddPropertyDecl(Decl({"Floor", TType::kUint8, {"Key"}}));
    EXPECT_EQ("root/cimv2:Room.Floor=NULL,Name=\"hall\"", instance->GetReference().GetPath());
    EXPECT_EQ(instance, fNamespace->GetInstance(instance->GetReference(), kNoContext));
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { fNamespace->GetInstance(Path("Room.Name=\"hall\""), kNoContext); }));
}

TEST_F(InMemClassChangeTest, AQualifierThatComesLateCountsAtOnce)
{
    fDisk->GetPropertyDecl("Size", kNoContext)->AddQualifier(Qualifier("Key"), kNoContext);
    EXPECT_EQ("Id Size", KeysOf(*fSolidState));
}

TEST_F(InMemClassChangeTest, APropertyThatBecomesAKeyLeavesInstancesOfSubclassesToBeFound)
{
    const auto instance = Add(fSolidState, {{"Id", "sda"}, {"Size", Uint64(7)}});
    fDisk->GetPropertyDecl("Size", kNoContext)->AddQualifier(Qualifier("Key"), kNoContext);
    EXPECT_EQ(instance, fNamespace->GetInstance(Path("SolidState.Id=\"sda\",Size=7"), kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound,
              StatusOf([&] { fNamespace->GetInstance(Path("SolidState.Id=\"sda\",Size=8"), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(fSolidState, {{"Id", "sda"}, {"Size", Uint64(7)}}); }));
    Add(fSolidState, {{"Id", "sda"}, {"Size", Uint64(8)}});
    fNamespace->DeleteInstance(Path("SolidState.Id=\"sda\",Size=7"), kNoContext);
    EXPECT_EQ("SolidState.Id=\"sda\",Size=8\n", InstancesOf(*fSolidState));
}

TEST_F(InMemClassChangeTest, AnInstanceGoesAlthoughItsKeysHaveChangedSince)
{
    const auto instance = Add(fRoom, {{"Name", "hall"}});
    fRoom->AddPropertyDecl(Decl({"Floor", TType::kUint8, {"Key"}}));
    EXPECT_TRUE(fRoom->RemoveInstance(instance));
    EXPECT_EQ("", InstancesOf(*fRoom));
}

TEST_F(InMemClassChangeTest, AReferenceToAClassIsFoundInItsNewSpelling)
{
    const auto cls = Declare("Place", nullptr);
    cls->AddPropertyDecl(Reference("Where", "Room"));
    const TCIMReference hall = Add(fRoom, {{"Name", "hall"}})->GetReference();
    const auto instance = Add(cls, {{"Where", TCIMValue(hall)}});
    fRoom->SetSpelling("ROOM");
    EXPECT_EQ(instance, fNamespace->GetInstance(instance->GetReference(), kNoContext));
}

TEST_F(InMemClassChangeTest, AddingAClassFailsForATakenNameAndForSuperclassesNotDeclaredHere)
{
    const auto tape = Allocate("Tape", fDevice);
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { Allocate("SmallTape", tape)->AddToNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Declare("DISK", nullptr); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Allocate("DISK", nullptr)->Validate(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { fDisk->AddToNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fNamespace->AllocateClass("", nullptr, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fNamespace->AllocateClass("<root>", nullptr, kNoContext); }));
    const auto other = TInMemNamespace::Create("other");
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { other->AllocateClass("Tape", fDisk, kNoContext); }));
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
}

TEST_F(InMemClassChangeTest, AClassGoesWhenNothingDependsOnIt)
{
    const auto instance = Add(fSolidState, {{"Id", "sda"}});
    EXPECT_EQ(TZELStatusCode::kClassInUse, StatusOf([&] { fDisk->RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kClassInUse, StatusOf([&] { fSolidState->RemoveFromNamespace(kNoContext); }));
    fNamespace->ClearInstances();
    fSolidState->RemoveFromNamespace(kNoContext);
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fSolidState->RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { instance->AddToNamespace(kNoContext); }));
    EXPECT_EQ("Device Disk Fan Room", SubClassesOf(*Root(), true));
    fSolidState->AddToNamespace(kNoContext);
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
}

TEST_F(InMemClassChangeTest, ChildClassesAreAddedAndRemovedFromAbove)
{
    const auto tape = Allocate("Tape", fDevice);
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fRoom->AddChildClass(tape); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDevice->AddChildClass(nullptr); }));
    EXPECT_TRUE(fDevice->AddChildClass(tape));
    EXPECT_FALSE(fDevice->AddChildClass(tape));
    EXPECT_EQ("Disk Fan Tape", SubClassesOf(*fDevice, false));
    EXPECT_TRUE(fDevice->RemoveChildClass(tape));
    EXPECT_FALSE(fDevice->RemoveChildClass(tape));
    EXPECT_TRUE(Root()->AddChildClass(Allocate("Building", nullptr)));
}

TEST_F(InMemClassChangeTest, ModifyClassTakesOverWhatIsMissing)
{
    const auto more = Allocate("Disk", fDevice, {{"SIZE", TType::kUint64, {}}, {"Model", TType::kString, {"Indexed"}}});
    more->AddQualifier(Qualifier("Version", TCIMValue("3")));
    more->AddMethodDecl(more->AllocateMethodDecl("Format", TType::kUint32, kNoContext));
    fDisk->ModifyClass(more, kNoContext);
    EXPECT_EQ("Id Size Model", PropertiesOf(*fDisk));
    EXPECT_EQ("Indexed", QualifiersOf(*fDisk->GetPropertyDecl("Model", kNoContext)));
    EXPECT_EQ("Version", QualifiersOf(*fDisk));
    EXPECT_EQ("Format", fDisk->GetMethodDecl("Format", kNoContext)->GetName(kNoContext));
    const auto different = Allocate("Disk", fDevice, {{"First", TType::kString, {}}, {"Size", TType::kString, {}}});
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDisk->ModifyClass(different, kNoContext); }));
    EXPECT_EQ("Id Size Model", PropertiesOf(*fDisk));
}

TEST_F(InMemClassChangeTest, ModifyClassTakesOverNothingIfASubclassHasAnotherType)
{
    const auto more = Allocate("Disk", fDevice, {{"Model", TType::kString, {}}, {"Wear", TType::kString, {}}});
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { fDisk->ModifyClass(more, kNoContext); }));
    EXPECT_EQ("Id Size", PropertiesOf(*fDisk));
}

TEST_F(InMemClassChangeTest, ANameMayChangeItsLetterCaseAndNothingElse)
{
    fDisk->SetSpelling("DISK");
    EXPECT_EQ("DISK", fNamespace->GetClass("disk", kNoContext)->GetName(kNoContext));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->SetSpelling("Disc"); }));
    fDisk->FindPropertyDecl("Size")->SetSpelling("size");
    EXPECT_EQ("Id size Wear", PropertiesOf(*fSolidState));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->FindPropertyDecl("Size")->SetSpelling("siz"); }));
}

}  // namespace
}  // namespace NORVZEL20
