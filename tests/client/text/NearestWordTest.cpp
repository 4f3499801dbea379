#include "client/text/NearestWord.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

TEST(NearestWord, IsWhatWasProbablyMeant)
{
    const struct {
        const char* typed;
        const char* nearest;
    } rows[] = {
        {"compar", "compare"},
        {"comp", "compare"},
        {"comprae", "compare"},
        {"cmpare", "compare"},
        {"compared", "compare"},
        {"shwo", "show"},
        {"sho", "show"},
        {"check", "check"},
        {"ch", "check"},
        {"chekc", "check"},
        {"explian", "explain"},
        {"c", ""},
        {"", ""},
        {"diff", ""},
        {"web01.xml", ""},
        {"Show", "show"},
        {"SHOW", ""},
        {"--ouput", "--output"},
        {"--strict", "--strict-schema"},
        {"--sr", ""},
        {"--s", ""},
        {"--self", ""},
        {"--halp", "--help"},
        {"-help", "--help"},
        {"--comparewithnothingelse", ""},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.nearest,
                  NearestWord(row.typed, {"compare", "check", "explain", "query", "show", "--output", "--strict-schema", "--help"}))
            << row.typed;
    }
}

TEST(NearestWord, IsTheNearestOfSeveral)
{
    EXPECT_EQ("abcdef", NearestWord("abcdxf", {"abcyyf", "abcdef", "abcdyf"}));
    EXPECT_EQ("", NearestWord("word", {}));
    EXPECT_EQ("", NearestWord(std::string(1000000, 'x'), {"word"}));
}

}  // namespace
}  // namespace NORVZEL20
