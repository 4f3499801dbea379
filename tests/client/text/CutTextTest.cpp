#include "client/text/CutText.h"

#include <gtest/gtest.h>

namespace NORVZEL20 {
namespace {

TEST(CutTextTest, OnlyALongTextIsCutAndBetweenCharacters)
{
    EXPECT_EQ("", CutText("", 4));
    EXPECT_EQ("four", CutText("four", 4));
    EXPECT_EQ("long...", CutText("longer", 4));
    EXPECT_EQ("m\xC3\xBC...", CutText("m\xC3\xBC\xC3\x9F\xC3\xBC", 4));
    EXPECT_EQ("...", CutText("a", 0));
}

}  // namespace
}  // namespace NORVZEL20
