#include <gtest/gtest.h>

#include "embedded/value/TNameText.h"

namespace NORVZEL20 {
namespace {

TEST(NameTextTest, NamesThatDifferInLetterCaseAreEqualAndHashAlike)
{
    EXPECT_TRUE(TNameText::Equal("CIM_Disk", "cim_DISK"));
    EXPECT_EQ(TNameText::Hash("CIM_Disk"), TNameText::Hash("cim_DISK"));
    EXPECT_EQ(0, TNameText::Compare("CIM_Disk", "cim_DISK"));
    EXPECT_FALSE(TNameText::Equal("CIM_Disk", "CIM_Disk2"));
    EXPECT_FALSE(TNameText::Equal("CIM_Disk", "CIM_Disc"));
}

TEST(NameTextTest, ASpellingIsTheSameIfEachByteIs)
{
    EXPECT_TRUE(TNameText::HasSameSpelling("", std::string_view()));
    EXPECT_FALSE(TNameText::HasSameSpelling("CIM_Disk", "CIM_Disk2"));
    for (std::size_t length = 1; length < 40; ++length) {
        const std::string name(length, 'a');
        EXPECT_TRUE(TNameText::HasSameSpelling(name, std::string(length, 'a')));
        for (std::size_t at = 0; at < length; ++at) {
            std::string other = name;
            other[at] = 'A';
            EXPECT_FALSE(TNameText::HasSameSpelling(name, other)) << other;
            EXPECT_TRUE(TNameText::Equal(name, other)) << other;
        }
    }
}

TEST(NameTextTest, OnlyAsciiLettersFold)
{
    EXPECT_FALSE(TNameText::Equal("\xC3\x84", "\xC3\xA4"));
    EXPECT_FALSE(TNameText::Equal("a[", "a{"));
    EXPECT_EQ("abc[\xC3\x84", TNameText::ToLower("ABC[\xC3\x84"));
}

TEST(NameTextTest, OrderIsThatOfTheLowerCaseBytes)
{
    EXPECT_LT(TNameText::Compare("a", "B"), 0);
    EXPECT_LT(TNameText::Compare("Key", "Key2"), 0);
    EXPECT_GT(TNameText::Compare("\xC3\x84", "z"), 0);
    EXPECT_LT(TNameText::Compare("A_", "AB"), 0) << "an underscore stands before lower-case letters";
    const std::string common(20, 'a');
    EXPECT_LT(TNameText::Compare(common + "B", common + "c"), 0);
    EXPECT_GT(TNameText::Compare(common + "c", common + "B"), 0);
    EXPECT_LT(TNameText::Compare(common, common + "b"), 0);
    EXPECT_EQ(0, TNameText::Compare(common + "bcdefghi", common + "BCDEFGHI"));
}

TEST(NameTextTest, MapsFindANameInAnySpelling)
{
    TNameMap<int> byName{{"Name", 1}};
    EXPECT_EQ(1, byName.find("NAME")->second);
    EXPECT_EQ(byName.end(), byName.find("Nam"));
}

}  // namespace
}  // namespace NORVZEL20
