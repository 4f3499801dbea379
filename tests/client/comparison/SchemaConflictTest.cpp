#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// Inventories whose declarations do not fit together: the message names them, and says what to do.
class SchemaConflictTest : public TPairFixture {};

TEST_F(SchemaConflictTest, APropertyThatAClassBelowDeclaresOtherwise)
{
    const std::string above = Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint32")));
    const std::string below =
        Document(System() + Class("Disk", "", KeyProperty("Id")) + Class("FastDisk", "Disk", Declaration("Size", "string")));
    EXPECT_EQ(
        "cimdelta: b.xml: property Size of class Disk of a.xml cannot be declared here: class FastDisk below it has one of that "
        "name with the type string instead of uint32; give them one type in both inventories, or another name\n",
        Compare(above, below));
    EXPECT_EQ("cimdelta: b.xml: class FastDisk of a.xml cannot be declared here: Type mismatch: property Size of class FastDisk is "
              "uint32, not string; a superclass has a property of "
              "another type in the two inventories\n",
              Compare(below, above));
}

TEST_F(SchemaConflictTest, AnOperatingSystemThatCannotBeDeclaredAsInTheOther)
{
    const auto standard = [](const std::string& type) {
        return Class("CIM_OperatingSystem", "", KeyProperty("Name") + Declaration("Version", type));
    };
    const std::string with = Document(
        standard("uint32") +
        Class("KALMO_OperatingSystem", "CIM_OperatingSystem", Declaration("Version", "uint32") + Declaration("OSType", "uint16")) +
        Instance("KALMO_OperatingSystem", Value("Name", "a") + Value("OSType", "36", "uint16")));
    EXPECT_EQ(
        "cimdelta: b.xml: has no instance of KALMO_OperatingSystem, which a comparison needs, and none can be made: the class "
        "cannot be declared as in a.xml, property Version of KALMO_OperatingSystem is uint32 there, but CIM_OperatingSystem "
        "declares it as string here; add one to the inventory\n",
        Compare(with, Document(standard("string"))));
}

TEST_F(SchemaConflictTest, AnOperatingSystemThatNoInstanceCanBeMadeOf)
{
    const std::string array = Class("KALMO_OperatingSystem", "",
                                    "<PROPERTY.ARRAY NAME=\"Names\" TYPE=\"string\">" + std::string(kKey) + "</PROPERTY.ARRAY>");
    EXPECT_EQ("cimdelta: a.xml: has no instance of KALMO_OperatingSystem, which a comparison needs, and none can be made: its key "
              "Names is an array; add one to the inventory\n",
              Compare(Document(array), Document(System())));
    const std::string below = Class("KALMO_OperatingSystem", "", KeyProperty("Name")) +
                              Class("Server", "KALMO_OperatingSystem", Declaration("OSType", "string"));
    EXPECT_EQ("cimdelta: a.xml: has no instance of KALMO_OperatingSystem, which a comparison needs, and none can be made: property "
              "OSType of Server is string instead of uint16; add one to the inventory\n",
              Compare(Document(below), Document(System())));
}

TEST_F(SchemaConflictTest, ValuesOfDifferentTypesAreEqualWhereThereAreNone)
{
    const auto disk = [](const std::string& type, const std::string& value) {
        return Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Size", type)) +
                        Instance("Disk", Value("Id", "1") + value));
    };
    const std::string coverage = "\n"
                                 "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
                                 "Of another type in b than in a, so equal only if both are NULL: Disk.Size.\n";
    EXPECT_EQ("No differences between a and b.\n" + coverage, Compare(disk("uint32", ""), disk("uint64", "")));
    EXPECT_EQ("1 difference between a and b: 1 changed value in 1 instance\n\nDisk\n~ Id=\"1\"\n    Size: uint32 1 -> uint64 1\n" +
                  coverage,
              Compare(disk("uint32", Value("Size", "1", "uint32")), disk("uint64", Value("Size", "1", "uint64"))));
}

/// Keys of which nothing is known get any value of their type.
TEST_F(SchemaConflictTest, AnOperatingSystemIsMadeWhateverTypesItsKeysHave)
{
    std::string keys = KeyProperty("Name");
    for (const std::string type : {"boolean", "uint8", "sint8", "uint16", "sint16", "uint32", "sint32", "uint64", "sint64",
                                   "real32", "real64", "char16", "datetime", "string"}) {
        keys += "<PROPERTY NAME=\"Key_" + type + "\" TYPE=\"" + type + "\">" + std::string(kKey) + "</PROPERTY>";
    }
    keys += "<PROPERTY.REFERENCE NAME=\"Key_reference\">" + std::string(kKey) + "</PROPERTY.REFERENCE>";
    const std::string declared = Document(Class("KALMO_OperatingSystem", "", keys));
    EXPECT_EQ("Nothing was compared between a and b.\n\n"
              "Compared: 0 classes; 0 instances of a, 0 instances of b.\n"
              "Not compared, because cimdelta made it: KALMO_OperatingSystem.\n"
              "Made in a: an instance of KALMO_OperatingSystem.\n"
              "Made in b: an instance of KALMO_OperatingSystem.\n",
              Compare(declared, declared, {"--allow-empty"}));
}

TEST_F(SchemaConflictTest, TypesAndKeysThatDifferAreReportedInJson)
{
    const std::string one = Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint32")));
    const std::string other =
        Document(System() + Class("Disk", "", KeyProperty("Id") + KeyProperty("Bus") + Declaration("Size", "string")));
    const auto note = [](const std::string& kind, const std::string& property) {
        return "      {\n        \"kind\": \"" + kind + "\",\n        \"inventory\": \"b\",\n        \"asIn\": \"a\",\n" +
               "        \"class\": \"Disk\"" + property + "\n      },\n";
    };
    const std::string notes = note("typeDiffers", ",\n        \"property\": \"Size\"") + note("keysDiffer", "");
    EXPECT_NE(std::string::npos, Compare(one, other, {"-o", "json"}).find("    \"schema\": [\n" + notes)) << fOut;
}

TEST_F(SchemaConflictTest, AnInstanceThatTheReferenceCannotTakeOverIsNamed)
{
    const std::string oneKey = Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("Bay", "string")) +
                                        Instance("Disk", Value("Id", "a")));
    const std::string twoKeys =
        Document(System() + Class("Disk", "", KeyProperty("Id") + KeyProperty("Bay")) +
                 Instance("Disk", Value("Id", "b") + Value("Bay", "1")) + Instance("Disk", Value("Id", "b") + Value("Bay", "2")));
    const std::string advice = "; without --strict-schema, the instances are reported as different ones\n";
    EXPECT_EQ("cimdelta: the comparison failed: instance "
              "Disk.Id=\"a\" of "
              "b.xml cannot be added to a.xml: the keys of class Disk are Id, Bay in a.xml and Id in b.xml" +
                  advice,
              Compare(twoKeys, oneKey, {"--strict-schema"}));
    EXPECT_EQ("cimdelta: the comparison failed: instance Disk.Bay=\"2\",Id=\"b\" of b.xml cannot "
              "be added to a.xml: the keys of class Disk are Id in a.xml and Id, Bay in b.xml" +
                  advice,
              Compare(oneKey, twoKeys, {"--strict-schema"}));
    EXPECT_EQ("3 differences between a and b: 1 instance only in a, 2 instances only in b\n",
              Compare(oneKey, twoKeys).substr(0, 75));
}

}  // namespace
}  // namespace NORVZEL20
