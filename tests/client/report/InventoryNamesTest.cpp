#include "client/report/TInventoryNames.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

using TSet = std::vector<std::size_t>;

TEST(InventoryNamesTest, ListsAreAsShortAsTheyCanBe)
{
    const std::vector<std::string> web = {"web01", "web02", "web03", "web04", "web06", "web07"};
    const struct {
        std::vector<std::string> labels;
        TSet inventories;
        const char* list;
    } rows[] = {
        {{"a", "b"}, {1}, "b"},
        {{"a", "b", "c"}, {1, 2}, "b, c"},
        {{"a", "b", "c", "d"}, {1, 2, 3}, "all"},
        {{"a", "b", "c", "d"}, {1, 3}, "b, d"},
        {web, {1, 2, 3, 4, 5}, "all"},
        {web, {1, 2, 3, 5}, "all but web06"},
        {web, {1, 2, 3, 4}, "all but web07"},
        {web, {1, 2, 3}, "web02..04"},
        {{"web01", "web02", "web03", "web04", "web06", "web07", "web09"}, {1, 2, 3, 4}, "all but web07, web09"},
        {{"a", "b", "c", "d", "e"}, {1, 2}, "b, c"},
        {{"a", "b", "c", "d", "e"}, {1, 2, 4}, "all but d"},
        {web, {1, 2}, "web02, web03"},
        {web, {1, 5}, "web02, web07"},
        {web, {0}, "web01"},
        {{"r", "n8", "n9", "n10", "x", "y", "z"}, {1, 2, 3}, "n8, n9, n10"},
        {{"r", "n08", "n09", "n10", "x", "y", "z"}, {1, 2, 3}, "n08..10"},
        {{"r", "a1", "b2", "c3", "x", "y", "z"}, {1, 2, 3}, "a1, b2, c3"},
        {{"r", "1", "2", "3", "x", "y", "z"}, {1, 2, 3}, "1..3"},
        {{"r", "a 1", "a 2", "a 3", "x", "y", "z"}, {1, 2, 3}, "\"a 1\", \"a 2\", \"a 3\""},
        {{"r", "all", "b", "web01..04", "others", "x", "y"}, {1, 3, 4}, "\"all\", \"web01..04\", \"others\""},
        {{"r", "12345678901234567890", "12345678901234567891", "12345678901234567892", "x", "y", "z"},
         {1, 2, 3},
         "12345678901234567890, 12345678901234567891, 12345678901234567892"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.list, TInventoryNames(row.labels, false).List(row.inventories));
    }
}

// Of the majority, the others alone count.
TEST(InventoryNamesTest, NamesTheFewInsteadOfTheMany)
{
    const std::vector<std::string> labels = {"majority", "a", "b", "c", "d"};
    const TInventoryNames fromMajority(labels, true);
    EXPECT_EQ("a, b", fromMajority.List({1, 2}));
    EXPECT_EQ("missing in a, b", fromMajority.WhoLacks({1, 2}));
    EXPECT_EQ("only in a, b", fromMajority.WhoHas({1, 2}));
    EXPECT_EQ("all but d", fromMajority.List({1, 2, 3}));
    EXPECT_EQ("only in d", fromMajority.WhoLacks({1, 2, 3}));
    const std::vector<std::string> first = {"r", "a", "b", "c", "d"};
    const TInventoryNames fromFirst(first, false);
    EXPECT_EQ("missing in a, b", fromFirst.WhoLacks({1, 2}));
    EXPECT_EQ("only in a, b", fromFirst.WhoHas({1, 2}));
    EXPECT_EQ("only in r, d", fromFirst.WhoLacks({1, 2, 3}));
    EXPECT_EQ("missing in r, d alone", fromFirst.WhoHas({1, 2, 3}));
}

}  // namespace
}  // namespace NORVZEL20
