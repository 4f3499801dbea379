#include "tests/embedded/store/InMemFixture.h"

#include "embedded/store/TInMemNamespaceProvider.h"
#include "host/TCIMDateTime.h"
#include "host/TNamespaceProviderManager.h"

namespace NORVZEL20 {
namespace {

class InMemNamespaceTest : public TInMemFixture {
  protected:
    TClassPointer disk = DeclareDisk();
};

TEST_F(InMemNamespaceTest, ProviderInmemIsThereFromTheStart)
{
    const auto provider = TNamespaceProviderManager::GetInstance()->FindProvider("inmem");
    ASSERT_NE(nullptr, provider);
    EXPECT_EQ("inmem", provider->GetName(none));
    EXPECT_EQ(0, provider->GetType(none));
    EXPECT_FALSE(provider->IsIndicationsSupported(none));
    const auto first = provider->AllocateNamespace(none, false, "root/cimv2");
    const auto second = provider->AllocateNamespace(none, true, "root/cimv2");
    EXPECT_NE(first, second);
    EXPECT_EQ(provider, first->GetNamespaceProvider(none));
    EXPECT_EQ(15, StatusOf([&] { first->GetClass("Disk", none); }));
    EXPECT_EQ("root/cimv2", boost::dynamic_pointer_cast<TInMemNamespace>(first)->GetNamespaceName());
}

TEST_F(InMemNamespaceTest, SlashesAroundItsNameAreTakenOff)
{
    EXPECT_EQ("root/cimv2", TInMemNamespace::Create("//root/cimv2/")->GetNamespaceName());
    EXPECT_EQ("", TInMemNamespace::Create("/")->GetNamespaceName());
}

TEST_F(InMemNamespaceTest, InstancesComeInOrderOfInsertionAndOfExactlyTheClass)
{
    const auto fast = Declare("FastDisk", disk);
    Add(disk, {{"Id", "sdb"}});
    Add(fast, {{"Id", "sda"}});
    Add(disk, {{"Id", "sda"}});
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\n", InstancesOf(*disk));
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\nFastDisk.Id=\"sda\"\n", InstancesOf(*disk, true));
    EXPECT_EQ("", InstancesOf(*ns->GetClass("<root>", none)));
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\nFastDisk.Id=\"sda\"\n", InstancesOf(*ns->GetClass("<root>", none), true));
}

TEST_F(InMemNamespaceTest, InstancesMayComeAndGoWhileTheyAreEnumerated)
{
    for (int number = 0; number < 100; ++number) {
        Add(disk, {{"Id", TCIMValue(std::to_string(number))}});
    }
    int seen = 0;
    disk->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            Add(disk, {{"Id", TCIMValue("new" + std::to_string(seen))}});
            ns->DeleteInstance(instance->GetReference(none), none);
            return ++seen > 0;
        },
        false, none);
    EXPECT_EQ(100, seen);
    EXPECT_EQ(100U, disk->GetInstanceCount());
}

TEST_F(InMemNamespaceTest, AllInstancesMayBeDeletedWhileTheyAreEnumerated)
{
    for (int number = 0; number < 100; ++number) {
        Add(disk, {{"Id", TCIMValue(std::to_string(number))}});
    }
    int seen = 0;
    disk->EnumerateInstances(
        [&](boost::shared_ptr<ICIMInstance> instance) {
            ns->DeleteInstance(instance->GetReference(none), none);
            return ++seen > 0;
        },
        false, none);
    EXPECT_EQ(100, seen);
    EXPECT_EQ("", InstancesOf(*disk));
}

TEST_F(InMemNamespaceTest, PathsFindInstancesWhateverTheirNamespaceAndLetterCase)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    for (const char* path : {"Disk.Id=\"sda\"", "root/cimv2:DISK.ID=\"sda\"", "//host/other:disk.id=\"sda\""}) {
        EXPECT_EQ(instance, ns->GetInstance(Path(path), none)) << path;
    }
    EXPECT_EQ(instance, ns->FindInstance(instance->GetReference()));
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
                {TType::kSint64, TCIMValue(std::int64_t(5)), "5"},
                {TType::kUint64, TCIMValue(~std::uint64_t(0)), "18446744073709551615"},
                {TType::kReal64, TCIMValue(0.5), "0.5"},
                {TType::kReal32, TCIMValue(2.0F), "2"},
                {TType::kChar16, TCIMValue(u'x'), "'x'"},
                {TType::kString, TCIMValue("5"), "\"5\""}};
    for (const auto& row : rows) {
        const auto cls = Declare("Of" + std::to_string(row.type), nullptr, {{"Key", row.type, {"Key"}}});
        const auto instance = Add(cls, {{"Key", row.value}});
        EXPECT_EQ(instance, ns->FindInstance(Path(cls->GetName() + ".Key=" + row.key))) << row.key;
        EXPECT_EQ(instance, ns->FindInstance(Path(instance->GetReference().GetPath()))) << row.key;
    }
}

TEST_F(InMemNamespaceTest, KeysOfDatetimesAndReferencesAreReadToo)
{
    TCIMDateTime time;
    ASSERT_TRUE(TCIMDateTime::Parse("20200102030405.000000+060", time));
    const auto event = Declare("Event", nullptr, {{"Time", TType::kDateTime, {"Key"}}});
    const auto instance = Add(event, {{"Time", TCIMValue(time)}});
    EXPECT_EQ(instance, ns->FindInstance(Path("Event.Time=\"20200102020405.000000+000\"")));
    const auto link = Allocate("Link", nullptr);
    link->AddPropertyDecl(Reference("To", "Event"));
    link->AddToNamespace(none);
    const auto linked = Add(link, {{"To", TCIMValue(instance->GetReference())}});
    EXPECT_EQ(linked, ns->FindInstance(Path(linked->GetReference().GetPath())));
}

TEST_F(InMemNamespaceTest, PathsThatFindNothing)
{
    Add(disk, {{"Id", "sda"}});
    Declare("Slot", nullptr, {{"Number", TType::kUint8, {"Key"}}});
    const struct {
        const char* path;
        int status;
    } rows[] = {
        {"Disk.Id=\"sdb\"", 15}, {"Disk.Id=\"SDA\"", 15}, {"Tape.Id=\"sda\"", 15}, {"Disk.Id=\"sda\",Size=1", 15}, {"Disk", 14},
        {"Disk.Size=1", 14},     {"Disk.Id=5", 13},       {"Slot.Number=256", 13}, {"Slot.Number=\"x\"", 13}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.status, StatusOf([&] { ns->GetInstance(Path(row.path), none); })) << row.path;
        EXPECT_EQ(row.status, StatusOf([&] { ns->DeleteInstance(Path(row.path), none); })) << row.path;
        EXPECT_EQ(row.status, StatusOf([&] { ns->ModifyInstance(Path(row.path), none, none); })) << row.path;
    }
    EXPECT_EQ(15, StatusOf([&] { ns->GetInstance(TCIMReference(), none); }));
}

TEST_F(InMemNamespaceTest, ADeletedInstanceLivesOnInItsHandlesAndMayComeBack)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    Add(disk, {{"Id", "sdb"}});
    ns->DeleteInstance(instance->GetReference(), none);
    EXPECT_EQ("Disk.Id=\"sdb\"\n", InstancesOf(*disk));
    EXPECT_EQ(15, StatusOf([&] { ns->DeleteInstance(instance->GetReference(), none); }));
    EXPECT_EQ("Id=sda Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    instance->AddToNamespace(none);
    EXPECT_EQ("Disk.Id=\"sdb\"\nDisk.Id=\"sda\"\n", InstancesOf(*disk));
}

TEST_F(InMemNamespaceTest, ModifyingSetsAllPropertiesOrNone)
{
    const auto instance = Add(disk, {{"Id", "sda"}, {"Label", "one"}});
    const TCIMReference path = instance->GetReference();
    ns->ModifyInstance(path, {{"LABEL", TCIMValue("two")}, {"Size", TCIMValue(std::uint64_t(5))}, {"Id", TCIMValue("sda")}}, none);
    EXPECT_EQ("Id=sda Size=5 Label=two Tags=NULL", ValuesOf(*instance));
    const struct {
        TCallContext properties;
        int status;
    } rows[] = {{{{"Label", TCIMValue("x")}, {"Zone", TCIMValue("x")}}, 15},
                {{{"Label", TCIMValue("x")}, {"Size", TCIMValue("x")}}, 13},
                {{{"Id", TCIMValue("sdb")}, {"Label", TCIMValue("x")}}, 5},
                {{{"Id", TCIMValue()}, {"Label", TCIMValue("x")}}, 5}};
    for (const auto& row : rows) {
        EXPECT_EQ(row.status, StatusOf([&] { ns->ModifyInstance(path, row.properties, none); }));
        EXPECT_EQ("Id=sda Size=5 Label=two Tags=NULL", ValuesOf(*instance));
    }
}

TEST_F(InMemNamespaceTest, ElementLevelChangesTellWhetherAnythingChanged)
{
    const auto instance = Allocate(disk, {{"Id", "sda"}});
    EXPECT_FALSE(disk->RemoveInstance(instance));
    EXPECT_TRUE(disk->AddInstance(instance));
    EXPECT_FALSE(disk->AddInstance(instance));
    EXPECT_FALSE(disk->AddInstance(Allocate(disk, {{"Id", "sda"}})));
    EXPECT_EQ(14, StatusOf([&] { disk->AddInstance(Allocate(disk, {})); }));
    EXPECT_EQ(5, StatusOf([&] { disk->AddInstance(Declare("Tape", nullptr)->AllocateInMemInstance()); }));
    EXPECT_EQ(5, StatusOf([&] { disk->AddInstance(nullptr); }));
    EXPECT_TRUE(disk->RemoveInstance(instance));
    EXPECT_FALSE(disk->RemoveInstance(nullptr));
    EXPECT_EQ("", InstancesOf(*disk));
}

TEST_F(InMemNamespaceTest, ClearedOfInstancesItKeepsItsClasses)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    ns->ClearInstances();
    EXPECT_EQ("", InstancesOf(*disk));
    EXPECT_FALSE(instance->IsAdded());
    Add(disk, {{"Id", "sda"}});
    EXPECT_EQ("Disk.Id=\"sda\"\n", InstancesOf(*disk));
}

TEST_F(InMemNamespaceTest, ThousandsComeAndGoInConstantTime)
{
    for (int number = 0; number < 20000; ++number) {
        Add(disk, {{"Id", TCIMValue(std::to_string(number))}});
        if (number >= 10) {
            ns->DeleteInstance(Path("Disk.Id=\"" + std::to_string(number - 10) + "\""), none);
        }
    }
    EXPECT_EQ(10U, disk->GetInstanceCount());
    EXPECT_EQ("Disk.Id=\"19990\"\n", InstancesOf(*disk).substr(0, 16));
    EXPECT_NE(nullptr, ns->FindInstance(Path("Disk.Id=\"19995\"")));
}

TEST_F(InMemNamespaceTest, QualifiersAreDeclaredOnce)
{
    const auto declare = [&](const char* name) {
        return ns->AllocateQualifierDecl(name, TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                         ICIMQualifierDecl::kFlavorDefault, none);
    };
    declare("Key");
    const auto units = declare("Units");
    EXPECT_EQ(12, StatusOf([&] { declare("KEY"); }));
    EXPECT_EQ(5, StatusOf([&] { declare(""); }));
    EXPECT_EQ(units, ns->GetQualifierDecl("units", none));
    EXPECT_EQ(TCIMValue(false), units->GetValue(none));
    EXPECT_EQ(ICIMQualifierDecl::kScopeProperty, units->GetScope(none));
    EXPECT_EQ(ICIMQualifierDecl::kFlavorDefault, units->GetFlavor(none));
    EXPECT_EQ(15, StatusOf([&] { ns->GetQualifierDecl("Max", none); }));
    EXPECT_EQ("Key Units", NamesOf<ICIMQualifierDecl>([&](const auto& callback) { ns->EnumerateQualifierDecls(callback, none); }));
}

TEST_F(InMemNamespaceTest, WhatIsNotOfferedIsRefused)
{
    EXPECT_EQ(31, StatusOf([&] { ns->SetUpcallNamespace(nullptr, none); }));
    EXPECT_EQ(31, StatusOf([&] { ns->AddUnderlyingNamespace(nullptr, none); }));
    EXPECT_EQ(1, StatusOf([&] {
                  ns->Subscribe(
                      nullptr, [](boost::shared_ptr<ICIMInstance>) { return true; }, none);
              }));
    int providers = 0;
    ns->EnumerateProviders([&](boost::shared_ptr<IProvider>) { return ++providers > 0; }, none);
    EXPECT_EQ(0, providers);
    const auto other = TInMemNamespace::Create("other");
    ICIMNamespace& target = *ns;
    EXPECT_EQ(&target, &(target = *other));
    EXPECT_EQ("root/cimv2", ns->GetNamespaceName());
    EXPECT_EQ("Disk", NamesOf<ICIMClass>([&](const auto& callback) { ns->EnumerateRootClasses(callback, none); }));
}

}  // namespace
}  // namespace NORVZEL20
