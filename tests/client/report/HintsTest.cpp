// What reports advise: the right option, which can be pasted into a shell whatever the names are.

#include <gtest/gtest.h>

#include "client/report/DescribeLargestGroup.h"
#include "client/report/DescribeNameHint.h"
#include "client/report/NamesOf.h"
#include "client/report/TClassLines.h"
#include "embedded/store/TInMemNamespace.h"
#include "tests/client/TDocumentsFixture.h"

namespace NORVZEL20 {
namespace {

TEST(Hints, TheLargestGroupIsQuoted)
{
    TFindings findings;
    findings.classes.emplace_back();
    findings.classes.front().className = "Disk$";
    findings.classes.front().changedProperties["it's"] = 9;
    EXPECT_EQ("9 of 10 differences are Disk$.it's: --exclude 'Disk$.it'\\''s'\n",
              DescribeLargestGroup(*TInMemNamespace::Create("root/cimv2"), findings, 10));
}

/// A class with disks, of which some are of a class below it.
class LargestGroupTest : public TDocumentsFixture {
  protected:
    /// The last line of the report.
    std::string Hint(const std::string& first, const std::string& second)
    {
        const std::string report =
            Result({"compare", Scratch("a.xml", Document(System() + first)), Scratch("b.xml", Document(System() + second))});
        return report.substr(report.rfind('\n', report.size() - 2) + 1);
    }

    static std::string Disks(int count, const std::string& size, const std::string& ofSpecial)
    {
        std::string contents = Class("Disk", "", KeyProperty("Id") + Declaration("Size", "string")) + Class("Special", "Disk", "");
        for (int i = 1; i <= count; ++i) {
            contents += Instance("Disk", Value("Id", "d" + std::to_string(i)) + Value("Size", size));
        }
        return contents + Instance("Special", Value("Id", "s") + Value("Size", ofSpecial)) +
               Class("Fan", "", KeyProperty("Id") + Declaration("Speed", "string")) +
               Instance("Fan", Value("Id", "f") + Value("Speed", size));
    }
};

TEST_F(LargestGroupTest, IsWhatTheOptionLeavesOut)
{
    EXPECT_EQ("9 of 10 differences are Disk.Size: --exclude Disk.Size\n", Hint(Disks(9, "1", "1"), Disks(9, "2", "1")));
    EXPECT_EQ("10 of 11 differences are Disk.Size and classes below it: --exclude Disk.Size\n",
              Hint(Disks(9, "1", "1"), Disks(9, "2", "2")));
    EXPECT_EQ("10 of 11 differences are in Disk and classes below it: --exclude Disk\n",
              Hint(Disks(9, "1", "1"), Disks(0, "2", "2")));
}

TEST(Hints, APropertyWithManyChangesIsQuoted)
{
    TChangeFinding change;
    change.change.property = "Size $.Used";
    change.change.others.push_back({{1}, TCIMValue(), {}});
    change.instances = 1;
    change.names.push_back("sda");
    TClassFindings findings;
    findings.properties.push_back({"Size $.Used", 9, 9, {1}, {change}});
    const std::vector<std::string> labels = {"a", "b"};
    const TInventoryNames names(labels, false);
    const TTextOptions options;
    const std::vector<TClassLines::TLine> lines = TClassLines(findings, names, options, true, 8).Write();
    ASSERT_EQ(2u, lines.size());
    EXPECT_NE(std::string::npos, lines.back().text.find("... 8 more (--property 'Size $')")) << lines.back().text;
}

TEST(Hints, APropertyWithNamesOfSystemsIsQuoted)
{
    TNameHint hint;
    hint.className = "System";
    hint.property = "The Name";
    hint.instances = {1, 1};
    const std::string text = DescribeNameHint(hint);
    EXPECT_NE(std::string::npos, text.find("The Name has one value in each inventory: try --self 'The Name'.")) << text;
}

}  // namespace
}  // namespace NORVZEL20
