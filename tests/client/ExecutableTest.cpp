#include <sys/wait.h>

#include <array>
#include <cstdio>

#include "tests/client/ClientTest.h"

namespace NORVZEL20 {
namespace {

/// Runs the installed program itself, through a shell.
class ExecutableTest : public ClientTest {
  protected:
    /// Gives exit status, standard output and standard error, one after the other.
    std::string Shell(const std::string& arguments, const std::string& before = std::string())
    {
        const std::string err = Scratch("stderr", "");
        const std::string command = before + CIMDELTA_PROGRAM + " " + arguments + " 2>" + err;
        std::FILE* pipe = popen(command.c_str(), "r");
        std::string out;
        std::array<char, 4096> buffer;
        while (const std::size_t count = std::fread(buffer.data(), 1, buffer.size(), pipe)) {
            out.append(buffer.data(), count);
        }
        const int status = pclose(pipe);
        return "[" + std::to_string(WEXITSTATUS(status)) + "]\n" + out + "--\n" + ReadFile(err);
    }
};

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

TEST_F(ExecutableTest, AnOutputFileThatFindsNoRoomLeavesWhatWasThere)
{
    const std::string file = Scratch("report", "what was there before");
    // Room for the counters that a coverage build writes at its end, not for the inventory.
    const std::string noRoom = "ulimit -f 8000; trap '' XFSZ; ";
    EXPECT_EQ("[2]\n--\ncimdelta: " + file + ": cannot be written: File too large\n",
              Shell("show " CIMDELTA_PAIR_DATA "/a.xml.xz -o cimxml --output " + file, noRoom));
    EXPECT_EQ("what was there before", ReadFile(file));
    EXPECT_EQ(0, std::system(("test -z \"$(ls " + file + ".* 2>/dev/null)\"").c_str()));
}

TEST_F(ExecutableTest, AWriterThatIsKilledLeavesWhatWasThere)
{
    const std::string file = Scratch("report", "what was there before");
    const std::string write = std::string(CIMDELTA_PROGRAM) + " show " CIMDELTA_PAIR_DATA "/a.xml.xz -o cimxml --output " + file;
    // Killed as soon as a part of the new file can be seen beside the old one; status 3 where the writer was faster.
    const std::string kill = "bash -c '" + write + " & while set -- " + file +
                             ".*; ! test -s \"$1\"; do kill -0 $! || exit 3; done; " +
                             "kill -KILL $!; wait $!; test $? = 137 || exit 3; rm " + file + ".*' 2>/dev/null";
    bool killed = false;
    for (int attempt = 0; attempt < 20 && !killed; ++attempt) {
        Scratch("report", "what was there before");
        killed = std::system(kill.c_str()) == 0;
    }
    ASSERT_TRUE(killed) << "the writer was never caught in the middle";
    EXPECT_EQ("what was there before", ReadFile(file));
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
