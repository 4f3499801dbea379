// Options that reports advise can be pasted into a shell, whatever the names are.

#include <gtest/gtest.h>

#include "client/report/DescribeLargestGroup.h"
#include "client/report/DescribeNameHint.h"
#include "client/report/NamesOf.h"
#include "client/report/TClassLines.h"

namespace NORVZEL20 {
namespace {

TEST(Hints, TheLargestGroupIsQuoted)
{
    TFindings findings;
    findings.classes.emplace_back();
    findings.classes.front().className = "Disk$";
    findings.classes.front().changedProperties["it's"] = 9;
    EXPECT_EQ("9 of 10 differences are Disk$.it's: --exclude 'Disk$.it'\\''s'\n", DescribeLargestGroup(findings, 10));
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
