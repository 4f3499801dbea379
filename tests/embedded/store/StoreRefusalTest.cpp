#include <functional>
#include <new>
#include <type_traits>

#include "embedded/store/TStoreRefusal.h"
#include "tests/embedded/store/TInMemFixture.h"
#include "tests/embedded/value/DateTimeOf.h"

namespace NORVZEL20 {
namespace {

static_assert(std::is_nothrow_copy_constructible_v<TStoreRefusal>, "an exception is copied while it is thrown");

/// Disk { Id key; Bay key }, with one instance.
class StoreRefusalTest : public TInMemFixture {
  protected:
    StoreRefusalTest()
    {
        fDisk = Declare("Disk", nullptr,
                        {{"Id", TType::kString, {"Key"}}, {"Bay", TType::kUint8, {"Key"}}, {"Size", TType::kUint64, {}}});
        fStored = AddDisk("sda");
    }

    TInstancePointer AllocateDisk(const std::string& id)
    {
        return Allocate(fDisk, {{"Id", TCIMValue(id)}, {"Bay", TCIMValue(static_cast<unsigned char>(1))}});
    }

    TInstancePointer AddDisk(const std::string& id)
    {
        auto disk = AllocateDisk(id);
        disk->AddToNamespace(kNoContext);
        return disk;
    }

    /// The text of the refusal that the call throws; "" if it throws nothing.
    template <class TCall>
    static std::string RefusalOf(TCall call)
    {
        try {
            call();
        } catch (const TStoreRefusal& refusal) {
            return refusal.what();
        }
        return "";
    }

    /// The text of any exception of the host that the call throws.
    static std::string TextOf(const std::function<void()>& call)
    {
        try {
            call();
        } catch (const TZELException& failure) {
            return failure.what();
        }
        return "";
    }

    TClassPointer fDisk;
    TInstancePointer fStored;
};

TEST_F(StoreRefusalTest, AnInstanceThatCannotBeAddedIsNamedWithItsKeys)
{
    const auto keyless = Allocate(fDisk, {{"Id", TCIMValue("sdb")}});
    EXPECT_EQ("Already exists: instance Disk.Bay=1,Id=\"sda\"", RefusalOf([&] { AddDisk("sda"); }));
    EXPECT_EQ("Already exists: instance Disk.Bay=1,Id=\"sda\"", RefusalOf([&] { AllocateDisk("sda")->Validate(kNoContext); }));
    EXPECT_EQ("Key without a value: key Bay of instance Disk.Bay=NULL,Id=\"sdb\"",
              RefusalOf([&] { keyless->AddToNamespace(kNoContext); }));
    EXPECT_EQ("Key without a value: key Bay of instance Disk.Bay=NULL,Id=\"sdb\"", RefusalOf([&] { fDisk->AddInstance(keyless); }));
    EXPECT_EQ("Invalid parameter: instance Disk.Bay=1,Id=\"sda\" is added already",
              RefusalOf([&] { fStored->AddToNamespace(kNoContext); }));
    EXPECT_EQ("", RefusalOf([&] { AddDisk("sdb"); }));
}

TEST_F(StoreRefusalTest, APathThatFindsNothingIsNamed)
{
    const std::pair<const char*, const char*> cases[] = {
        {"root/x:Disk.Id=\"sdz\",Bay=1", "Not found: instance Disk.Bay=1,Id=\"sdz\""},
        {"//web01/root/x:Disk.Id=\"sdz\",Bay=1", "Not found: instance Disk.Bay=1,Id=\"sdz\""},
        {"Fan.Id=\"1\"", "Not found: instance Fan.Id=\"1\""},
        {"Disk.Id=\"sda\"", "Key without a value: key Bay of path Disk.Id=\"sda\""},
        {"Disk.Id=\"sda\",Bay=\"first\"", "Type mismatch: key Bay of path Disk.Bay=\"first\",Id=\"sda\" is no uint8"},
    };
    for (const auto& [path, refusal] : cases) {
        EXPECT_EQ(refusal, RefusalOf([&, &text = path] { fNamespace->GetInstance(Path(text), kNoContext); }));
        EXPECT_EQ(refusal, RefusalOf([&, &text = path] { fNamespace->DeleteInstance(Path(text), kNoContext); }));
        EXPECT_EQ(refusal, RefusalOf([&, &text = path] { fNamespace->ModifyInstance(Path(text), {}, kNoContext); }));
    }
}

TEST_F(StoreRefusalTest, KeysAreShownAsTheyWereWritten)
{
    const TClassPointer event = Declare("Event", nullptr, {{"When", TType::kDateTime, {"Key"}}});
    const auto add = [&](const char* when) {
        Allocate(event, {{"When", TCIMValue(DateTimeOf(when))}})->AddToNamespace(kNoContext);
    };
    EXPECT_EQ("", RefusalOf([&] { add("20240229110000.000000+000"); }));
    EXPECT_EQ("Already exists: instance Event.When=\"20240229120000.000000+060\"",
              RefusalOf([&] { add("20240229120000.000000+060"); }));
    EXPECT_EQ("Not found: instance Event.When=\"20250101120000.000000+060\"",
              RefusalOf([&] { fNamespace->GetInstance(Path("Event.When=\"20250101120000.000000+060\""), kNoContext); }));
}

TEST_F(StoreRefusalTest, AChangeThatIsRefusedIsNamed)
{
    const TCIMReference path = fStored->GetReference();
    EXPECT_EQ("Not found: property Weight of instance Disk.Bay=1,Id=\"sda\"", RefusalOf([&] {
                  fNamespace->ModifyInstance(path, {{"Weight", TCIMValue(1)}}, kNoContext);
              }));
    EXPECT_EQ("Invalid parameter: another value for key Id of instance Disk.Bay=1,Id=\"sda\"", RefusalOf([&] {
                  fNamespace->ModifyInstance(path, {{"Id", TCIMValue("sdb")}}, kNoContext);
              }));
}

TEST_F(StoreRefusalTest, ADeclarationThatIsThereIsNamed)
{
    const auto declare = [&] {
        fNamespace->AllocateQualifierDecl("Alias", TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                          ICIMQualifierDecl::kFlavorDefault, kNoContext);
    };
    EXPECT_EQ("Already exists: class DISK", RefusalOf([&] { Declare("DISK", nullptr); }));
    EXPECT_EQ("", RefusalOf(declare));
    EXPECT_EQ("Already exists: qualifier Alias", RefusalOf(declare));
}

TEST_F(StoreRefusalTest, AValueOfAnotherTypeIsRefusedByInstanceAndProperty)
{
    const std::string refusal = "Type mismatch: property Size of instance Disk.Bay=1,Id=\"sda\" is uint64, not string";
    const auto size = fStored->GetProperty("Size", kNoContext);
    EXPECT_EQ(refusal, RefusalOf([&] { size->SetValue(TCIMValue("big"), kNoContext); }));
    EXPECT_EQ(refusal, RefusalOf([&] { size->MarkChanged(TCIMValue("big")); }));
    EXPECT_EQ(refusal, RefusalOf([&] {
                  fNamespace->ModifyInstance(fStored->GetReference(), {{"size", TCIMValue("big")}}, kNoContext);
              }));
    EXPECT_EQ("Not found: property Weight of instance Disk.Bay=1,Id=\"sda\"",
              RefusalOf([&] { fStored->GetProperty("Weight", kNoContext); }));
}

TEST_F(StoreRefusalTest, AStaticValueOfAnotherTypeIsRefusedByClassAndProperty)
{
    const TClassPointer fan = Declare("Fan", fDisk, {{"Count", TType::kUint8, {"Static"}}});
    const std::string refusal = "Type mismatch: property Count of class Fan is uint8, not string[]";
    const TCIMValue texts(TType::kArrayString, 0, {});
    EXPECT_EQ(refusal, RefusalOf([&] { fan->SetPropertyValue("Count", texts, kNoContext); }));
    EXPECT_EQ(refusal, RefusalOf([&] { Allocate(fan, {})->GetProperty("Count", kNoContext)->MarkChanged(texts); }));
    EXPECT_EQ("Type mismatch: property Free is uint8, not string[]",
              RefusalOf([&] { TInMemPropertyDecl("Free", TCIMValue::Null(TType::kUint8)).Fit(texts); }));
}

TEST_F(StoreRefusalTest, ADeclarationOfAnotherTypeIsRefusedByClassAndMember)
{
    const TClassPointer fast = Declare("FastDisk", fDisk, {{"Speed", TType::kUint8, {}}});
    fDisk->AddMethodDecl(fDisk->AllocateMethodDecl("Spin", TType::kUint32, kNoContext));
    EXPECT_EQ("Type mismatch: property Size of class FastDisk is uint64, not string", RefusalOf([&] {
                  fast->AddPropertyDecl(Decl({"Size", TType::kString, {}}));
              }));
    EXPECT_EQ("Type mismatch: property Speed of class FastDisk is uint8, not string", RefusalOf([&] {
                  fDisk->AddPropertyDecl(Decl({"SPEED", TType::kString, {}}));
              }));
    EXPECT_EQ("Type mismatch: property Weight has no type",
              RefusalOf([&] { fDisk->AllocatePropertyDecl("Weight", TCIMValue(), kNoContext); }));

    const TClassPointer other = Allocate("Other", nullptr, {{"Size", TType::kString, {}}});
    EXPECT_EQ("Type mismatch: property Size of class Disk is uint64, not string",
              RefusalOf([&] { fDisk->ModifyClass(other, kNoContext); }));
    const TClassPointer spinning = Allocate("Spinning", nullptr, {});
    spinning->AddMethodDecl(spinning->AllocateMethodDecl("spin", TType::kString, kNoContext));
    EXPECT_EQ("Type mismatch: method Spin of class Disk is uint32, not string",
              RefusalOf([&] { fDisk->ModifyClass(spinning, kNoContext); }));

    const auto alias = fNamespace->AllocateQualifierDecl("Alias", TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                                         ICIMQualifierDecl::kFlavorDefault, kNoContext);
    EXPECT_EQ("Type mismatch: qualifier Alias is boolean, not string",
              RefusalOf([&] { fDisk->AllocateQualifier(alias, TCIMValue("disc"), kNoContext); }));
}

TEST_F(StoreRefusalTest, AClassThatCannotBeDeclaredIsNamed)
{
    const TClassPointer device = Allocate("Device", nullptr, {});
    const TClassPointer part = Allocate("Part", device, {{"Size", TType::kString, {}}});
    EXPECT_EQ("Not found: superclass Device of class Part", RefusalOf([&] { part->Validate(kNoContext); }));
    EXPECT_EQ("Not found: class Part", RefusalOf([&] { Allocate(part, {})->AddToNamespace(kNoContext); }));
    device->AddToNamespace(kNoContext);
    device->AddPropertyDecl(Decl({"Size", TType::kUint64, {}}));
    EXPECT_EQ("Type mismatch: property Size of class Device is uint64, not string as in class Part",
              RefusalOf([&] { part->AddToNamespace(kNoContext); }));
}

TEST_F(StoreRefusalTest, WhatIsInUseIsNamed)
{
    const TClassPointer fast = Declare("FastDisk", fDisk);
    Allocate(fast, {{"Id", TCIMValue("sdb")}, {"Bay", TCIMValue(static_cast<unsigned char>(1))}})->AddToNamespace(kNoContext);
    EXPECT_EQ("Class in use: class Disk has subclasses", RefusalOf([&] { fDisk->RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ("Class in use: class FastDisk has instances", RefusalOf([&] { fast->RemoveFromNamespace(kNoContext); }));
    EXPECT_EQ("Class in use: key Id of class Disk, which has instances",
              RefusalOf([&] { fDisk->RemovePropertyDecl(fDisk->GetPropertyDecl("id", kNoContext)); }));
}

/// The caller has the names, and hosts agree on the text: the plug-in writes it to the log.
TEST_F(StoreRefusalTest, ALookUpByNameReportsTheStatusAlone)
{
    const std::function<void()> lookUps[] = {
        [&] { fNamespace->GetClass("Fan", kNoContext); },  [&] { fDisk->GetPropertyDecl("Weight", kNoContext); },
        [&] { fDisk->GetMethodDecl("Spin", kNoContext); }, [&] { fDisk->GetProperty("Size", kNoContext); },
        [&] { fDisk->GetQualifier("Alias", kNoContext); }, [&] { fNamespace->GetQualifierDecl("Alias", kNoContext); },
    };
    for (const auto& lookUp : lookUps) {
        EXPECT_EQ("Not found", TextOf(lookUp));
    }
}

TEST_F(StoreRefusalTest, ALongPathIsCutOffBetweenCharacters)
{
    std::string id;
    for (int i = 0; i < 100; ++i) {
        id += "\xE2\x82\xAC";
    }
    AddDisk(id);
    // `Disk.Bay=1,Id="` has 15 bytes, and 61 characters of three bytes fit behind it.
    EXPECT_EQ("Already exists: instance Disk.Bay=1,Id=\"" + id.substr(0, 61 * 3) + "...", RefusalOf([&] { AddDisk(id); }));
}

TEST_F(StoreRefusalTest, WithoutMemoryTheStatusIsLeft)
{
    const TStoreRefusal refusal(TZELStatusCode::kAlreadyExists, []() -> std::string { throw std::bad_alloc(); });
    EXPECT_STREQ("Already exists", refusal.what());
    const TStoreRefusal copy(refusal);
    EXPECT_STREQ("Already exists", copy.what());
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, copy.GetStatusCode().GetStatus());
}

}  // namespace
}  // namespace NORVZEL20
