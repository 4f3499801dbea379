// What inventories say that they lack, in reports.
#include "client/inventory/NotCollected.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const char kDisks[] = "<VALUE.OBJECT><CLASS NAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"string\"><QUALIFIER NAME=\"Key\" "
                      "TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
                      "</QUALIFIER></PROPERTY></CLASS></VALUE.OBJECT><VALUE.OBJECT><INSTANCE CLASSNAME=\"Disk\"><PROPERTY "
                      "NAME=\"Id\" TYPE=\"string\"><VALUE>sda"
                      "</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>";

std::string Inventory(const std::vector<TNotCollected>& lacks)
{
    std::string text = WriteNotCollected("root/cimv2", lacks, true);
    return text.insert(text.find("</DECLGROUP"), kDisks);
}

class LacksTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        TClientFixture::SetUp();
        fWhole = "a=" + Scratch("whole.xml", Inventory({}));
    }

    std::string With(const std::vector<TNotCollected>& lacks) { return "b=" + Scratch("with.xml", Inventory(lacks)); }

    std::string Report(const std::string& other, const std::string& option)
    {
        Run({"compare", fWhole, other, option});
        EXPECT_EQ("", fErr);
        return fOut;
    }

    std::string fWhole;
};

const TNotCollected kFans{"instances", "CIM_ERR_FAILED (1), \"crashed\"", {"Fan", "Sensor", "Pump", "Valve", "Tap"}, 5};
const TNotCollected kFiles{"files", "not everybody may read it", {"/etc/a"}, 40};

TEST_F(LacksTest, TheReportNamesThemInShort)
{
    EXPECT_NE(
        std::string::npos,
        Report(With({kFans, kFiles}), "--limit=100")
            .find("\nb was collected without instances: Fan, Sensor, Pump and 2 more (CIM_ERR_FAILED (1), \"crashed\"); files:"
                  " /etc/a and 39 more (not everybody may read it) (--coverage)\n"))
        << fOut;
}

TEST_F(LacksTest, ManyReasonsAndManyInventoriesAreShortened)
{
    std::vector<std::string> command = {"compare", fWhole};
    for (int i = 0; i < 8; ++i) {
        const std::string name = std::to_string(i);
        std::vector<TNotCollected> lacks(i == 0 ? 5 : 1, {"files", "", {"x"}, 1});
        for (std::size_t k = 0; k < lacks.size(); ++k) {
            lacks[k].reason = name + std::to_string(k);
        }
        command.push_back("i" + name + "=" + Scratch(name + ".xml", Inventory(lacks)));
    }
    Run(command);
    EXPECT_NE(std::string::npos,
              fOut.find("\ni0 was collected without files: x (00); files: x (01); files: x (02); and 2 more (--coverage)\n"
                        "i1 was collected without files: x (10) (--coverage)\n"))
        << fOut;
    EXPECT_NE(std::string::npos, fOut.find("\n3 more inventories were not collected whole (--coverage)\n")) << fOut;
}

TEST_F(LacksTest, TheCoverageNamesThemAll)
{
    EXPECT_NE(std::string::npos,
              Report(With({kFans, kFiles}), "--coverage")
                  .find("\nb was collected without instances: Fan, Sensor, Pump, Valve, Tap (CIM_ERR_FAILED (1),"
                        " \"crashed\").\nb was collected without files: /etc/a and 39 more (not everybody may read it).\n"))
        << fOut;
}

TEST_F(LacksTest, JsonHasThemAsTheyAre)
{
    const std::string json = Report(With({kFiles}), "--format=json");
    EXPECT_NE(std::string::npos, json.find("\"notCollected\": [")) << json;
    for (const char* field : {"\"kind\": \"files\"", "\"reason\": \"not everybody may read it\"", "\"count\": 40", "\"/etc/a\""}) {
        EXPECT_NE(std::string::npos, json.find(field)) << field;
    }
    EXPECT_EQ(std::string::npos, Report("b=" + Scratch("other.xml", Inventory({})), "--format=json").find("notCollected"));
}

TEST_F(LacksTest, EqualInventoriesThatLackSomethingAreNotComparedCompletely)
{
    const std::string lacking = With({kFiles});
    Run({"compare", lacking, "c=" + Scratch("same.xml", Inventory({kFiles}))});
    EXPECT_EQ(0, fStatus) << fErr;
    EXPECT_NE(std::string::npos,
              fOut.find("\nb, c were collected without files: /etc/a and 39 more (not everybody may read it) (--coverage)\n"))
        << fOut;
    const std::string whole = "d=" + Scratch("again.xml", Inventory({}));
    Run({"compare", fWhole, whole});
    EXPECT_EQ(std::string::npos, fOut.find("without")) << fOut;
    Run({"compare", "--format=json", fWhole, whole});
    EXPECT_NE(std::string::npos, fOut.find("\"everythingCompared\": true")) << fOut;
    Run({"compare", "--format=json", lacking, "c=" + Scratch("third.xml", Inventory({kFiles}))});
    EXPECT_NE(std::string::npos, fOut.find("\"everythingCompared\": false")) << fOut;
}

TEST_F(LacksTest, AClassOfThatNameWithOtherContentsIsLeftAlone)
{
    const std::string other =
        "<CIM><DECLARATION><DECLGROUP><VALUE.OBJECT><CLASS NAME=\"KALMO_NotCollected\"><PROPERTY NAME=\"Kind\" "
        "TYPE=\"uint8\"><QUALIFIER NAME=\"Key\""
        " TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS></VALUE.OBJECT><VALUE.OBJECT><INSTANCE"
        " CLASSNAME=\"KALMO_NotCollected\"><PROPERTY NAME=\"Kind\" "
        "TYPE=\"uint8\"><VALUE>1</VALUE></PROPERTY></INSTANCE></VALUE.OBJECT>"
        "</DECLGROUP></DECLARATION></CIM>";
    Run({"compare", "a=" + Scratch("one.xml", other), "b=" + Scratch("two.xml", other)});
    EXPECT_EQ(0, fStatus) << fErr;
    EXPECT_EQ(std::string::npos, fOut.find("without")) << fOut;
}

}  // namespace
}  // namespace NORVZEL20
