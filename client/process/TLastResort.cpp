#include "client/process/TLastResort.h"

#include <unistd.h>

#include <exception>
#include <utility>

#include "client/process/ExitStatus.h"
#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

TLastResort::TLastResort(IConsole& console, std::chrono::milliseconds patience, std::string message, void (*cleanUp)() noexcept)
    : fConsole(console), fMessage(std::move(message)), fCleanUp(cleanUp)
{
    const TSignalsHeld held;
    try {
        fThread = std::thread([this, patience] { Wait(patience); });
    } catch (const std::exception&) {
        // There is no thread, or no memory for one; the work itself needs neither.
    }
}

TLastResort::~TLastResort()
{
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fDone = true;
    }
    fWake.notify_one();
    if (fThread.joinable()) {
        fThread.join();
    }
}

void TLastResort::Wait(std::chrono::milliseconds patience) noexcept
{
    std::unique_lock<std::mutex> lock(fMutex);
    if (!fWake.wait_for(lock, patience, [this] { return fDone; })) {
        fConsole.Say(fMessage);
        fCleanUp();
        _exit(kExitTrouble);
    }
}

}  // namespace NORVZEL20
