#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Results of `-o cimxml` are inventories too, with classes that have the names of the comparison's own records.
class RecordKeysTest : public TClientFixture {
  protected:
    /// The message or report of a comparison of two results under a rule for their records.
    std::string Compare(const std::string& rule)
    {
        const std::string first = Scratch("first.xml", Result({"compare", "--detail", "-o", "cimxml", "web01.xml", "web02.xml"}));
        const std::string second = Scratch("second.xml", Result({"compare", "--detail", "-o", "cimxml", "web01.xml", "web03.xml"}));
        const std::string rules = Scratch("rules", "<DifftoolSpec>\n<class name='" + rule + "/>\n</DifftoolSpec>");
        Run({"compare", "--detail", "--spec", rules, first, second});
        return fStatus == 2 ? Shorten(fErr.substr(fErr.rfind("cimdelta: ")), rules, "R") : fOut.substr(0, fOut.find(' '));
    }

    static std::string Refusal(const std::string& cls)
    {
        return "cimdelta: R:2: rules for class " + cls +
               " cannot have excludekeys, because the comparison keeps its own records in a class of that name; leave out "
               "excludekeys, "
               "or make both results with -o ndjson and compare those with diff\n";
    }
};

TEST_F(RecordKeysTest, ExcludingThemIsRefusedForEachOfTheThreeClasses)
{
    EXPECT_EQ(Refusal("KALMO_Delta"), Compare("KALMO_Delta' default='include' excludekeys='DeltaID'"));
    EXPECT_EQ(Refusal("KALMO_DeltaClass"), Compare("KALMO_DeltaClass' default='include' excludekeys='DeltaClassID'"));
    EXPECT_EQ(Refusal("KALMO_DeltaClassAssocToDelta"),
              Compare("KALMO_DeltaClassAssocToDelta' default='include' excludekeys='Class'"));
}

TEST_F(RecordKeysTest, WithAllTheirKeysOrUncomparedTheyDoNotMatter)
{
    EXPECT_EQ("13", Compare("KALMO_Delta' default='include'"));
    EXPECT_EQ("2",
              Compare("KALMO_Delta' default='exclude' excludekeys='DeltaID'/><class name='KALMO_DeltaClass' default='include'"));
}

TEST_F(RecordKeysTest, AnOptionThatExcludesThemIsRefusedToo)
{
    const std::string first = Scratch("first.xml", Result({"compare", "-o", "cimxml", "web01.xml", "web02.xml"}));
    const std::string second = Scratch("second.xml", Result({"compare", "-o", "cimxml", "web01.xml", "web03.xml"}));
    const std::string refused = Complaint({"compare", first, second, "--exclude-key", "KALMO_Delta.*"});
    EXPECT_EQ("cimdelta: --exclude-key 'KALMO_Delta.*': rules for class KALMO_Delta cannot have excludekeys",
              refused.substr(0, refused.find(',')));
    const std::string noise = Result({"noise", first, second});
    EXPECT_EQ(std::string::npos, noise.find("--exclude-key KALMO")) << noise;
}

/// Rules may name the classes although no inventory has instances of them.
TEST_F(RecordKeysTest, WithoutInstancesTheyDoNotMatter)
{
    const std::string class_ = "<VALUE.OBJECT><CLASS NAME=\"KALMO_Delta\"><PROPERTY NAME=\"DeltaID\" TYPE=\"uint64\"><QUALIFIER "
                               "NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS></VALUE.OBJECT>";
    std::string text = ReadFile("web01.xml");
    const std::string file = Scratch("declared.xml", text.insert(text.find("<VALUE.OBJECT>"), class_));
    const std::string rules = Scratch("rules", "<DifftoolSpec><class name='KALMO_Delta' default='include' excludekeys='DeltaID'/>"
                                               "<class name='INV_Package' default='include'/></DifftoolSpec>");
    Run({"compare", "--detail", "--spec", rules, file, "web02.xml"});
    EXPECT_EQ(1, fStatus) << fErr;
    EXPECT_NE(std::string::npos, fOut.find("INV_Package\n~ Name=\"bash\"\n")) << fOut;
}

}  // namespace
}  // namespace NORVZEL20
