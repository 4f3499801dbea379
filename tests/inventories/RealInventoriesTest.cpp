// Real inventories, compared by the plug-in and by a program that shares nothing with it.
//
// The other program wrote its differences into the oracle files beside the inventories. The plug-in must find the same ones, except
// for pairs of values that are equal in CIM although their texts differ; those are listed one by one.

#include <gtest/gtest.h>

#include <algorithm>
#include <iterator>

#include "tests/inventories/OracleTable.h"
#include "tests/inventories/TInventoryRun.h"

namespace NORVZEL20 {
namespace {

const std::string kData = TEST_DATA;

// The first ten lines that are in one of the sets only; the sets have up to 28,000 lines.
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
        const std::set<std::string> expected = ReadOracle(kData + "/pair/" + oracle, {"Depends", "Constraints"}, true);
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

class LosslessTest : public testing::TestWithParam<const char*> {};

TEST_P(LosslessTest, WhatIsLoadedWrittenAndLoadedAgainIsTheSame)
{
    const std::string written = WriteInventory(*LoadInventory(kData + GetParam()));
    EXPECT_GT(written.size(), 90000U);
    EXPECT_TRUE(written == WriteInventory(*LoadInventoryText(written)));
}

INSTANTIATE_TEST_SUITE_P(PackageIndexAndTypes, LosslessTest,
                         testing::Values("/pair/a.xml.xz", "/pair/b.xml.xz", "/pair/c.xml.xz", "/typepair/A.xml",
                                         "/typepair/B.xml"));

// The other program compares texts. Here 0 equals -0, a real32 has 32 bits, datetimes are compared as instants whatever their
// offset, and letter case does not count in the class name of an embedded object.
const std::set<std::string> kEqualInValue = {
    "DIFF TST_AllTypes.Id=\"case-198\" p_real64", "DIFF TST_AllTypes.Id=\"case-205\" p_real32",
    "DIFF TST_AllTypes.Id=\"case-206\" p_datetime", "DIFF TST_AllTypes.Id=\"case-215\" e_inst"};

TEST(EveryTypeTest, ValuesOfAllTypesDifferAsListed)
{
    TInventoryRun run(kData + "/typepair/A.xml", kData + "/typepair/B.xml");
    run.Compare({"TST_Base", "TST_Part", "TST_Link"});
    std::set<std::string> expected = ReadOracle(kData + "/typepair/oracle.tsv", {"a_uint16", "a_uint32"}, false);
    for (const std::string& difference : kEqualInValue) {
        EXPECT_EQ(1U, expected.erase(difference)) << difference;
    }
    EXPECT_EQ(150U, expected.size());
    EXPECT_EQ("", Unmatched(expected, run.Differences(false)));
}

}  // namespace
}  // namespace NORVZEL20
