#include "tests/embedded/store/TDevicesFixture.h"

namespace NORVZEL20 {
namespace {

using InMemClassChangeTest = TDevicesFixture;

TEST_F(InMemClassChangeTest, APropertyThatComesLateReachesAllBelow)
{
    EXPECT_TRUE(device->AddPropertyDecl(Decl({"Serial", TType::kString, {"Key"}})));
    EXPECT_EQ("Id Serial Size Wear", PropertiesOf(*solidState));
    EXPECT_EQ("Id Serial", KeysOf(*solidState));
    EXPECT_EQ("Id Serial", PropertiesOf(*device));
}

TEST_F(InMemClassChangeTest, PropertiesThatComeLateComeInTheOrderOfThoseThatComeEarly)
{
    const auto tape = Declare("Tape", fan, {{"Serial", TType::kString, {}}, {"Length", TType::kUint32, {}}});
    const auto reel = Declare("Reel", tape, {{"Width", TType::kUint8, {}}});
    disk->AddPropertyDecl(Decl({"Blocks", TType::kUint64, {}}));
    device->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    device->AddPropertyDecl(Decl({"Weight", TType::kUint32, {"Key"}}));
    fan->AddPropertyDecl(Decl({"Blades", TType::kUint8, {}}));
    EXPECT_EQ("Id Serial Weight Speed Blades Length Width", PropertiesOf(*reel));
    EXPECT_EQ("Id Serial Weight Size Blocks Wear", PropertiesOf(*solidState));
    EXPECT_EQ("Id Weight", KeysOf(*reel));
    EXPECT_EQ("Id Weight", KeysOf(*solidState));
    EXPECT_EQ(tape, boost::dynamic_pointer_cast<TInMemPropertyDecl>(reel->GetPropertyDecl("Serial", none))->GetOwner());
    EXPECT_EQ("Id=r1 Serial=NULL Weight=NULL Speed=NULL Blades=NULL Length=NULL Width=7",
              ValuesOf(*Allocate(reel, {{"Id", "r1"}, {"Width", TCIMValue(std::uint8_t(7))}})));
}

TEST_F(InMemClassChangeTest, ASubclassThatIsDeclaredLateHasWhatItsSuperclassGotMeanwhile)
{
    const auto tape = Allocate("Tape", device, {{"Length", TType::kUint32, {}}});
    device->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    tape->AddToNamespace(none);
    EXPECT_EQ("Id Serial Length", PropertiesOf(*tape));
}

TEST_F(InMemClassChangeTest, AnOverrideKeepsItsPlaceAndInheritsTheKey)
{
    const auto tape = Allocate("Tape", device, {{"Length", TType::kUint32, {}}, {"ID", TType::kString, {"Upper"}}});
    tape->AddToNamespace(none);
    EXPECT_EQ("ID Length", PropertiesOf(*tape));
    EXPECT_EQ("ID", KeysOf(*tape));
    EXPECT_EQ("Upper Key", QualifiersOf(*tape->GetPropertyDecl("id", none)));
    EXPECT_EQ("Key", QualifiersOf(*device->GetPropertyDecl("id", none)));
}

TEST_F(InMemClassChangeTest, AnOverrideOfAnotherTypeIsRefusedFromAboveAndBelow)
{
    EXPECT_EQ(13, StatusOf([&] { disk->AddPropertyDecl(Decl({"Id", TType::kUint32, {}})); }));
    EXPECT_EQ(13, StatusOf([&] { device->AddPropertyDecl(Decl({"wear", TType::kString, {}})); }));
    EXPECT_EQ("Id", PropertiesOf(*device));
    EXPECT_EQ("Id Size", PropertiesOf(*disk));
}

TEST_F(InMemClassChangeTest, ASuperclassThatGotAnotherTypeMeanwhileKeepsAClassOut)
{
    const auto tape = Allocate("Tape", device, {{"Length", TType::kUint32, {}}});
    device->AddPropertyDecl(Decl({"Length", TType::kUint64, {}}));
    EXPECT_EQ(13, StatusOf([&] { tape->Validate(none); }));
    EXPECT_EQ(13, StatusOf([&] { tape->AddToNamespace(none); }));
    EXPECT_EQ("Disk Fan", SubClassesOf(*device, false));
}

TEST_F(InMemClassChangeTest, ADeclarationBelongsToOneClassAndStandsThereOnce)
{
    const auto decl = Decl({"Serial", TType::kString, {}});
    EXPECT_TRUE(disk->AddPropertyDecl(decl));
    EXPECT_FALSE(disk->AddPropertyDecl(Decl({"SERIAL", TType::kString, {}})));
    EXPECT_EQ(5, StatusOf([&] { fan->AddPropertyDecl(decl); }));
    EXPECT_EQ(5, StatusOf([&] { fan->AddPropertyDecl(nullptr); }));
}

TEST_F(InMemClassChangeTest, ARemovedPropertyGoesFromAllBelowAndMayComeBack)
{
    const auto size = disk->GetPropertyDecl("Size", none);
    const auto instance = Add(solidState, {{"Id", "sda"}, {"Size", TCIMValue(std::uint64_t(5))}});
    EXPECT_FALSE(solidState->RemovePropertyDecl(size));
    EXPECT_TRUE(disk->RemovePropertyDecl(size));
    EXPECT_FALSE(disk->RemovePropertyDecl(size));
    EXPECT_EQ("Id Wear", PropertiesOf(*solidState));
    EXPECT_EQ("Id=sda Wear=NULL", ValuesOf(*instance));
    EXPECT_EQ(15, StatusOf([&] { instance->GetProperty("Size", none); }));
    EXPECT_TRUE(disk->AddPropertyDecl(Decl({"Size", TType::kString, {}})));
    EXPECT_EQ("Id=sda Size=NULL Wear=NULL", ValuesOf(*instance));
}

TEST_F(InMemClassChangeTest, RemovingAnOverrideBringsBackWhatItOverrode)
{
    const auto own = Decl({"Id", TType::kString, {"Upper"}});
    disk->AddPropertyDecl(own);
    EXPECT_EQ("Upper Key", QualifiersOf(*solidState->GetPropertyDecl("Id", none)));
    Add(disk, {{"Id", "sda"}});
    EXPECT_TRUE(disk->RemovePropertyDecl(own));
    EXPECT_EQ("Key", QualifiersOf(*solidState->GetPropertyDecl("Id", none)));
}

TEST_F(InMemClassChangeTest, AKeyOfAClassWithInstancesStays)
{
    const auto key = device->GetPropertyDecl("Id", none);
    Add(fan, {{"Id", "fan0"}});
    EXPECT_EQ(19, StatusOf([&] { device->RemovePropertyDecl(key); }));
    EXPECT_EQ("Id", KeysOf(*fan));
}

/// Two instances would have one path.
TEST_F(InMemClassChangeTest, AKeyThatAnOverrideMadeStaysWhileThereAreInstances)
{
    const auto label = Decl({"Label", TType::kString, {}});
    const auto own = Decl({"Label", TType::kString, {"Key"}});
    device->AddPropertyDecl(label);
    disk->AddPropertyDecl(own);
    Add(solidState, {{"Id", "sda"}, {"Label", "one"}});
    Add(solidState, {{"Id", "sda"}, {"Label", "two"}});
    EXPECT_EQ(19, StatusOf([&] { disk->RemovePropertyDecl(own); }));
    EXPECT_EQ("Id Label", KeysOf(*solidState));
    ns->ClearInstances();
    Add(fan, {{"Id", "fan0"}, {"Label", "none of its keys"}});
    EXPECT_TRUE(disk->RemovePropertyDecl(own));
    EXPECT_EQ("Id", KeysOf(*solidState));
}

TEST_F(InMemClassChangeTest, AnOverrideThatRepeatsTheKeyMayGo)
{
    const auto own = Decl({"Id", TType::kString, {"Key"}});
    disk->AddPropertyDecl(own);
    Add(disk, {{"Id", "sda"}});
    EXPECT_EQ(0, StatusOf([&] { own->AddQualifier(Qualifier("Key", TCIMValue(false)), none); }));
    EXPECT_TRUE(disk->RemovePropertyDecl(own));
    EXPECT_EQ("Id", KeysOf(*disk));
}

TEST_F(InMemClassChangeTest, AKeyIsNotUnsaidWhileThereAreInstances)
{
    const auto id = device->GetPropertyDecl("Id", none);
    Add(fan, {{"Id", "fan0"}});
    EXPECT_EQ(19, StatusOf([&] { id->AddQualifier(Qualifier("KEY", TCIMValue(false)), none); }));
    EXPECT_EQ("Id", KeysOf(*fan));
    EXPECT_EQ("Key", QualifiersOf(*id));
    EXPECT_EQ(0, StatusOf([&] { id->AddQualifier(Qualifier("Key"), none); }));
    ns->ClearInstances();
    EXPECT_EQ(0, StatusOf([&] { id->AddQualifier(Qualifier("Key", TCIMValue(false)), none); }));
    EXPECT_EQ("", KeysOf(*fan));
}

TEST_F(InMemClassChangeTest, AKeyThatComesLateLeavesInstancesToBeFound)
{
    const auto instance = Add(room, {{"Name", "hall"}});
    room->AddPropertyDecl(Decl({"Floor", TType::kUint8, {"Key"}}));
    EXPECT_EQ("root/cimv2:Room.Floor=NULL,Name=\"hall\"", instance->GetReference().GetPath());
    EXPECT_EQ(instance, ns->GetInstance(instance->GetReference(), none));
    EXPECT_EQ(14, StatusOf([&] { ns->GetInstance(Path("Room.Name=\"hall\""), none); }));
}

TEST_F(InMemClassChangeTest, AQualifierThatComesLateCountsAtOnce)
{
    disk->GetPropertyDecl("Size", none)->AddQualifier(Qualifier("Key"), none);
    EXPECT_EQ("Id Size", KeysOf(*solidState));
}

TEST_F(InMemClassChangeTest, APropertyThatBecomesAKeyLeavesInstancesOfSubclassesToBeFound)
{
    const auto instance = Add(solidState, {{"Id", "sda"}, {"Size", TCIMValue(std::uint64_t(7))}});
    disk->GetPropertyDecl("Size", none)->AddQualifier(Qualifier("Key"), none);
    EXPECT_EQ(instance, ns->GetInstance(Path("SolidState.Id=\"sda\",Size=7"), none));
    EXPECT_EQ(15, StatusOf([&] { ns->GetInstance(Path("SolidState.Id=\"sda\",Size=8"), none); }));
    EXPECT_EQ(12, StatusOf([&] { Add(solidState, {{"Id", "sda"}, {"Size", TCIMValue(std::uint64_t(7))}}); }));
    Add(solidState, {{"Id", "sda"}, {"Size", TCIMValue(std::uint64_t(8))}});
    ns->DeleteInstance(Path("SolidState.Id=\"sda\",Size=7"), none);
    EXPECT_EQ("SolidState.Id=\"sda\",Size=8\n", InstancesOf(*solidState));
}

TEST_F(InMemClassChangeTest, AnInstanceGoesAlthoughItsKeysHaveChangedSince)
{
    const auto instance = Add(room, {{"Name", "hall"}});
    room->AddPropertyDecl(Decl({"Floor", TType::kUint8, {"Key"}}));
    EXPECT_TRUE(room->RemoveInstance(instance));
    EXPECT_EQ("", InstancesOf(*room));
}

TEST_F(InMemClassChangeTest, AReferenceToAClassIsFoundInItsNewSpelling)
{
    const auto cls = Declare("Place", nullptr);
    cls->AddPropertyDecl(Reference("Where", "Room"));
    const TCIMReference hall = Add(room, {{"Name", "hall"}})->GetReference();
    const auto instance = Add(cls, {{"Where", TCIMValue(hall)}});
    room->SetSpelling("ROOM");
    EXPECT_EQ(instance, ns->GetInstance(instance->GetReference(), none));
}

TEST_F(InMemClassChangeTest, AddingAClassFailsWhere)
{
    const auto tape = Allocate("Tape", device);
    EXPECT_EQ(15, StatusOf([&] { Allocate("SmallTape", tape)->AddToNamespace(none); }));
    EXPECT_EQ(12, StatusOf([&] { Declare("DISK", nullptr); }));
    EXPECT_EQ(12, StatusOf([&] { Allocate("DISK", nullptr)->Validate(none); }));
    EXPECT_EQ(12, StatusOf([&] { disk->AddToNamespace(none); }));
    EXPECT_EQ(5, StatusOf([&] { ns->AllocateClass("", nullptr, none); }));
    EXPECT_EQ(5, StatusOf([&] { ns->AllocateClass("<root>", nullptr, none); }));
    const auto other = TInMemNamespace::Create("other");
    EXPECT_EQ(5, StatusOf([&] { other->AllocateClass("Tape", disk, none); }));
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
}

TEST_F(InMemClassChangeTest, AClassGoesWhenNothingDependsOnIt)
{
    const auto instance = Add(solidState, {{"Id", "sda"}});
    EXPECT_EQ(19, StatusOf([&] { disk->RemoveFromNamespace(none); }));
    EXPECT_EQ(19, StatusOf([&] { solidState->RemoveFromNamespace(none); }));
    ns->ClearInstances();
    solidState->RemoveFromNamespace(none);
    EXPECT_EQ(15, StatusOf([&] { solidState->RemoveFromNamespace(none); }));
    EXPECT_EQ(15, StatusOf([&] { instance->AddToNamespace(none); }));
    EXPECT_EQ("Device Disk Fan Room", SubClassesOf(*Root(), true));
    solidState->AddToNamespace(none);
    EXPECT_EQ("Device Disk SolidState Fan Room", SubClassesOf(*Root(), true));
}

TEST_F(InMemClassChangeTest, ChildClassesAreAddedAndRemovedFromAbove)
{
    const auto tape = Allocate("Tape", device);
    EXPECT_EQ(5, StatusOf([&] { room->AddChildClass(tape); }));
    EXPECT_EQ(5, StatusOf([&] { device->AddChildClass(nullptr); }));
    EXPECT_TRUE(device->AddChildClass(tape));
    EXPECT_FALSE(device->AddChildClass(tape));
    EXPECT_EQ("Disk Fan Tape", SubClassesOf(*device, false));
    EXPECT_TRUE(device->RemoveChildClass(tape));
    EXPECT_FALSE(device->RemoveChildClass(tape));
    EXPECT_TRUE(Root()->AddChildClass(Allocate("Building", nullptr)));
}

TEST_F(InMemClassChangeTest, ModifyClassTakesOverWhatIsMissing)
{
    const auto more = Allocate("Disk", device, {{"SIZE", TType::kUint64, {}}, {"Model", TType::kString, {"Indexed"}}});
    more->AddQualifier(Qualifier("Version", TCIMValue("3")));
    more->AddMethodDecl(more->AllocateMethodDecl("Format", TType::kUint32, none));
    disk->ModifyClass(more, none);
    EXPECT_EQ("Id Size Model", PropertiesOf(*disk));
    EXPECT_EQ("Indexed", QualifiersOf(*disk->GetPropertyDecl("Model", none)));
    EXPECT_EQ("Version", QualifiersOf(*disk));
    EXPECT_EQ("Format", disk->GetMethodDecl("Format", none)->GetName(none));
    const auto different = Allocate("Disk", device, {{"First", TType::kString, {}}, {"Size", TType::kString, {}}});
    EXPECT_EQ(13, StatusOf([&] { disk->ModifyClass(different, none); }));
    EXPECT_EQ("Id Size Model", PropertiesOf(*disk));
}

TEST_F(InMemClassChangeTest, ModifyClassTakesOverNothingWhereASubclassStandsInTheWay)
{
    const auto more = Allocate("Disk", device, {{"Model", TType::kString, {}}, {"Wear", TType::kString, {}}});
    EXPECT_EQ(13, StatusOf([&] { disk->ModifyClass(more, none); }));
    EXPECT_EQ("Id Size", PropertiesOf(*disk));
}

TEST_F(InMemClassChangeTest, ANameMayChangeItsLetterCaseAndNothingElse)
{
    disk->SetSpelling("DISK");
    EXPECT_EQ("DISK", ns->GetClass("disk", none)->GetName(none));
    EXPECT_EQ(5, StatusOf([&] { disk->SetSpelling("Disc"); }));
    disk->FindPropertyDecl("Size")->SetSpelling("size");
    EXPECT_EQ("Id size Wear", PropertiesOf(*solidState));
    EXPECT_EQ(5, StatusOf([&] { disk->FindPropertyDecl("Size")->SetSpelling("siz"); }));
}

}  // namespace
}  // namespace NORVZEL20
