// An accepted difference is gone if the run compared what it is about and found no such difference. What the run did not compare is
// not gone: it stays in the file, and the report says so.

#include "tests/client/baseline/TBaselineFixture.h"

namespace NORVZEL20 {
namespace {

using NotComparedTest = TBaselineFixture;

const std::string kSizeOfShelf = "~ Shelf.Id=\"s1\" Size: uint16 1 -> uint16 2 in web02\n";

TEST_F(NotComparedTest, AClassThatNoInventoryDeclaresIsNotGone)
{
    System("web02", {{"sda", "1"}, {"sdb", "5"}});
    const std::string entries = "+ Shelf.Id=\"s1\" in web02\n" + kSizeOfShelf;
    WriteEntries(entries);
    EXPECT_EQ("\n2 accepted differences are for what was not compared: + Shelf.Id=\"s1\" in web02, ...\n",
              Since().substr(Compare({}).find('\n') + 1));
    EXPECT_EQ(0, fStatus);
    Accept();
    EXPECT_EQ(entries, Entries());
}

TEST_F(NotComparedTest, APropertyThatNoInventoryDeclaresIsNotGone)
{
    System("web02", {{"sda", "1"}, {"sdb", "5"}});
    const std::string entries = "~ Disk.Id=\"sda\" Model: \"A\" -> \"B\" in web02\n";
    WriteEntries(entries);
    EXPECT_NE(std::string::npos, Since().find("\n1 accepted difference is for what was not compared: ~ Disk.Id=\"sda\" Model"))
        << fReport;
    Accept();
    EXPECT_EQ(entries, Entries());
}

TEST_F(NotComparedTest, AClassThatIsDeclaredAndHasNoInstanceIsGone)
{
    const std::string shelf = Class("Shelf", "", KeyProperty("Id") + Declaration("Size", "uint16"));
    SystemWith("web01", shelf);
    SystemWith("web02", shelf);
    WriteEntries(kSizeOfShelf);
    EXPECT_NE(std::string::npos, Since().find("\nCompared with base.txt: 1 gone; 0 accepted\n")) << fReport;
    Accept();
    EXPECT_EQ("", Entries());
}

TEST_F(NotComparedTest, AClassWithoutInstancesThatTheRulesLeaveOutIsNotGone)
{
    const std::string shelf = Class("Shelf", "", KeyProperty("Id") + Declaration("Size", "uint16"));
    SystemWith("web01", shelf);
    SystemWith("web02", shelf);
    WriteEntries(kSizeOfShelf);
    EXPECT_NE(std::string::npos, Since({"--exclude", "Shelf"}).find("\n1 accepted difference is for what was not compared: "))
        << fReport;
}

TEST_F(NotComparedTest, WhatOptionsLeaveOutStaysWhenTheRestIsAccepted)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}, {"sdc", "7"}});
    Accept();
    const std::string all = Entries();
    Accept({"--exclude", "Disk.Size"});
    EXPECT_EQ(all, Entries());
    Accept({"--class", "KALMO_*"});
    EXPECT_EQ(all, Entries());
}

TEST_F(NotComparedTest, OfAnInstanceThatIsAnotherNowThePropertiesThatWereLeftOutStay)
{
    const auto disk = [](const char* id, const char* size) {
        return Instance("Disk", Value("Id", id) + Value("Model", "A") + Value("Size", size, "uint16"));
    };
    const std::string declared =
        Class("Disk", "", KeyProperty("Id") + Declaration("Model", "string") + Declaration("Size", "uint16"));
    SystemWith("web01", declared + disk("sda", "1"));
    SystemWith("web02", declared + disk("sda", "1") + disk("sdb", "2"));
    Accept();
    SystemWith("web02", declared + disk("sda", "1") + disk("sdb", "3"));
    EXPECT_NE(std::string::npos, Since({"--property", "Size"}).find(" in web02; has Size: uint16 3; accepted: Size: uint16 2\n"))
        << fReport;
    Accept({"--property", "Size"});
    EXPECT_EQ("+ Disk.Id=\"sdb\" Model: \"A\", Size: uint16 3 in web02\n", Entries());
}

TEST_F(NotComparedTest, WhatWasAcceptedByOtherKeysIsNotGone)
{
    const auto disk = [](const char* id, const char* bus, const char* size) {
        return Instance("Disk", Value("Id", id) + Value("Bus", bus) + Value("Size", size, "uint16"));
    };
    const std::string declared = Class("Disk", "", KeyProperty("Id") + KeyProperty("Bus") + Declaration("Size", "uint16"));
    SystemWith("web01", declared + disk("sda", "a,b", "1") + disk("sdb", "2", "1"));
    SystemWith("web02", declared + disk("sda", "a,b", "2") + disk("sdc", "3", "1"));
    Accept();
    const std::string since = Since({"--exclude-key", "Bus"});
    EXPECT_EQ("Compared with base.txt: 2 new; 1 accepted\n"
              "2 accepted differences are for what was not compared: + Disk.Bus=\"3\",Id=\"sdc\" in web02, ...\n",
              since.substr(since.find("Compared with")));
    Accept({"--exclude-key", "Bus"});
    EXPECT_EQ("- Disk.Bus=\"2\",Id=\"sdb\" in web02\n"
              "+ Disk.Bus=\"3\",Id=\"sdc\" Size: uint16 1 in web02\n"
              "~ Disk.Bus=\"a,b\",Id=\"sda\" Size: uint16 1 -> uint16 2 in web02\n"
              "~ Disk.Id=\"sda\" Size: uint16 1 -> uint16 2 in web02\n"
              "+ Disk.Id=\"sdc\" Size: uint16 1 in web02\n",
              Entries());
    EXPECT_NE(std::string::npos, Since().find("3 accepted differences.\n")) << fReport;
}

TEST_F(NotComparedTest, AnArrayAsAKeyIsReadBack)
{
    const std::string key =
        "<PROPERTY.ARRAY NAME=\"Id\" TYPE=\"uint8\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
        "</QUALIFIER></PROPERTY.ARRAY>";
    const auto disk = [&](const char* size) {
        return Class("Disk", "", key + Declaration("Size", "uint16")) +
               Instance("Disk",
                        "<PROPERTY.ARRAY NAME=\"Id\" TYPE=\"uint8\"><VALUE.ARRAY><VALUE>1</VALUE><VALUE>2</VALUE></VALUE.ARRAY>"
                        "</PROPERTY.ARRAY>" +
                            Value("Size", size, "uint16"));
    };
    SystemWith("web01", disk("1"));
    SystemWith("web02", disk("2"));
    Accept();
    EXPECT_EQ("~ Disk.Id={1, 2} Size: uint16 1 -> uint16 2 in web02\n", Entries());
    EXPECT_NE(std::string::npos, Since().find("1 accepted difference.\n")) << fReport;
}

TEST_F(NotComparedTest, WithExcludedKeysNamesMayBeInAnyLetterCase)
{
    const std::string disks = Class("Disk", "", KeyProperty("Id") + KeyProperty("Bus") + Declaration("Size", "uint16")) +
                              Instance("Disk", Value("Id", "sda") + Value("Bus", "1") + Value("Size", "1", "uint16"));
    SystemWith("web01", disks);
    SystemWith("web02", disks);
    WriteEntries("~ DISK.ID=\"sda\" SIZE: uint16 1 -> uint16 2 in web02\n- DISK.BUS=\"2\",ID=\"sda\" in web02\n");
    EXPECT_NE(std::string::npos, Since({"--exclude-key", "Bus"}).find("\nCompared with base.txt: 2 gone; 0 accepted\n")) << fReport;
}

TEST_F(NotComparedTest, EntriesForTheReferenceAreSaidToBeThat)
{
    System("web02", {{"sda", "2"}, {"sdb", "5"}});
    Accept();
    const std::string accepted = Entries();
    const std::string report = Since({"--reference", "web02"});
    EXPECT_NE(std::string::npos, report.find("\n1 accepted difference is for web02, which is the reference in this run\n"))
        << report;
    EXPECT_EQ(std::string::npos, report.find("not in this run")) << report;
    Accept({"--reference", "web02"});
    EXPECT_EQ(accepted + "~ Disk.Id=\"sda\" Size: uint16 2 -> uint16 1 in web01\n", Entries());
}

}  // namespace
}  // namespace NORVZEL20
