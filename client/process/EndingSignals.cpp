// Cleaning up on a signal without hiding it from the parent.
//
// A handler that called exit() would turn "killed by SIGINT" into an ordinary exit status, and a shell script would go on with its
// next command. So the handler cleans up, restores the signal's default action and raises the signal again. The kernel blocks a
// signal while its handler runs: the second one becomes pending, arrives when the handler returns, and ends the process by the
// default action. The other ending signals are blocked as well, so no second handler interrupts the clean-up.
#include "client/process/EndingSignals.h"

namespace NORVZEL20 {

namespace {

const int kEnding[] = {SIGHUP,  SIGINT,  SIGQUIT, SIGTERM, SIGALRM,   SIGUSR1,  SIGUSR2,
                       SIGPROF, SIGPOLL, SIGPWR,  SIGXCPU, SIGVTALRM, SIGSTKFLT};

// Set before the handler is installed, and never changed afterwards.
void (*gCleanUpOnSignal)() = nullptr;

extern "C" void CleanUpAndEnd(int number)
{
    gCleanUpOnSignal();
    std::signal(number, SIG_DFL);
    raise(number);
}

}  // namespace

sigset_t EndingSignals() noexcept
{
    sigset_t signals;
    sigemptyset(&signals);
    for (const int number : kEnding) {
        sigaddset(&signals, number);
    }
    for (int number = SIGRTMIN; number <= SIGRTMAX; ++number) {
        sigaddset(&signals, number);
    }
    return signals;
}

void CleanUpOnEndingSignals(void (*cleanUp)()) noexcept
{
    gCleanUpOnSignal = cleanUp;
    const sigset_t ending = EndingSignals();
    for (int number = 1; number <= SIGRTMAX; ++number) {
        struct sigaction action = {};
        // An action that is not the default is somebody's choice: nohup ignores SIGHUP, a profiler handles SIGPROF.
        if (sigismember(&ending, number) != 1 || sigaction(number, nullptr, &action) != 0 || action.sa_handler != SIG_DFL) {
            continue;
        }
        action = {};
        action.sa_handler = &CleanUpAndEnd;
        action.sa_mask = ending;
        sigaction(number, &action, nullptr);
    }
}

}  // namespace NORVZEL20
