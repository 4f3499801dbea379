#include "tests/client/TStartedProgram.h"

#include <gtest/gtest.h>
#include <spawn.h>
#include <sys/wait.h>
#include <unistd.h>

#include <csignal>

#include "client/process/EndingSignals.h"

namespace NORVZEL20 {

namespace {

// Restores the default action of ending signals in the program. A shell that runs the test in the background ignores some.
class TSignals {
  public:
    explicit TSignals(int ignored)
    {
        sigset_t signals = EndingSignals();
        posix_spawnattr_init(&fAttributes);
        if (ignored != 0) {
            sigdelset(&signals, ignored);
        }
        posix_spawnattr_setsigdefault(&fAttributes, &signals);
        posix_spawnattr_setflags(&fAttributes, POSIX_SPAWN_SETSIGDEF);
    }
    TSignals(const TSignals&) = delete;
    TSignals& operator=(const TSignals&) = delete;
    ~TSignals() { posix_spawnattr_destroy(&fAttributes); }

    const posix_spawnattr_t* Get() const { return &fAttributes; }

  private:
    posix_spawnattr_t fAttributes;
};

}  // namespace

TStartedProgram::TStartedProgram(const std::vector<std::string>& arguments, const TDescriptors& descriptors, int ignored)
{
    std::string program = CIMDELTA_PROGRAM;
    std::vector<std::string> texts = arguments;
    std::vector<char*> argv(1, &program[0]);
    for (std::string& text : texts) {
        argv.push_back(&text[0]);
    }
    argv.push_back(nullptr);
    posix_spawn_file_actions_t actions;
    posix_spawn_file_actions_init(&actions);
    for (const auto& descriptor : descriptors) {
        posix_spawn_file_actions_adddup2(&actions, descriptor.second, descriptor.first);
    }
    const TSignals signals(ignored);
    const int error = posix_spawn(&fProcess, program.c_str(), &actions, signals.Get(), argv.data(), environ);
    EXPECT_EQ(0, error);
    fEnded = error != 0;
    posix_spawn_file_actions_destroy(&actions);
}

TStartedProgram::~TStartedProgram()
{
    if (!HasEnded()) {
        Signal(SIGKILL);
        Wait();
    }
}

bool TStartedProgram::HasEnded()
{
    fEnded = fEnded || waitpid(fProcess, &fStatus, WNOHANG) == fProcess;
    return fEnded;
}

void TStartedProgram::Signal(int number)
{
    if (!HasEnded()) {
        kill(fProcess, number);
    }
}

std::string TStartedProgram::Wait()
{
    fEnded = fEnded || waitpid(fProcess, &fStatus, 0) == fProcess;
    return WIFSIGNALED(fStatus) ? "signal " + std::to_string(WTERMSIG(fStatus)) : "status " + std::to_string(WEXITSTATUS(fStatus));
}

}  // namespace NORVZEL20
