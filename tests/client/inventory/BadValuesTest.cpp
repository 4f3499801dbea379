#include <algorithm>

#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

/// Values that do not fit their types, and what --bad-values makes of them.
class BadValuesTest : public TDocumentsFixture {
  protected:
    static std::string Disks(const std::string& instances)
    {
        return Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint16")) + instances;
    }

    static std::string Disk(const std::string& id, const std::string& size)
    {
        return Instance("Disk", Value("Id", id) + Value("Size", size, "uint16"));
    }

    /// The lines of the report that are about such values, with those of standard error in front.
    std::string Found(const std::vector<std::string>& documents, const std::vector<std::string>& options)
    {
        const std::string report = Compare(documents, options);
        return report.substr(report.find("\nValues of ") + 1);
    }
};

TEST_F(BadValuesTest, TheRefusalNamesTheOption)
{
    const std::string good = Disks(Disk("sda", "1"));
    const std::string bad = Disks(Disk("sda", "70000") + Disk("sdb", "") + Disk("sdc", "3"));
    EXPECT_EQ("cimdelta: b.xml:5:153: found \"70000\" in property \"Size\" of class \"Disk\", expected a uint16 (instance "
              "Disk.Id=\"sda\"); "
              "1 more value does not fit its type; correct them, or have such values loaded as NULL or as text with --bad-values "
              "null or --bad-values text\n",
              Compare({good, bad}));
    EXPECT_EQ(2, fStatus);
}

TEST_F(BadValuesTest, AKeyIsRefusedWithTheOptionThatHelps)
{
    const std::string contents =
        Class("Port", "", Declaration("Number", "uint8", kKey)) + Instance("Port", Value("Number", "300", "uint8"));
    EXPECT_EQ("cimdelta: a.xml:5:89: found \"300\" in key \"Number\" of class \"Port\", expected a uint8; a key cannot be NULL, so "
              "correct "
              "it, or have such values loaded as text with --bad-values text\n",
              Compare({contents, contents}, {"--bad-values", "null"}));
    EXPECT_EQ("cimdelta: a.xml:5:89: found \"300\" in property \"Number\" of class \"Port\", expected a uint8 (instance "
              "Port.Number=\"300\"); correct it, or have such values loaded as text with --bad-values text\n",
              Compare({contents, contents}));
    EXPECT_EQ("No differences in what was compared between a and b; not everything was, see below.",
              Compare({contents, contents}, {"--bad-values", "text"}).substr(0, 83));
    EXPECT_EQ(0, fStatus);
}

TEST_F(BadValuesTest, WithNullTheRestIsCompared)
{
    const std::string a = Disks(Disk("sda", "70000") + Disk("sdb", "1") + Disk("sdc", "80000"));
    const std::string b = Disks(Disk("sda", "5") + Disk("sdb", "2") + Disk("sdc", "x"));
    EXPECT_EQ(
        "2 differences between a and b: 2 changed values in 2 instances\n"
        "\n"
        "Disk\n"
        "~ Id=\"sda\"\n"
        "    Size: NULL -> 5\n"
        "~ Id=\"sdb\"\n"
        "    Size: 1 -> 2\n"
        "\n"
        "Compared: 2 classes; 4 instances of a, 4 instances of b.\n"
        "Values of a that do not fit their types, taken as NULL: Disk.Size (2, the first \"70000\" for a uint16 at a.xml:5).\n"
        "Values of b that do not fit their types, taken as NULL: Disk.Size (1: \"x\" for a uint16 at b.xml:7).\n",
        Compare({a, b}, {"--bad-values", "null"}));
    EXPECT_EQ(1, fStatus);
}

TEST_F(BadValuesTest, WithTextTheyAreCompared)
{
    const std::string a = Disks(Disk("sda", "70000") + Disk("sdb", "70000") + Disk("sdc", "70000"));
    const std::string b = Disks(Disk("sda", "70000") + Disk("sdb", "80000") + Disk("sdc", "7"));
    EXPECT_EQ("Disk\n"
              "~ Id=\"sdb\"\n"
              "    Size: 70000 -> 80000\n"
              "~ Id=\"sdc\"\n"
              "    Size: string 70000 -> uint16 7\n",
              [&] {
                  const std::string report = Compare({a, b}, {"--bad-values", "text"});
                  return report.substr(report.find("Disk\n"), report.find("\n\nCompared") + 1 - report.find("Disk\n"));
              }());
    EXPECT_EQ(
        "Values of a that do not fit their types, compared as text: Disk.Size (3, the first \"70000\" for a uint16 at a.xml:5).\n"
        "Values of b that do not fit their types, compared as text: Disk.Size (2, the first \"70000\" for a uint16 at b.xml:5).\n",
        Found({a, b}, {"--bad-values", "text"}));
}

TEST_F(BadValuesTest, ThreeInventoriesAreComparedAsTwo)
{
    const auto disk = [](const std::string& size) { return Disks(Disk("sda", size)); };
    const std::string report = Compare({disk("70000"), disk("7"), disk("70000")}, {"--bad-values", "text"});
    EXPECT_NE(std::string::npos, report.find("    Size: string 70000 -> b: uint16 7\n")) << report;
}

/// The agreement of what could not be compared as what it is is no agreement of everything.
TEST_F(BadValuesTest, NoDifferencesIsNotSaidOfThem)
{
    const std::string disks = Disks(Disk("sda", "70000"));
    for (const std::string choice : {"null", "text"}) {
        const std::string report = Compare({disks, disks}, {"--bad-values", choice});
        EXPECT_EQ("No differences in what was compared between a and b; not everything was, see below.\n", report.substr(0, 84));
        EXPECT_EQ(0, fStatus);
        const std::string json = Compare({disks, disks}, {"--bad-values", choice, "-o", "ndjson"});
        EXPECT_NE(std::string::npos, json.find("\"everythingCompared\":false")) << json;
        EXPECT_NE(
            std::string::npos,
            json.find(
                "{\"inventory\":\"a\",\"class\":\"Disk\",\"property\":\"Size\",\"values\":1,\"takenAs\":\"" + choice +
                "\",\"first\":{\"text\":\"70000\",\"type\":\"uint16\",\"instance\":\"Disk.Id=\\\"sda\\\"\",\"file\":\"a.xml\","
                "\"line\":5,\"column\":153}}"))
            << json;
    }
}

/// Such a text is in the place of a path, by which the plug-in compares references.
TEST_F(BadValuesTest, AReferenceThatIsNoneIsComparedAsText)
{
    const auto on = [](const std::string& property) {
        return Class("Part", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"On\"/>") +
               Instance("Part", Value("Id", "1") + property);
    };
    const std::string bad = on(Value("On", "nowhere: =\""));
    const std::string other = on(Value("On", "somewhere: =\""));
    const std::string good = on("<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path("Disk", "Id", "1") +
                                "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    const auto change = [&](const std::string& a, const std::string& b) {
        const std::string report = Compare({a, b}, {"--bad-values", "text"});
        const std::size_t begin = report.find("    On: ");
        return begin == std::string::npos ? report.substr(0, report.find('\n'))
                                          : report.substr(begin, report.find('\n', begin) - begin);
    };
    EXPECT_EQ("No differences in what was compared between a and b; not everything was, see below.", change(bad, bad));
    EXPECT_EQ("    On: \"nowhere: =\\\"\" -> \"somewhere: =\\\"\"", change(bad, other));
    EXPECT_EQ("    On: string \"nowhere: =\\\"\" -> reference Disk.Id=\"1\"", change(bad, good));
    EXPECT_EQ("    On: reference Disk.Id=\"1\" -> string \"nowhere: =\\\"\"", change(good, bad));
}

/// Bags of texts stay bags.
TEST_F(BadValuesTest, ArraysWithOneAreComparedAsTheirDeclarationSays)
{
    const auto list = [](const std::string& qualifiers, const std::string& first, const std::string& second) {
        return Class("Disk", "",
                     KeyProperty("Id") + "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"uint8\">" + qualifiers + "</PROPERTY.ARRAY>") +
               Instance("Disk", Value("Id", "1") + "<PROPERTY.ARRAY NAME=\"L\" TYPE=\"uint8\"><VALUE.ARRAY><VALUE>" + first +
                                    "</VALUE><VALUE>" + second + "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>");
    };
    const std::string ordered = "<QUALIFIER NAME=\"ArrayType\" TYPE=\"string\"><VALUE>Ordered</VALUE></QUALIFIER>";
    Compare({list("", "1", "300"), list("", "300", "0x1")}, {"--bad-values", "text"});
    EXPECT_EQ(0, fStatus);
    const std::string report = Compare({list(ordered, "1", "300"), list(ordered, "300", "1")}, {"--bad-values", "text"});
    EXPECT_NE(std::string::npos, report.find("    L: {\"1\", \"300\"} -> {\"300\", \"1\"}\n")) << report;
}

TEST_F(BadValuesTest, AllCommandsTakeTheChoice)
{
    const std::string file = Scratch("a.xml", Document(System() + Disks(Disk("sda", "70000") + Disk("sdb", "8"))));
    const std::string rules = Scratch("rules.xml", "<DifftoolSpec default=\"include\"><Disk/></DifftoolSpec>");
    const auto run = [&](const std::vector<std::string>& arguments) {
        Run(arguments);
        return std::to_string(fStatus) + " " + Shorten(fErr, file, "a.xml");
    };
    const std::string warning = "cimdelta: a.xml:5:153: warning: \"70000\" in Disk.Size is no uint16; ";
    EXPECT_EQ("0 " + warning + "taken as NULL\n", run({"show", file, "Disk", "--bad-values", "null"}));
    EXPECT_EQ("0 " + warning + "kept as text\n", run({"query", "SELECT Size FROM Disk WHERE Size > 5", file, "--bad-values=text"}));
    EXPECT_EQ("Disk.Id=\"sdb\"\n    Size: 8\n", fOut);
    EXPECT_EQ("0 " + warning + "taken as NULL\n", run({"explain", "Disk.Size", "--schema", file, "--bad-values", "null"}));
    EXPECT_EQ("2 cimdelta: --bad-values maybe is no choice; name one: refuse, null or text; see cimdelta show --help\n",
              run({"show", file, "--bad-values", "maybe"}));
}

/// A wrong declaration makes many such values, and there may be many of these.
TEST_F(BadValuesTest, OnlyTenPropertiesHaveAWarning)
{
    std::string declarations;
    std::string values;
    for (int i = 0; i < 12; ++i) {
        declarations += Declaration("P" + std::to_string(i), "uint8");
        values += Value("P" + std::to_string(i), "x", "uint8");
    }
    const std::string file = Scratch(
        "a.xml", Document(Class("Disk", "", KeyProperty("Id") + declarations) + Instance("Disk", Value("Id", "1") + values)));
    Run({"show", file, "--bad-values", "null"});
    EXPECT_EQ(11, std::count(fErr.begin(), fErr.end(), '\n'));
    EXPECT_NE(std::string::npos, fErr.find(": warning: values of 2 more properties do not fit their types\n")) << fErr;
}

}  // namespace
}  // namespace NORVZEL20
