#include <gtest/gtest.h>

#include "client/collect/TOmissions.h"
#include "tests/client/collect/FactsText.h"

namespace NORVZEL20 {

namespace {

std::string LinesOf(const TOmissions& omissions)
{
    std::string text;
    for (const std::string& line : omissions.MakeLines()) {
        text += line + "\n";
    }
    return text;
}

}  // namespace

TEST(OmissionsTest, EachKindIsALineWithItsReasons)
{
    TOmissions omissions;
    omissions.Add("users", "x", "/b");
    omissions.Add("files", "y", "/c", "do z");
    omissions.Add("files", "x", "/a");
    omissions.Add("files", "y", "/d", "do z");
    EXPECT_EQ("not collected: files: /a: x; /c, /d: y (do z)\nnot collected: users: /b: x\n", LinesOf(omissions));
    EXPECT_EQ("NotCollected: Kind=files Reason=x Count=1 Subjects={\"/a\"}\n"
              "NotCollected: Kind=files Reason=y Count=2 Subjects={\"/c\", \"/d\"}\n"
              "NotCollected: Kind=users Reason=x Count=1 Subjects={\"/b\"}\n",
              FactsText(omissions.MakeFacts()));
}

TEST(OmissionsTest, ManySubjectsAreCounted)
{
    TOmissions omissions;
    for (int i = 0; i < 4; ++i) {
        omissions.Add("files", "x", std::to_string(i));
    }
    EXPECT_EQ("not collected: files: 0, 1, 2, 3: x\n", LinesOf(omissions));
    for (int i = 4; i < 25; ++i) {
        omissions.Add("files", "x", std::to_string(i));
    }
    EXPECT_EQ("not collected: files: 0, 1, 2 and 22 others: x\n", LinesOf(omissions));
    const std::string facts = FactsText(omissions.MakeFacts());
    EXPECT_EQ("NotCollected: Kind=files Reason=x Count=25 Subjects={\"0\"", facts.substr(0, 56));
    EXPECT_NE(std::string::npos, facts.find("\"19\"} Others=5\n")) << facts;
}

TEST(OmissionsTest, NothingIsNoLine)
{
    EXPECT_EQ("", LinesOf(TOmissions()));
    EXPECT_TRUE(TOmissions().MakeFacts().empty());
}

}  // namespace NORVZEL20
