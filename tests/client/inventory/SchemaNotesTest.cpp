#include <sstream>

#include "client/inventory/CollectObjects.h"
#include "client/inventory/MakeMissingOperatingSystems.h"
#include "client/inventory/PropertyValue.h"
#include "client/inventory/TInventoryLoader.h"
#include "embedded/value/TValueText.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TFakeConsole.h"
#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// What is said about schemas that differ, beside what is done about it.
class SchemaNotesTest : public TPairFixture {
  protected:
    static std::string Names(const std::string& arrayType, const std::vector<std::string>& names)
    {
        std::string values;
        for (const std::string& name : names) {
            values += "<VALUE>" + name + "</VALUE>";
        }
        const std::string qualifier =
            arrayType.empty() ? arrayType
                              : "<QUALIFIER NAME=\"ArrayType\" TYPE=\"string\"><VALUE>" + arrayType + "</VALUE></QUALIFIER>";
        return Document(
            System() +
            Class("Disk", "",
                  KeyProperty("Id") + "<PROPERTY.ARRAY NAME=\"Names\" TYPE=\"string\">" + qualifier + "</PROPERTY.ARRAY>") +
            Instance("Disk", Value("Id", "1") + "<PROPERTY.ARRAY NAME=\"Names\" TYPE=\"string\"><VALUE.ARRAY>" + values +
                                 "</VALUE.ARRAY></PROPERTY.ARRAY>"));
    }

    /// What the report of three schemas says at its end, without what it says of declarations that were completed.
    std::string Differences(const std::string& inA, const std::string& inB, const std::string& inC)
    {
        const std::string a = Scratch("a.xml", Document(System() + inA));
        const std::string b = Scratch("b.xml", Document(System() + inB));
        const std::string c = Scratch("c.xml", Document(System() + inC));
        Run({"compare", "--detail", a, b, c});  // with a message on each array, because the documents declare no qualifiers
        std::istringstream report(Shorten(Named(fOut, a, b), c.substr(c.rfind('/') + 1, c.size() - c.rfind('/') - 5), "c"));
        std::string differences;
        bool reached = false;
        for (std::string line; std::getline(report, line);) {
            if (reached && line.compare(0, 9, "Declared ") != 0 && line.find(" no instances in any ") == std::string::npos) {
                differences += line + "\n";
            }
            reached = reached || line.compare(0, 9, "Compared:") == 0;
        }
        return reached ? differences : "no coverage";
    }
};

TEST_F(SchemaNotesTest, TheReferenceDecidesWhetherTheOrderOfAnArrayCounts)
{
    const std::string bag = Names("", {"x", "y"});
    const std::string ordered = Names("Ordered", {"y", "x"});
    EXPECT_EQ("No differences between a and b.\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "The order of the array Disk.Names counts in b and not in a; compared as in a.\n",
              Compare(bag, ordered));
    EXPECT_EQ("1 difference between a and b: 1 changed value in 1 instance\n"
              "\n"
              "Disk\n"
              "~ Id=\"1\"\n"
              "    Names: {\"y\", \"x\"} -> {\"x\", \"y\"}\n"
              "\n"
              "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
              "The order of the array Disk.Names counts in a and not in b; compared as in a.\n",
              Compare(ordered, bag));
    EXPECT_NE(std::string::npos,
              Compare(bag, ordered, {"-o", "ndjson"})
                  .find("{\"kind\":\"arrayTypeDiffers\",\"inventory\":\"b\",\"asIn\":\"a\",\"class\":\"Disk\",\"property\":"
                        "\"Names\",\"declared\":\"Ordered\",\"declaredAsIn\":\"Bag\"}"));
    EXPECT_EQ(std::string::npos, Compare(ordered, Names("Indexed", {"y", "x"})).find("Disk.Names"));
}

TEST_F(SchemaNotesTest, ArraysInAnEmbeddedObjectAreComparedInOrder)
{
    const auto document = [](const std::string& values) {
        return Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration("In", "string")) +
                        Instance("Disk", Value("Id", "1") +
                                             "<PROPERTY NAME=\"In\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>"
                                             "<![CDATA[<INSTANCE CLASSNAME=\"X\"><PROPERTY.ARRAY NAME=\"A\" "
                                             "TYPE=\"string\"><VALUE.ARRAY>" +
                                             values + "</VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>]]></VALUE></PROPERTY>"));
    };
    const std::string forth = document("<VALUE>x</VALUE><VALUE>y</VALUE>");
    Compare(forth, forth);
    EXPECT_EQ(0, fStatus) << fOut;
    Compare(forth, document("<VALUE>y</VALUE><VALUE>x</VALUE>"));
    EXPECT_EQ(1, fStatus) << fOut;
}

TEST_F(SchemaNotesTest, AClassBelowAnotherClassIsNamed)
{
    const auto document = [](const std::string& super) {
        return Document(System() + Class("Element", "", KeyProperty("Id")) + Class("Device", "", KeyProperty("Id")) +
                        Class("Disk", super, super.empty() ? KeyProperty("Id") : "") + Instance("Disk", Value("Id", "1")));
    };
    const std::string coverage = "No differences between a and b.\n"
                                 "\n"
                                 "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
                                 "2 classes have no instances in any inventory.\n";
    EXPECT_EQ(coverage + "Disk is below Element in a and below Device in b; rules are inherited as in a.\n",
              Compare(document("Element"), document("Device")));
    EXPECT_EQ(coverage + "Disk is a top-level class in a and below Device in b; rules are inherited as in a.\n",
              Compare(document(""), document("Device")));
    EXPECT_NE(std::string::npos, Compare(document(""), document("Device"), {"-o", "ndjson"})
                                     .find("{\"kind\":\"superClassDiffers\",\"inventory\":\"b\",\"asIn\":\"a\",\"class\":\"Disk\","
                                           "\"declared\":\"Device\",\"declaredAsIn\":\"\"}"));
}

/// What the reference lacks it has from the first that declares it, against which the others are then held.
TEST_F(SchemaNotesTest, WhatTheReferenceLacksIsHeldAgainstTheFirstThatDeclaresIt)
{
    const auto disk = [](const std::string& super, const std::string& more) {
        return Class("Base", "", KeyProperty("Id")) + Class("Disk", super, (super.empty() ? KeyProperty("Id") : "") + more);
    };
    const std::string declared = Class("Disk", "", KeyProperty("Id"));
    const std::string bag = "<PROPERTY.ARRAY NAME=\"A\" TYPE=\"string\"/>";
    const std::string ordered = "<PROPERTY.ARRAY NAME=\"A\" TYPE=\"string\"><QUALIFIER NAME=\"ArrayType\" TYPE=\"string\">"
                                "<VALUE>Ordered</VALUE></QUALIFIER></PROPERTY.ARRAY>";
    const struct {
        std::string inA, inB, inC;
        std::string expected;
    } rows[] = {
        {declared, disk("", Declaration("Size", "uint32")), disk("", Declaration("Size", "string")),
         "Of another type in c than in b, so equal only if both are NULL: Disk.Size.\n"},
        {"", disk("", Declaration("Size", "uint32")), disk("", Declaration("Size", "string")),
         "Of another type in c than in b, so equal only if both are NULL: Disk.Size.\n"},
        {declared, declared, disk("", Declaration("Size", "string")), ""},
        {declared, disk("", bag), disk("", ordered), "The order of the array Disk.A counts in c and not in b; compared as in b.\n"},
        {"", disk("", ordered), disk("", bag), "The order of the array Disk.A counts in b and not in c; compared as in b.\n"},
        {"", disk("", KeyProperty("Bus")), disk("", Declaration("Bus", "string")),
         "Identified by other keys in c than in b: Disk; instances match only under rules that exclude the keys that one of them "
         "lacks.\n"},
        {"", disk("Base", ""), disk("", ""), "Disk is below Base in b and a top-level class in c; rules are inherited as in b.\n"},
        // The reference's superclass decides.
        {Class("Base", "", KeyProperty("Id") + ordered), Class("Base", "", KeyProperty("Id") + bag) + Class("Disk", "Base", ""),
         Class("Base", "", KeyProperty("Id") + ordered) + Class("Disk", "Base", ""),
         "The order of the array Base.A counts in a and not in b; compared as in a.\n"
         "The order of the array Disk.A counts in a and not in b; compared as in a.\n"},
        // An array that an inventory does not declare itself says nothing of its order.
        {Class("Base", "", KeyProperty("Id") + bag), Class("Base", "", KeyProperty("Id")) + Class("Disk", "Base", ordered),
         Class("Base", "", KeyProperty("Id")) + Class("Disk", "Base", ""), ""},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.expected, Differences(row.inA, row.inB, row.inC));
    }
}

TEST_F(SchemaNotesTest, InstancesMatchUnderRulesThatExcludeTheKeyThatOneInventoryLacks)
{
    const auto disk = [](const std::string& declaration, const std::string& value) {
        return Document(System() + Class("Disk", "", KeyProperty("Id") + declaration) + Instance("Disk", Value("Id", "1") + value));
    };
    const std::string less = disk("", "");
    const std::string more = disk(KeyProperty("Bus"), Value("Bus", "x"));
    EXPECT_EQ("2 differences between a and b: 1 instance only in a, 1 instance only in b\n", Compare(less, more).substr(0, 74));
    const std::string rules =
        Scratch("rules", "<DifftoolSpec><class name='Disk' default='include' excludekeys='Bus'/></DifftoolSpec>");
    EXPECT_NE(std::string::npos, Compare(less, more, {"--spec", rules}).find("\n~ Id=\"1\"\n    Bus: NULL -> x\n")) << fOut;
}

TEST_F(SchemaNotesTest, ATimeOfCollectionIsLeftOutInEveryLetterCase)
{
    const auto collected = [](const std::string& name, const std::string& time) {
        return Document(System() + Class("Disk", "", KeyProperty("Id") + Declaration(name, "string")) +
                        Instance("Disk", Value("Id", "1") + Value(name, time)));
    };
    const std::string coverage = "No differences between a and b, times of collection aside.\n"
                                 "\n"
                                 "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
                                 "Property of Disk not compared, because it is the time of collection: DateTimeOfCollection.\n";
    const std::string inA = "Spelled in a as comparisons require: Disk.DateTimeOfCollection (was datetimeofcollection).\n";
    const std::string inB = "Spelled in b as comparisons require: Disk.DateTimeOfCollection (was DATETIMEOFCOLLECTION).\n";
    EXPECT_EQ(coverage + inA + inB, Compare(collected("datetimeofcollection", "x"), collected("DATETIMEOFCOLLECTION", "y")));
    EXPECT_EQ(coverage + inB, Compare(collected("DateTimeOfCollection", "x"), collected("DATETIMEOFCOLLECTION", "y")));
    EXPECT_NE(std::string::npos,
              Compare(collected("datetimeofcollection", "x"), collected("DateTimeOfCollection", "y"), {"-o", "ndjson"})
                  .find("{\"kind\":\"propertyRespelled\",\"inventory\":\"a\",\"asIn\":\"a\",\"class\":\"Disk\","
                        "\"property\":\"DateTimeOfCollection\",\"before\":\"datetimeofcollection\"}"));
}

TEST_F(SchemaNotesTest, AnOperatingSystemIsMadeAfterTheStandardOneWithTheSmallestPath)
{
    const auto system = [](const std::string& name, const std::string& type) {
        return Instance("Server", Value("Name", name) + Value("OSType", type, "uint16"));
    };
    const std::string declared = Class("CIM_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", "uint16")) +
                                 Class("Server", "CIM_OperatingSystem", "");
    const struct {
        std::string contents;
        std::string expected;
    } rows[] = {
        {declared + system("web", "58"), "web 58"},
        {declared + system("web", "58") + system("db", "36"), "db 36"},
        {declared + Instance("Server", Value("Name", "x")), "x 0"},
        {declared, "unknown 0"},
        {"", "unknown 0"},
    };
    for (const auto& row : rows) {
        TFakeConsole console;
        std::vector<TInventory> inventories = TInventoryLoader(console).Load(SourcesOf({Scratch("a.xml", Document(row.contents))}));
        ASSERT_EQ(1U, MakeMissingOperatingSystems(inventories).size());
        std::string made;
        inventories[0]
            .ns->FindClass("KALMO_OperatingSystem")
            ->EnumerateInstances(
                [&made](const boost::shared_ptr<ICIMInstance>& instance) {
                    made += ValueOf(*instance, "Name").ToText() + " " + ValueOf(*instance, "OSType").ToText();
                    return true;
                },
                false, TCallContext());
        EXPECT_EQ(row.expected, made);
    }
}

TEST_F(SchemaNotesTest, AnOperatingSystemIsMadeWithTheTypesThatAreDeclared)
{
    const struct {
        const char* standard;  // the type of OSType in CIM_OperatingSystem
        const char* value;     // there
        const char* declared;  // the type of OSType in KALMO_OperatingSystem
        const char* made;
    } rows[] = {
        {"uint16", "36", "uint8", "36"},     {"uint16", "36", "sint8", "36"},    {"uint16", "36", "uint16", "36"},
        {"uint16", "36", "sint16", "36"},    {"uint16", "36", "uint32", "36"},   {"uint16", "36", "sint32", "36"},
        {"uint16", "36", "uint64", "36"},    {"uint16", "36", "sint64", "36"},   {"sint64", "36", "uint16", "36"},
        {"uint16", "300", "uint8", "0"},     {"uint32", "65536", "uint32", "0"}, {"sint32", "-1", "sint32", "0"},
        {"string", "36", "uint16", "0"},     {"uint16", "36", "string", "NULL"}, {"uint16", "36", "real32", "NULL"},
        {"uint16", "36", "boolean", "NULL"},
    };
    for (const auto& row : rows) {
        TFakeConsole console;
        std::vector<TInventory> inventories = TInventoryLoader(console).Load(SourcesOf({Scratch(
            "a.xml", Document(Class("CIM_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", row.standard)) +
                              Instance("CIM_OperatingSystem", Value("Name", "x") + Value("OSType", row.value, row.standard)) +
                              Class("KALMO_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", row.declared))))}));
        ASSERT_EQ(1U, MakeMissingOperatingSystems(inventories).size());
        const boost::shared_ptr<TInMemClass> systems = inventories[0].ns->FindClass("KALMO_OperatingSystem");
        const TCIMValue made = ValueOf(*InstancesOf(*systems).at(0), "OSType");
        EXPECT_EQ(row.made, made.ToText()) << row.standard << " " << row.value << " " << row.declared;
        EXPECT_EQ(row.declared, TValueText::DescribeType(made.GetType()));
    }
}

}  // namespace
}  // namespace NORVZEL20
