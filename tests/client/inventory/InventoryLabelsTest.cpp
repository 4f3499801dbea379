#include "client/inventory/InventoryLabels.h"

#include <gtest/gtest.h>

#include <boost/algorithm/string/join.hpp>
#include <nlohmann/json.hpp>

#include "client/process/TClientError.h"
#include "tests/client/SourcesOf.h"
#include "tests/client/TClientFixture.h"
#include "tests/client/TOutputFolder.h"

namespace NORVZEL20 {
namespace {

std::string Labels(const std::vector<std::string>& paths)
{
    return boost::algorithm::join(MakeInventoryLabels(SourcesOf(paths)), "|");
}

TEST(InventoryLabels, AreFileNamesWithoutDirectoryAndSuffixes)
{
    EXPECT_EQ("web01|web02|web03|web04.example.org",
              Labels({"/srv/web01.xml", "web02.xml.gz", "../x/web03.cimxml.xz", "web04.example.org.xml.zst"}));
}

TEST(InventoryLabels, LackSuffixesInAnyLetterCase)
{
    EXPECT_EQ("web01|web02|web03|web04|web05.response|.MOF",
              Labels({"web01.mof", "web02.XML", "web03.Mof.GZ", "web04.CIM", "web05.response", ".MOF"}));
}

TEST(InventoryLabels, ArePathsWhereNamesAreAlike)
{
    EXPECT_EQ("old/web01.xml|new/web01.xml|b", Labels({"old/web01.xml", "new/web01.xml", "b.xml"}));
}

TEST(InventoryLabels, AreNumberedWherePathsAreAlike)
{
    EXPECT_EQ("a.xml|a.xml#2|a.xml#3", Labels({"a.xml", "a.xml", "a.xml"}));
}

TEST(InventoryLabels, KeepWhatWouldBecomeEmpty)
{
    EXPECT_EQ(".xml|stdin|/", Labels({".xml", "-", "/"}));
}

TEST(InventoryLabels, AreTheNamesOfFolders)
{
    EXPECT_EQ("web01|..", Labels({"srv/web01//", ".."}));
}

TEST(InventoryLabels, ThoseGivenStay)
{
    EXPECT_EQ("dir/web01.xml|web01|web01#2",
              boost::algorithm::join(
                  MakeInventoryLabels({{"", "", "dir/web01.xml", {}}, {"", "web01", "x", {}}, {"", "web01#2", "x", {}}}), "|"));
    EXPECT_THROW(MakeInventoryLabels({{"", "web01", "x", {}}, {"", "web01", "y", {}}}), TClientError);
}

TEST(InventoryLabels, NumberedOnesDoNotCollideWithOthers)
{
    EXPECT_EQ("a#2|a|a#3", Labels({"a#2", "a", "a"}));
}

TEST(InventoryLabels, AreUtf8WithoutControlCharacters)
{
    EXPECT_EQ("caf\\xe9|caf\xc3\xa9|two\\nlines|\\xe0\\x80\\xaf",
              Labels({"caf\xe9.xml", "caf\xc3\xa9.xml", "two\nlines.xml", "\xe0\x80\xaf.xml"}));
}

TEST(InventoryLabels, AreNotAlikeAfterReplacement)
{
    EXPECT_EQ("\\xe8|\\xe9", Labels({"\xe8.xml", "\xe9.xml"}));
    EXPECT_EQ("a/\\xe9.xml|b/\\xe9.xml", Labels({"a/\xe9.xml", "b/\\xe9.xml"}));
    EXPECT_EQ("\\xe9.xml|\\xe9.xml#2", Labels({"\xe9.xml", "\\xe9.xml"}));
}

/// Labels in reports.
class LabelsInReportsTest : public TClientFixture {
  protected:
    /// Compares web01.xml with web02.xml and web03.xml under these file names.
    std::string Compare(const std::string& second, const std::string& third, const std::string& format)
    {
        std::filesystem::copy_file("web02.xml", fFolder / second, std::filesystem::copy_options::overwrite_existing);
        std::filesystem::copy_file("web03.xml", fFolder / third, std::filesystem::copy_options::overwrite_existing);
        return Result({"compare", "--detail", "-o", format, "web01.xml", fFolder / second, fFolder / third});
    }

    const TOutputFolder fFolder;
};

TEST_F(LabelsInReportsTest, OneLabelDoesNotReadLikeTwo)
{
    const std::string report = Compare("a, b.xml", "c.xml", "text");
    EXPECT_EQ("10 differences between web01 and \"a, b\", c: 2 instances of web01 missing elsewhere, 2 instances only elsewhere, 6 "
              "changed values in 3 instances\n"
              "\n"
              "INV_Disk\n"
              "- BootId=1,Device=\"sda\"  (not in \"a, b\")\n",
              report.substr(0, report.find("+ BootId")));
    EXPECT_NE(std::string::npos, report.find(" instances of \"a, b\", ")) << report;
    EXPECT_EQ("a, b", nlohmann::json::parse(Compare("a, b.xml", "c.xml", "json"))["inventories"][1]["label"]);
}

TEST_F(LabelsInReportsTest, NamesThatAreNotUtf8StayApart)
{
    const nlohmann::json inventories = nlohmann::json::parse(Compare("\xe8.xml", "\xe9.xml", "json"))["inventories"];
    EXPECT_EQ("\\xe8", inventories[1]["label"]);
    EXPECT_EQ("\\xe9", inventories[2]["label"]);
    EXPECT_NE(std::string::npos, Compare("\xe8.xml", "\xe9.xml", "text").find(" between web01 and \\xe8, \\xe9: "));
}

}  // namespace
}  // namespace NORVZEL20
