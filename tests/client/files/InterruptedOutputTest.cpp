// The promise of --output: the file appears whole or not at all. The program is really killed here, at a moment that is found by
// watching its folder.

#include <fcntl.h>
#include <sys/ioctl.h>
#include <sys/resource.h>

#include <chrono>
#include <csignal>
#include <cstdlib>
#include <thread>

#include "tests/client/TOutputFolder.h"
#include "tests/client/TProgramFixture.h"
#include "tests/client/TStartedProgram.h"

namespace NORVZEL20 {
namespace {

const char kLarge[] = CIMDELTA_PAIR_DATA "/a.xml.xz";
const char kBefore[] = "what was there before";

/// Results that do not arrive: the program is killed on the way, or the reader of the result goes away or waits.
class InterruptedOutputTest : public TProgramFixture {
  protected:
    void SetUp() override
    {
        TProgramFixture::SetUp();
        // Some of the signals would write a core file.
        struct rlimit core = {};
        ASSERT_EQ(0, getrlimit(RLIMIT_CORE, &core));
        core.rlim_cur = 0;
        ASSERT_EQ(0, setrlimit(RLIMIT_CORE, &core));
        PutBack();
    }

    void PutBack() { std::ofstream(fReport, std::ios::binary) << kBefore; }

    /// Sends the program the signal after its temporary file has appeared in the folder and before the report is complete. Repeats
    /// that until the moment is hit. Returns how the program ended.
    std::string EndInTheMiddle(const std::vector<std::string>& arguments, int signal)
    {
        const std::string before = fFolder.List();
        if (fWhole.empty()) {
            fWhole = Result({"show", kLarge, "-o", "cimxml"});
        }
        const int silence = open("/dev/null", O_WRONLY | O_CLOEXEC);
        std::string end;
        for (int attempt = 0; attempt < 50 && end.empty(); ++attempt) {
            PutBack();
            TStartedProgram program(arguments, {{STDERR_FILENO, silence}});
            while (fFolder.List() == before && !program.HasEnded()) {
                std::this_thread::sleep_for(std::chrono::microseconds(100));
            }
            program.Signal(signal);
            const std::string outcome = program.Wait();
            if (outcome.find("signal") == 0 && ReadFile(fReport) != fWhole) {
                end = outcome;
            }
        }
        close(silence);
        return end.empty() ? "the program was never caught in the middle" : end;
    }

    const std::vector<std::string> WriteReport() const { return {"show", kLarge, "-o", "cimxml", "--output", fReport}; }

    const TOutputFolder fFolder;
    const std::string fReport = fFolder / "report";
    std::string fWhole;
};

TEST_F(InterruptedOutputTest, NoRoomLeavesWhatWasThere)
{
    // Room for the counters that a coverage build writes at its end, not for the inventory.
    const std::string noRoom = "ulimit -f 8000; ";
    EXPECT_EQ("[2]\n--\ncimdelta: " + fReport + ": cannot be written: File too large\n",
              Shell(std::string("show ") + kLarge + " -o cimxml --output " + fReport, noRoom));
    EXPECT_EQ(kBefore, ReadFile(fReport));
    EXPECT_EQ("report ", fFolder.List());
}

TEST_F(InterruptedOutputTest, NothingIsSavedIfTheReportCannotBeMade)
{
    EXPECT_EQ("[2]\n--\ncimdelta: " + fReport + ": cannot be written: File too large\n",
              Shell("compare " CIMDELTA_PAIR_DATA "/a.xml.xz " CIMDELTA_PAIR_DATA "/b.xml.xz -o json --output " + fReport +
                        " --accept " + (fFolder / "accepted") + " --save-rules " + (fFolder / "rules"),
                    "ulimit -f 8000; "));
    EXPECT_EQ("report ", fFolder.List());
}

TEST_F(InterruptedOutputTest, AWriterThatIsKilledLeavesWhatWasThere)
{
    EXPECT_EQ("signal 9", EndInTheMiddle(WriteReport(), SIGKILL));
    EXPECT_EQ(kBefore, ReadFile(fReport));
}

TEST_F(InterruptedOutputTest, SignalsLeaveNothingUnfinished)
{
    for (const int signal : {SIGTERM, SIGINT, SIGHUP, SIGQUIT, SIGXCPU, SIGALRM, SIGUSR1, SIGIO, SIGPWR, SIGRTMIN, SIGRTMAX}) {
        EXPECT_EQ("signal " + std::to_string(signal), EndInTheMiddle(WriteReport(), signal));
        EXPECT_EQ(kBefore, ReadFile(fReport));
        EXPECT_EQ("report ", fFolder.List());
    }
}

TEST_F(InterruptedOutputTest, ASignalThatIsIgnoredStaysSo)
{
    const auto before = std::signal(SIGHUP, SIG_IGN);
    TStartedProgram program(WriteReport(), {}, SIGHUP);
    while (fFolder.List() == "report " && !program.HasEnded()) {
        program.Signal(SIGHUP);
    }
    program.Signal(SIGHUP);
    EXPECT_EQ("status 0", program.Wait());
    std::signal(SIGHUP, before);
    EXPECT_TRUE(Result({"show", kLarge, "-o", "cimxml"}) == ReadFile(fReport));
}

TEST_F(InterruptedOutputTest, AClosedStandardOutputEndsQuietly)
{
    EXPECT_EQ("[2]\n--\n", Shell("show web01.xml >&-"));
    EXPECT_EQ("[2]\n--\n", Shell("--version >&-"));
    EXPECT_EQ("[0]\n--\n", Shell("show web01.xml --output " + fReport + " >&-"));
    EXPECT_EQ(Result({"show", "web01.xml"}), ReadFile(fReport));
}

TEST_F(InterruptedOutputTest, AStandardOutputThatIsNotForWritingIsReported)
{
    EXPECT_EQ("[2]\n--\ncimdelta: standard output cannot be written: Bad file descriptor\n", Shell("show web01.xml 1<web01.xml"));
}

TEST_F(InterruptedOutputTest, NoInventoryTakesThePlaceOfAClosedStandardInput)
{
    for (int i = 0; i < 20; ++i) {
        EXPECT_EQ("[2]\n--\ncimdelta: standard input: cannot be read: it is closed\n", Shell("compare - web02.xml <&-"));
        EXPECT_EQ("[2]\n--\ncimdelta: standard input: cannot be read: it is closed\n", Shell("compare web02.xml - <&- >&-"));
    }
}

TEST_F(InterruptedOutputTest, APipeThatWouldBlockIsWaitedFor)
{
    int ends[2];
    ASSERT_EQ(0, pipe2(ends, O_CLOEXEC));
    ASSERT_EQ(0, fcntl(ends[1], F_SETFL, O_NONBLOCK));
    const int capacity = fcntl(ends[1], F_GETPIPE_SZ);
    TStartedProgram program({"show", kLarge, "-o", "cimxml"}, {{STDOUT_FILENO, ends[1]}});
    close(ends[1]);
    for (int held = 0; held < capacity && !program.HasEnded();) {
        ASSERT_EQ(0, ioctl(ends[0], FIONREAD, &held));
        std::this_thread::sleep_for(std::chrono::microseconds(100));
    }
    std::string text;
    std::array<char, 4096> buffer;
    for (ssize_t count = 1; count > 0;) {
        count = read(ends[0], buffer.data(), buffer.size());
        text.append(buffer.data(), static_cast<std::size_t>(count < 0 ? 0 : count));
    }
    close(ends[0]);
    EXPECT_EQ("status 0", program.Wait());
    EXPECT_TRUE(text == Result({"show", kLarge, "-o", "cimxml"})) << text.size();
}

TEST_F(InterruptedOutputTest, AFifoWhoseReaderGoesEndsQuietly)
{
    const std::string fifo = fFolder / "fifo";
    const std::string reader = "mkfifo " + fifo + "; head -c 1 " + fifo + " >/dev/null & ";
    EXPECT_EQ("[2]\n--\n", Shell(std::string("show ") + kLarge + " -o cimxml --output " + fifo, reader));
}

TEST_F(InterruptedOutputTest, WhatADescriptorLeadsToIsAddedTo)
{
    ASSERT_EQ(0, access("/proc/self/fd/1", F_OK)) << "/dev/stdout leads nowhere; mount /proc";
    const std::string result = Result({"show", "web01.xml"});
    EXPECT_EQ("[0]\n--\n", Shell("show web01.xml --output /dev/stdout >> " + fReport));
    EXPECT_EQ(kBefore + result, ReadFile(fReport));
    const std::string err =
        Shell("show web01.xml --output /dev/fd/7; echo behind >&7; } 7>" + fReport + "; true", "{ echo ahead >&7; ");
    EXPECT_EQ("ahead\n" + result + "behind\n", ReadFile(fReport)) << err;
    EXPECT_EQ("[0]\n" + result + "--\n", Shell("show web01.xml --output /dev/stdout | cat"));
}

TEST_F(InterruptedOutputTest, LinksAreFollowedAndStay)
{
    ASSERT_EQ(0, symlink("report", (fFolder / "link").c_str()));
    ASSERT_EQ(0, symlink("link", (fFolder / "second").c_str()));
    const std::string result = Result({"show", "web01.xml"});
    Result({"show", "web01.xml", "--output", fFolder / "second"});
    EXPECT_EQ(result, ReadFile(fReport));
    unlink(fReport.c_str());
    Result({"show", "web01.xml", "--output", fFolder / "second"});
    EXPECT_EQ(result, ReadFile(fReport));
    EXPECT_TRUE(std::filesystem::is_symlink(fFolder / "link"));
    EXPECT_TRUE(std::filesystem::is_symlink(fFolder / "second"));
    ASSERT_EQ(0, symlink("round", (fFolder / "round").c_str()));
    EXPECT_EQ("cimdelta: R: cannot be written: Too many levels of symbolic links\n",
              Shorten(Complaint({"show", "web01.xml", "--output", fFolder / "round"}), fFolder / "round", "R"));
}

TEST_F(InterruptedOutputTest, ANameMayBeAsLongAsNamesCanBe)
{
    const std::string file = fFolder / std::string(255, 'n');
    EXPECT_EQ("", Result({"show", "web01.xml", "--output", file}));
    EXPECT_EQ(Result({"show", "web01.xml"}), ReadFile(file));
    EXPECT_EQ("cimdelta: F: cannot be written: File name too long\n",
              Shorten(Complaint({"show", "web01.xml", "--output", file + "n"}), file + "n", "F"));
    EXPECT_EQ(std::string(255, 'n') + " report ", fFolder.List());
}

}  // namespace
}  // namespace NORVZEL20
