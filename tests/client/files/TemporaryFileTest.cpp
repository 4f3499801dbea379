// The text is kept in memory if the kernel allows it, and otherwise in a folder. System calls fail here, so the second way is taken
// too. In the signal test the process itself is ended, in a child of the test.

#include "client/files/TTemporaryFile.h"

#include <fcntl.h>
#include <sys/resource.h>

#include <cerrno>
#include <csignal>
#include <cstdlib>

#include "client/process/EndingSignals.h"
#include "tests/client/TClientFixture.h"
#include "tests/client/TOutputFolder.h"
#include "tests/client/files/TSystemCalls.h"

namespace NORVZEL20 {
namespace {

const char kContent[] = "what another reader needs";
const char kAnonymous[] = "/proc/self/fd/";

/// Temporary files, with TMPDIR leading to a folder that the test watches.
class TemporaryFileTest : public TClientFixture {
  protected:
    void SetUp() override
    {
        TClientFixture::SetUp();
        setenv("TMPDIR", fFolder.GetPath().c_str(), 1);
    }

    void TearDown() override
    {
        unsetenv("TMPDIR");
        TClientFixture::TearDown();
    }

    /// What a temporary file is while it lives: "anonymous" or "in the folder", and its content.
    std::string Make() const
    {
        const TTemporaryFile file(kContent);
        const bool isAnonymous = file.GetPath().find(kAnonymous) == 0;
        EXPECT_EQ(isAnonymous ? "" : file.GetPath().substr(fFolder.GetPath().size() + 1) + " ", fFolder.List());
        return (isAnonymous ? "anonymous: " : "in the folder: ") + ReadFile(file.GetPath());
    }

    const TOutputFolder fFolder;
};

TEST_F(TemporaryFileTest, IsInNoFolder)
{
    EXPECT_EQ(std::string("anonymous: ") + kContent, Make());
}

TEST_F(TemporaryFileTest, IsReadFromItsBeginningEachTime)
{
    const TTemporaryFile file(kContent);
    EXPECT_EQ(kContent, ReadFile(file.GetPath()));
    EXPECT_EQ(kContent, ReadFile(file.GetPath()));
}

TEST_F(TemporaryFileTest, IsNotInherited)
{
    const TTemporaryFile file(kContent);
    EXPECT_EQ(FD_CLOEXEC, fcntl(std::stoi(file.GetPath().substr(sizeof kAnonymous - 1)), F_GETFD));
}

TEST_F(TemporaryFileTest, KeepsNoDescriptor)
{
    std::string before;
    {
        const TTemporaryFile file(kContent);
        before = file.GetPath();
    }
    EXPECT_EQ(before, TTemporaryFile(kContent).GetPath());
    {
        TSystemCalls calls;
        calls.Fail("write", 1, ENOSPC);
        EXPECT_EQ(std::string("in the folder: ") + kContent, Make());
    }
    EXPECT_EQ(before, TTemporaryFile(kContent).GetPath());
}

TEST_F(TemporaryFileTest, IsInTheFolderIfItCannotBeAnonymous)
{
    const struct {
        const char* call;
        int error;
    } rows[] = {{"memfd_create", ENOSYS}, {"write", ENOSPC}, {"open", ENOENT}};
    for (const auto& row : rows) {
        TSystemCalls calls;
        calls.Fail(row.call, 1, row.error);
        EXPECT_EQ(std::string("in the folder: ") + kContent, Make()) << row.call;
        EXPECT_EQ("", fFolder.List()) << row.call;
    }
}

TEST_F(TemporaryFileTest, TheRulesThatCompareMakesAreReadInEitherWay)
{
    const std::vector<std::string> compare{"compare", "--detail", "web01.xml", "web02.xml"};
    const std::string anonymous = Result(compare);
    TSystemCalls calls;
    calls.Fail("memfd_create", 1, ENOSYS);
    EXPECT_EQ(anonymous, Result(compare));
    EXPECT_EQ(1, calls.GetCount("mkostemp"));
    EXPECT_EQ("", fFolder.List());
}

TEST_F(TemporaryFileTest, TheFolderNeedNotExistIfTheFileIsAnonymous)
{
    setenv("TMPDIR", "/nowhere", 1);
    EXPECT_EQ(0u, Result({"compare", "--detail", "web01.xml", "web02.xml"}).find("8 differences between web01 and web02: "));
    TSystemCalls calls;
    calls.Fail("memfd_create", 1, ENOSYS);
    EXPECT_EQ(
        "cimdelta: /nowhere/cimdelta-XXXXXX: no temporary file can be made: No such file or directory; TMPDIR names the folder\n",
        Complaint({"compare", "--detail", "web01.xml", "web02.xml"}));
}

/// Makes a temporary file in the folder and ends the process by the signal. Comes back only if there is no such file.
void EndWithFile(int signal, const TOutputFolder& folder)
{
    const struct rlimit noCore = {};
    setrlimit(RLIMIT_CORE, &noCore);
    std::signal(signal, SIG_DFL);
    CleanUpOnEndingSignals(&TUnfinishedFile::RemoveAll);
    TSystemCalls calls;
    calls.Fail("memfd_create", 1, ENOSYS);
    const TTemporaryFile file(kContent);
    if (!folder.List().empty()) {
        raise(signal);
    }
}

using TemporaryFileDeathTest = TemporaryFileTest;

TEST_F(TemporaryFileDeathTest, EachSignalThatEndsTheProcessRemovesTheFile)
{
    const int signals[] = {SIGHUP,  SIGINT, SIGQUIT, SIGTERM,   SIGALRM,   SIGUSR1,  SIGUSR2, SIGPROF,
                           SIGPOLL, SIGPWR, SIGXCPU, SIGVTALRM, SIGSTKFLT, SIGRTMIN, SIGRTMAX};
    for (const int signal : signals) {
        EXPECT_EXIT(EndWithFile(signal, fFolder), ::testing::KilledBySignal(signal), "") << signal;
        EXPECT_EQ("", fFolder.List()) << signal;
    }
}

}  // namespace
}  // namespace NORVZEL20
