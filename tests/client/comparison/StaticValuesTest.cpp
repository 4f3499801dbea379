#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// Three disks whose firmware is one value of their class.
std::string Disks(const std::string& firmware)
{
    std::string disks;
    for (const char* const id : {"0", "1", "2"}) {
        disks += Instance("Disk", Value("Id", id) + Value("Firmware", firmware));
    }
    return Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Firmware", "string", Qualifier("Static"))) +
                    disks);
}

const char kDisks[] = "Disk\n"
                      "~ Id=\"0\"\n"
                      "    Firmware: old -> new\n"
                      "~ Id=\"1\"\n"
                      "    Firmware: old -> new\n"
                      "~ Id=\"2\"\n"
                      "    Firmware: old -> new\n"
                      "\n";

class StaticValuesTest : public TPairFixture {};

TEST_F(StaticValuesTest, EveryInstanceOfAPairShowsTheValueBefore)
{
    EXPECT_EQ(std::string("3 differences between a and b: 3 changed values in 3 instances\n\n") + kDisks +
                  "Compared: 2 classes; 4 instances of a, 4 instances of b.\n",
              Compare(Disks("old"), Disks("new")));
    EXPECT_EQ("No differences between a and b.\n\nCompared: 2 classes; 4 instances of a, 4 instances of b.\n",
              Compare(Disks("old"), Disks("old")));
}

TEST_F(StaticValuesTest, APropertyMayBeStaticInOneInventoryAlone)
{
    const std::string ordinary =
        Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Firmware", "string")) +
                 Instance("Disk", Value("Id", "0") + Value("Firmware", "x")) +
                 Instance("Disk", Value("Id", "1") + Value("Firmware", "y")) + Instance("Disk", Value("Id", "2")));
    EXPECT_EQ("3 differences between a and b: 3 changed values in 3 instances\n"
              "\n"
              "Disk\n"
              "~ Id=\"0\"\n"
              "    Firmware: old -> x\n"
              "~ Id=\"1\"\n"
              "    Firmware: old -> y\n"
              "~ Id=\"2\"\n"
              "    Firmware: old -> NULL\n"
              "\n"
              "Compared: 2 classes; 4 instances of a, 4 instances of b.\n",
              Compare(Disks("old"), ordinary));
    EXPECT_NE(std::string::npos, Compare(ordinary, Disks("old")).find("    Firmware: y -> old\n"));
}

TEST_F(StaticValuesTest, AnArrayInTheDeclarationIsABagUnlessItSaysOtherwise)
{
    const auto disk = [](const std::string& qualifiers, const std::string& first, const std::string& second) {
        return Document(System() +
                        Class("Disk", "",
                              KeyProperty("Id") + "<PROPERTY.ARRAY NAME=\"Modes\" TYPE=\"string\">" + Qualifier("Static") +
                                  qualifiers + "<VALUE.ARRAY><VALUE>" + first + "</VALUE><VALUE>" + second +
                                  "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>") +
                        Instance("Disk", Value("Id", "0")));
    };
    const auto arrayType = [](const std::string& type) {
        return "<QUALIFIER NAME=\"ArrayType\" TYPE=\"string\"><VALUE>" + type + "</VALUE></QUALIFIER>";
    };
    const std::string equal = "No differences between a and b.\n\nCompared: 2 classes; 2 instances of a, 2 instances of b.\n";
    EXPECT_EQ(equal, Compare(disk("", "x", "y"), disk("", "y", "x")));
    EXPECT_EQ(equal, Compare(disk(arrayType("Bag"), "x", "y"), disk(arrayType("Bag"), "y", "x")));
    EXPECT_NE(std::string::npos, Compare(disk(arrayType("Ordered"), "x", "y"), disk(arrayType("Ordered"), "y", "x"))
                                     .find("    Modes: {\"x\", \"y\"} -> {\"y\", \"x\"}\n"));
}

/// The value of the one that declares it may stand in the declaration itself.
TEST_F(StaticValuesTest, APropertyThatOneInventoryDoesNotDeclareIsNullThere)
{
    const std::string key = KeyProperty("Id");
    const std::string with = Document(
        System() +
        Class("Disk", "",
              key + "<PROPERTY NAME=\"Firmware\" TYPE=\"string\">" + Qualifier("Static") + "<VALUE>old</VALUE></PROPERTY>") +
        Instance("Disk", Value("Id", "0")));
    const std::string without = Document(System() + Class("Disk", "", key) + Instance("Disk", Value("Id", "0")));
    const std::string begin = "1 difference between a and b: 1 changed value in 1 instance\n\nDisk\n~ Id=\"0\"\n    Firmware: ";
    const std::string end = "\nCompared: 2 classes; 2 instances of a, 2 instances of b.\nDeclared in ";
    EXPECT_EQ(begin + "old -> NULL\n" + end + "b as in a: Disk.Firmware.\n", Compare(with, without));
    EXPECT_EQ(begin + "NULL -> old\n" + end + "a as in b: Disk.Firmware.\n", Compare(without, with));
}

/// Whatever instance comes first.
TEST_F(StaticValuesTest, AnInventoryWithTwoValuesIsRefused)
{
    const auto document = [](const std::string& first, const std::string& second) {
        return Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Firmware", "string", Qualifier("Static"))) +
                        Instance("Disk", Value("Id", first) + Value("Firmware", first)) +
                        Instance("Disk", Value("Id", second) + Value("Firmware", second)));
    };
    EXPECT_EQ(
        "cimdelta: a.xml:6:159: found \"2\" in the static property \"Firmware\" of class \"Disk\", which has \"1\" in another "
        "instance; all instances share one value\n",
        Compare(document("1", "2"), Disks("1")));
    EXPECT_EQ(
        "cimdelta: a.xml:6:159: found \"1\" in the static property \"Firmware\" of class \"Disk\", which has \"2\" in another "
        "instance; all instances share one value\n",
        Compare(document("2", "1"), Disks("1")));
}

TEST_F(StaticValuesTest, SoDoesEveryInstanceOfThree)
{
    const std::string old = Scratch("a.xml", Disks("old"));
    const std::string other = Scratch("b.xml", Disks("new"));
    const std::string third = Scratch("c.xml", Disks("new"));
    const std::string report = Named(Result({"compare", "--detail", old, other, third}), old, other);
    EXPECT_EQ(0u, report.find("3 differences between a and b, ")) << report;
    EXPECT_NE(std::string::npos, report.find("    Firmware: old -> b, ")) << report;
}

}  // namespace
}  // namespace NORVZEL20
