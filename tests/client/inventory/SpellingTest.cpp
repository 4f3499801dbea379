#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// Inventories that spell or declare the same things differently: they compare as equal.
class SpellingTest : public TPairFixture {};

std::string Disks(const std::string& key, const std::string& binding)
{
    const std::string disk = "<VALUE.REFERENCE>" + Path("Disk", binding, "sda") + "</VALUE.REFERENCE>";
    return Document(
        Class("Disk", "", KeyProperty(key)) +
        Class("Part", "",
              "<PROPERTY.REFERENCE NAME=\"On\">" + std::string(kKey) + "</PROPERTY.REFERENCE>" + Declaration("Text", "string")) +
        Instance("Disk", Value(key, "sda")) +
        Instance("Part", "<PROPERTY.REFERENCE NAME=\"On\">" + disk + "</PROPERTY.REFERENCE>" + Value("Text", "x")) + System());
}

const char kEqualDisks[] = "No differences between a and b.\n"
                           "\n"
                           "Compared: 3 classes; 3 instances of a, 3 instances of b.\n"
                           "Spelled in b as in a: Disk.Id (was ID).\n";

TEST_F(SpellingTest, AKeyInAnotherLetterCaseIsTheSameKeyInReferencesToo)
{
    EXPECT_EQ(kEqualDisks, Compare(Disks("Id", "Id"), Disks("ID", "ID")));
    EXPECT_EQ(kEqualDisks, Compare(Disks("Id", "iD"), Disks("ID", "id")));
}

TEST_F(SpellingTest, AReferenceToAClassThatAnInventoryLacksIsWrittenAsTheOtherDeclaresIt)
{
    const std::string use = Class("Use", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"On\"/>") +
                            Instance("Use", Value("Id", "1") + "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" +
                                                Path("disk", "id", "sda") + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "1 class has no instances in any inventory.\n"
              "Declared in b as in a: class Disk.\n",
              Compare(Document(Class("Disk", "", KeyProperty("Id")) + use + System()), Document(use + System())));
}

TEST_F(SpellingTest, AnObjectWithinAValueAndAStaticPropertyHoldReferencesToo)
{
    const auto document = [](const std::string& cls, const std::string& key) {
        const std::string path =
            "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path(cls, key, "sda") + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
        return Document(
            Class(cls, "", KeyProperty(key)) +
            Class("Use", "",
                  KeyProperty("Id") + Declaration("In", "string") + "<PROPERTY.REFERENCE NAME=\"On\">" + Qualifier("Static") +
                      "</PROPERTY.REFERENCE>") +
            Instance("Use", Value("Id", "1") + path + "<PROPERTY NAME=\"In\" TYPE=\"string\" EmbeddedObject=\"object\">" +
                                "<VALUE><![CDATA[<INSTANCE CLASSNAME=\"X\">" + path + "</INSTANCE>]]></VALUE></PROPERTY>") +
            System());
    };
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "1 class has no instances in any inventory.\n"
              "Spelled in b as in a: Disk (was DISK).\n"
              "Spelled in b as in a: Disk.Id (was ID).\n",
              Compare(document("Disk", "Id"), document("DISK", "ID")));
}

std::string Sub(const std::string& above, const std::string& own, const std::string& key)
{
    return Document(Class("Base", "", above) + Class("Sub", "Base", own + Declaration("V", "string")) +
                    Instance("Sub", Value(key, "x") + Value("V", "1")) + System());
}

TEST_F(SpellingTest, AKeyMayBeDeclaredInTheClassOrAboveIt)
{
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "1 class has no instances in any inventory.\n"
              "Declared in a as in b: Base.Name.\n"
              "Identified by other keys in b than in a: Base; instances match only under rules that exclude the keys that one of "
              "them lacks.\n"
              "Spelled in b as in a: Sub.name (was Name).\n",
              Compare(Sub("", KeyProperty("name"), "name"), Sub(KeyProperty("Name"), "", "Name")));
}

TEST_F(SpellingTest, AnOverrideMaySpellTheKeyAnotherWay)
{
    const std::string inherited = Sub(KeyProperty("Name"), "", "Name");
    const std::string overridden = Sub(KeyProperty("Name"), KeyProperty("NAME"), "Name");
    const std::string equal = "No differences between a and b.\n"
                              "\n"
                              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
                              "1 class has no instances in any inventory.\n"
                              "Spelled in b as in a: ";
    EXPECT_EQ(equal + "Sub.Name (was NAME).\n", Compare(inherited, overridden));
    EXPECT_EQ(equal + "Sub.NAME (was Name).\n", Compare(overridden, inherited));
}

TEST_F(SpellingTest, InstancesThatAreOneAsTheOtherDeclaresAreRefused)
{
    const std::string disk = Class("Disk", "", "<PROPERTY NAME=\"Id\" TYPE=\"uint32\">" + std::string(kKey) + "</PROPERTY>");
    const auto part = [](const std::string& id) {
        return Instance("Part", "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path("Disk", "Id", id) +
                                    "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    };
    const std::string parts = Class("Part", "", "<PROPERTY.REFERENCE NAME=\"On\">" + std::string(kKey) + "</PROPERTY.REFERENCE>");
    EXPECT_EQ(
        "cimdelta: b.xml: has two instances root/cimv2:Part.On=\"Disk.Id=1\" once names are spelled and keys are declared as in "
        "the other inventories; remove one of them\n",
        Compare(Document(disk + parts + part("1") + System()), Document(parts + part("1") + part("01") + System())));
}

TEST_F(SpellingTest, TheOrderOfClassesInAFileDoesNotShowInTheNotes)
{
    const std::string one = Class("X1", "", KeyProperty("Id"));
    const std::string two = Class("X2", "", KeyProperty("Id"));
    const std::string report = Compare(Document(System()), Document(System() + one + two));
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "Compared: 1 class; 1 instance of a, 1 instance of b.\n"
              "2 classes have no instances in any inventory.\n"
              "Declared in a as in b: class X1, class X2.\n",
              report);
    EXPECT_EQ(report, Compare(Document(System()), Document(two + System() + one)));
}

}  // namespace
}  // namespace NORVZEL20
