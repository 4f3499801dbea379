#include "tests/client/Documents.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const char kHeader[] = "class,instance,name,kind,property,inventory,reference value,value,reference type,type\r\n";

/// Reports as tables.
class CsvFormatTest : public TClientFixture {
  protected:
    /// The rows of a comparison of notes with one text each; without one, the text is null.
    std::string RowsOf(const std::string& before, const std::string& after)
    {
        const std::string cls = System() + Class("Note", "", KeyProperty("Id") + Declaration("Text", "string"));
        return Rows(cls + Instance("Note", Value("Id", "1") + before), cls + Instance("Note", Value("Id", "1") + after));
    }

    /// The rows without the header. The inventories are called "a" and "b".
    std::string Rows(const std::string& before, const std::string& after)
    {
        const std::string text = Result(
            {"compare", "-o", "csv", "a=" + Scratch("before.xml", Document(before)), "b=" + Scratch("after.xml", Document(after))});
        EXPECT_EQ(kHeader, text.substr(0, sizeof kHeader - 1));
        return text.substr(std::min(text.size(), sizeof kHeader - 1));
    }
};

TEST_F(CsvFormatTest, EachDifferenceIsARowForEachInventory)
{
    EXPECT_EQ(
        kHeader +
            std::string(
                "INV_Disk,\"INV_Disk.BootId=1,Device=\"\"sda\"\"\",BootId=1,onlyInReference,,web02,,,,\r\n"
                "INV_Disk,\"INV_Disk.BootId=7,Device=\"\"sda\"\"\",BootId=7,onlyInOthers,,web02,,,,\r\n"
                "INV_Package,\"INV_Package.Name=\"\"bash\"\"\",bash,changed,Depends,web02,\"{\"\"libc6\"\", \"\"libtinfo6\"\"}\","
                "\"{\"\"libc6\"\", \"\"libtinfo6\"\", \"\"base-files\"\"}\",string[],string[]\r\n"
                "INV_Package,\"INV_Package.Name=\"\"bash\"\"\",bash,changed,Version,web02,5.1,5.2,string,string\r\n"
                "INV_Package,\"INV_Package.Name=\"\"bash\"\"\",bash,changed,Version,web03,5.1,5.2,string,string\r\n"
                "INV_Package,\"INV_Package.Name=\"\"curl\"\"\",curl,onlyInOthers,,web02,,,,\r\n"
                "INV_Package,\"INV_Package.Name=\"\"curl\"\"\",curl,onlyInOthers,,web03,,,,\r\n"
                "INV_Package,\"INV_Package.Name=\"\"nginx\"\"\",nginx,changed,Section,web03,web, web,string,string\r\n"
                "INV_Package,\"INV_Package.Name=\"\"nginx\"\"\",nginx,changed,Version,web02,1.22,1.24,string,string\r\n"
                "INV_Package,\"INV_Package.Name=\"\"nginx\"\"\",nginx,changed,Version,web03,1.22,,string,string\r\n"
                "INV_Package,\"INV_Package.Name=\"\"telnet\"\"\",telnet,onlyInReference,,web02,,,,\r\n"
                "INV_Service,\"INV_Service.Id=\"\"ssh\"\"\",ssh,changed,Caption,web03,Secure shell,\"Secure\nshell \u009b31m\","
                "string,string\r\n"
                "INV_Service,\"INV_Service.Id=\"\"ssh\"\"\",ssh,changed,Started,web02,TRUE,FALSE,boolean,boolean\r\n"),
        Result({"compare", "-o", "csv", "web01.xml", "web02.xml", "web03.xml"}));
}

TEST_F(CsvFormatTest, ANullIsNoEmptyText)
{
    EXPECT_EQ("Note,\"Note.Id=\"\"1\"\"\",1,changed,Text,b,,,string NULL,string\r\n", RowsOf("", Value("Text", "")));
    EXPECT_EQ("Note,\"Note.Id=\"\"1\"\"\",1,changed,Text,b,NULL,,string,string NULL\r\n", RowsOf(Value("Text", "NULL"), ""));
}

TEST_F(CsvFormatTest, ATextThatASpreadsheetTakesForAFormulaGetsAnApostrophe)
{
    const struct {
        const char* text;
        const char* cell;
    } rows[] = {
        {"=1+1", "'=1+1"},   {"+49 30", "'+49 30"},    {"-noexec", "'-noexec"},           {"@SUM(A1)", "'@SUM(A1)"},
        {"&#9;=1", "'\t=1"}, {"&#13;=1", "\"'\r=1\""}, {"&#10;=1", "\"'\n=1\""},          {"'quoted'", "''quoted'"},
        {"a=1", "a=1"},      {"5-3", "5-3"},           {"=a,\"b\"", "\"'=a,\"\"b\"\"\""}, {"\u00fc", "\u00fc"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ("Note,\"Note.Id=\"\"1\"\"\",1,changed,Text,b,x," + std::string(row.cell) + ",string,string\r\n",
                  RowsOf(Value("Text", "x"), Value("Text", row.text)))
            << row.text;
    }
}

TEST_F(CsvFormatTest, NumbersStayNumbers)
{
    const std::string cls =
        System() + Class("Probe", "", KeyProperty("Id") + Declaration("Degrees", "sint16") + Declaration("Factor", "real32"));
    const auto probe = [&](const std::string& degrees, const std::string& factor) {
        return cls + Instance("Probe", Value("Id", "1") + Value("Degrees", degrees, "sint16") + Value("Factor", factor, "real32"));
    };
    EXPECT_EQ("Probe,\"Probe.Id=\"\"1\"\"\",1,changed,Degrees,b,-5,-6,sint16,sint16\r\n"
              "Probe,\"Probe.Id=\"\"1\"\"\",1,changed,Factor,b,0.1,-INF,real32,real32\r\n",
              Rows(probe("-5", "0.1"), probe("-6", "-INF")));
}

TEST_F(CsvFormatTest, IfNothingWasComparedThereIsNoTable)
{
    Run({"compare", "-o", "csv", "--spec", Scratch("rules", "<DifftoolSpec/>"), "web01.xml", "web02.xml"});
    EXPECT_EQ(2, fStatus);
    EXPECT_EQ("", fOut);
    EXPECT_NE(std::string::npos, fErr.find("nothing was compared")) << fErr;
}

TEST_F(CsvFormatTest, WithoutDifferencesThereIsTheHeaderAlone)
{
    EXPECT_EQ(kHeader, Result({"compare", "-o", "csv", "web01.xml", "web01-again.xml"}));
}

}  // namespace
}  // namespace NORVZEL20
