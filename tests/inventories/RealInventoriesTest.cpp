// Real inventories, compared by the plug-in and by a program that shares nothing with it.

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>

#include "tests/inventories/OracleTable.h"
#include "tests/inventories/TInventoryRun.h"

namespace NORVZEL20 {
namespace {

const std::string kData = TEST_DATA;

// The first lines that only one of the sides has, which is what a person wants to see of two sets of 28,000.
std::string Unmatched(const std::set<std::string>& expected, const std::set<std::string>& found)
{
    std::vector<std::string> lines;
    std::set_symmetric_difference(expected.begin(), expected.end(), found.begin(), found.end(), std::back_inserter(lines));
    std::string text;
    for (std::size_t i = 0; i < std::min<std::size_t>(lines.size(), 10); ++i) {
        text += (expected.count(lines[i]) != 0 ? "missing: " : "not expected: ") + lines[i] + "\n";
    }
    return text;
}

class PackageIndexTest : public testing::Test {
  protected:
    void ExpectDifferencesOf(const std::string& other, const std::string& oracle, std::size_t count)
    {
        TInventoryRun run(kData + "/pair/a.xml.xz", kData + "/pair/" + other);
        run.Compare({"DEB_Package", "DEB_PackageDependency"});
        const std::set<std::string> expected = ReadOracle(kData + "/pair/" + oracle, true);
        EXPECT_EQ(count, expected.size());
        EXPECT_EQ("", Unmatched(expected, run.Differences(true)));
    }
};

TEST_F(PackageIndexTest, TheNextReleaseDiffersAsListed)
{
    ExpectDifferencesOf("b.xml.xz", "oracle-ab.tsv.xz", 28703);
}

TEST_F(PackageIndexTest, SecurityUpdatesDifferAsListed)
{
    ExpectDifferencesOf("c.xml.xz", "oracle-ac.tsv.xz", 913);
}

TEST(EveryTypeTest, ValuesOfAllTypesDifferAsListed)
{
    TInventoryRun run(kData + "/typepair/A.xml", kData + "/typepair/B.xml");
    run.Compare({"TST_Base", "TST_Part", "TST_Link"});
    std::set<std::string> expected = ReadOracle(kData + "/typepair/oracle.tsv", false);
    EXPECT_EQ(151U, expected.size());
    EXPECT_EQ("", Unmatched(expected, run.Differences(false)));
}

}  // namespace
}  // namespace NORVZEL20
