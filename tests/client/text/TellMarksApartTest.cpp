#include "client/text/TellMarksApart.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

using TTexts = std::vector<std::string>;

TEST(TellMarksApartTest, EscapesMarksOnlyIfTheyDiffer)
{
    const struct {
        TTexts texts;
        TTexts told;
    } rows[] = {
        {{"\u00e9", "e\u0301"}, {"\u00e9", "e\\u0301"}},
        {{"M\u00fcller", "M\u00f6ller"}, {"M\u00fcller", "M\u00f6ller"}},
        {{"e\u0301 one", "e\u0301 two"}, {"e\u0301 one", "e\u0301 two"}},
        {{"a\u0301\u0323", "a\u0323\u0301"}, {"a\\u0301\\u0323", "a\\u0323\\u0301"}},
        {{"\u00c5", "\u212b"}, {"\u00c5", "\\u212b"}},
        {{"\uac00", "\u1100\u1161"}, {"\uac00", "\u1100\\u1161"}},
        {{"e\u0301", "\u00e9", "e"}, {"e\\u0301", "\u00e9", "e"}},
        {{"\U0001f600 a", "\U0001f600 b"}, {"\U0001f600 a", "\U0001f600 b"}},
        {{}, {}},
    };
    for (const auto& row : rows) {
        TTexts texts = row.texts;
        TellMarksApart(texts);
        EXPECT_EQ(row.told, texts);
        TellMarksApart(texts);
        EXPECT_EQ(row.told, texts);
    }
}

}  // namespace
}  // namespace NORVZEL20
