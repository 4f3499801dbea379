#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// `compare` from the arguments to the report, over the small inventories of tests/client/data. Reports are compared as whole
/// texts.
class CompareTest : public TClientFixture {
  protected:
    /// The inventory without its last instance.
    static std::string WithoutLast(std::string inventory)
    {
        const std::string end = "</INSTANCE></VALUE.OBJECT>\n";
        const std::size_t begin = inventory.rfind("<VALUE.OBJECT><INSTANCE");
        return inventory.erase(begin, inventory.find(end, begin) + end.size() - begin);
    }
};

TEST_F(CompareTest, APairIsReportedWithOldAndNewValues)
{
    EXPECT_EQ("8 differences between web01 and web02: 2 instances only in web01, 2 instances only in web02, 4 changed values in 3 "
              "instances\n"
              "\n"
              "INV_Disk\n"
              "- BootId=1,Device=\"sda\"\n"
              "+ BootId=7,Device=\"sda\"\n"
              "\n"
              "INV_Package\n"
              "~ Name=\"bash\"\n"
              "    Depends: {\"libc6\", \"libtinfo6\"} -> {\"libc6\", \"libtinfo6\", \"base-files\"}\n"
              "    Version: 5.1 -> 5.2\n"
              "+ Name=\"curl\"\n"
              "~ Name=\"nginx\"\n"
              "    Version: 1.22 -> 1.24\n"
              "- Name=\"telnet\"\n"
              "\n"
              "INV_Service\n"
              "~ Id=\"ssh\"\n"
              "    Started: TRUE -> FALSE\n"
              "\n"
              "Compared: 4 classes; 6 instances of web01, 6 instances of web02.\n"
              "1 class has no instances in any inventory.\n"
              "Property of KALMO_OperatingSystem not compared, because it is the time of collection: DateTimeOfCollection.\n",
              Result({"compare", "--detail", "web01.xml", "web02.xml"}));
    EXPECT_EQ(1, fStatus);
}

TEST_F(CompareTest, OfSeveralInventoriesEqualValuesStandTogether)
{
    EXPECT_EQ("10 differences between web01 and web02, web03: 2 instances of web01 missing elsewhere, 2 instances only elsewhere, "
              "6 changed values in 3 instances\n"
              "\n"
              "INV_Disk\n"
              "- BootId=1,Device=\"sda\"  (not in web02)\n"
              "+ BootId=7,Device=\"sda\"  (in web02)\n"
              "\n"
              "INV_Package\n"
              "~ Name=\"bash\"\n"
              "    Depends: {\"libc6\", \"libtinfo6\"} -> web02: {\"libc6\", \"libtinfo6\", \"base-files\"}\n"
              "    Version: 5.1 -> web02, web03: 5.2\n"
              "+ Name=\"curl\"  (in web02, web03)\n"
              "~ Name=\"nginx\"\n"
              "    Section: web -> web03: \" web\"\n"
              "    Version: 1.22 -> web02: 1.24 / web03: \"\"\n"
              "- Name=\"telnet\"  (not in web02)\n"
              "\n"
              "INV_Service\n"
              "~ Id=\"ssh\"\n"
              "    Caption: Secure shell -> web03: \"Secure\\nshell \\u009b31m\"\n"
              "    Started: TRUE -> web02: FALSE\n"
              "\n"
              "Compared: 4 classes; 6 instances of web01, 6 instances of web02, 7 instances of web03.\n"
              "1 class has no instances in any inventory.\n"
              "Property of KALMO_OperatingSystem not compared, because it is the time of collection: DateTimeOfCollection.\n",
              Result({"compare", "--detail", "web01.xml", "web02.xml", "web03.xml"}));
    EXPECT_EQ(1, fStatus);
}

TEST_F(CompareTest, WhatIsEqualInAnotherOrderIsNoDifference)
{
    EXPECT_EQ("No differences between web01 and web01-again, times of collection aside.\n"
              "\n"
              "Compared: 4 classes; 6 instances of web01, 6 instances of web01-again.\n"
              "1 class has no instances in any inventory.\n"
              "Property of KALMO_OperatingSystem not compared, because it is the time of collection: DateTimeOfCollection.\n",
              Result({"compare", "--detail", "web01.xml", "web01-again.xml"}));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CompareTest, OrderInTheFilesDoesNotShowInTheReport)
{
    const std::string report = Result({"compare", "--detail", "web01.xml", "web02.xml", "web03.xml"});
    const std::string same =
        Shorten(Result({"compare", "--detail", "web01-again.xml", "web02.xml", "web03.xml"}), "web01-again", "web01");
    EXPECT_EQ(report, same);
}

TEST_F(CompareTest, EveryRunGivesTheSameBytes)
{
    const std::string first =
        Result({"compare", "--detail", "-o", "json", "web01.xml", "web02.xml.gz", "web03.xml", "web02.xml.xz"});
    for (int i = 0; i < 10; ++i) {
        ASSERT_EQ(first, Result({"compare", "--detail", "-o", "json", "web01.xml", "web02.xml.gz", "web03.xml", "web02.xml.xz"}));
    }
}

TEST_F(CompareTest, CompressedInventoriesAreReadWhateverTheirNames)
{
    const std::string plain = Result({"compare", "--detail", "web01.xml", "web02.xml"});
    for (const char* suffix : {".gz", ".xz", ".zst"}) {
        EXPECT_EQ(plain, Result({"compare", "--detail", "web01.xml", std::string("web02.xml") + suffix}));
        const std::string renamed = Scratch("web02.xml", ReadFile(std::string("web02.xml") + suffix));
        Run({"compare", "--detail", "-o", "ndjson", "web01.xml", renamed});
        EXPECT_EQ(1, fStatus) << suffix << fErr;
    }
}

TEST_F(CompareTest, RulesSayWhatCountsAndTheReportSaysSo)
{
    EXPECT_EQ("5 differences between web01 and web02: 1 instance only in web01, 1 instance only in web02, 3 changed values in 2 "
              "instances\n"
              "\n"
              "INV_Package\n"
              "~ Name=\"bash\"\n"
              "    Depends: {\"libc6\", \"libtinfo6\"} -> {\"libc6\", \"libtinfo6\", \"base-files\"}\n"
              "    Version: 5.1 -> 5.2\n"
              "+ Name=\"curl\"\n"
              "~ Name=\"nginx\"\n"
              "    Version: 1.22 -> 1.24\n"
              "- Name=\"telnet\"\n"
              "\n"
              "Compared: 2 classes; 4 instances of web01, 4 instances of web02.\n"
              "1 class has no instances in any inventory.\n"
              "Not compared, because no element of the rules is for the class or one above it: INV_Service (1 / 1), "
              "KALMO_OperatingSystem (1 / 1).\n"
              "Properties of INV_Disk not compared, because the rules leave them out: BootId.\n"
              "Properties of INV_Package not compared, because the rules leave them out: Size.\n",
              Result({"compare", "--detail", "--spec", "rules.xml", "web01.xml", "web02.xml"}));
}

TEST_F(CompareTest, NoDifferencesIsNotSaidOverWhatRulesLeaveOut)
{
    EXPECT_EQ("No differences in what was compared between web01 and web01-again; not everything was, see below.\n",
              Result({"compare", "--detail", "--spec", "rules.xml", "web01.xml", "web01-again.xml"}).substr(0, 98));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CompareTest, InstancesThatShareAKeyAreReported)
{
    EXPECT_EQ(
        "5 differences between web02 and two-boots: 3 instances only in web02, 1 instance only in two-boots, 1 changed value in 1 "
        "instance\n"
        "\n"
        "INV_Disk\n"
        "~ Device=\"sda\"\n"
        "    SizeMB: 500 -> 900 (one of 2 instances of two-boots with this key)\n"
        "+ Device=\"sdb\"\n"
        "\n"
        "INV_Package\n"
        "- Name=\"bash\"\n"
        "- Name=\"curl\"\n"
        "- Name=\"nginx\"\n"
        "\n"
        "Compared: 2 classes; 4 instances of web02, 3 instances of two-boots.\n"
        "1 class has no instances in any inventory.\n"
        "Not compared, because no element of the rules is for the class or one above it: INV_Service (1 / 0), "
        "KALMO_OperatingSystem (1 / 1).\n"
        "Properties of INV_Disk not compared, because the rules leave them out: BootId.\n"
        "Properties of INV_Package not compared, because the rules leave them out: Size.\n"
        "Instances of INV_Disk with the key of an earlier one, since the rules leave out BootId: 1 of two-boots, compared with the "
        "same instance of web02 as the earlier one.\n",
        Result({"compare", "--detail", "--spec", "rules.xml", "web02.xml", "two-boots.xml"}));
    const std::string turned = Result({"compare", "--detail", "--spec", "rules.xml", "two-boots.xml", "web02.xml"});
    EXPECT_NE(std::string::npos, turned.find("leave out BootId: 1 of two-boots, not compared.\n")) << turned;
    EXPECT_NE(std::string::npos, turned.find("Compared: 2 classes; 2 instances of two-boots, 4 instances of web02.\n")) << turned;
}

TEST_F(CompareTest, NoDifferencesIsNotSaidOverInstancesThatShareAKey)
{
    const std::string rules = Scratch("share", "<DifftoolSpec><class name='INV_Disk' default='include' excludekeys='BootId'/>"
                                               "<class name='KALMO_OperatingSystem' default='include'/></DifftoolSpec>");
    const std::string both = WithoutLast(ReadFile("two-boots.xml"));
    const std::string two = Scratch("two.xml", both);
    const std::string one = Scratch("one.xml", WithoutLast(both));
    Run({"compare", "--detail", "--spec", rules, two, one});
    EXPECT_EQ("No differences in what was compared", fOut.substr(0, 35));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CompareTest, AnOperatingSystemIsMadeIfTheClassHasNoInstance)
{
    const std::string none = Scratch("none.xml", WithoutLast(ReadFile("empty-classes.xml")));
    Run({"compare", "--detail", "--allow-empty", none, "empty-classes.xml"});
    EXPECT_EQ("", fErr);
    EXPECT_EQ("Nothing was compared between ", fOut.substr(0, 29));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CompareTest, AnInstanceGoneUnderExcludedKeysIsFoundByItsPath)
{
    EXPECT_NE(std::string::npos, Result({"compare", "--detail", "--spec", "rules.xml", "two-boots.xml", "web02.xml"})
                                     .find("INV_Disk\n- Device=\"sdb\"  (path: root/cimv2:INV_Disk.BootId=1,Device=\"sdb\")\n\n"));
}

TEST_F(CompareTest, WhatAnotherInventoryDeclaresIsDeclaredAndReported)
{
    Run({"compare", "--detail", "web01.xml", "other-schema.xml"});
    EXPECT_EQ("6 differences between web01 and other-schema: 2 instances only in web01, 2 instances only in other-schema, 2 "
              "changed values in 1 "
              "instance\n"
              "\n"
              "ACME_OperatingSystem\n"
              "+ CreationClassName=\"ACME_OperatingSystem\",Name=\"acme\"\n"
              "\n"
              "INV_Disk\n"
              "- BootId=1,Device=\"sda\"\n"
              "\n"
              "INV_Extra\n"
              "+ Serial=5\n"
              "\n"
              "INV_Package\n"
              "~ Name=\"bash\"\n"
              "    Depends: {\"libc6\", \"libtinfo6\"} -> NULL\n"
              "    Vendor: NULL -> Debian\n"
              "\n"
              "INV_Service\n"
              "- Id=\"ssh\"\n"
              "\n"
              "Compared: 5 classes; 5 instances of web01, 5 instances of other-schema.\n"
              "2 classes have no instances in any inventory.\n"
              "Not compared, because cimdelta made the instance of other-schema: KALMO_OperatingSystem (1 / 0).\n"
              "Declared in web01 as in other-schema: class ACME_OperatingSystem, class CIM_OperatingSystem, class INV_Extra, "
              "INV_Package.Vendor.\n"
              "Declared in other-schema as in web01: class INV_Disk, class INV_Element, INV_Package.Depends, class INV_Service.\n"
              "Made in other-schema: an instance of KALMO_OperatingSystem.\n"
              "Spelled in other-schema as in web01: INV_Package (was inv_package).\n"
              "Spelled in other-schema as in web01: INV_Package.Version (was version).\n",
              fOut);
    EXPECT_EQ("", fErr);
    EXPECT_EQ(1, fStatus);
}

TEST_F(CompareTest, InventoriesWithoutOperatingSystemAreCompleteAllTheSame)
{
    const std::string again = Scratch("again.xml", ReadFile("other-schema.xml"));
    Run({"compare", "--detail", "other-schema.xml", again});
    EXPECT_EQ("No differences between other-schema and A.\n"
              "\n"
              "Compared: 3 classes; 5 instances of other-schema, 5 instances of A.\n"
              "1 class has no instances in any inventory.\n"
              "Not compared, because cimdelta made it: KALMO_OperatingSystem.\n"
              "Made in other-schema: an instance of KALMO_OperatingSystem.\n"
              "Made in A: an instance of KALMO_OperatingSystem.\n",
              Shorten(fOut, again.substr(again.rfind('/') + 1, again.size() - again.rfind('/') - 5), "A"));
    EXPECT_EQ("", fErr);
    EXPECT_EQ(0, fStatus);
}

TEST_F(CompareTest, TypesAndKeysThatDifferAreReportedAndCompared)
{
    EXPECT_EQ("7 differences between web01 and other-types: 4 instances only in web01, 2 instances only in other-types, 1 changed "
              "value in 1 "
              "instance\n"
              "\n"
              "INV_Disk\n"
              "- BootId=1,Device=\"sda\"\n"
              "+ BootId=NULL,Device=\"sda\"\n"
              "\n"
              "INV_Package\n"
              "~ Name=\"bash\"\n"
              "    Size: uint64 100 -> uint32 100\n"
              "- Name=\"nginx\"\n"
              "- Name=\"telnet\"\n"
              "+ Name=\"zsh\"\n"
              "\n"
              "INV_Service\n"
              "- Id=\"ssh\"\n"
              "\n"
              "Compared: 4 classes; 6 instances of web01, 4 instances of other-types.\n"
              "1 class has no instances in any inventory.\n"
              "Property of KALMO_OperatingSystem not compared, because it is the time of collection: DateTimeOfCollection.\n"
              "Declared in other-types as in web01: INV_Disk.BootId, class INV_Element, class INV_Service.\n"
              "Identified by other keys in other-types than in web01: INV_Disk; instances match only under rules that exclude the "
              "keys that "
              "one of them lacks.\n"
              "Of another type in other-types than in web01, so equal only if both are NULL: INV_Package.Size.\n",
              Result({"compare", "--detail", "web01.xml", "other-types.xml"}));
}

TEST_F(CompareTest, IfTypesDifferRecordsStillNameTheOneOtherInventory)
{
    const std::string records =
        Scratch("records.xml", Result({"compare", "--detail", "-o", "cimxml", "web01.xml", "other-types.xml"}));
    EXPECT_EQ(
        "{\"class\":\"KALMO_Delta\",\"instance\":\"KALMO_Delta.DeltaID=1\",\"properties\":{\"NamespaceIndices\":[1]}}\n"
        "{\"class\":\"KALMO_Delta\",\"instance\":\"KALMO_Delta.DeltaID=4\",\"properties\":{\"NamespaceIndices\":[1]}}\n",
        Result({"query", "-o", "ndjson", "SELECT NamespaceIndices FROM KALMO_Delta WHERE DeltaID = 1 OR DeltaID = 4", records}));
}

TEST_F(CompareTest, AStrictSchemaIsTakenAsItIs)
{
    EXPECT_EQ("cimdelta: the comparison failed: other-schema.xml declares no "
              "class KALMO_OperatingSystem; without --strict-schema, cimdelta declares and makes what is missing\n",
              Complaint({"compare", "--detail", "--strict-schema", "web01.xml", "other-schema.xml"}));
    EXPECT_EQ("cimdelta: the comparison failed: property Size of class INV_Package is uint64 in web01.xml and uint32 in "
              "other-types.xml; without --strict-schema, the values are reported as different\n",
              Complaint({"compare", "--detail", "--strict-schema", "web01.xml", "other-types.xml"}));
    EXPECT_EQ("cimdelta: the comparison failed: other-types.xml does not declare class INV_Service, of which web01.xml has "
              "instances; without --strict-schema, cimdelta "
              "declares "
              "and makes what is missing\n",
              Complaint({"compare", "--detail", "--strict-schema", "web01.xml", "web02.xml", "other-types.xml"}));
}

TEST_F(CompareTest, AStrictSchemaThatFitsGivesTheSameReport)
{
    EXPECT_EQ(Result({"compare", "--detail", "web01.xml", "web02.xml"}),
              Result({"compare", "--detail", "--strict-schema", "web01.xml", "web02.xml"}));
}

TEST_F(CompareTest, ColourMarksTheKindOfADifference)
{
    fColored = true;
    const std::string report = Result({"compare", "--detail", "web01.xml", "web02.xml"});
    EXPECT_NE(std::string::npos, report.find("\x1b[31m- Name=\"telnet\"\x1b[0m\n"));
    EXPECT_NE(std::string::npos, report.find("\x1b[32m+ Name=\"curl\"\x1b[0m\n"));
    EXPECT_NE(std::string::npos, report.find("\x1b[33m~ Name=\"bash\"\x1b[0m\n"));
    fColored = false;
    EXPECT_EQ(std::string::npos, Result({"compare", "--detail", "web01.xml", "web02.xml"}).find('\x1b'));
}

}  // namespace
}  // namespace NORVZEL20
