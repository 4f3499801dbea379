#include "embedded/store/TInMemStaging.h"

#include "tests/embedded/store/InMemFixture.h"

namespace NORVZEL20 {
namespace {

class InMemStagingTest : public TInMemFixture {
  protected:
    std::string Contents()
    {
        std::string text = NamesOf<ICIMQualifierDecl>([&](const auto& callback) { ns->EnumerateQualifierDecls(callback, none); });
        return text + "|" + SubClassesOf(*ns->GetClass("<root>", none), true) + "|" +
               InstancesOf(*ns->GetClass("<root>", none), true);
    }

    void Fill(TInMemStaging& staging)
    {
        staging.AddQualifierDecl(boost::make_shared<TInMemQualifierDecl>("Key", TCIMValue(false), ICIMQualifierDecl::kScopeProperty,
                                                                         ICIMQualifierDecl::kFlavorDefault));
        const auto tape = Allocate("Tape", nullptr, {{"Id", TType::kString, {"Key"}}});
        staging.AddClass(tape);
        staging.AddClass(Allocate("SmallTape", tape));
        staging.AddInstance(Allocate(disk, {{"Id", "sdb"}}));
        staging.AddInstance(Allocate(tape, {{"Id", "t0"}}));
        staging.AddInstance(Allocate(disk, {{"Id", "sdc"}}));
        staging.AddInstance(Allocate(record, {}));
    }

    TClassPointer disk = DeclareDisk();
    TClassPointer record = Declare("Record", nullptr, {{"Number", TType::kUint64, {"Key", "Generated"}}});
    TInstancePointer first = Add(disk, {{"Id", "sda"}});
};

TEST_F(InMemStagingTest, CommittedEverythingStays)
{
    {
        TInMemStaging staging(ns);
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
        TInMemStaging staging(ns);
        Fill(staging);
        EXPECT_NE(before, Contents());
    }
    EXPECT_EQ(before, Contents());
    EXPECT_EQ(15, StatusOf([&] { ns->GetClass("Tape", none); }));
    EXPECT_EQ(nullptr, ns->FindInstance(Path("Disk.Id=\"sdb\"")));
    EXPECT_EQ(first, ns->FindInstance(Path("Disk.Id=\"sda\"")));
    Add(record, {});
    EXPECT_EQ("Record.Number=1\n", InstancesOf(*record));
}

TEST_F(InMemStagingTest, WhatWasTakenBackMayBeStagedAgain)
{
    {
        TInMemStaging staging(ns);
        Fill(staging);
    }
    TInMemStaging staging(ns);
    Fill(staging);
    staging.Commit();
    EXPECT_EQ(3U, disk->GetInstanceCount());
}

TEST_F(InMemStagingTest, StaticValuesAreAsTheyWereToo)
{
    disk->AddPropertyDecl(Decl({"Firmware", TType::kString, {"Static"}}));
    const auto firmware = disk->GetProperty("Firmware", none);
    firmware->SetValue(TCIMValue("old"), none);
    {
        TInMemStaging staging(ns);
        staging.KeepStaticValues(*disk);
        Allocate(disk, {{"Id", "sdb"}, {"Firmware", "newer"}});
        staging.KeepStaticValues(*disk);
        firmware->MarkChanged(TCIMValue("newest"));
    }
    EXPECT_EQ("old", firmware->GetValue(none).ToText());
    EXPECT_FALSE(dynamic_cast<const TInMemStaticProperty&>(*firmware).IsChanged());
    {
        TInMemStaging staging(ns);
        staging.KeepStaticValues(*disk);
        Allocate(disk, {{"Id", "sdb"}, {"Firmware", "new"}});
        staging.Commit();
    }
    EXPECT_EQ("new", firmware->GetValue(none).ToText());
}

TEST_F(InMemStagingTest, RefusesWhatIsThereAndGoesOn)
{
    TInMemStaging staging(ns);
    const auto same = Allocate(disk, {{"Id", "sda"}});
    EXPECT_EQ(12, StatusOf([&] { staging.AddInstance(same); }));
    EXPECT_EQ("root/cimv2:Disk.Id=\"sda\"", same->GetReference().GetPath());
    staging.AddInstance(Allocate(disk, {{"Id", "sdb"}}));
    EXPECT_EQ(12, StatusOf([&] { staging.AddInstance(Allocate(disk, {{"Id", "sdb"}})); }));
    EXPECT_EQ(14, StatusOf([&] { staging.AddInstance(Allocate(disk, {})); }));
    EXPECT_EQ(12, StatusOf([&] { staging.AddClass(Allocate("disk", nullptr)); }));
    const auto undeclared = Allocate("Tape", nullptr);
    EXPECT_EQ(15, StatusOf([&] { staging.AddClass(Allocate("SmallTape", undeclared)); }));
    EXPECT_EQ(15, StatusOf([&] { staging.AddInstance(undeclared->AllocateInMemInstance()); }));
    staging.Commit();
    EXPECT_EQ("|Disk Record|Disk.Id=\"sda\"\nDisk.Id=\"sdb\"\n", Contents());
}

}  // namespace
}  // namespace NORVZEL20
