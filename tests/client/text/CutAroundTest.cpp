#include "client/text/CutAround.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

std::string Cut(const std::string& one, const std::string& other)
{
    const auto [first, second] = CutAround(one, other);
    return first + " | " + second;
}

TEST(CutAroundTest, ShortTextsStay)
{
    EXPECT_EQ("one text | another text", Cut("one text", "another text"));
}

TEST(CutAroundTest, OfLongTextsTheDifferenceStays)
{
    const std::string head(50, 'h');
    const std::string tail(50, 't');
    EXPECT_EQ("...hhhhhhhhhhhhOLDtttttttttttt... | ...hhhhhhhhhhhhNEWtttttttttttt...",
              Cut(head + "OLD" + tail, head + "NEW" + tail));
    EXPECT_EQ("...hhhhhhhhhhhhOLD | ...hhhhhhhhhhhhNEW", Cut(head + head + "OLD", head + head + "NEW"));
    EXPECT_EQ("OLDtttttttttttt... | NEWtttttttttttt...", Cut("OLD" + tail + tail, "NEW" + tail + tail));
}

TEST(CutAroundTest, WhatOneTextHasMoreStays)
{
    const std::string head(70, 'h');
    EXPECT_EQ("...hhhhhhhhhhhh | ...hhhhhhhhhhhh and more", Cut(head, head + " and more"));
    EXPECT_EQ("...hhhhhhhhhhhh | ...hhhhhhhhhhhhh", Cut(head, head + "h"));
}

TEST(CutAroundTest, CharactersStayWhole)
{
    const std::string head(49, 'h');
    std::string umlauts;
    for (int i = 0; i < 30; ++i) {
        umlauts += "\u00e4";
    }
    const auto [one, other] = CutAround(umlauts + "x" + umlauts, umlauts + "y" + umlauts);
    EXPECT_EQ("...\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4x\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4...", one);
    EXPECT_EQ("...\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4y\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4...", other);
    // The first bytes of two characters may be equal.
    EXPECT_EQ("...hhhhhhhhhhh\u00e4 | ...hhhhhhhhhhh\u00f6", Cut(head + head + "\u00e4", head + head + "\u00f6"));
}

}  // namespace
}  // namespace NORVZEL20
