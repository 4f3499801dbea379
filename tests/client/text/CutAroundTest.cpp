#include "client/text/CutAround.h"

#include <gtest/gtest.h>

#include <boost/algorithm/string/join.hpp>

namespace NORVZEL20 {
namespace {

std::string Cut(const std::vector<std::string>& texts)
{
    return boost::algorithm::join(CutAround(texts), " | ");
}

std::string Cut(const std::string& one, const std::string& other)
{
    return Cut({one, other});
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

TEST(CutAroundTest, WhatAllTextsHaveIsCut)
{
    const std::string head(50, 'h');
    const std::string tail(50, 't');
    EXPECT_EQ("...hhhhhhhhhhhhONEtttttttttttt... | ...hhhhhhhhhhhhTWOtttttttttttt... | ...hhhhhhhhhhhhtttttttttttt...",
              Cut({head + "ONE" + tail, head + "TWO" + tail, head + tail}));
    // Two of them have more in common.
    EXPECT_EQ("...hhhhhhhhhhhhONEtttttttttttt... | ...hhhhhhhhhhhhOLDtttttttttttt... | ...hhhhhhhhhhhhtttttttttttt...",
              Cut({head + "ONE" + tail, head + "OLD" + tail, head + tail}));
    EXPECT_EQ("NULL | ...hhhhhhhhhhhhONEtttttttttttt... | ...hhhhhhhhhhhhTWOtttttttttttt...",
              Cut({"NULL", head + "ONE" + tail, head + "TWO" + tail}));
    EXPECT_EQ("NULL | x | " + head + "ONE and more", Cut({"NULL", "x", head + "ONE and more"}));
}

TEST(CutAroundTest, CharactersStayWhole)
{
    const std::string head(49, 'h');
    std::string umlauts;
    for (int i = 0; i < 30; ++i) {
        umlauts += "\u00e4";
    }
    EXPECT_EQ("...\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4x\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4... | "
              "...\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4y\u00e4\u00e4\u00e4\u00e4\u00e4\u00e4...",
              Cut(umlauts + "x" + umlauts, umlauts + "y" + umlauts));
    // The first bytes of two characters may be equal.
    EXPECT_EQ("...hhhhhhhhhhh\u00e4 | ...hhhhhhhhhhh\u00f6", Cut(head + head + "\u00e4", head + head + "\u00f6"));
}

}  // namespace
}  // namespace NORVZEL20
