#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// Inventories without an operating system: the one that is made is never compared, and those of the others are.
class MadeSystemTest : public TPairFixture {
  protected:
    void SetUp() override
    {
        TPairFixture::SetUp();
        fFirst = Scratch("a.xml", Document(Real("old")));
        fSecond = Scratch("b.xml", Document(Real("new")));
        fThird = Scratch("c.xml", Document(Class("Disk", "", KeyProperty("Id"))));
    }

    static std::string Real(const std::string& version)
    {
        return Class("KALMO_OperatingSystem", "",
                     KeyProperty("Name") + Declaration("OSType", "uint16") + Declaration("Version", "string")) +
               Instance("KALMO_OperatingSystem",
                        Value("Name", "host") + Value("OSType", "36", "uint16") + Value("Version", version));
    }

    /// The report on the inventories, named by the last letter of their labels.
    std::string Report(const std::vector<std::string>& inventories, const std::vector<std::string>& options = {})
    {
        std::vector<std::string> arguments{"compare", "--detail", "--allow-empty"};
        arguments.insert(arguments.end(), inventories.begin(), inventories.end());
        arguments.insert(arguments.end(), options.begin(), options.end());
        Run(arguments);
        std::string report = fOut;
        for (const std::string& path : {fFirst, fSecond, fThird}) {
            const std::string label = path.substr(path.rfind('/') + 1);
            report = Shorten(Shorten(report, path, label.substr(label.size() - 5)), label.substr(0, label.size() - 4),
                             label.substr(label.size() - 5, 1));
        }
        return report;
    }

    static std::string FirstLine(const std::string& report) { return report.substr(0, report.find('\n')); }

    /// What a command says about these inventories, in which "R" is the file of Including().
    std::string OfRules(std::vector<std::string> arguments, const std::vector<std::string>& options,
                        const std::vector<std::string>& schemas)
    {
        arguments.insert(arguments.end(), options.begin(), options.end());
        for (const std::string& schema : schemas) {
            arguments.insert(arguments.end(), {"--schema", schema});
        }
        Run(arguments);
        EXPECT_EQ(0, fStatus) << fErr;
        std::string text = Shorten(fOut, Including(), "R");
        for (const std::string name : {"a.xml", "b.xml", "c.xml", "d.xml"}) {
            text = Shorten(text, fFirst.substr(0, fFirst.size() - 5) + name, name);
        }
        return text;
    }

    std::string Including()
    {
        return Scratch("rules", "<DifftoolSpec><class name='KALMO_OperatingSystem' default='include'/></DifftoolSpec>");
    }

    std::string fFirst;
    std::string fSecond;
    std::string fThird;
};

const char kOthersCompared[] = "1 difference between a and b, c: 1 changed value in 1 instance\n"
                               "\n"
                               "KALMO_OperatingSystem\n"
                               "~ Name=\"host\"\n"
                               "    Version: old -> b: new\n"
                               "\n"
                               "Compared: 1 class; 1 instance of a, 1 instance of b, 0 instances of c.\n"
                               "1 class has no instances in any inventory.\n"
                               "KALMO_OperatingSystem not compared in c, because cimdelta made the instance there.\n"
                               "Declared in a as in c: class Disk.\n"
                               "Declared in b as in c: class Disk.\n"
                               "Made in c: an instance of KALMO_OperatingSystem.\n";

TEST_F(MadeSystemTest, OneThatIsMadeHidesNoDifferenceAmongTheOthers)
{
    EXPECT_EQ(kOthersCompared, Report({fFirst, fSecond, fThird}));
}

TEST_F(MadeSystemTest, RulesThatIncludeTheClassChangeNothing)
{
    EXPECT_EQ(kOthersCompared, Report({fFirst, fSecond, fThird}, {"--spec", Including()}));
}

TEST_F(MadeSystemTest, JsonSaysWhereItIsNotCompared)
{
    const std::string report = Report({fFirst, fSecond, fThird}, {"-o", "ndjson"});
    EXPECT_NE(std::string::npos, report.find("{\"class\":\"KALMO_OperatingSystem\",\"state\":\"compared\",\"instances\":[1,1,0],"))
        << report;
    EXPECT_NE(std::string::npos, report.find(",\"madeIn\":[\"c\"]")) << report;
    EXPECT_NE(std::string::npos, report.find("\"everythingCompared\":false")) << report;
}

TEST_F(MadeSystemTest, OnlyInstancesOfTheInventoriesAreCounted)
{
    const std::string fourth = Scratch("d.xml", ReadFile(fThird));
    const struct {
        std::vector<std::string> inventories;
        const char* text;
        const char* json;
    } rows[] = {
        {{fFirst, fThird}, "made the instance of c: KALMO_OperatingSystem (1 / 0).\n", "[1,0]"},
        {{fThird, fFirst, fSecond}, "made the instance of c: KALMO_OperatingSystem (0 / 1 / 1).\n", "[0,1,1]"},
        {{fThird, fourth}, "made it: KALMO_OperatingSystem.\n", "[0,0]"},
    };
    for (const auto& row : rows) {
        const std::string report = Report(row.inventories);
        EXPECT_NE(std::string::npos, report.find("\nNot compared, because cimdelta " + std::string(row.text))) << report;
        const std::string lines = Report(row.inventories, {"-o", "ndjson"});
        EXPECT_NE(std::string::npos, lines.find("{\"class\":\"KALMO_OperatingSystem\",\"state\":\"madeByCimdelta\",\"instances\":" +
                                                std::string(row.json) + ","))
            << lines;
    }
}

TEST_F(MadeSystemTest, NoRecordNamesTheInventory)
{
    const std::string records = Scratch("records.xml", Report({fFirst, fThird, fSecond}, {"-o", "cimxml"}));
    EXPECT_EQ("{\"class\":\"KALMO_Delta\",\"instance\":\"KALMO_Delta.DeltaID=3\",\"properties\":{\"NamespaceIndices\":[2]}}\n",
              Result({"query", "-o", "ndjson", "SELECT NamespaceIndices FROM KALMO_Delta", records}));
}

TEST_F(MadeSystemTest, IfTheReferenceOrAllOthersHaveNoneTheClassIsNotCompared)
{
    const std::string rules = Including();
    const std::vector<std::vector<std::string>> sets{
        {fFirst, fThird}, {fThird, fFirst}, {fThird, fFirst, fSecond}, {fFirst, fThird, Scratch("d.xml", ReadFile(fThird))}};
    for (const std::vector<std::string>& inventories : sets) {
        for (const std::vector<std::string>& options : {std::vector<std::string>(), {"--spec", rules}}) {
            const std::string report = Report(inventories, options);
            EXPECT_EQ("Nothing was compared between", report.substr(0, 28));
            EXPECT_NE(std::string::npos, report.find("\nNot compared, because cimdelta made the instance of ")) << report;
            EXPECT_EQ(std::string::npos, report.find("Version")) << report;
        }
        const std::string records = Scratch("records.xml", Report(inventories, {"--spec", rules, "-o", "cimxml"}));
        for (const std::string record : {"KALMO_Delta", "KALMO_DeltaClass", "KALMO_DeltaClassAssocToDelta"}) {
            EXPECT_EQ("", Result({"query", "-o", "ndjson", "SELECT * FROM " + record, records}));
        }
    }
}

TEST_F(MadeSystemTest, ExplainSaysFirstThatItIsNotCompared)
{
    const std::string name = "KALMO_OperatingSystem.Name";
    const std::vector<std::string> rules{"--spec", Including()};
    for (const std::vector<std::string>& options : {std::vector<std::string>(), rules}) {
        EXPECT_EQ("KALMO_OperatingSystem: not compared, since cimdelta made the instance of c.xml\n"
                  "  Name: not compared, since cimdelta made the instance of c.xml\n"
                  "  OSType: not compared, since cimdelta made the instance of c.xml\n"
                  "  Version: not compared, since cimdelta made the instance of c.xml\n",
                  OfRules({"explain", "KALMO_OperatingSystem"}, options, {fThird, fFirst}));
        EXPECT_EQ(name + ": not compared, since cimdelta made the instance of c.xml\n",
                  OfRules({"explain", name}, options, {fFirst, fThird}));
        EXPECT_EQ(name + ": not compared, since cimdelta made the instances of c.xml, d.xml\n",
                  OfRules({"explain", name}, options, {fThird, fFirst, Scratch("d.xml", ReadFile(fThird))}));
    }
}

TEST_F(MadeSystemTest, ExplainNamesTheInventoriesInWhichItIsNotCompared)
{
    const std::vector<std::string> rules{"--spec", Including()};
    const std::string reason = ", by default, R:1 (element for class KALMO_OperatingSystem)\n";
    EXPECT_EQ("KALMO_OperatingSystem: compared; default include, R:1 (element for class KALMO_OperatingSystem)\n"
              "  not compared in c.xml, since cimdelta made its instance\n"
              "  Name: compared" +
                  reason + "  OSType: compared" + reason + "  Version: compared" + reason,
              OfRules({"explain", "KALMO_OperatingSystem"}, rules, {fFirst, fSecond, fThird}));
    EXPECT_EQ(
        "KALMO_OperatingSystem.Name: compared" + reason + "  not compared in c.xml, d.xml, since cimdelta made their instances\n",
        OfRules({"explain", "KALMO_OperatingSystem.Name"}, rules, {fFirst, fSecond, fThird, Scratch("d.xml", ReadFile(fThird))}));
    EXPECT_EQ(std::string::npos, OfRules({"explain", "KALMO_OperatingSystem"}, rules, {fFirst, fSecond}).find("cimdelta made"));
}

TEST_F(MadeSystemTest, CheckSaysWhatCompareSays)
{
    const auto effective = [this](const std::vector<std::string>& schemas) {
        const std::string listing = OfRules({"check", Including()}, {}, schemas);
        const std::size_t begin = listing.find("  KALMO_OperatingSystem: ");
        return listing.substr(begin, listing.find('\n', begin) - begin);
    };
    EXPECT_EQ("  KALMO_OperatingSystem: not compared, since cimdelta made the instance of c.xml", effective({fThird, fFirst}));
    EXPECT_EQ("  KALMO_OperatingSystem: not compared, since cimdelta made the instance of c.xml", effective({fFirst, fThird}));
    EXPECT_EQ("  KALMO_OperatingSystem: not compared, since cimdelta made the instance of c.xml", effective({fThird}));
    EXPECT_EQ("  KALMO_OperatingSystem: 3 of 3 properties compared; not compared in c.xml, since cimdelta made its instance",
              effective({fFirst, fSecond, fThird}));
    EXPECT_EQ("  KALMO_OperatingSystem: 3 of 3 properties compared", effective({fFirst, fSecond}));
}

TEST_F(MadeSystemTest, OneThatIsMadeForTheReferenceHasTheTypeThatAnotherDeclares)
{
    const auto declaring = [](const std::string& type) {
        return Document(Class("KALMO_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", type)));
    };
    const std::string none = Document(Class("Disk", "", KeyProperty("Id")) + Instance("Disk", Value("Id", "1")));
    EXPECT_EQ("1 difference between a and b: 1 instance only in a", FirstLine(Compare(none, declaring("uint32"))));
    EXPECT_EQ("1 difference between a and b: 1 instance only in b", FirstLine(Compare(declaring("uint32"), none)));
    EXPECT_EQ("1 difference between a and b: 1 instance only in b", FirstLine(Compare(declaring("uint16"), none)));
    EXPECT_NE(std::string::npos,
              Compare(none, declaring("string"))
                  .find("cimdelta: the comparison failed: "
                        "the first KALMO_OperatingSystem of a.xml has no OSType between 0 and 65535; the class declares it as "
                        "string, not as "
                        "an integer\n"));
}

TEST_F(MadeSystemTest, DifferencesOfOtherClassesStay)
{
    const auto disk = [](const std::string& size) {
        return Class("Disk", "", KeyProperty("Id") + Declaration("Size", "string")) +
               Instance("Disk", Value("Id", "1") + Value("Size", size));
    };
    const std::string report = Compare(Document(Real("old") + disk("1")), Document(disk("2")));
    EXPECT_EQ("1 difference between a and b: 1 changed value in 1 instance\n\nDisk\n~ Id=\"1\"\n    Size: 1 -> 2\n",
              report.substr(0, report.find("\nCompared")));
}

}  // namespace
}  // namespace NORVZEL20
