#include <gtest/gtest.h>

#include <fstream>
#include <iterator>

#include "tests/client/collect/TCollectFixture.h"

namespace NORVZEL20 {

/// The command itself, on the system that runs the test.
class CollectCommandTest : public TCollectFixture {
  protected:
    std::string Text(const std::string& path)
    {
        std::ifstream file(path, std::ios::binary);
        return std::string(std::istreambuf_iterator<char>(file), std::istreambuf_iterator<char>());
    }

    TOutputFolder fFolder;
};

TEST_F(CollectCommandTest, WritesTheInventoryToAFileOrToStandardOutput)
{
    const std::string path = fFolder / "web01.xml";
    EXPECT_EQ(std::string::npos, Run({"collect", "--only", "system", "-o", path.c_str()}).find("<CIM"));
    EXPECT_EQ(0, fStatus);
    EXPECT_NE(std::string::npos, Text(path).find("<INSTANCE CLASSNAME=\"KALMO_OperatingSystem\">"));
    EXPECT_EQ("web01.xml ", fFolder.List());
    EXPECT_NE(std::string::npos, Run({"collect", "--only", "system"}).find("<INSTANCE CLASSNAME=\"KALMO_OperatingSystem\">"));
    EXPECT_EQ(0, fStatus);
}

TEST_F(CollectCommandTest, TheSystemMeetsItself)
{
    const std::string before = fFolder / "before.xml";
    const std::string after = fFolder / "after.xml";
    Run({"collect", "--only", "system,processors,users", "-o", before.c_str()});
    Run({"collect", "--only", "system,processors,users", "--output", after.c_str()});
    Run({"compare", "--spec", CIMDELTA_LINUX_RULES, before.c_str(), after.c_str()});
    EXPECT_EQ(0, fStatus);
}

TEST_F(CollectCommandTest, WrongOptionsAreRefusedBeforeAnythingIsRead)
{
    const std::string none = fFolder / "none/x.xml";
    const struct {
        std::vector<const char*> arguments;
        std::string message;
    } rows[] = {
        {{"collect", "--only", "package"}, "cimdelta: package is no kind of thing that is collected; did you mean packages?\n"},
        {{"collect", "--skip", "users,zzzzzz"},
         "cimdelta: zzzzzz is no kind of thing that is collected; name one: system, processors, memory, disks, mounts, network, "
         "packages, "
         "units, kernel, users, jobs, sockets, files or certificates\n"},
        {{"collect", "--only", "users,jobs", "--skip", "system,users"},
         "cimdelta: found users in --only and in --skip, expected it in one of them; leave out the other\n"},
        {{"collect", "-o", none.c_str()}, "cimdelta: " + none + ": cannot be written: No such file or directory\n"},
        {{"collect", "web01.xml"}, "cimdelta: web01.xml is one argument too many; see cimdelta collect --help\n"},
        {{"collect", "--only", ""}, "cimdelta: --only: must not be empty; see cimdelta collect --help\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.message, Run(row.arguments));
        EXPECT_EQ(2, fStatus);
    }
    EXPECT_EQ("", fFolder.List());
}

}  // namespace NORVZEL20
