#include "client/comparison/TComparison.h"
#include "client/inventory/TInventoryLoader.h"
#include "client/process/TClientError.h"
#include "embedded/store/TInMemInstance.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TFakeConsole.h"
#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// `--strict-schema`: a run over inventories that do not fit names the place at which it failed.
class StrictSchemaTest : public TPairFixture {
  protected:
    static std::string Disks(const std::string& declarations, const std::string& instances, const std::string& name = "Disk")
    {
        return Document(System() + Class(name, "", declarations) + instances);
    }

    static std::string Disk(const std::string& properties, const std::string& name = "Disk") { return Instance(name, properties); }
};

const char kAdvice[] = "; without --strict-schema, cimdelta declares and makes what is missing\n";
const char kTypesAdvice[] = "; without --strict-schema, the values are reported as different\n";
const char kKeysAdvice[] = "; without --strict-schema, the instances are reported as different ones\n";
const char kSpellingAdvice[] = "; without --strict-schema, names get the spelling of a.xml\n";

TEST_F(StrictSchemaTest, TheMessageNamesThePlace)
{
    const std::string id = KeyProperty("Id");
    const std::string one = Disks(id, Disk(Value("Id", "1")));
    const std::string sized = Disks(id + Declaration("Size", "uint32"), Disk(Value("Id", "1") + Value("Size", "5", "uint32")));
    const struct {
        std::string a;
        std::string b;
        std::string message;
        std::string advice;
    } rows[] = {
        {one, Disks(id + KeyProperty("Bus"), Disk(Value("Id", "1") + Value("Bus", "x"))),
         "a.xml does not declare property Bus of class Disk, which instance Disk.Bus=\"x\",Id=\"1\" of b.xml has", kAdvice},
        {Disks(id + KeyProperty("Bus"), Disk(Value("Id", "1") + Value("Bus", "x"))), one,
         "instance Disk.Id=\"1\" of b.xml cannot be added to a.xml: the keys of class Disk are Id, Bus in a.xml and Id in b.xml",
         kKeysAdvice},
        {one, Disks(KeyProperty("ID"), Disk(Value("ID", "1"))),
         "instance Disk.ID=\"1\" of b.xml cannot be added to a.xml: the keys of class Disk are Id in a.xml and ID in b.xml",
         kSpellingAdvice},
        {one, Disks(id, Disk(Value("Id", "1"), "disk"), "disk"),
         "instance disk.Id=\"1\" of b.xml cannot be added to a.xml: class Disk is spelled disk in b.xml", kSpellingAdvice},
        {one, Disks(id + Declaration("Size", "uint32"), Disk(Value("Id", "2") + Value("Size", "5", "uint32"))),
         "a.xml does not declare property Size of class Disk, which instance Disk.Id=\"2\" of b.xml has", kAdvice},
        {sized, one, "b.xml does not declare property Size of class Disk", kAdvice},
        {sized, Disks(id + Declaration("Size", "string"), Disk(Value("Id", "1") + Value("Size", "5"))),
         "property Size of class Disk is uint32 in a.xml and string in b.xml", kTypesAdvice},
        {sized, Disks(id + Declaration("Size", "string"), Disk(Value("Id", "2") + Value("Size", "5"))),
         "property Size of class Disk is uint32 in a.xml and string in b.xml",
         "; without --strict-schema, instances of both types are compared\n"},
    };
    for (const auto& row : rows) {
        const std::string message = Compare(row.a, row.b, {"--strict-schema"});
        EXPECT_EQ("cimdelta: the comparison failed: " + row.message + row.advice, message);
        // The advice holds: without the option, the run succeeds.
        EXPECT_EQ(std::string::npos, Compare(row.a, row.b).find("cimdelta: ")) << row.message;
    }
}

/// The first class differs in type too, but no value of it ends the run.
TEST_F(StrictSchemaTest, AnInnocentPropertyIsNotNamed)
{
    const auto document = [](const std::string& type, const std::string& fan, const std::string& disk) {
        const std::string declared = KeyProperty("Id") + Declaration("Size", type) + Declaration("Speed", type);
        return Document(System() + Class("Disk", "", declared) + Class("Fan", "", declared) +
                        Instance("Disk", Value("Id", "1") + disk) + Instance("Fan", Value("Id", "1") + fan));
    };
    const std::string message = Compare(document("uint32", "", Value("Size", "5", "uint32")),
                                        document("string", Value("Speed", "5"), ""), {"--strict-schema"});
    EXPECT_EQ("cimdelta: the comparison failed: property Speed of class Fan is uint32 in a.xml and string in b.xml" +
                  std::string(kTypesAdvice),
              message);
}

/// If a static value differs, the run leaves the reference as it is. What it could not take over is then no cause.
TEST_F(StrictSchemaTest, AnInnocentPropertyIsNotNamedIfAStaticValueDiffers)
{
    const auto document = [](const std::string& shared, const std::string& disks, const std::string& part) {
        return Document(System() + Class("Host", "", KeyProperty("Id") + Declaration("Site", "string", Qualifier("Static"))) +
                        Instance("Host", Value("Id", "1") + Value("Site", shared)) + disks + part);
    };
    const auto disks = [](const std::string& declared, const std::string& values) {
        return Class("Disk", "", KeyProperty("Id") + declared) + Instance("Disk", Value("Id", "1") + values);
    };
    const std::string on =
        "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path("Disk", "Id", "1") + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
    const std::string reference =
        Class("Part", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"On\"/>") + Instance("Part", Value("Id", "1") + on);
    const std::string text =
        Class("Part", "", KeyProperty("Id") + Declaration("On", "string")) + Instance("Part", Value("Id", "1") + Value("On", "x"));
    const std::string number = disks(Declaration("Size", "uint32"), Value("Size", "5", "uint32"));
    const struct {
        std::string a;
        std::string b;
    } rows[] = {
        {number, disks(Declaration("Size", "string"), Value("Size", "5"))},
        {disks("", ""), disks(Declaration("Size", "string"), "") + Instance("Disk", Value("Id", "9") + Value("Size", "5"))},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("cimdelta: the comparison failed: property On of class Part is reference in a.xml and string in b.xml" +
                      std::string(kTypesAdvice),
                  Compare(document("one", row.a, reference), document("two", row.b, text), {"--strict-schema"}));
        Compare(document("one", row.a, ""), document("two", row.b, ""), {"--strict-schema"});
        EXPECT_EQ(1, fStatus) << fErr;
    }
}

/// The disks that only b has are in the reference when a later class fails.
TEST_F(StrictSchemaTest, AnInstanceThatWasAddedIsNotNamed)
{
    const auto document = [](const std::string& disk, const std::string& more) {
        return Document(System() + Class("Disk", "", KeyProperty("Id")) + Class("Fan", "", KeyProperty("Id") + more) + disk +
                        Instance("Fan", Value("Id", "1")));
    };
    EXPECT_EQ("cimdelta: the comparison failed: b.xml does not declare property Speed of class Fan" + std::string(kAdvice),
              Compare(document("", Declaration("Speed", "string")), document(Disk(Value("Id", "9")), ""), {"--strict-schema"}));
}

TEST_F(StrictSchemaTest, OfThreeInventoriesOnlyAReferenceNeedsItsType)
{
    const auto parts = [](const std::string& declaration, const std::string& value) {
        return Document(System() + Class("Part", "", KeyProperty("Id") + declaration) + Instance("Part", Value("Id", "1") + value));
    };
    const std::string a = Scratch("a.xml", parts("<PROPERTY.REFERENCE NAME=\"On\"/>",
                                                 "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path("Disk", "Id", "1") +
                                                     "</VALUE.REFERENCE></PROPERTY.REFERENCE>"));
    const std::string b = Scratch("b.xml", parts(Declaration("On", "string"), Value("On", "x")));
    EXPECT_EQ("cimdelta: the comparison failed: property On of class Part is reference in a.xml and string in b.xml" +
                  std::string(kTypesAdvice),
              Named(Complaint({"compare", "--detail", "--strict-schema", a, Scratch("c.xml", ReadFile(a)), b}), a, b));
}

/// No inventory in a file nests references so deep; the key is put there by hand.
TEST_F(StrictSchemaTest, AKeyThatHasNoPathIsNamed)
{
    const std::string a = Scratch(
        "a.xml", Document(System() + Class("Part", "", "<PROPERTY.REFERENCE NAME=\"On\">" + kKey + "</PROPERTY.REFERENCE>")));
    TFakeConsole console;
    std::vector<TInventory> inventories = TInventoryLoader(console).Load(SourcesOf({a, a}));
    TCIMReference path;
    path.SetClassName("Part");
    for (int level = 0; level < 12; ++level) {
        TCIMReference outer;
        outer.SetClassName("Part");
        outer.AddKeyValue("On", TCIMValue(path));
        path = outer;
    }
    const boost::shared_ptr<TInMemInstance> part = inventories[1].ns->FindClass("Part")->AllocateInMemInstance();
    part->SetSlot(0, TCIMValue(path));
    part->AddToNamespace(TCallContext());
    try {
        TComparison(inventories, console).Run(std::nullopt, true);
        FAIL() << "the run did not end";
    } catch (const TClientError& error) {
        EXPECT_EQ("the comparison failed: the keys On of an instance of class Part of a.xml cannot be written as a "
                  "path: Invalid parameter",
                  Shorten(error.what(), a, "a.xml"));
    }
}

TEST_F(StrictSchemaTest, TheAdviceIsOnlyGivenIfItHelps)
{
    const auto typed = [](const std::string& type) {
        return Document(Class("KALMO_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", type)) +
                        Instance("KALMO_OperatingSystem", Value("Name", "a")));
    };
    EXPECT_EQ("cimdelta: the comparison failed: the first "
              "KALMO_OperatingSystem of a.xml has no OSType between 0 and 65535\n",
              Compare(typed("uint16"), typed("uint16"), {"--strict-schema"}));
}

TEST_F(StrictSchemaTest, EachInstanceHasTheKeysOfItsOwnClass)
{
    const std::string a = Scratch("a.xml", Disks(KeyProperty("Id"), Disk(Value("Id", "1"))));
    const std::string b =
        Scratch("b.xml", Disks(KeyProperty("Id") + KeyProperty("Bus"), Disk(Value("Id", "1") + Value("Bus", "x"))));
    const std::string c = Scratch("c.xml", ReadFile(a));
    const std::string report = Named(Result({"compare", "--detail", "--strict-schema", "-o", "ndjson", a, b, c}), a, b);
    EXPECT_NE(std::string::npos,
              report.find("\"instance\":\"Disk.Bus=\\\"x\\\",Id=\\\"1\\\"\",\"keys\":{\"Id\":\"1\",\"Bus\":\"x\"}"))
        << report;
    EXPECT_NE(std::string::npos, report.find("\"instance\":\"Disk.Id=\\\"1\\\"\",\"keys\":{\"Id\":\"1\"}")) << report;
    EXPECT_NE(std::string::npos, report.find("{\"kind\":\"keysDiffer\",\"inventory\":\"b\",")) << report;
}

TEST_F(StrictSchemaTest, AClassThatTheReferenceDoesNotDeclareIsReported)
{
    const std::string report = Compare(Document(System()), Disks(KeyProperty("Id"), Disk(Value("Id", "1"))), {"--strict-schema"});
    EXPECT_NE(std::string::npos, report.find("\nNot compared, because a does not declare the class: Disk (0 / 1).\n")) << report;
}

TEST_F(StrictSchemaTest, NamesThatDifferInLetterCaseAreReported)
{
    const std::string a = Scratch("a.xml", Disks(KeyProperty("Id"), Disk(Value("Id", "1"))));
    const std::string b = Scratch("b.xml", Disks(KeyProperty("ID"), Disk(Value("ID", "1"), "disk"), "disk"));
    const std::string c = Scratch("c.xml", ReadFile(a));
    const std::string report = Named(Result({"compare", "--detail", "--strict-schema", a, b, c}), a, b);
    EXPECT_NE(
        std::string::npos,
        report.find(
            "\nDisk is spelled disk in b, so instances do not match.\nDisk.Id is spelled ID in b, so instances do not match.\n"))
        << report;
    EXPECT_NE(std::string::npos,
              Result({"compare", "--detail", "--strict-schema", "-o", "ndjson", a, b, c}).find("\"kind\":\"spellingDiffers\""));
}

/// A run over two inventories adds what the other one has to the reference, which takes names in any letter case for the same.
TEST_F(StrictSchemaTest, OfTwoInventoriesNamesInAnotherLetterCaseFailOverTheSameInstance)
{
    const std::string a = Disks(KeyProperty("Id"), Disk(Value("Id", "1")));
    const struct {
        const char* what;
        std::string same;
        std::string different;
    } rows[] = {
        {"class", Disks(KeyProperty("Id"), Disk(Value("Id", "1"), "disk"), "disk"),
         Disks(KeyProperty("Id"), Disk(Value("Id", "2"), "disk"), "disk")},
        {"key", Disks(KeyProperty("ID"), Disk(Value("ID", "1"))), Disks(KeyProperty("ID"), Disk(Value("ID", "2")))},
    };
    for (const auto& row : rows) {
        const std::string message = Compare(a, row.same, {"--strict-schema"});
        EXPECT_EQ(2, fStatus) << row.what;
        EXPECT_NE(std::string::npos, message.find("=\"1\" of b.xml cannot be added to a.xml: ")) << message;
        const std::string report = Compare(a, row.different, {"--strict-schema"});
        EXPECT_EQ("2 differences between a and b: 1 instance only in a, 1 instance only in b\n",
                  report.substr(0, report.find('\n') + 1))
            << row.what;
        EXPECT_NE(std::string::npos, report.find(" in b, so instances do not match.\n")) << report;
    }
}

TEST_F(StrictSchemaTest, ATimeOfCollectionInAnotherLetterCaseIsCompared)
{
    const auto collected = [](const std::string& time) {
        return Disks(KeyProperty("Id") + Declaration("datetimeofcollection", "string"),
                     Disk(Value("Id", "1") + Value("datetimeofcollection", time)));
    };
    EXPECT_NE(std::string::npos,
              Compare(collected("x"), collected("y"), {"--strict-schema"}).find("    datetimeofcollection: x -> y\n"));
}

}  // namespace
}  // namespace NORVZEL20
