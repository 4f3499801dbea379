#include "embedded/query/TLikePattern.h"

#include <gtest/gtest.h>

#include <string>
#include <vector>

namespace NORVZEL20 {
namespace {

struct TMatchRow {
    const char* pattern;
    const char* text;
    bool fits;
};

void ExpectMatches(const std::vector<TMatchRow>& rows)
{
    for (const TMatchRow& row : rows) {
        EXPECT_EQ(row.fits, TLikePattern(row.pattern).Matches(row.text)) << row.pattern << " on " << row.text;
    }
}

TEST(LikePatternTest, SignsStandForCharacters)
{
    ExpectMatches({
        {"", "", true},
        {"", "a", false},
        {"a", "a", true},
        {"a", "A", false},
        {"a", "ab", false},
        {"%", "", true},
        {"%", "abc", true},
        {"%%", "abc", true},
        {"a%", "a", true},
        {"a%", "ba", false},
        {"%c", "abc", true},
        {"%c", "abcd", false},
        {"aa%a", "aa", false},
        {"a%c", "abcabc", true},
        {"a%b%c", "axxbxxc", true},
        {"a%b%c", "axxcxxb", false},
        {"_", "a", true},
        {"_", "", false},
        {"_", "ab", false},
        {"_", "\xc3\xa4", true},
        {"__", "\xc3\xa4", false},
        {"_b_", "abc", true},
        {"\xff", "\xff", true},
        {"\xff", "\xfe", false},
    });
}

TEST(LikePatternTest, SetsStandForOneOfTheirCharacters)
{
    ExpectMatches({
        {"[a-c]", "b", true},     {"[a-c]", "d", false},    {"[^a-c]", "d", true}, {"[^a-c]", "b", false},
        {"[^a-c]", "", false},    {"[abx-z]9", "y9", true}, {"[%]", "%", true},    {"[%]", "a", false},
        {"100[%]", "100%", true}, {"[_]", "_", true},       {"[]]", "]", true},    {"[]a]", "a", true},
        {"[a-]", "-", true},      {"[a", "[a", true},       {"[a", "a", false},    {"[", "[", true},
        {"[]", "[]", true},       {"[^", "[^", true},       {"a]", "a]", true},    {"[\xc3\xa0-\xc3\xbf]", "\xc3\xa4", true},
    });
}

TEST(LikePatternTest, ManyPercentSignsTakeNoMoreThanQuadraticTime)
{
    std::string pattern;
    for (int number = 0; number < 200; ++number) {
        pattern += "%a";
    }
    const std::string text(20000, 'a');
    EXPECT_TRUE(TLikePattern(pattern).Matches(text));
    EXPECT_FALSE(TLikePattern(pattern + "b").Matches(text));
}

}  // namespace
}  // namespace NORVZEL20
