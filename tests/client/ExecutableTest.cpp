#include <cstdlib>

#include "tests/client/ProgramTest.h"

namespace NORVZEL20 {
namespace {

class ExecutableTest : public ProgramTest {};

const char kPackages[] =
    "[0]\nINV_Disk.BootId=1,Device=\"sda\"\n    Device: sda\n    BootId: 1\n    SizeMB: 500\n    Model: A 1\n--\n";

TEST_F(ExecutableTest, ResultsGoToStandardOutputAlone)
{
    EXPECT_EQ(kPackages, Shell("show web01.xml INV_Disk"));
    EXPECT_EQ("[0]\ncimdelta 0.1.0\n--\n", Shell("--version"));
}

TEST_F(ExecutableTest, TroubleGoesToStandardErrorAlone)
{
    EXPECT_EQ("[2]\n--\ncimdelta: none.xml: cannot be opened: No such file or directory\n", Shell("compare web01.xml none.xml"));
    EXPECT_EQ("[2]\n--\ncimdelta: name a command: compare, check, explain, query or show; see cimdelta --help\n", Shell("frob"));
}

TEST_F(ExecutableTest, TheStatusTellsWhetherSomethingDiffers)
{
    EXPECT_EQ("[0]", Shell("compare web01.xml web01-again.xml").substr(0, 3));
    EXPECT_EQ("[1]", Shell("compare web01.xml web02.xml").substr(0, 3));
}

TEST_F(ExecutableTest, StandardInputIsAnInventoryToo)
{
    EXPECT_EQ(kPackages, Shell("show - INV_Disk < web01.xml"));
    EXPECT_EQ("[1]\n8 differences between web01 and stdin: ", Shell("compare web01.xml - < web02.xml.gz").substr(0, 43));
}

TEST_F(ExecutableTest, AnOutputFileAppearsWhole)
{
    const std::string report = Shell("compare web01.xml web02.xml");
    const std::string file = Scratch("report", "what was there before");
    EXPECT_EQ("[1]\n--\n", Shell("compare --output " + file + " web01.xml web02.xml"));
    EXPECT_EQ(report, "[1]\n" + ReadFile(file) + "--\n");
}

TEST_F(ExecutableTest, AnOutputFileStaysWhereTroubleComesUp)
{
    const std::string file = Scratch("report", "what was there before");
    EXPECT_EQ("[2]", Shell("compare --output " + file + " web01.xml none.xml").substr(0, 3));
    EXPECT_EQ("what was there before", ReadFile(file));
    EXPECT_EQ("[2]\n--\ncimdelta: /nowhere/report: cannot be written: No such file or directory\n",
              Shell("compare --output /nowhere/report web01.xml web02.xml"));
}

TEST_F(ExecutableTest, AFullDeviceIsTold)
{
    EXPECT_EQ("[2]\n--\ncimdelta: standard output cannot be written: No space left on device\n",
              Shell("show web01.xml > /dev/full"));
    EXPECT_EQ("[2]\n--\ncimdelta: /dev/full: cannot be written: No space left on device\n",
              Shell("show web01.xml --output /dev/full"));
}

TEST_F(ExecutableTest, AClosedPipeEndsQuietly)
{
    // The reader is gone before the inventory comes.
    const std::string err = Scratch("pipe", "");
    const std::string command = "bash -c '{ sleep 0.3; cat web01.xml; } | { " + std::string(CIMDELTA_PROGRAM) +
                                " show - -o cimxml; echo $? >&2; } 2>" + err + " | true'";
    ASSERT_EQ(0, std::system(command.c_str()));
    EXPECT_EQ("2\n", ReadFile(err));
}

}  // namespace
}  // namespace NORVZEL20
