#include "client/process/EndingSignals.h"

namespace NORVZEL20 {

namespace {

const int kEnding[] = {SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGXCPU};

void (*gCleanUp)() = nullptr;  // set before the handler is installed

extern "C" void CleanUpAndEnd(int number)
{
    gCleanUp();
    // Held while this runs, it arrives as soon as it returns, and does what it does to a process that minds no signals.
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
    return signals;
}

void CleanUpOnEndingSignals(void (*cleanUp)()) noexcept
{
    gCleanUp = cleanUp;
    for (const int number : kEnding) {
        struct sigaction action = {};
        if (sigaction(number, nullptr, &action) != 0 || action.sa_handler == SIG_IGN) {
            continue;
        }
        action = {};
        action.sa_handler = &CleanUpAndEnd;
        action.sa_mask = EndingSignals();
        sigaction(number, &action, nullptr);
    }
}

}  // namespace NORVZEL20
