#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// A property that is a reference in one inventory and something else in another: a difference of type like any other.
class ReferenceTypeTest : public TPairFixture {
  protected:
    static std::string Parts(const std::string& declaration, const std::string& value)
    {
        return Document(System() + Class("Part", "", KeyProperty("Id") + declaration) + Instance("Part", Value("Id", "1") + value));
    }

    static std::string Pointing(const std::string& disk)
    {
        return "<PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE>" + Path("Disk", "Id", disk) +
               "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
    }

    static std::string Referring(const std::string& disk)
    {
        return Parts("<PROPERTY.REFERENCE NAME=\"On\"/>", disk.empty() ? disk : Pointing(disk));
    }

    static std::string Writing(const std::string& disk)
    {
        return Parts(Declaration("On", "string"), disk.empty() ? disk : Value("On", "Disk.Id=\"" + disk + "\""));
    }

    static std::string Report(const std::string& change)
    {
        return "1 difference between a and b: 1 changed value in 1 instance\n\nPart\n~ Id=\"1\"\n    On: " + change + "\n" +
               kCoverage;
    }

    static constexpr char kCoverage[] = "\n"
                                        "Compared: 2 classes; 2 instances of a, 2 instances of b.\n"
                                        "Of another type in b than in a, so equal only if both are NULL: Part.On.\n";
};

constexpr char ReferenceTypeTest::kCoverage[];

TEST_F(ReferenceTypeTest, TheValuesAreShownWithTheirTypes)
{
    EXPECT_EQ(Report("reference Disk.Id=\"sda\" -> string \"Disk.Id=\\\"sda\\\"\""), Compare(Referring("sda"), Writing("sda")));
    EXPECT_EQ(Report("string \"Disk.Id=\\\"sda\\\"\" -> reference Disk.Id=\"sda\""), Compare(Writing("sda"), Referring("sda")));
}

TEST_F(ReferenceTypeTest, TheOtherTypeMayBeAnyType)
{
    const std::string array = "<PROPERTY.REFARRAY NAME=\"On\"><VALUE.REFARRAY><VALUE.REFERENCE>" + Path("Disk", "Id", "sda") +
                              "</VALUE.REFERENCE></VALUE.REFARRAY></PROPERTY.REFARRAY>";
    EXPECT_EQ(Report("reference Disk.Id=\"sda\" -> reference[] {Disk.Id=\"sda\"}"),
              Compare(Referring("sda"), Parts("<PROPERTY.REFARRAY NAME=\"On\"/>", array)));
    EXPECT_EQ(Report("reference Disk.Id=\"sda\" -> uint32 5"),
              Compare(Referring("sda"), Parts(Declaration("On", "uint32"), Value("On", "5", "uint32"))));
}

TEST_F(ReferenceTypeTest, OnlyNullsAreEqual)
{
    EXPECT_EQ(std::string("No differences between a and b.\n") + kCoverage, Compare(Referring(""), Writing("")));
    EXPECT_EQ(Report("reference Disk.Id=\"sda\" -> string NULL"), Compare(Referring("sda"), Writing("")));
    EXPECT_EQ(Report("reference NULL -> string \"Disk.Id=\\\"sda\\\"\""), Compare(Referring(""), Writing("sda")));
}

TEST_F(ReferenceTypeTest, AThirdInventoryIsComparedAsEver)
{
    const std::string first = Scratch("a.xml", Referring("sda"));
    const std::string second = Scratch("b.xml", Writing("sda"));
    const std::string third = Scratch("c.xml", Referring("sdb"));
    for (const std::vector<std::string>& others : {std::vector<std::string>{second, third}, {third, second}}) {
        const std::string report = Result({"compare", "--detail", "-o", "ndjson", first, others[0], others[1]});
        EXPECT_NE(std::string::npos, report.find("\"type\":\"string\",\"value\":\"Disk.Id=\\\"sda\\\"\"}")) << report;
        EXPECT_NE(std::string::npos, report.find("\"type\":\"reference\",\"value\":\"Disk.Id=\\\"sdb\\\"\"}")) << report;
    }
    const std::string report = Named(Result({"compare", "--detail", first, second, third}), first, second);
    EXPECT_NE(std::string::npos, report.find("\n    On: reference Disk.Id=\"sda\" -> b: string \"Disk.Id=\\\"sda\\\"\" / "))
        << report;
    EXPECT_NE(std::string::npos, report.find(": reference Disk.Id=\"sdb\"\n")) << report;
}

TEST_F(ReferenceTypeTest, AStaticValueIsShownToo)
{
    const std::string isStatic = Qualifier("Static");
    EXPECT_EQ(Report("reference Disk.Id=\"sda\" -> string \"Disk.Id=\\\"sda\\\"\""),
              Compare(Parts("<PROPERTY.REFERENCE NAME=\"On\">" + isStatic + "</PROPERTY.REFERENCE>", Pointing("sda")),
                      Parts(Declaration("On", "string", isStatic), Value("On", "Disk.Id=\"sda\""))));
}

TEST_F(ReferenceTypeTest, InstancesWithSuchAKeyDoNotMatch)
{
    const std::string referring = Document(
        System() +
        Class("Part", "", "<PROPERTY.REFERENCE NAME=\"On\">" + kKey + "</PROPERTY.REFERENCE>" + Declaration("V", "string")) +
        Instance("Part", Pointing("sda")));
    const std::string writing = Document(System() + Class("Part", "", KeyProperty("On") + Declaration("V", "string")) +
                                         Instance("Part", Value("On", "Disk.Id=\"sda\"")));
    EXPECT_EQ("2 differences between a and b: 1 instance only in a, 1 instance only in b\n"
              "\n"
              "Part\n"
              "+ On=\"(string) Disk.Id=\\\"sda\\\"\"\n"
              "- On=\"Disk.Id=\\\"sda\\\"\"\n" +
                  std::string(kCoverage),
              Compare(referring, writing));
    EXPECT_NE(std::string::npos, Compare(referring, writing, {"-o", "ndjson"}).find("\"keys\":{\"On\":\"Disk.Id=\\\"sda\\\"\"}"));
}

}  // namespace
}  // namespace NORVZEL20
