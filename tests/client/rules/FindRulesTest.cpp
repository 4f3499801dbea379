// Rules that come with the program, by their name.
#include "client/rules/FindRules.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <string>

namespace NORVZEL20 {
namespace {

/// In an empty folder.
class FindRulesTest : public testing::Test {
  protected:
    void SetUp() override
    {
        std::string folder = testing::TempDir() + "cimdelta-rules-XXXXXX";
        ASSERT_NE(nullptr, mkdtemp(folder.data()));
        fFolder = folder;
        ASSERT_EQ(0, chdir(fFolder.c_str()));
    }

    void TearDown() override
    {
        unlink("linux");
        ASSERT_EQ(0, chdir("/"));
        rmdir(fFolder.c_str());
    }

    std::string fFolder;
};

TEST_F(FindRulesTest, AWordNamesRulesOfTheProgram)
{
    const std::string found = FindRules("linux");
    const std::string end = "/data/rules/linux.xml";
    ASSERT_LT(end.size(), found.size());
    EXPECT_EQ(end, found.substr(found.size() - end.size()));
    std::string line;
    EXPECT_TRUE(std::getline(std::ifstream(found), line));
}

TEST_F(FindRulesTest, AFileOfThatNameIsMeantFirst)
{
    std::ofstream("linux") << "<DifftoolSpec/>";
    EXPECT_EQ("linux", FindRules("linux"));
}

TEST_F(FindRulesTest, EverythingElseIsAPath)
{
    for (const char* name : {"", "-", "none", "linux.xml", "./linux", "../rules/linux", "Linux"}) {
        EXPECT_EQ(name, FindRules(name)) << name;
    }
}

}  // namespace
}  // namespace NORVZEL20
