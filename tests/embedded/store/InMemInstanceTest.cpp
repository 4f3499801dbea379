#include "tests/embedded/store/InMemFixture.h"

#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {
namespace {

class InMemInstanceTest : public TInMemFixture {
  protected:
    TInMemProperty& Property(const TInstancePointer& instance, const char* name) { return *instance->FindProperty(name); }

    TClassPointer disk = DeclareDisk();
};

TEST_F(InMemInstanceTest, StartsWithNullsOfTheDeclaredTypes)
{
    const auto instance = disk->AllocateInstance(none);
    EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ(TType::kUint64, instance->GetProperty("Size", none)->GetValue(none).GetType());
    EXPECT_EQ(disk, instance->GetClass(none));
    EXPECT_EQ("", InstancesOf(*disk));
}

TEST_F(InMemInstanceTest, PropertiesAreFoundInAnyLetterCase)
{
    const auto instance = Allocate(disk, {{"ID", "sda"}, {"size", TCIMValue(std::uint64_t(7))}});
    EXPECT_EQ("Id=sda Size=7 Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ("Size", instance->GetProperty("SIZE", none)->GetPropertyDecl(none)->GetName(none));
    EXPECT_EQ(15, StatusOf([&] { instance->GetProperty("Colour", none); }));
    EXPECT_EQ(nullptr, instance->FindProperty("Colour"));
}

TEST_F(InMemInstanceTest, ValuesMustHaveTheDeclaredType)
{
    const auto instance = Allocate(disk, {{"Size", TCIMValue(std::uint64_t(7))}});
    const struct {
        const char* property;
        TCIMValue value;
        int status;
    } rows[] = {{"Size", TCIMValue("7"), 13},  {"Size", TCIMValue(7U), 13},
                {"Label", Texts({"a"}), 13},   {"Tags", TCIMValue("a"), 13},
                {"Tags", TCIMValue(true), 13}, {"Label", TCIMValue("a"), 0},
                {"Size", TCIMValue(), 0},      {"Size", TCIMValue::Null(TType::kString), 0}};
    for (const auto& row : rows) {
        const auto property = instance->GetProperty(row.property, none);
        EXPECT_EQ(row.status, StatusOf([&] { property->SetValue(row.value, none); })) << row.property << row.value.ToText();
    }
    EXPECT_EQ(TType::kUint64, instance->GetProperty("Size", none)->GetValue(none).GetType());
}

TEST_F(InMemInstanceTest, ARefusedValueLeavesThePropertyAsItWas)
{
    const auto instance = Allocate(disk, {{"Label", "data"}});
    TInMemProperty& label = Property(instance, "Label");
    EXPECT_EQ(13, StatusOf([&] { label.SetValue(TCIMValue(1U), none); }));
    EXPECT_EQ(13, StatusOf([&] { label.MarkChanged(TCIMValue(1U)); }));
    EXPECT_EQ(TCIMValue("data"), label.GetValue());
    EXPECT_FALSE(label.IsChanged());
    EXPECT_EQ(nullptr, label.GetEarlierValue());
}

TEST_F(InMemInstanceTest, AStringHoldsAnEmbeddedObject)
{
    const auto object = boost::make_shared<const TEmbeddedObject>("Partition");
    const auto instance = Allocate(disk, {{"Label", TCIMValue(object)}});
    EXPECT_EQ(object, instance->GetProperty("Label", none)->GetValue(none).GetEmbeddedObject());
}

TEST_F(InMemInstanceTest, AnArrayIsABagUnlessDeclaredOtherwise)
{
    const auto ordered = Decl({"Ordered", TType::kArrayString, {}});
    ordered->AddQualifier(Qualifier("ArrayType", TCIMValue("Ordered")));
    const auto bag = Decl({"Bag", TType::kArrayString, {}});
    bag->AddQualifier(Qualifier("ArrayType", TCIMValue("BAG")));
    disk->AddPropertyDecl(ordered);
    disk->AddPropertyDecl(bag);
    disk->AddPropertyDecl(Decl({"Octets", TType::kArrayString, {"OctetString"}}));
    const auto instance = Allocate(
        disk,
        {{"Tags", Texts({"a", "b"})}, {"Ordered", Texts({"a", "b"})}, {"Bag", Texts({"a", "b"})}, {"Octets", Texts({"a", "b"})}});
    const TCIMValue turned = Texts({"b", "a"});
    EXPECT_TRUE(Property(instance, "Tags").GetValue() == turned);
    EXPECT_TRUE(Property(instance, "Bag").GetValue() == turned);
    EXPECT_FALSE(Property(instance, "Ordered").GetValue() == turned);
    EXPECT_FALSE(Property(instance, "Octets").GetValue() == turned);
}

TEST_F(InMemInstanceTest, MarkChangedRemembersTheValueBeforeTheFirstChange)
{
    const auto instance = Add(disk, {{"Id", "sda"}, {"Label", "one"}});
    TInMemProperty& label = Property(instance, "Label");
    EXPECT_EQ(nullptr, label.GetEarlierValue());
    label.MarkChanged(TCIMValue("two"));
    label.MarkChanged(TCIMValue("three"));
    EXPECT_EQ(TCIMValue("three"), label.GetValue());
    EXPECT_TRUE(label.IsChanged());
    EXPECT_EQ(TCIMValue("one"), *label.GetEarlierValue());
    EXPECT_FALSE(Property(instance, "Size").IsChanged());
}

TEST_F(InMemInstanceTest, AnEarlierNullIsAValueToo)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    Property(instance, "Label").MarkChanged(TCIMValue("two"));
    ASSERT_NE(nullptr, Property(instance, "Label").GetEarlierValue());
    EXPECT_TRUE(Property(instance, "Label").GetEarlierValue()->IsNull());
}

TEST_F(InMemInstanceTest, MarkRemovedKeepsTheValue)
{
    const auto instance = Add(disk, {{"Id", "sda"}, {"Label", "one"}});
    Property(instance, "Label").MarkRemoved();
    EXPECT_TRUE(Property(instance, "Label").IsRemoved());
    EXPECT_FALSE(Property(instance, "Label").IsChanged());
    EXPECT_EQ(TCIMValue("one"), Property(instance, "Label").GetValue());
}

TEST_F(InMemInstanceTest, AChangedKeyDoesNotChangeWhichInstanceItIs)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    Property(instance, "Id").MarkChanged(TCIMValue("sdb"));
    Property(instance, "Id").SetValue(TCIMValue("sdc"), none);
    EXPECT_EQ("Id=sdc Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", instance->GetReference(none).GetPath());
    EXPECT_EQ(instance, ns->GetInstance(Path("Disk.Id=\"sda\""), none));
    EXPECT_EQ(15, StatusOf([&] { ns->GetInstance(Path("Disk.Id=\"sdc\""), none); }));
    Add(disk, {{"Id", "sdc"}});
    EXPECT_EQ(12, StatusOf([&] { Add(disk, {{"Id", "sda"}}); }));
}

TEST_F(InMemInstanceTest, DeletedAndAddedAgainItIsFoundByItsChangedKey)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    Property(instance, "Id").SetValue(TCIMValue("sdb"), none);
    ns->DeleteInstance(Path("Disk.Id=\"sda\""), none);
    instance->AddToNamespace(none);
    EXPECT_EQ("Disk.Id=\"sdb\"\n", InstancesOf(*disk));
    EXPECT_EQ(instance, ns->FindInstance(Path("Disk.Id=\"sdb\"")));
}

TEST_F(InMemInstanceTest, ReferencesNameNamespaceClassAndKeys)
{
    const auto instance = Allocate(disk, {{"Id", "a\"b"}});
    const TCIMReference path = instance->GetReference(none);
    EXPECT_EQ("root/cimv2:Disk.Id=\"a\\\"b\"", path.GetPath());
    EXPECT_EQ(disk, path.GetClass());
    EXPECT_EQ(ns, path.GetNamespace());
}

TEST_F(InMemInstanceTest, AddingFailsWhere)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    EXPECT_EQ(12, StatusOf([&] { Add(disk, {{"Id", "sda"}}); }));
    EXPECT_EQ(12, StatusOf([&] { Allocate(disk, {{"Id", "sda"}})->Validate(none); }));
    EXPECT_EQ(0, StatusOf([&] { Allocate(disk, {{"Id", "SDA"}})->Validate(none); }));
    EXPECT_EQ(5, StatusOf([&] { instance->AddToNamespace(none); }));
    const auto keyless = Allocate(disk, {{"Label", "x"}});
    EXPECT_EQ(14, StatusOf([&] { keyless->AddToNamespace(none); }));
    EXPECT_EQ(14, StatusOf([&] { keyless->Validate(none); }));
    EXPECT_EQ("Id", *keyless->FindMissingKey());
    EXPECT_EQ("Disk.Id=\"sda\"\n", InstancesOf(*disk));
}

TEST_F(InMemInstanceTest, AClassWithoutKeysHasOneInstance)
{
    const auto setting = Declare("Setting", nullptr, {{"Value", TType::kString, {}}});
    const auto instance = Add(setting, {{"Value", "on"}});
    EXPECT_EQ(instance, ns->GetInstance(Path("Setting"), none));
    EXPECT_EQ(12, StatusOf([&] { Add(setting, {{"Value", "off"}}); }));
}

TEST_F(InMemInstanceTest, GeneratedKeysGetTheNextNumberOfTheirClass)
{
    const auto record = Declare("Record", nullptr, {{"Number", TType::kUint64, {"Key", "Generated"}}});
    const auto special = Declare("Special", record);
    Add(record, {});
    Add(record, {});
    Add(special, {});
    Add(record, {{"Number", TCIMValue(std::uint64_t(7))}});
    const auto last = Add(record, {});
    EXPECT_EQ("Record.Number=1\nRecord.Number=2\nRecord.Number=7\nRecord.Number=8\nSpecial.Number=1\n", InstancesOf(*record, true));
    ns->DeleteInstance(last->GetReference(), none);
    Add(record, {});
    EXPECT_EQ("Record.Number=1\nRecord.Number=2\nRecord.Number=7\nRecord.Number=9\n", InstancesOf(*record));
    EXPECT_EQ(12, StatusOf([&] { Add(record, {{"Number", TCIMValue(std::uint64_t(7))}}); }));
}

TEST_F(InMemInstanceTest, OnlyUint64KeysAreGenerated)
{
    const auto record = Declare("Record", nullptr, {{"Number", TType::kUint32, {"Key", "Generated"}}});
    EXPECT_EQ(14, StatusOf([&] { Add(record, {}); }));
}

TEST_F(InMemInstanceTest, InstancesThatAreThereGetALaterPropertyAsNull)
{
    const auto instance = Add(disk, {{"Id", "sda"}});
    disk->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    const auto serial = instance->GetProperty("Serial", none);
    disk->AddPropertyDecl(Decl({"Heat", TType::kUint8, {}}));
    disk->AddPropertyDecl(Decl({"Wear", TType::kUint8, {}}));
    serial->SetValue(TCIMValue("S1"), none);
    instance->FindProperty("Wear")->MarkChanged(TCIMValue(static_cast<unsigned char>(3)));
    EXPECT_EQ("Id=sda Size=NULL Label=NULL Tags=NULL Serial=S1 Heat=NULL Wear=3", ValuesOf(*instance));
    EXPECT_EQ("Serial", serial->GetPropertyDecl(none)->GetName(none));
    EXPECT_TRUE(instance->FindProperty("Wear")->GetEarlierValue()->IsNull());
    EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL Serial=NULL Heat=NULL Wear=NULL", ValuesOf(*disk->AllocateInstance(none)));
}

TEST_F(InMemInstanceTest, HandlesKeepTheInstanceAliveAndOutliveTheNamespace)
{
    auto instance = Add(disk, {{"Id", "sda"}, {"Label", "data on a rather long disk"}});
    const auto label = instance->GetProperty("Label", none);
    ns.reset();
    disk.reset();
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", instance->GetReference(none).GetPath());
    EXPECT_FALSE(instance->IsAdded());
    EXPECT_EQ(18, StatusOf([&] { instance->AddToNamespace(none); }));
    instance.reset();
    EXPECT_EQ("data on a rather long disk", label->GetValue(none).ToText());
    label->SetValue(TCIMValue("x"), none);
    EXPECT_EQ("Label", label->GetPropertyDecl(none)->GetName(none));
}

TEST_F(InMemInstanceTest, ANamespaceWithReferencesIntoItselfIsDestroyed)
{
    auto part = Allocate("Part", nullptr, {{"Name", TType::kString, {"Key"}}});
    part->AddPropertyDecl(Reference("Disk", "Disk"));
    part->AddPropertyDecl(Decl({"Default", TType::kReference, {"Static"}}));
    part->AddToNamespace(none);
    auto target = Add(disk, {{"Id", "sda"}});
    auto instance = Add(part, {{"Name", "p1"}, {"Disk", TCIMValue(target->GetReference())}});
    part->SetPropertyValue("Default", TCIMValue(instance->GetReference()), none);
    EXPECT_EQ("root/cimv2:Part.Disk=\"root/cimv2:Disk.Id=\\\"sda\\\"\",Name=\"p1\"",
              part->GetProperty("Default", none)->GetValue(none).ToText());
    const boost::weak_ptr<TInMemNamespace> watchedNamespace = ns;
    const boost::weak_ptr<TInMemClass> watchedClass = part;
    const boost::weak_ptr<TInMemInstance> watchedTarget = target;
    instance.reset();
    target.reset();
    part.reset();
    ns.reset();
    EXPECT_TRUE(watchedTarget.expired());
    EXPECT_TRUE(watchedNamespace.expired());
    EXPECT_TRUE(watchedClass.expired());
}

TEST_F(InMemInstanceTest, AStaticPropertyIsMarkedForAllInstances)
{
    const auto cls = Declare("Model", nullptr, {{"Id", TType::kString, {"Key"}}, {"Firmware", TType::kString, {"Static"}}});
    const auto one = Add(cls, {{"Id", "1"}, {"Firmware", "old"}});
    const auto two = Add(cls, {{"Id", "2"}});
    const auto ofTwo = two->GetProperty("Firmware", none);
    const auto& stored = dynamic_cast<const TInMemStaticProperty&>(*ofTwo);
    EXPECT_FALSE(stored.IsChanged());
    EXPECT_EQ(nullptr, stored.GetEarlierValue());
    EXPECT_EQ(13, StatusOf([&] { ofTwo->MarkChanged(TCIMValue(5)); }));
    EXPECT_FALSE(stored.IsChanged());
    one->GetProperty("Firmware", none)->MarkChanged(TCIMValue("new"));
    one->GetProperty("Firmware", none)->MarkChanged(TCIMValue("newer"));
    one->GetProperty("Firmware", none)->MarkRemoved();
    EXPECT_EQ("newer", ofTwo->GetValue(none).ToText());
    ASSERT_NE(nullptr, stored.GetEarlierValue());
    EXPECT_EQ("old", stored.GetEarlierValue()->ToText());
    EXPECT_TRUE(stored.IsRemoved());
}

}  // namespace
}  // namespace NORVZEL20
