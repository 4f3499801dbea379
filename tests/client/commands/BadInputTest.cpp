#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Input that cannot be used: one message that names the place and what to do, exit status 2 and no result.
class BadInputTest : public TClientFixture {
  protected:
    struct TRow {
        std::string rules;
        std::string message;
    };

    /// Expects each of these rules to be refused by compare and by check, with its message, in which R stands for the file.
    void ExpectRefusals(const std::vector<TRow>& rows)
    {
        for (const TRow& row : rows) {
            SCOPED_TRACE(row.rules);
            const std::string rules = Scratch("rules", row.rules);
            const std::string expected = "cimdelta: " + row.message + "\n";
            EXPECT_EQ(expected, Shorten(Complaint({"compare", "--spec", rules, "web01.xml", "web02.xml"}), rules, "R"));
            EXPECT_EQ(expected, Shorten(Complaint({"check", rules, "--schema", "web01.xml"}), rules, "R"));
        }
    }
};

TEST_F(BadInputTest, RulesOfAnotherFormAreRefused)
{
    ExpectRefusals({
        {"<difftoolspec/>",
         "R:1: element difftoolspec is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value"},
        {"<DifftoolSpec version='1.1'/>", "R:1: version \"1.1\" of DifftoolSpec is unknown; use \"1.0\""},
        {"<DifftoolSpec foo='1.0'/>",
         "R:1: element DifftoolSpec has an unknown attribute foo; its only attribute is version, at most \"1.0\""},
        {"<DifftoolSpec>\n<clas name='INV_Disk'/></DifftoolSpec>",
         "R:2: element clas is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value"},
        {"<DifftoolSpec><class name='INV_Disk' default='Include'/></DifftoolSpec>",
         "R:1: default \"Include\" is neither \"include\" nor \"exclude\"; letter case counts"},
        {"<DifftoolSpec><class name='INV_Disk' deflt='include'/></DifftoolSpec>",
         "R:1: element class has an unknown attribute deflt; its attributes are name, default and excludekeys"},
        {"<DifftoolSpec><class name='INV_Disk'><list/></class></DifftoolSpec>",
         "R:1: element list is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value"},
    });
}

TEST_F(BadInputTest, NamesInRulesThatTheReferenceLacksAreRefused)
{
    ExpectRefusals({
        {"<DifftoolSpec>\n\n<class default='include'/></DifftoolSpec>",
         "R:3: element class has no name; give it the name of a class of the reference"},
        {"<DifftoolSpec>\n<class name=''/></DifftoolSpec>",
         "R:2: element class has no name; give it the name of a class of the reference"},
        {"<DifftoolSpec>\n<class name='INV_Dsk'/></DifftoolSpec>",
         "R:2: class INV_Dsk is not declared in the reference; correct the name or remove the element"},
        {"<DifftoolSpec>\n<class name='INV_Disk'>\n<includelist>\n<value>Sise</value>\n</includelist></class></DifftoolSpec>",
         "R:4: class INV_Disk has no property \"Sise\"; the name counts as it stands between the tags, blanks included"},
        {"<DifftoolSpec><class name='INV_Disk'><includelist><value> Model </value></includelist></class></DifftoolSpec>",
         "R:1: class INV_Disk has no property \" Model \"; the name counts as it stands between the tags, blanks included"},
        {"<DifftoolSpec><class name=' INV_Disk'/></DifftoolSpec>",
         "R:1: class \" INV_Disk\" is not declared in the reference; correct the name or remove the element"},
        {"<DifftoolSpec><class name='%t %c'/></DifftoolSpec>",
         "R:1: class \"%t %c\" is not declared in the reference; correct the name or remove the element"},
        {"<DifftoolSpec><class name='INV_Disk'><includelist><value/></includelist></class></DifftoolSpec>",
         "R:1: class INV_Disk has no property \"\"; the name counts as it stands between the tags, blanks included"},
        {"<DifftoolSpec><class name='&lt;root&gt;'><includelist><value>Name</value></includelist></class></DifftoolSpec>",
         "R:1: class <root> has no property \"Name\"; the name counts as it stands between the tags, blanks included"},
    });
}

TEST_F(BadInputTest, FilesThatAreNoRulesAreRefused)
{
    ExpectRefusals({
        {"<DifftoolSpec>\n<class name='INV_Disk'>\n</DifftoolSpec>", "R:3: mismatched tag; correct the file"},
        {"<DifftoolSpec>", "R:1: no element found; correct the file"},
        {"", "R: the file is empty; rules are an element DifftoolSpec with elements class in it"},
        {" \n\n", "R: the file is empty; rules are an element DifftoolSpec with elements class in it"},
        {"<DifftoolSpec>\n&<DifftoolSpec>", "R:2: not well-formed (invalid token); correct the file"},
        {"\x1f\x8b\x08", "R: this file is compressed with gzip; rules are read as plain text only, so decompress it first"},
        {"\x28\xb5\x2f\xfd", "R: this file is compressed with zstd; rules are read as plain text only, so decompress it first"},
        {"rules", "R:1: syntax error; correct the file"},
    });
}

/// An earlier mistake of another kind on the same line, or an encoding that has every byte, is none of the encoding.
TEST_F(BadInputTest, OnlyTextThatCannotBeDecodedIsToBeSavedAsUtf8)
{
    ExpectRefusals({
        {"<DifftoolSpec>\n<!-- f\xFCr -->\n</DifftoolSpec>",
         "R:2: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<?xml version='1.0' encoding='KOI8-R'?>\n<DifftoolSpec/>",
         "R:1: the text cannot be decoded (unknown encoding); save the file as UTF-8"},
        {"<?xml version='1.0' encoding='UTF-16'?>\n<DifftoolSpec/>",
         "R:1: the text cannot be decoded (encoding specified in XML declaration is incorrect); save the file as UTF-8"},
        {"<?xml version='1.0' encoding='Utf-8'?><DifftoolSpec>\xFC</DifftoolSpec>",
         "R:1: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<DifftoolSpec>\n<!-- \xE0\x80\xAF -->\n</DifftoolSpec>",
         "R:2: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<DifftoolSpec>\n\n<!-- \xED\xA0\x80 -->\n</DifftoolSpec>",
         "R:3: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<DifftoolSpec>\n<!-- gr\xC3\xBC\xC3\x9F \xFC --> & </DifftoolSpec>",
         "R:2: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<DifftoolSpec/>\n\xC3", "R:2: the text cannot be decoded (partial character); save the file as UTF-8"},
        {"<?xml version='1.0' encoding='ISO-8859-1'?><DifftoolSpec>\xFC & </DifftoolSpec>",
         "R:1: not well-formed (invalid token); correct the file"},
        {"<DifftoolSpec>\n&<x/>\n<!-- f\xFCr -->\n</DifftoolSpec>", "R:2: not well-formed (invalid token); correct the file"},
        {"<DifftoolSpec>\n& <!-- f\xFCr -->\n</DifftoolSpec>", "R:2: not well-formed (invalid token); correct the file"},
        {"<DifftoolSpec>\n<!-- f\xFCr --></class>\n</DifftoolSpec>",
         "R:2: the text cannot be decoded (not well-formed (invalid token)); save the file as UTF-8"},
        {"<?xml version='1.0' encoding='iso-8859-1'?><DifftoolSpec>&\xA0</DifftoolSpec>",
         "R:1: not well-formed (invalid token); correct the file"},
        {std::string("<DifftoolSpec>\0</DifftoolSpec>", 30), "R:1: not well-formed (invalid token); correct the file"},
        {std::string("<\0\xA0\0", 4), "R:1: not well-formed (invalid token); correct the file"},
        {std::string("\xFF\xFE<\0&\0", 6), "R:1: not well-formed (invalid token); correct the file"},
        {"<DifftoolSpec>\xEF\xBF\xBF</DifftoolSpec>", "R:1: not well-formed (invalid token); correct the file"},
    });
}

TEST_F(BadInputTest, LongTextFromRulesIsShortened)
{
    const std::string text(100, 'x');
    const std::string shown = std::string(80, 'x') + "...";
    const struct {
        std::string rules;
        std::string message;
    } rows[] = {
        {"<" + text + "/>", "element " + shown + " is not"},
        {"<DifftoolSpec version='" + text + "'/>", "version \"" + shown + "\" of"},
        {"<DifftoolSpec " + text + "=''/>", "attribute " + shown + ";"},
        {"<DifftoolSpec><class " + text + "=''/></DifftoolSpec>", "attribute " + shown + ";"},
        {"<DifftoolSpec><class default='" + text + "'/></DifftoolSpec>", "default \"" + shown + "\" is"},
        {"<DifftoolSpec><class name='" + text + "'/></DifftoolSpec>", "class " + shown + " is"},
        {"<DifftoolSpec><class name='INV_Disk'><includelist><value>" + text + "</value></includelist></class></DifftoolSpec>",
         "property \"" + shown + "\";"},
    };
    for (const auto& row : rows) {
        const std::string complaint = Complaint({"check", Scratch("long", row.rules), "--schema", "web01.xml"});
        EXPECT_NE(std::string::npos, complaint.find(row.message)) << complaint;
    }
}

TEST_F(BadInputTest, EachPathThatIsNotARulesFileGetsItsMessage)
{
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory; name a rules file that can be read, or - for "
              "standard input\n",
              Complaint({"compare", "--spec", "none.xml", "web01.xml", "web02.xml"}));
    EXPECT_EQ("cimdelta: .: is a directory; name a rules file that can be read, or - for standard input\n",
              Complaint({"compare", "--spec", ".", "web01.xml", "web02.xml"}));
}

TEST_F(BadInputTest, RulesThatCannotBeReadAreTheOnlyMessage)
{
    // Nothing is said of the inventories either, which lack an operating system.
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory; name a rules file that can be read, or - for "
              "standard input\n",
              Complaint({"compare", "--spec", "none.xml", "other-schema.xml", "rules.xml"}));
    const std::string rules = Scratch("malformed", "<DifftoolSpec>");
    for (const std::vector<std::string>& command :
         {std::vector<std::string>{"compare", "--spec", rules, "other-schema.xml", "web01.xml"},
          std::vector<std::string>{"check", rules, "--schema", "other-schema.xml"},
          std::vector<std::string>{"explain", "INV_Extra", "--spec", rules, "--schema", "other-schema.xml"}}) {
        EXPECT_EQ("cimdelta: R:1: no element found; correct the file\n", Shorten(Complaint(command), rules, "R"));
    }
}

/// The plug-in would compare without rules if it were given a file of this name.
TEST_F(BadInputTest, RulesMayHaveAnyName)
{
    const std::string rules =
        Scratch("rules.xml|fVMWareEnable", "<DifftoolSpec><class name='INV_Disk' default='include'/></DifftoolSpec>");
    const std::string report = Result({"compare", "--spec", rules, "web01.xml", "web02.xml"});
    EXPECT_NE(std::string::npos, report.find("INV_Disk")) << report;
    EXPECT_EQ(std::string::npos, report.find("INV_Package\n")) << report;
}

TEST_F(BadInputTest, RulesLargerThanTheLimitAreRefused)
{
    const std::string rules = Scratch("large", "");
    ASSERT_EQ(0, truncate(rules.c_str(), 104857601));
    EXPECT_EQ("cimdelta: R: is larger than 104857600 bytes, the most that rules may have\n",
              Shorten(Complaint({"compare", "--spec", rules, "web01.xml", "web02.xml"}), rules, "R"));
}

TEST_F(BadInputTest, StandardInputIsReadOnlyOnce)
{
    const std::string message = "cimdelta: standard input (-) can be read only once; save it to a file first\n";
    EXPECT_EQ(message, Complaint({"compare", "-", "-"}));
    EXPECT_EQ(message, Complaint({"compare", "--spec", "-", "web01.xml", "-"}));
    EXPECT_EQ(message, Complaint({"check", "-", "--schema", "-"}));
    EXPECT_EQ(message, Complaint({"explain", "INV_Disk", "--spec", "-", "--schema", "-"}));
}

TEST_F(BadInputTest, InventoriesThatCannotBeOpenedAreNamed)
{
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory\n", Complaint({"compare", "none.xml", "web02.xml"}));
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory\n", Complaint({"show", "none.xml"}));
}

TEST_F(BadInputTest, AllInventoriesThatCannotBeReadAreNamed)
{
    EXPECT_EQ("cimdelta: none.xml: cannot be opened: No such file or directory; 2 more cannot be read: a.xml, b.xml\n",
              Complaint({"compare", "web01.xml", "none.xml", "a.xml", "web02.xml", "b.xml"}));
    std::vector<std::string> compare(1, "compare");
    for (int i = 0; i < 15; ++i) {
        compare.push_back("none" + std::to_string(i));
    }
    EXPECT_EQ(
        "cimdelta: none0: cannot be opened: No such file or directory; 14 more cannot be read: none1, none2, none3, none4, none5, "
        "none6, none7, none8, none9, none10, none11, none12 and 2 more\n",
        Complaint(compare));
}

TEST_F(BadInputTest, OfSeveralInventoriesThatCannotBeLoadedTheFirstIsReported)
{
    const std::string first = Scratch("first.xml", "<CIM>\n<SURPRISE/></CIM>");
    const std::string second = Scratch("second.xml", "no XML");
    for (int i = 0; i < 20; ++i) {
        EXPECT_EQ(0u, Complaint({"compare", "web01.xml", first, second, "web02.xml"}).find("cimdelta: " + first + ":2:1: "));
    }
}

TEST_F(BadInputTest, InventoriesThatAreNoInventoriesAreReportedWithTheirPlace)
{
    const struct {
        const char* inventory;
        const char* begins;
    } rows[] = {
        {"", "cimdelta: I:1:1: "},
        {"no XML", "cimdelta: I:1:1: "},
        {"<CIM>\n<DECLARATION>", "cimdelta: I:2:"},
        {"<CIM>\n<SURPRISE/></CIM>", "cimdelta: I:2:1: "},
        {"<?xml version='1.0' encoding='EBCDIC-X'?><CIM/>", "cimdelta: I:1:"},
        {"<CIM><DECLARATION><DECLGROUP>\n<VALUE.OBJECT><INSTANCE CLASSNAME='Nix'/></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>",
         "cimdelta: I:2:"},
    };
    int number = 0;
    for (const auto& row : rows) {
        SCOPED_TRACE(row.inventory);
        const std::string inventory = Scratch(std::to_string(number++), row.inventory);
        const std::string message = Shorten(Complaint({"compare", "web01.xml", inventory}), inventory, "I");
        EXPECT_EQ(row.begins, message.substr(0, std::string(row.begins).size())) << message;
        EXPECT_EQ(message.size() - 1, message.find('\n')) << message;
    }
}

TEST_F(BadInputTest, AnEmptyArgumentIsNoArgument)
{
    EXPECT_EQ("cimdelta: --spec: must not be empty; see cimdelta compare --help\n",
              Complaint({"compare", "--spec", "", "web01.xml", "web02.xml"}));
    EXPECT_EQ("cimdelta: OTHER: must not be empty; see cimdelta compare --help\n",
              Complaint({"compare", "web01.xml", "web02.xml", ""}));
    EXPECT_EQ("cimdelta: --output: must not be empty; see cimdelta show --help\n",
              Complaint({"show", "web01.xml", "--output", ""}));
    EXPECT_EQ("cimdelta: INVENTORY: must not be empty; see cimdelta show --help\n", Complaint({"show", ""}));
    EXPECT_EQ("cimdelta: --schema: must not be empty; see cimdelta check --help\n",
              Complaint({"check", "rules.xml", "--schema", ""}));
}

TEST_F(BadInputTest, BracketsAreNoList)
{
    EXPECT_EQ("cimdelta: [a: cannot be opened: No such file or directory; 1 more cannot be read: b]\n",
              Complaint({"compare", "web01.xml", "[a,b]"}));
    EXPECT_EQ("cimdelta: [a]: cannot be opened: No such file or directory\n", Complaint({"show", "[a]"}));
    EXPECT_EQ("cimdelta: [json] is no format; name one: text, json, ndjson or cimxml; see cimdelta show --help\n",
              Complaint({"show", "web01.xml", "-o", "[json]"}));
    EXPECT_EQ("cimdelta: [c] is one argument too many; see cimdelta show --help\n", Complaint({"show", "web01.xml", "b", "[c]"}));
}

TEST_F(BadInputTest, ALongKeyMakesNoLongMessage)
{
    const auto instance = [](const std::string& number) {
        return "<VALUE.OBJECT><INSTANCE CLASSNAME='A'><PROPERTY NAME='Id' TYPE='string'><VALUE>" + std::string(1000000, 'k') +
               "</VALUE></PROPERTY><PROPERTY NAME='N' TYPE='uint8'><VALUE>" + number +
               "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";
    };
    const std::string inventory =
        Scratch("long", "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME='A'>"
                        "<PROPERTY NAME='Id' TYPE='string'><QUALIFIER NAME='Key' TYPE='boolean'><VALUE>true</VALUE></QUALIFIER>"
                        "</PROPERTY><PROPERTY NAME='N' TYPE='uint8'/></CLASS></VALUE.OBJECT>\n" +
                            instance("1") + "\n" + instance("2") + "</DECLGROUP></DECLARATION></CIM>");
    EXPECT_EQ("cimdelta: I:3:1000158: found a second instance \"root/cimv2:A.Id=\"" + std::string(63, 'k') +
                  "...\" with \"2\" in property \"N\", but the one at I:2:1000158 has \"1\"; remove one of the two\n",
              Shorten(Complaint({"show", inventory}), inventory, "I"));
}

}  // namespace
}  // namespace NORVZEL20
