#include <sys/stat.h>

#include <cstdlib>

#include "tests/client/TProgramFixture.h"

namespace NORVZEL20 {
namespace {

class ExecutableTest : public TProgramFixture {};

const char kPackages[] =
    "[0]\nINV_Disk.BootId=1,Device=\"sda\"\n    Device: sda\n    BootId: 1\n    SizeMB: 500\n    Model: A 1\n--\n";

TEST_F(ExecutableTest, ResultsGoToStandardOutputAlone)
{
    EXPECT_EQ(kPackages, Shell("show web01.xml INV_Disk"));
    EXPECT_EQ("[0]\ncimdelta 0.1.0\n--\n", Shell("--version"));
}

TEST_F(ExecutableTest, TroubleGoesToStandardErrorAlone)
{
    EXPECT_EQ("[2]\n--\ncimdelta: none.xml: cannot be opened: No such file or directory\n",
              Shell("compare --detail web01.xml none.xml"));
    EXPECT_EQ("[2]\n--\ncimdelta: frob is no command; name one: compare, noise, check, explain, query, show or collect; see "
              "cimdelta --help\n",
              Shell("frob"));
}

TEST_F(ExecutableTest, TheEnvironmentDecidesOnColoursInAPipe)
{
    const auto isColored = [this](const std::string& environment, const std::string& options) {
        return Shell("compare " + options + " web01.xml web02.xml", environment).find("\x1b[") != std::string::npos;
    };
    EXPECT_FALSE(isColored("", ""));
    EXPECT_TRUE(isColored("CLICOLOR_FORCE=1 ", ""));
    EXPECT_FALSE(isColored("CLICOLOR_FORCE=0 ", ""));
    EXPECT_FALSE(isColored("CLICOLOR_FORCE= ", ""));
    EXPECT_FALSE(isColored("CLICOLOR_FORCE=1 NO_COLOR=1 ", ""));
    EXPECT_TRUE(isColored("NO_COLOR=1 ", "--color always"));
    EXPECT_FALSE(isColored("CLICOLOR_FORCE=1 ", "--color never"));
}

TEST_F(ExecutableTest, ColumnsIsTheWidthOfAPipe)
{
    const auto hasWhole = [this](const std::string& environment) {
        const std::string report = Shell("compare --summary web01.xml front-end-of-shop=web02.xml back-end=web03.xml", environment);
        return report.find("    8  front-end-of-shop        5  back-end\n") != std::string::npos;
    };
    EXPECT_TRUE(hasWhole(""));
    EXPECT_FALSE(hasWhole("COLUMNS=40 "));
    for (const char* const unclear : {"0", "", "40x", "-1", "99999999999999999999999"}) {
        EXPECT_TRUE(hasWhole("COLUMNS=" + std::string(unclear) + " ")) << unclear;
    }
}

TEST_F(ExecutableTest, MessagesMoveNoTerminal)
{
    EXPECT_EQ("[2]\n--\ncimdelta: \\x1b[31m\\u202e\\u009b\\u061c\\x7f\\n.xml: cannot be opened: No such file or directory\n",
              Shell("show '\x1b[31m\u202e\u009b\u061c\x7f\n.xml'"));
    const std::string undeclared =
        Scratch("term", "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION><DECLGROUP><VALUE.OBJECT>"
                        "<INSTANCE CLASSNAME='\u009b2J\u202e'/></VALUE.OBJECT></DECLGROUP></DECLARATION></CIM>");
    EXPECT_NE(std::string::npos,
              Shell("show " + undeclared).find("found an instance of class \"\\u009b2J\\u202e\", which is not declared"))
        << Shell("show " + undeclared);
}

TEST_F(ExecutableTest, TheStatusSaysWhetherSomethingDiffers)
{
    EXPECT_EQ("[0]", Shell("compare --detail web01.xml web01-again.xml").substr(0, 3));
    EXPECT_EQ("[1]", Shell("compare --detail web01.xml web02.xml").substr(0, 3));
}

TEST_F(ExecutableTest, StandardInputIsAnInventoryToo)
{
    EXPECT_EQ(kPackages, Shell("show - INV_Disk < web01.xml"));
    EXPECT_EQ("[1]\n8 differences between web01 and stdin: ", Shell("compare --detail web01.xml - < web02.xml.gz").substr(0, 43));
    EXPECT_EQ(
        "[2]\n--\ncimdelta: standard input: cannot be read: the gzip data is damaged (it ends early); fetch or make it anew\n",
        Shell("compare --detail web01.xml -", "head -c 700 web02.xml.gz | "));
}

TEST_F(ExecutableTest, RulesMayComeFromStandardInputOrAPipe)
{
    const std::string compared = Shell("compare --detail --spec rules.xml web01.xml web02.xml");
    EXPECT_EQ("[1]", compared.substr(0, 3));
    EXPECT_EQ(compared, Shell("compare --detail --spec - web01.xml web02.xml < rules.xml"));
    EXPECT_EQ(compared, Shell("compare --detail --spec /dev/fd/0 web01.xml web02.xml", "cat rules.xml | "));
    EXPECT_EQ("[0]\nINV_Package.Size: not compared, excluded by the list at standard input:5 (element for class INV_Package)\n--\n",
              Shell("explain INV_Package.Size --spec - --schema web01.xml < rules.xml"));
    EXPECT_EQ("[0]\nstandard input: 2 elements, 0 warnings\n",
              Shell("check - --schema web01.xml", "cat rules.xml | ").substr(0, 43));
    EXPECT_EQ("[2]\n--\ncimdelta: standard input: the file is empty; rules are an element DifftoolSpec with elements class in it\n",
              Shell("check - --schema web01.xml < /dev/null"));
}

TEST_F(ExecutableTest, AnOutputFileAppearsWhole)
{
    const std::string report = Shell("compare --detail web01.xml web02.xml");
    const std::string file = Scratch("report", "what was there before");
    EXPECT_EQ("[1]\n--\n", Shell("compare --detail --output " + file + " web01.xml web02.xml"));
    EXPECT_EQ(report, "[1]\n" + ReadFile(file) + "--\n");
}

TEST_F(ExecutableTest, AnOutputFileOfThatNameIsStandardOutput)
{
    EXPECT_EQ(kPackages, Shell("show web01.xml INV_Disk --output -"));
    EXPECT_NE(0, access("-", F_OK));
}

TEST_F(ExecutableTest, AnOutputFileKeepsOwnerAndRights)
{
    const std::string file = Scratch("report", "what was there before");
    ASSERT_EQ(0, chmod(file.c_str(), 0640));
    if (geteuid() == 0) {
        ASSERT_EQ(0, chown(file.c_str(), 1, 2));
    }
    struct stat before = {};
    struct stat after = {};
    ASSERT_EQ(0, stat(file.c_str(), &before));
    EXPECT_EQ("[0]\n--\n", Shell("show web01.xml INV_Disk --output " + file));
    ASSERT_EQ(0, stat(file.c_str(), &after));
    EXPECT_NE(before.st_ino, after.st_ino);
    EXPECT_EQ(before.st_mode, after.st_mode);
    EXPECT_EQ(before.st_uid, after.st_uid);
    EXPECT_EQ(before.st_gid, after.st_gid);
}

TEST_F(ExecutableTest, AnOutputFileStaysInTrouble)
{
    const std::string file = Scratch("report", "what was there before");
    EXPECT_EQ("[2]", Shell("compare --detail --output " + file + " web01.xml none.xml").substr(0, 3));
    EXPECT_EQ("what was there before", ReadFile(file));
    EXPECT_EQ("[2]\n--\ncimdelta: /nowhere/report: cannot be written: No such file or directory\n",
              Shell("compare --detail --output /nowhere/report web01.xml web02.xml"));
}

TEST_F(ExecutableTest, AFullDeviceIsReported)
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
