// Commands when memory runs out: a command either is not affected or ends in order. Exhaust fails each allocation of the main
// thread in turn, within the test. Spend fails every seventh one, each in a child, because the process may terminate.

#include <gtest/gtest.h>
#include <sys/wait.h>
#include <unistd.h>

#include <memory>
#include <string>
#include <vector>

#include "client/CommandLine.h"
#include "client/files/TUnfinishedFile.h"
#include "client/process/LackOfMemory.h"
#include "client/process/TStandardConsole.h"
#include "tests/faults/FailEachAllocation.h"

namespace NORVZEL20 {
namespace {

using EMode = TFailingAllocator::EMode;

const int kAllCame = 10;

/// Keeps what a command writes, without allocating.
class TFixedConsole : public IConsole {
  public:
    void WriteResult(std::string_view piece) override { Append(fOut, fOutLength, piece); }
    void Say(std::string_view line) noexcept override
    {
        Append(fErr, fErrLength, line);
        Append(fErr, fErrLength, "\n");
    }
    bool IsColored() const override { return false; }
    std::size_t GetWidth() const override { return 0; }
    bool IsTerminal() const override { return false; }
    void ShowProgress(std::string_view) noexcept override {}

    std::string GetOut() const { return std::string(fOut, fOutLength); }
    std::string GetErr() const { return std::string(fErr, fErrLength); }

  private:
    template <std::size_t size>
    static void Append(char (&all)[size], std::size_t& length, std::string_view text) noexcept
    {
        const std::size_t count = text.copy(all + length, size - length);
        length += count;
    }

    char fOut[32768];
    std::size_t fOutLength = 0;
    char fErr[4096];
    std::size_t fErrLength = 0;
};

/// A command and its outcome when there is enough memory.
struct TCommand {
    std::vector<const char*> arguments;
    int status = -1;
    std::string out;
    std::string err;
};

/// Runs a command while memory runs out. Either that has no effect, or the command ends with kExitTrouble (2), a message and no
/// result.
class TRunCommand : public IFaultyAction {
  public:
    explicit TRunCommand(const TCommand& command) : fCommand(command) {}

    void Act() override { fStatus = RunClient(static_cast<int>(fCommand.arguments.size()), fCommand.arguments.data(), *fConsole); }

    void Verify(const std::string&) override
    {
        const std::string err = fConsole->GetErr();
        if (fStatus == fCommand.status && err == fCommand.err) {
            EXPECT_EQ(fCommand.out, fConsole->GetOut());
            return;
        }
        EXPECT_EQ(2, fStatus);
        EXPECT_EQ("", fConsole->GetOut());
        const std::size_t last = err.rfind("cimdelta: ");
        ASSERT_NE(std::string::npos, last) << err;
        EXPECT_NE(std::string::npos, err.find("memory", last)) << err;
    }

  private:
    const TCommand& fCommand;
    std::unique_ptr<TFixedConsole> fConsole = std::make_unique<TFixedConsole>();
    int fStatus = -1;
};

/// Runs a command in a process of its own in which the `number`-th allocation fails. Returns its exit status, standard output and
/// standard error. If the command made fewer allocations, kAllCame is added to the status.
std::string RunInProcess(const std::vector<const char*>& arguments, std::size_t number, EMode mode)
{
    int ends[2];
    EXPECT_EQ(0, pipe(ends));
    const pid_t child = fork();
    if (child == 0) {
        dup2(ends[1], STDOUT_FILENO);
        dup2(ends[1], STDERR_FILENO);
        EndInOrderWithoutMemory(&TUnfinishedFile::RemoveAll);
        TStandardConsole console;
        TFailingAllocator::Fail(number, mode);
        const int status = RunClient(static_cast<int>(arguments.size()), arguments.data(), console);
        TFailingAllocator::Stop();
        _exit(TFailingAllocator::HasFailed() ? status : status + kAllCame);
    }
    close(ends[1]);
    std::string text;
    char buffer[4096];
    for (ssize_t count = 1; count > 0;) {
        count = read(ends[0], buffer, sizeof buffer);
        text.append(buffer, static_cast<std::size_t>(count < 0 ? 0 : count));
    }
    close(ends[0]);
    int status = 0;
    EXPECT_EQ(child, waitpid(child, &status, 0));
    EXPECT_TRUE(WIFEXITED(status)) << text;
    return std::to_string(WEXITSTATUS(status)) + ": " + text;
}

class MemoryFaultTest : public testing::TestWithParam<EMode> {
  protected:
    void SetUp() override { ASSERT_EQ(0, chdir(CIMDELTA_CLIENT_TEST_DATA)); }

    /// Fails every seventh allocation of the command's main thread, each in a process of its own, since the process may terminate.
    static void Spend(const std::vector<const char*>& arguments)
    {
        std::vector<const char*> all(1, "cimdelta");
        all.insert(all.end(), arguments.begin(), arguments.end());
        const std::string whole = RunInProcess(all, 0, GetParam());
        std::size_t number = 1;
        for (std::string outcome; outcome != whole && !HasFailure(); number += 7) {
            outcome = RunInProcess(all, number, GetParam());
            if (outcome != whole && outcome.substr(1) != whole.substr(2)) {
                EXPECT_EQ("2: cimdelta: ", outcome.substr(0, 13)) << number;
                EXPECT_NE(std::string::npos, outcome.find("memory")) << outcome;
                EXPECT_EQ(outcome.size() - 1, outcome.find('\n')) << outcome;
            }
        }
        EXPECT_LT(700u, number);
    }

    /// Fails each allocation of the command's main thread in turn.
    static void Exhaust(const std::vector<const char*>& arguments)
    {
        TCommand command;
        command.arguments.push_back("cimdelta");
        command.arguments.insert(command.arguments.end(), arguments.begin(), arguments.end());
        const auto console = std::make_unique<TFixedConsole>();
        command.status = RunClient(static_cast<int>(command.arguments.size()), command.arguments.data(), *console);
        command.out = console->GetOut();
        command.err = console->GetErr();
        ASSERT_NE("", command.out + command.err);
        FailEachAllocation(
            arguments.empty() ? "nothing" : arguments[0], [&] { return std::make_unique<TRunCommand>(command); }, GetParam());
    }
};

TEST_P(MemoryFaultTest, Show)
{
    Exhaust({"show", "web02.xml.gz"});
    Exhaust({"show", "web02.xml.xz", "INV_Package", "-o", "cimxml"});
    Exhaust({"show", "none.xml"});
}

TEST_P(MemoryFaultTest, Query)
{
    Exhaust({"query", "SELECT Name FROM INV_Package WHERE Version LIKE '5%'", "web01.xml"});
}

TEST_P(MemoryFaultTest, Compare)
{
    Exhaust({"compare", "--detail", "web01.xml", "web02.xml"});
    Exhaust({"compare", "--detail", "web01.xml", "other-schema.xml", "-o", "cimxml"});
}

TEST_P(MemoryFaultTest, CheckAndExplain)
{
    Exhaust({"check", "odd-rules.xml", "--schema", "web01.xml"});
    Exhaust({"explain", "INV_Package.Version", "--spec", "rules.xml", "--schema", "web01.xml"});
}

// The JSON library allocates in destructors, which terminates the process if it fails: that must happen in order, too.
TEST_P(MemoryFaultTest, JsonEndsTheProcessInOrder)
{
    Spend({"show", "web02.xml", "INV_Package", "-o", "json"});
    Spend({"compare", "--detail", "web01.xml", "web02.xml", "-o", "ndjson"});
}

TEST_P(MemoryFaultTest, WrongUsage)
{
    Exhaust({"frob"});
    Exhaust({"show"});
}

INSTANTIATE_TEST_SUITE_P(Faults, MemoryFaultTest, testing::Values(EMode::kOnce, EMode::kFromThenOn),
                         [](const auto& test) { return test.param == EMode::kOnce ? "Once" : "FromThenOn"; });

}  // namespace
}  // namespace NORVZEL20
