#include "embedded/store/TInMemStaging.h"

#include "tests/embedded/store/TInMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemStagingTest : public TInMemFixture {
  protected:
    std::string Contents()
    {
        std::string text =
            NamesOf<ICIMQualifierDecl>([&](const auto& callback) { fNamespace->EnumerateQualifierDecls(callback, kNoContext); });
        return text + "|" + SubClassesOf(*fNamespace->GetClass("<root>", kNoContext), true) + "|" +
               InstancesOf(*fNamespace->GetClass("<root>", kNoContext), true);
    }

    void Fill(TInMemStaging& staging)
    {
        staging.AddQualifierDecl(boost::make_shared<TInMemQualifierDecl>("Key", TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                                                         ICIMQualifierDecl::kFlavorDefault));
        const auto tape = Allocate("Tape", nullptr, {{"Id", TType::kString, {"Key"}}});
        staging.AddClass(tape);
        staging.AddClass(Allocate("SmallTape", tape));
        staging.AddInstance(Allocate(fDisk, {{"Id", "sdb"}}));
        staging.AddInstance(Allocate(tape, {{"Id", "t0"}}));
        staging.AddInstance(Allocate(fDisk, {{"Id", "sdc"}}));
        staging.AddInstance(Allocate(fRecord, {}));
    }

    TClassPointer fDisk = DeclareDisk();
    TClassPointer fRecord = Declare("Record", nullptr, {{"Number", TType::kUint64, {"Key", "Generated"}}});
    TInstancePointer fFirst = Add(fDisk, {{"Id", "sda"}});
};

TEST_F(InMemStagingTest, CommittedEverythingStays)
{
    {
        TInMemStaging staging(fNamespace);
        Fill(staging);
        staging.Commit();
    }
    EXPECT_EQ("Key|Disk Record Tape SmallTape|Disk.Id=\"sda\"\nDisk.Id=\"sdb\"\nDisk.Id=\"sdc\"\nRecord.Number=1\nTape.Id=\"t0\"\n",
              Contents());
}

TEST_F(InMemStagingTest, OtherwiseTheNamespaceIsAsItWas)
{
    const std::string before = Contents();
    {
        TInMemStaging staging(fNamespace);
        Fill(staging);
        EXPECT_NE(before, Contents());
    }
    EXPECT_EQ(before, Contents());
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { fNamespace->GetClass("Tape", kNoContext); }));
    EXPECT_EQ(nullptr, fNamespace->FindInstance(Path("Disk.Id=\"sdb\"")));
    EXPECT_EQ(fFirst, fNamespace->FindInstance(Path("Disk.Id=\"sda\"")));
    Add(fRecord, {});
    EXPECT_EQ("Record.Number=1\n", InstancesOf(*fRecord));
}

TEST_F(InMemStagingTest, WhatWasTakenBackMayBeStagedAgain)
{
    {
        TInMemStaging staging(fNamespace);
        Fill(staging);
    }
    TInMemStaging staging(fNamespace);
    Fill(staging);
    staging.Commit();
    EXPECT_EQ(3U, fDisk->GetInstanceCount());
}

TEST_F(InMemStagingTest, StaticValuesAreAsTheyWereToo)
{
    fDisk->AddPropertyDecl(Decl({"Firmware", TType::kString, {"Static"}}));
    const auto firmware = fDisk->GetProperty("Firmware", kNoContext);
    firmware->SetValue(TCIMValue("old"), kNoContext);
    {
        TInMemStaging staging(fNamespace);
        staging.KeepStaticValues(*fDisk);
        Allocate(fDisk, {{"Id", "sdb"}, {"Firmware", "newer"}});
        staging.KeepStaticValues(*fDisk);
        firmware->MarkChanged(TCIMValue("newest"));
    }
    EXPECT_EQ("old", firmware->GetValue(kNoContext).ToText());
    EXPECT_FALSE(dynamic_cast<const TInMemStaticProperty&>(*firmware).IsChanged());
    {
        TInMemStaging staging(fNamespace);
        staging.KeepStaticValues(*fDisk);
        Allocate(fDisk, {{"Id", "sdb"}, {"Firmware", "new"}});
        staging.Commit();
    }
    EXPECT_EQ("new", firmware->GetValue(kNoContext).ToText());
}

TEST_F(InMemStagingTest, RefusesWhatIsThereAndGoesOn)
{
    TInMemStaging staging(fNamespace);
    const auto same = Allocate(fDisk, {{"Id", "sda"}});
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { staging.AddInstance(same); }));
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", same->GetReference().GetPath());
    staging.AddInstance(Allocate(fDisk, {{"Id", "sdb"}}));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { staging.AddInstance(Allocate(fDisk, {{"Id", "sdb"}})); }));
    EXPECT_EQ(TZELStatusCode::kKeyMissing, StatusOf([&] { staging.AddInstance(Allocate(fDisk, {})); }));
    EXPECT_EQ(TZELStatusCode::kAlreadyExists, StatusOf([&] { staging.AddClass(Allocate("disk", nullptr)); }));
    const auto undeclared = Allocate("Tape", nullptr);
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { staging.AddClass(Allocate("SmallTape", undeclared)); }));
    EXPECT_EQ(TZELStatusCode::kNotFound, StatusOf([&] { staging.AddInstance(undeclared->AllocateInMemInstance()); }));
    staging.Commit();
    EXPECT_EQ("|Disk Record|Disk.Id=\"sda\"\nDisk.Id=\"sdb\"\n", Contents());
}

}  // namespace
}  // namespace NORVZEL20
