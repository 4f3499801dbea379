#include "tests/embedded/store/TInMemFixture.h"

#include <functional>

#include "embedded/value/TEmbeddedObject.h"

namespace NORVZEL20 {
namespace {

class InMemInstanceTest : public TInMemFixture {
  protected:
    TInMemProperty& Property(const TInstancePointer& instance, const char* name) { return *instance->FindProperty(name); }

    TClassPointer fDisk = DeclareDisk();
};

TEST_F(InMemInstanceTest, StartsWithNullsOfTheDeclaredTypes)
{
    const auto instance = fDisk->AllocateInstance(kNoContext);
    EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ(TType::kUint64, instance->GetProperty("Size", kNoContext)->GetValue(kNoContext).GetType());
    EXPECT_EQ(fDisk, instance->GetClass(kNoContext));
    EXPECT_EQ("", InstancesOf(*fDisk));
}

TEST_F(InMemInstanceTest, PropertiesAreFoundInAnyLetterCase)
{
    const auto instance = Allocate(fDisk, {{"ID", "sda"}, {"size", Uint64(7)}});
    EXPECT_EQ("Id=sda Size=7 Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ("Size", instance->GetProperty("SIZE", kNoContext)->GetPropertyDecl(kNoContext)->GetName(kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { instance->GetProperty("Colour", kNoContext); }));
    EXPECT_EQ(nullptr, instance->FindProperty("Colour"));
}

TEST_F(InMemInstanceTest, ValuesMustHaveTheDeclaredType)
{
    const auto instance = Allocate(fDisk, {{"Size", Uint64(7)}});
    const struct {
        const char* property;
        TCIMValue value;
        int status;
    } rows[] = {{"Size", TCIMValue("7"), TZELStatusCode::kTypeMismatch},
                {"Size", TCIMValue(7U), TZELStatusCode::kTypeMismatch},
                {"Label", Texts({"a"}), TZELStatusCode::kTypeMismatch},
                {"Tags", TCIMValue("a"), TZELStatusCode::kTypeMismatch},
                {"Tags", TCIMValue(true), TZELStatusCode::kTypeMismatch},
                {"Label", TCIMValue("a"), TZELStatusCode::kSuccess},
                {"Size", TCIMValue(), TZELStatusCode::kSuccess},
                {"Size", TCIMValue::Null(TType::kString), TZELStatusCode::kSuccess}};
    for (const auto& row : rows) {
        const auto property = instance->GetProperty(row.property, kNoContext);
        EXPECT_EQ(row.status, StatusOf([&] { property->SetValue(row.value, kNoContext); })) << row.property << row.value.ToText();
    }
    EXPECT_EQ(TType::kUint64, instance->GetProperty("Size", kNoContext)->GetValue(kNoContext).GetType());
}

TEST_F(InMemInstanceTest, ARefusedValueLeavesThePropertyAsItWas)
{
    const auto instance = Allocate(fDisk, {{"Label", "data"}});
    TInMemProperty& label = Property(instance, "Label");
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { label.SetValue(TCIMValue(1U), kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { label.MarkChanged(TCIMValue(1U)); }));
    EXPECT_EQ(TCIMValue("data"), label.GetValue());
    EXPECT_FALSE(label.IsChanged());
    EXPECT_EQ(nullptr, label.GetEarlierValue());
}

TEST_F(InMemInstanceTest, AStringHoldsAnEmbeddedObject)
{
    const auto object = boost::make_shared<const TEmbeddedObject>("Partition");
    const auto instance = Allocate(fDisk, {{"Label", TCIMValue(object)}});
    EXPECT_EQ(object, instance->GetProperty("Label", kNoContext)->GetValue(kNoContext).GetEmbeddedObject());
}

TEST_F(InMemInstanceTest, AnArrayIsABagUnlessDeclaredOtherwise)
{
    const auto ordered = Decl({"Ordered", TType::kArrayString, {}});
    ordered->AddQualifier(Qualifier("ArrayType", TCIMValue("Ordered")));
    const auto bag = Decl({"Bag", TType::kArrayString, {}});
    bag->AddQualifier(Qualifier("ArrayType", TCIMValue("BAG")));
    fDisk->AddPropertyDecl(ordered);
    fDisk->AddPropertyDecl(bag);
    fDisk->AddPropertyDecl(Decl({"Octets", TType::kArrayString, {"OctetString"}}));
    const auto instance = Allocate(
        fDisk,
        {{"Tags", Texts({"a", "b"})}, {"Ordered", Texts({"a", "b"})}, {"Bag", Texts({"a", "b"})}, {"Octets", Texts({"a", "b"})}});
    const TCIMValue turned = Texts({"b", "a"});
    EXPECT_TRUE(Property(instance, "Tags").GetValue() == turned);
    EXPECT_TRUE(Property(instance, "Bag").GetValue() == turned);
    EXPECT_FALSE(Property(instance, "Ordered").GetValue() == turned);
    EXPECT_FALSE(Property(instance, "Octets").GetValue() == turned);
}

TEST_F(InMemInstanceTest, MarkChangedRemembersTheValueBeforeTheFirstChange)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}, {"Label", "one"}});
    TInMemProperty& label = Property(instance, "Label");
    EXPECT_EQ(nullptr, label.GetEarlierValue());
    label.MarkChanged(TCIMValue("two"));
    label.MarkChanged(TCIMValue("three"));
    EXPECT_EQ(TCIMValue("three"), label.GetValue());
    EXPECT_TRUE(label.IsChanged());
    EXPECT_EQ(TCIMValue("one"), *label.GetEarlierValue());
    EXPECT_FALSE(Property(instance, "Size").IsChanged());
}

TEST_F(InMemInstanceTest, AStandInMayHaveAnyType)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}, {"Label", "one"}});
    Property(instance, "Label").MarkStandIn(TCIMValue(5U));
    EXPECT_EQ(TCIMValue(5U), Property(instance, "Label").GetValue());
    EXPECT_EQ(TCIMValue("one"), *Property(instance, "Label").GetEarlierValue());
    Property(instance, "Id").MarkStandIn(TCIMValue(6U));
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", instance->GetReference(kNoContext).GetPath());
    EXPECT_EQ(instance, fNamespace->GetInstance(Path("Disk.Id=\"sda\""), kNoContext));
}

TEST_F(InMemInstanceTest, AStaticPropertyHasOneStandInForAllInstances)
{
    const auto cls = Declare("Model", nullptr, {{"Id", TType::kString, {"Key"}}, {"Firmware", TType::kString, {"Static"}}});
    const auto one = Add(cls, {{"Id", "1"}, {"Firmware", "old"}});
    const auto two = Add(cls, {{"Id", "2"}});
    TInMemStaticProperty& shared = cls->FindPropertyDecl("Firmware")->GetStaticProperty();
    shared.MarkStandIn(TCIMValue(5U));
    EXPECT_EQ(TCIMValue(5U), two->GetProperty("Firmware", kNoContext)->GetValue(kNoContext));
    EXPECT_EQ(TCIMValue("old"), *shared.GetEarlierValue());
}

TEST_F(InMemInstanceTest, AnEarlierNullIsAValueToo)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    Property(instance, "Label").MarkChanged(TCIMValue("two"));
    ASSERT_NE(nullptr, Property(instance, "Label").GetEarlierValue());
    EXPECT_TRUE(Property(instance, "Label").GetEarlierValue()->IsNull());
}

TEST_F(InMemInstanceTest, MarkRemovedKeepsTheValue)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}, {"Label", "one"}});
    Property(instance, "Label").MarkRemoved();
    EXPECT_TRUE(Property(instance, "Label").IsRemoved());
    EXPECT_FALSE(Property(instance, "Label").IsChanged());
    EXPECT_EQ(TCIMValue("one"), Property(instance, "Label").GetValue());
}

TEST_F(InMemInstanceTest, AChangedKeyDoesNotChangeWhichInstanceItIs)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    Property(instance, "Id").MarkChanged(TCIMValue("sdb"));
    Property(instance, "Id").SetValue(TCIMValue("sdc"), kNoContext);
    EXPECT_EQ("Id=sdc Size=NULL Label=NULL Tags=NULL", ValuesOf(*instance));
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", instance->GetReference(kNoContext).GetPath());
    EXPECT_EQ(instance, fNamespace->GetInstance(Path("Disk.Id=\"sda\""), kNoContext));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetInstance(Path("Disk.Id=\"sdc\""), kNoContext); }));
    Add(fDisk, {{"Id", "sdc"}});
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(fDisk, {{"Id", "sda"}}); }));
}

TEST_F(InMemInstanceTest, DeletedAndAddedAgainItIsFoundByItsChangedKey)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    Property(instance, "Id").SetValue(TCIMValue("sdb"), kNoContext);
    fNamespace->DeleteInstance(Path("Disk.Id=\"sda\""), kNoContext);
    instance->AddToNamespace(kNoContext);
    EXPECT_EQ("Disk.Id=\"sdb\"\n", InstancesOf(*fDisk));
    EXPECT_EQ(instance, fNamespace->FindInstance(Path("Disk.Id=\"sdb\"")));
}

TEST_F(InMemInstanceTest, ReferencesNameNamespaceClassAndKeys)
{
    const auto instance = Allocate(fDisk, {{"Id", "a\"b"}});
    const TCIMReference path = instance->GetReference(kNoContext);
    EXPECT_EQ("root/cimv2:Disk.Id=\"a\\\"b\"", path.GetPath());
    EXPECT_EQ(fDisk, path.GetClass());
    EXPECT_EQ(fNamespace, path.GetNamespace());
}

TEST_F(InMemInstanceTest, AddingFailsForKeysThatAreTakenOrMissingAndTheSecondTime)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(fDisk, {{"Id", "sda"}}); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Allocate(fDisk, {{"Id", "sda"}})->Validate(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kSuccess, StatusOf([&] { Allocate(fDisk, {{"Id", "SDA"}})->Validate(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kInvalidParameter, StatusOf([&] { instance->AddToNamespace(kNoContext); }));
    const auto keyless = Allocate(fDisk, {{"Label", "x"}});
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { keyless->AddToNamespace(kNoContext); }));
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { keyless->Validate(kNoContext); }));
    EXPECT_EQ("Id", *keyless->FindMissingKey());
    EXPECT_EQ("Disk.Id=\"sda\"\n", InstancesOf(*fDisk));
}

TEST_F(InMemInstanceTest, AClassWithoutKeysHasOneInstance)
{
    const auto setting = Declare("Setting", nullptr, {{"Value", TType::kString, {}}});
    const auto instance = Add(setting, {{"Value", "on"}});
    EXPECT_EQ(instance, fNamespace->GetInstance(Path("Setting"), kNoContext));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(setting, {{"Value", "off"}}); }));
}

TEST_F(InMemInstanceTest, GeneratedKeysGetTheNextNumberOfTheirClass)
{
    const auto record = Declare("Record", nullptr, {{"Number", TType::kUint64, {"Key", "Generated"}}});
    const auto special = Declare("Special", record);
    Add(record, {});
    Add(record, {});
    Add(special, {});
    Add(record, {{"Number", Uint64(7)}});
    const auto last = Add(record, {});
    EXPECT_EQ("Record.Number=1\nRecord.Number=2\nRecord.Number=7\nRecord.Number=8\nSpecial.Number=1\n", InstancesOf(*record, true));
    fNamespace->DeleteInstance(last->GetReference(), kNoContext);
    Add(record, {});
    EXPECT_EQ("Record.Number=1\nRecord.Number=2\nRecord.Number=7\nRecord.Number=9\n", InstancesOf(*record));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { Add(record, {{"Number", Uint64(7)}}); }));
}

TEST_F(InMemInstanceTest, OnlyUint64KeysAreGenerated)
{
    const auto record = Declare("Record", nullptr, {{"Number", TType::kUint32, {"Key", "Generated"}}});
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { Add(record, {}); }));
}

TEST_F(InMemInstanceTest, InstancesThatAreThereGetALaterPropertyAsNull)
{
    const auto instance = Add(fDisk, {{"Id", "sda"}});
    fDisk->AddPropertyDecl(Decl({"Serial", TType::kString, {}}));
    const auto serial = instance->GetProperty("Serial", kNoContext);
    fDisk->AddPropertyDecl(Decl({"Heat", TType::kUint8, {}}));
    fDisk->AddPropertyDecl(Decl({"Wear", TType::kUint8, {}}));
    serial->SetValue(TCIMValue("S1"), kNoContext);
    instance->FindProperty("Wear")->MarkChanged(TCIMValue(static_cast<unsigned char>(3)));
    EXPECT_EQ("Id=sda Size=NULL Label=NULL Tags=NULL Serial=S1 Heat=NULL Wear=3", ValuesOf(*instance));
    EXPECT_EQ("Serial", serial->GetPropertyDecl(kNoContext)->GetName(kNoContext));
    EXPECT_TRUE(instance->FindProperty("Wear")->GetEarlierValue()->IsNull());
    EXPECT_EQ("Id=NULL Size=NULL Label=NULL Tags=NULL Serial=NULL Heat=NULL Wear=NULL",
              ValuesOf(*fDisk->AllocateInstance(kNoContext)));
}

TEST_F(InMemInstanceTest, HandlesKeepTheInstanceAliveAndOutliveTheNamespace)
{
    auto instance = Add(fDisk, {{"Id", "sda"}, {"Label", "data on a rather long disk"}});
    const auto label = instance->GetProperty("Label", kNoContext);
    fNamespace.reset();
    fDisk.reset();
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", instance->GetReference(kNoContext).GetPath());
    EXPECT_FALSE(instance->IsAdded());
    EXPECT_EQ(TZELStatusCode::kNamespaceGone, StatusOf([&] { instance->AddToNamespace(kNoContext); }));
    instance.reset();
    EXPECT_EQ("data on a rather long disk", label->GetValue(kNoContext).ToText());
    label->SetValue(TCIMValue("x"), kNoContext);
    EXPECT_EQ("Label", label->GetPropertyDecl(kNoContext)->GetName(kNoContext));
}

TEST_F(InMemInstanceTest, ANamespaceWithReferencesIntoItselfIsDestroyed)
{
    auto part = Allocate("Part", nullptr, {{"Name", TType::kString, {"Key"}}});
    part->AddPropertyDecl(Reference("Disk", "Disk"));
    part->AddPropertyDecl(Decl({"Default", TType::kReference, {"Static"}}));
    part->AddToNamespace(kNoContext);
    auto target = Add(fDisk, {{"Id", "sda"}});
    auto instance = Add(part, {{"Name", "p1"}, {"Disk", TCIMValue(target->GetReference())}});
    part->SetPropertyValue("Default", TCIMValue(instance->GetReference()), kNoContext);
    EXPECT_EQ("root/cimv2:Part.Disk=\"root/cimv2:Disk.Id=\\\"sda\\\"\",Name=\"p1\"",
              part->GetProperty("Default", kNoContext)->GetValue(kNoContext).ToText());
    const boost::weak_ptr<TInMemNamespace> watchedNamespace = fNamespace;
    const boost::weak_ptr<TInMemClass> watchedClass = part;
    const boost::weak_ptr<TInMemInstance> watchedTarget = target;
    instance.reset();
    target.reset();
    part.reset();
    fNamespace.reset();
    EXPECT_TRUE(watchedTarget.expired());
    EXPECT_TRUE(watchedNamespace.expired());
    EXPECT_TRUE(watchedClass.expired());
}

TEST_F(InMemInstanceTest, AStaticValueDoesNotKeepItsClassAliveThroughKeysOfKeys)
{
    const std::vector<std::pair<TType::ECIMType, std::function<TCIMValue(const TCIMValue&)>>> places{
        {TType::kReference, [](const TCIMValue& path) { return path; }},
        {TType::kArrayReference,
         [](const TCIMValue& path) { return TCIMValue(TType::kReference, 1, std::vector<TCIMValue>{path}); }},
        {TType::kString,
         [](const TCIMValue& path) {
             const auto object = boost::make_shared<TEmbeddedObject>("Use");
             object->AddProperty({"Of", path, "", 0, "", false, {}});
             return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
         }},
    };
    std::vector<boost::weak_ptr<TInMemClass>> watched;
    for (const auto& [type, place] : places) {
        SCOPED_TRACE(static_cast<int>(type));
        const auto ns = TInMemNamespace::Create("root/hw");
        auto part = ns->AllocateInMemClass("Part", nullptr);
        part->AddPropertyDecl(Decl({"Name", TType::kString, {"Key"}}));
        part->AddPropertyDecl(Decl({"Default", type, {"Static"}}));
        part->AddToNamespace(kNoContext);
        auto link = ns->AllocateInMemClass("Link", nullptr);
        link->AddPropertyDecl(Reference("To", "Part"));
        link->AddToNamespace(kNoContext);
        const TCIMReference target = Add(part, {{"Name", "p1"}})->GetReference();
        const TCIMReference path = Add(link, {{"To", TCIMValue(target)}})->GetReference();
        part->SetPropertyValue("Default", place(TCIMValue(path)), kNoContext);
        EXPECT_EQ(place(TCIMValue(path)), part->GetProperty("Default", kNoContext)->GetValue(kNoContext));
        watched.push_back(part);
    }
    for (const boost::weak_ptr<TInMemClass>& part : watched) {
        EXPECT_TRUE(part.expired());
    }
}

TEST_F(InMemInstanceTest, AStaticPropertyIsMarkedForAllInstances)
{
    const auto cls = Declare("Model", nullptr, {{"Id", TType::kString, {"Key"}}, {"Firmware", TType::kString, {"Static"}}});
    const auto one = Add(cls, {{"Id", "1"}, {"Firmware", "old"}});
    const auto two = Add(cls, {{"Id", "2"}});
    const auto ofTwo = two->GetProperty("Firmware", kNoContext);
    const auto& stored = dynamic_cast<const TInMemStaticProperty&>(*ofTwo);
    EXPECT_FALSE(stored.IsChanged());
    EXPECT_EQ(nullptr, stored.GetEarlierValue());
    EXPECT_EQ(TZELStatusCode::kTypeMismatch, StatusOf([&] { ofTwo->MarkChanged(TCIMValue(5)); }));
    EXPECT_FALSE(stored.IsChanged());
    one->GetProperty("Firmware", kNoContext)->MarkChanged(TCIMValue("new"));
    one->GetProperty("Firmware", kNoContext)->MarkChanged(TCIMValue("newer"));
    one->GetProperty("Firmware", kNoContext)->MarkRemoved();
    EXPECT_EQ("newer", ofTwo->GetValue(kNoContext).ToText());
    ASSERT_NE(nullptr, stored.GetEarlierValue());
    EXPECT_EQ("old", stored.GetEarlierValue()->ToText());
    EXPECT_TRUE(stored.IsRemoved());
}

}  // namespace
}  // namespace NORVZEL20
