// Pages as files. How they look and work in a browser is tested in tests/html.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>
#include <set>

#include "client/report/html/Base64.h"
#include "client/report/html/Sha256.h"
#include "tests/client/TDocumentsFixture.h"
#include "tests/client/report/html/Unpack.h"

namespace NORVZEL20 {
namespace {

const std::string kDeclared =
    Class("Disk", "", KeyProperty("Id") + Declaration("Size", "uint64") + Declaration("Model", "string")) +
    Class("Tape", "Disk", "");

std::string Disk(const std::string& id, const std::string& size, const std::string& model, const std::string& cls = "Disk")
{
    return Instance(cls, Value("Id", id) + Value("Size", size, "uint64") + Value("Model", model));
}

class HtmlFormatTest : public TDocumentsFixture {
  protected:
    void Write(const std::vector<std::string>& instances)
    {
        std::vector<std::string> documents;
        for (const std::string& contents : instances) {
            documents.push_back(kDeclared + contents);
        }
        fPage = Compare(documents, {"-o", "html"});
        fPage = fOut;
    }

    std::string Part(const std::string& begin, const std::string& end) const
    {
        const std::size_t first = fPage.find(begin) + begin.size();
        return fPage.substr(first, fPage.find(end, first) - first);
    }

    nlohmann::json Overview() const { return nlohmann::json::parse(Unpack(Part("id=\"overview-data\">", "</script>"))); }

    /// The numbers of a column of the rows.
    std::vector<std::uint32_t> Column(const std::string& name) const
    {
        const std::string rows = Unpack(Part("id=\"rows-data\">", "</script>"));
        const std::size_t head = Number(rows, 0);
        std::size_t at = 4 + head;
        const nlohmann::json described = nlohmann::json::parse(rows.substr(4, head));
        for (const auto& column : described["columns"]) {
            const auto count = column[1].get<std::size_t>();
            if (column[0] == name) {
                std::vector<std::uint32_t> numbers;
                for (std::size_t i = 0; i < count; ++i) {
                    numbers.push_back(Number(rows, at + 4 * i));
                }
                return numbers;
            }
            at += 4 * count;
        }
        throw std::out_of_range(name);
    }

    std::string fPage;

  private:
    static std::uint32_t Number(const std::string& bytes, std::size_t at)
    {
        std::uint32_t number = 0;
        for (std::size_t i = 4; i-- > 0;) {
            number = number << 8U | static_cast<unsigned char>(bytes[at + i]);
        }
        return number;
    }
};

TEST_F(HtmlFormatTest, EachDifferenceHasARow)
{
    Write({Disk("a", "1", "x") + Disk("b", "2", "y") + Disk("c", "3", "z"),
           Disk("a", "5", "w") + Disk("b", "2", "v") + Disk("d", "4", "u")});
    const std::vector<std::uint32_t> differences = Column("rowDifference");
    EXPECT_EQ((std::set<std::uint32_t>{0, 1, 2, 3, 4}), std::set<std::uint32_t>(differences.begin(), differences.end()));
    EXPECT_EQ(5u, Overview()["counts"]["differences"].get<std::size_t>());
    EXPECT_EQ(1, fStatus);
}

TEST_F(HtmlFormatTest, TheSameComparisonGivesTheSamePage)
{
    Write({Disk("a", "1", "x"), Disk("a", "2", "y")});
    const std::string first = fPage;
    Write({Disk("a", "1", "x"), Disk("a", "2", "y")});
    EXPECT_EQ(first, fPage);
}

TEST_F(HtmlFormatTest, ThePolicyNamesTheScriptAndTheStyleOfThePage)
{
    Write({Disk("a", "1", "x"), Disk("a", "2", "y")});
    const std::string policy = Part("http-equiv=\"Content-Security-Policy\" content=\"", "\"");
    EXPECT_EQ("default-src 'none'; script-src 'sha256-" + EncodeBase64(Sha256(Part("<script>", "</script>"))) +
                  "'; style-src 'sha256-" + EncodeBase64(Sha256(Part("<style>", "</style>"))) +
                  "'; base-uri 'none'; form-action 'none'",
              policy);
}

TEST_F(HtmlFormatTest, FindingsAreChangesOfAPropertyInTheSameInventories)
{
    Write({Disk("a", "1", "x") + Disk("b", "1", "x"), Disk("a", "2", "x") + Disk("b", "3", "x"), Disk("a", "1", "y")});
    std::string text;
    const nlohmann::json overview = Overview();
    for (const auto& finding : overview["findings"]) {
        text += std::to_string(finding["kind"].get<int>()) + " " + finding["property"].get<std::string>() + " set " +
                overview["sets"][finding["set"].get<std::size_t>()]["text"].get<std::string>() + " rows " +
                std::to_string(finding["rows"].get<int>()) + " changes " + std::to_string(finding["changes"].get<int>()) +
                " rarity " + std::to_string(finding["rarity"].get<int>()) + "\n";
    }
    const std::string labels = Overview()["inventories"][1]["label"].get<std::string>();
    const std::string third = Overview()["inventories"][2]["label"].get<std::string>();
    EXPECT_EQ("0  set " + third + " rows 1 changes 0 rarity 1\n2 Model set " + third + " rows 1 changes 1 rarity 1\n2 Size set " +
                  labels + " rows 2 changes 2 rarity 1\n",
              text);
}

TEST_F(HtmlFormatTest, RulesThatWouldLeaveAFindingOutFitTheRulesInUse)
{
    const struct {
        const char* description;
        std::string rules;
        std::string place;
        std::string xml;
    } kCases[] = {
        {"an element of the class decides", "<class name='Disk' default='include'/>",
         "put this list into the element of Disk at line 1", "    <excludelist>\n      <value>Size</value>\n    </excludelist>\n"},
        {"the property is in a list", "<class name='Disk'><includelist><value>Size</value></includelist></class>",
         "take Size out of the list at line 1, and put this list into the same element",
         "    <excludelist>\n      <value>Size</value>\n    </excludelist>\n"},
        {"an element of a class above decides", "<class name='&lt;root&gt;' default='include'/>", "put this element at the end",
         "  <class name=\"Disk\" default=\"include\">\n    <excludelist>\n      <value>Size</value>\n    </excludelist>\n  "
         "</class>\n"},
        {"the class above decides by a list",
         "<class name='&lt;root&gt;' default='include'/><class name='Disk' default='include'/>",
         "put this list into the element of Disk at line 1", "    <excludelist>\n      <value>Size</value>\n    </excludelist>\n"},
    };
    for (const auto& row : kCases) {
        Rules(row.rules);
        Write({Disk("a", "1", "x"), Disk("a", "2", "x")});
        const nlohmann::json rule = Overview()["findings"][0]["rule"];
        EXPECT_NE(std::string::npos, rule["place"].get<std::string>().find(row.place)) << row.description << ": " << rule["place"];
        EXPECT_EQ(row.xml, rule["xml"].get<std::string>()) << row.description;
    }
}

TEST_F(HtmlFormatTest, AClassIsLeftOutWithTheListingsThatItInherits)
{
    Rules("<class name='Disk'><includelist><value>Size</value></includelist></class>");
    Write({Disk("a", "1", "x", "Tape"), ""});
    const nlohmann::json rule = Overview()["findings"][0]["rule"];
    EXPECT_EQ("  <class name=\"Tape\" default=\"exclude\">\n    <excludelist>\n      <value>Size</value>\n    </excludelist>\n  "
              "</class>\n",
              rule["xml"].get<std::string>());
}

TEST_F(HtmlFormatTest, TheDigestIsThatOfTheRules)
{
    const std::string rules = "<class name='Disk' default='include'/>";
    Rules(rules);
    Write({Disk("a", "1", "x"), Disk("a", "2", "x")});
    EXPECT_EQ(Sha256Hex("<DifftoolSpec>" + rules + "</DifftoolSpec>"), Overview()["rules"]["digest"].get<std::string>());
}

}  // namespace
}  // namespace NORVZEL20
