#include <limits>

#include "embedded/store/TInMemNamespaceProvider.h"
#include "host/TCIMDateTime.h"
#include "host/TNamespaceProviderManager.h"
#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemNamespaceTest : public TInMemFixture {
  protected:
    TClassPointer fDisk = DeclareDisk();
};

TEST_F(InMemNamespaceTest, ProviderInmemIsThereFromTheStart)
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("inmem");
    ASSERT_NE(nullptr, provider);
    EXPECT_EQ("inmem", provider->GetName(kNoContext));
    EXPECT_EQ(0, provider->GetType(kNoContext));
    EXPECT_FALSE(provider->IsIndicationsSupported(kNoContext));
    const auto first = provider->AllocateNamespace(kNoContext, false, "root/cimv2");
    const auto second = provider->AllocateNamespace(kNoContext, true, "root/cimv2");
    EXPECT_NE(first, second);
    EXPECT_EQ(provider, first->GetNamespaceProvider(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { first->GetClass("Disk", kNoContext); }));
    EXPECT_EQ("root/cimv2", boost::dynamic_pointer_cast<TInMemNamespace>(first)->GetNamespaceName());
}

TEST_F(InMemNamespaceTest, SlashesAroundItsNameAreTakenOff)
{
    EXPECT_EQ("root/cimv2", TInMemNamespace::Create("//root/cimv2/")->GetNamespaceName());
    EXPECT_EQ("", TInMemNamespace::Create("/")->GetNamespaceName());
}

TEST_F(InMemNamespaceTest, InstancesComeInOrderOfInsertionAndOfExactlyTheClass)
{
    const auto fast = Declare("FastDisk", fDisk);
    Add(fDisk, {{"Id", "sdb"}});
    Add(fast, {{"Id", "sda"}});
    Add(fDisk, {{"Id", "sda"}});
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\n", InstancesOf(*fDisk));
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\nFastDisk.Id=\"sda\"\n", InstancesOf(*fDisk, true));
    EXPECT_EQ("", InstancesOf(*fNamespace->GetClass("<root>", kNoContext)));
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\nFastDisk.Id=\"sda\"\n",
              InstancesOf(*fNamespace->GetClass("<root>", kNoContext), true));
}

TEST_F(InMemNamespaceTest, InstancesMayComeAndGoWhileTheyAreEnumerated)
{
    for (int number = 0; number < 100; ++number) {
        Add(fDisk, {{"Id", TCIMValue(std::to_string(number))}});
    }
    int seen = 0;
    fDisk->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            Add(fDisk, {{"Id", TCIMValue("new" + std::to_string(seen))}});
            fNamespace->DeleteInstance(instance->GetReference(kNoContext), kNoContext);
            return ++seen > 0;
        },
        false, kNoContext);
    EXPECT_EQ(100, seen);
    EXPECT_EQ(100U, fDisk->GetInstanceCount());
}

TEST_F(InMemNamespaceTest, AllInstancesMayBeDeletedWhileTheyAreEnumerated)
{
    for (int number = 0; number < 100; ++number) {
        Add(fDisk, {{"Id", TCIMValue(std::to_string(number))}});
    }
    int seen = 0;
    fDisk->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            fNamespace->DeleteInstance(instance->GetReference(kNoContext), kNoContext);
            return ++seen > 0;
        },
        false, kNoContext);
    EXPECT_EQ(100, seen);
    EXPECT_EQ("", InstancesOf(*fDisk));
}

TEST_F(InMemNamespaceTest, PathsFindInstancesWhateverTheirNamespaceAndLetterCase)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    for (const char* path : {"Disk.Id=\"sda\"", "root/cimv2:DISK.ID=\"sda\"", "//host/other:disk.id=\"sda\""}) {
        EXPECT_EQ(instance, fNamespace->GetInstance(Path(path), kNoContext)) << path;
    }
    EXPECT_EQ(instance, fNamespace->FindInstance(instance->GetReference()));
}

TEST_F(InMemNamespaceTest, KeysReadFromTextFindEveryType)
{
    const struct {
        TType::ECIMType type;
        TCIMValue value;
        const char* key;
    } rows[] = {{TType::kBoolean, TCIMValue(true), "TRUE"},
                {TType::kUint8, TCIMValue(static_cast<unsigned char>(200)), "200"},
                {TType::kSint16, TCIMValue(static_cast<short>(-5)), "-5"},
                {TType::kSint64, TCIMValue(static_cast<std::int64_t>(5)), "5"},
                {TType::kUint64, TCIMValue(std::numeric_limits<std::uint64_t>::max()), "18446744073709551615"},
                {TType::kReal64, TCIMValue(0.5), "0.5"},
                {TType::kReal32, TCIMValue(2.0F), "2"},
                {TType::kChar16, TCIMValue(u'x'), "'x'"},
                {TType::kString, TCIMValue("5"), "\"5\""}};
    for (const auto& row : rows) {
        const auto cls = Declare("Of" + std::to_string(row.type), nullptr, {{"Key", row.type, {"Key"}}});
        const auto instance = Add(cls, {{"Key", row.value}});
        EXPECT_EQ(instance, fNamespace->FindInstance(Path(cls->GetName() + ".Key=" + row.key))) << row.key;
        EXPECT_EQ(instance, fNamespace->FindInstance(Path(instance->GetReference().GetPath()))) << row.key;
    }
}

TEST_F(InMemNamespaceTest, KeysOfDatetimesAndReferencesAreReadToo)
{
    TCIMDateTime time;
    ASSERT_TRUE(TCIMDateTime::Parse("20200102030405.000000+060", time));
    const auto event = Declare("Event", nullptr, {{"Time", TType::kDateTime, {"Key"}}});
    const auto instance = Add(event, {{"Time", TCIMValue(time)}});
    EXPECT_EQ(instance, fNamespace->FindInstance(Path("Event.Time=\"20200102020405.000000+000\"")));
    const auto link = Allocate("Link", nullptr);
    link->AddPropertyDecl(Reference("To", "Event"));
    link->AddToNamespace(kNoContext);
    const auto linked = Add(link, {{"To", TCIMValue(instance->GetReference())}});
    EXPECT_EQ(linked, fNamespace->FindInstance(Path(linked->GetReference().GetPath())));
}

TEST_F(InMemNamespaceTest, PathsThatFindNothing)
{
    Add(fDisk, {{"Id", "sda"}});
    Declare("Slot", nullptr, {{"Number", TType::kUint8, {"Key"}}});
    const struct {
        const char* path;
        int status;
    } rows[] = {{"Disk.Id=\"sdb\"", TZELStatusCode::kNotFound},
                {"Disk.Id=\"SDA\"", TZELStatusCode::kNotFound},
                {"Tape.Id=\"sda\"", TZELStatusCode::kNotFound},
                {"Disk.Id=\"sda\",Size=1", TZELStatusCode::kNotFound},
                {"Disk", TZELStatusCode::kKeyMissing},
                {"Disk.Size=1", TZELStatusCode::kKeyMissing},
                {"Disk.Id=5", TZELStatusCode::kTypeMismatch},
                {"Slot.Number=256", TZELStatusCode::kTypeMismatch},
                {"Slot.Number=\"x\"", TZELStatusCode::kTypeMismatch}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.status, StatusOf([&] { fNamespace->GetInstance(Path(row.path), kNoContext); })) << row.path;
        EXPECT_EQ(row.status, StatusOf([&] { fNamespace->DeleteInstance(Path(row.path), kNoContext); })) << row.path;
        EXPECT_EQ(row.status, StatusOf([&] { fNamespace->ModifyInstance(Path(row.path), kNoContext, kNoContext); })) << row.path;
    }
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetInstance(TCIMReference(), kNoContext); }));
}

TEST_F(InMemNamespaceTest, ADeletedInstanceLivesOnInItsHandlesAndMayComeBack)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    Add(fDisk, {{"Id", "sdb"}});
    fNamespace->DeleteInstance(instance->GetReference(), kNoContext);
    EXPECT_EQ("Disk.Id=\"sdb\"\n", InstancesOf(*fDisk));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->DeleteInstance(instance->GetReference(), kNoContext); }));
    EXPECT_EQ("Id=sda Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    instance->AddToNamespace(kNoContext);
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\n", InstancesOf(*fDisk));
}

TEST_F(InMemNamespaceTest, ModifyingSetsAllPropertiesOrNone)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}, {"Label", "one"}});
    const TCIMReference path = instance->GetReference();
    fNamespace->ModifyInstance(path, {{"LABEL", TCIMValue("two")}, {"Size", Uint64(5)}, {"Id", TCIMValue("sda")}}, kNoContext);
    EXPECT_EQ("Id=sda Size=5 Label=two Tags=NULL", ValuesOf(*instance));
    const struct {
        TCallContext properties;
        int status;
    } rows[] = {{{{"Label", TCIMValue("x")}, {"Zone", TCIMValue("x")}}, TZELStatusCode::kNotFound},
                {{{"Label", TCIMValue("x")}, {"Size", TCIMValue("x")}}, TZELStatusCode::kTypeMismatch},
                {{{"Id", TCIMValue("sdb")}, {"Label", TCIMValue("x")}}, TZELStatusCode::kInvalidParameter},
                {{{"Id", TCIMValue()}, {"Label", TCIMValue("x")}}, TZELStatusCode::kInvalidParameter}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.status, StatusOf([&] { fNamespace->ModifyInstance(path, row.properties, kNoContext); }));
        EXPECT_EQ("Id=sda Size=5 Label=two Tags=NULL", ValuesOf(*instance));
    }
}

TEST_F(InMemNamespaceTest, ElementLevelChangesReturnWhetherAnythingChanged)
{
    const auto instance = Allocate(fDisk, {{"Id", "sda"}});
    EXPECT_FALSE(fDisk->RemoveInstance(instance));
    EXPECT_TRUE(fDisk->AddInstance(instance));
    EXPECT_FALSE(fDisk->AddInstance(instance));
    EXPECT_FALSE(fDisk->AddInstance(Allocate(fDisk, {{"Id", "sda"}})));
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { fDisk->AddInstance(Allocate(fDisk, {})); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter,
              StatusOf([&] { fDisk->AddInstance(Declare("Tape", nullptr)->AllocateInMemInstance()); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { fDisk->AddInstance(nullptr); }));
    EXPECT_TRUE(fDisk->RemoveInstance(instance));
    EXPECT_FALSE(fDisk->RemoveInstance(nullptr));
    EXPECT_EQ("", InstancesOf(*fDisk));
}

TEST_F(InMemNamespaceTest, ClearedOfInstancesItKeepsItsClasses)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    fNamespace->ClearInstances();
    EXPECT_EQ("", InstancesOf(*fDisk));
    EXPECT_FALSE(instance->IsAdded());
    Add(fDisk, {{"Id", "sda"}});
    EXPECT_EQ("Disk.Id=\"sda\"\n", InstancesOf(*fDisk));
}

TEST_F(InMemNamespaceTest, ThousandsComeAndGoInConstantTime)
{
    for (int number = 0; number < 20000; ++number) {
        Add(fDisk, {{"Id", TCIMValue(std::to_string(number))}});
        if (number >= 10) {
            fNamespace->DeleteInstance(Path("Disk.Id=\"" + std::to_string(number - 10) + "\""), kNoContext);
        }
    }
    EXPECT_EQ(10U, fDisk->GetInstanceCount());
    EXPECT_EQ("Disk.Id=\"19990\"\n", InstancesOf(*fDisk).substr(0, 16));
    EXPECT_NE(nullptr, fNamespace->FindInstance(Path("Disk.Id=\"19995\"")));
}

TEST_F(InMemNamespaceTest, QualifiersAreDeclaredOnce)
{
    const auto declare = [&](const char* name) {
        return fNamespace->AllocateQualifierDecl(name, TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                                 ICIMQualifierDecl::kFlavorDefault, kNoContext);
    };
    declare("Key");
    const auto units = declare("Units");
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { declare("KEY"); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { declare(""); }));
    EXPECT_EQ(units, fNamespace->GetQualifierDecl("units", kNoContext));
    EXPECT_EQ(TCIMValue(false), units->GetValue(kNoContext));
    EXPECT_EQ(ICIMQualifierDecl::kScopeProperty, units->GetScope(kNoContext));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorDefault, units->GetFlavor(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetQualifierDecl("Max", kNoContext); }));
    EXPECT_EQ("Key Units",
              NamesOf<ICIMQualifierDecl>([&](const auto& callback) { fNamespace->EnumerateQualifierDecls(callback, kNoContext); }));
}

TEST_F(InMemNamespaceTest, WhatIsNotOfferedIsRefused)
{
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { fNamespace->SetUpcallNamespace(nullptr, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotSupported, StatusOf([&] { fNamespace->AddUnderlyingNamespace(nullptr, kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kNotOffered, StatusOf([&] {
                  fNamespace->Subscribe(
                      nullptr, [](boost::shared_ptr<ICIMInstance>) { return true; }, kNoContext);
              }));
    int providers = 0;
    fNamespace->EnumerateProviders([&](boost::shared_ptr<IProvider>) { return ++providers > 0; }, kNoContext);
    EXPECT_EQ(0, providers);
    const auto other = TInMemNamespace::Create("other");
    ICIMNamespace& target = *fNamespace;
    EXPECT_EQ(&target, &(target = *other));
    EXPECT_EQ("root/cimv2", fNamespace->GetNamespaceName());
    EXPECT_EQ("Disk", NamesOf<ICIMClass>([&](const auto& callback) { fNamespace->EnumerateRootClasses(callback, kNoContext); }));
}

}  // namespace
}  // namespace NORVZEL20
