// Rules that come with the program, by their name.
#include "client/rules/FindRules.h"

#include <gtest/gtest.h>
#include <unistd.h>

#include <cstdlib>
#include <fstream>
#include <string>

#include "client/process/TClientError.h"
#include "client/rules/ReadRules.h"

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

    static std::string Complaint(const std::string& name)
    {
        try {
            ReadRules(name);
        } catch (const TClientError& error) {
            return error.what();
        }
        return "none";
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

TEST_F(FindRulesTest, AWordWithoutRulesIsRefusedWithTheFileThatWasLookedFor)
{
    const std::string shipped = FindRules("linux");
    const std::string folder = shipped.substr(0, shipped.rfind('/') + 1);
    const std::string advice = "; name a rules file that can be read, or - for standard input";
    EXPECT_EQ("none: cannot be opened: No such file or directory, and the program has no rules " + folder + "none.xml" + advice,
              Complaint("none"));
    EXPECT_EQ("none.xml: cannot be opened: No such file or directory" + advice, Complaint("none.xml"));
}

}  // namespace
}  // namespace NORVZEL20
