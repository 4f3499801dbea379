#include <nlohmann/json.hpp>
#include <set>

#include "client/inventory/TInventoryFile.h"
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

/// Three states of a package index, compared with the list of what differs between them that came with the data.
class RealInventoriesTest : public TClientFixture {
  protected:
    void SetUp() override { ASSERT_EQ(0, chdir(CIMDELTA_PAIR_DATA)); }

    static std::vector<std::vector<std::string>> ReadTable(const std::string& path)
    {
        TInventoryFile file(path);
        std::string text;
        char buffer[65536];
        while (const std::size_t count = file.Read(buffer, sizeof(buffer))) {
            text.append(buffer, count);
        }
        std::vector<std::vector<std::string>> rows(1, std::vector<std::string>(1));
        for (const char character : text) {
            if (character == '\n') {
                rows.push_back({""});
            } else if (character == '\t') {
                rows.back().push_back("");
            } else {
                rows.back().back() += character;
            }
        }
        return rows;
    }

    // One line for each difference: kind, class, key, property, values.
    static std::set<std::string> Expected(const std::string& oracle)
    {
        std::set<std::string> lines;
        for (const std::vector<std::string>& row : ReadTable(oracle)) {
            // The other class is an association, whose keys this table writes as objects and the report as path text.
            if (row.size() < 7 || row[1] != "DEB_Package") {
                continue;
            }
            const std::string kind = row[0] == "A_ONLY" ? "onlyInReference" : row[0] == "B_ONLY" ? "onlyInOthers" : "changed";
            std::string line = kind + " " + nlohmann::json::parse(row[2]).dump();
            if (kind == "changed") {
                line += " " + row[3] + " " + nlohmann::json::parse(row[4]).dump() + " " + nlohmann::json::parse(row[5]).dump();
            }
            lines.insert(line);
        }
        return lines;
    }

    static std::set<std::string> Found(const std::string& report)
    {
        std::set<std::string> lines;
        const nlohmann::json document = nlohmann::json::parse(report);
        for (const nlohmann::json& difference : document["differences"]) {
            if (difference["class"] != "DEB_Package") {
                continue;
            }
            std::string line = difference["kind"].get<std::string>() + " " + difference["keys"].dump();
            if (difference["kind"] == "changed") {
                line += " " + difference["property"].get<std::string>() + " " + difference["reference"]["value"].dump() + " " +
                        difference["others"][0]["value"].dump();
            }
            lines.insert(line);
        }
        return lines;
    }
};

TEST_F(RealInventoriesTest, TheReportIsTheListThatCameWithTheData)
{
    Run({"compare", "--detail", "-o", "json", "a.xml.xz", "c.xml.xz"});
    ASSERT_EQ(1, fStatus) << fErr;
    const std::set<std::string> expected = Expected("oracle-ac.tsv.xz");
    ASSERT_GT(expected.size(), 500u);
    EXPECT_TRUE(expected == Found(fOut));
    Run({"compare", "--detail", "-o", "json", "a.xml.xz", "b.xml.xz"});
    ASSERT_EQ(1, fStatus) << fErr;
    EXPECT_TRUE(Expected("oracle-ab.tsv.xz") == Found(fOut));
}

TEST_F(RealInventoriesTest, CountsAgreeOverAllClasses)
{
    Run({"compare", "--detail", "a.xml.xz", "b.xml.xz"});
    EXPECT_EQ("28703 differences between a and b: 955 instances only in a, 1648 instances only in b, 26100 changed values in 5945 "
              "instances\n",
              fOut.substr(0, fOut.find('\n') + 1));
    Run({"compare", "--detail", "a.xml.xz", "c.xml.xz"});
    EXPECT_EQ("913 differences between a and c: 2 instances only in c, 911 changed values in 267 instances\n",
              fOut.substr(0, fOut.find('\n') + 1));
}

}  // namespace
}  // namespace NORVZEL20
