#include "client/process/TProgress.h"

#include <exception>
#include <new>
#include <utility>

#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

TProgress::TProgress(IConsole& console, std::string doing, TAmount amount, std::chrono::milliseconds patience)
    : fConsole(console), fDoing(std::move(doing)), fAmount(std::move(amount)), fPatience(patience)
{
    const TSignalsHeld held;
    try {
        fThread = std::thread([this] { Wait(); });
    } catch (const std::exception&) {
        // There is no thread, or no memory for one; the work itself needs neither.
    }
}

TProgress::~TProgress()
{
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fDone = true;
    }
    fWake.notify_one();
    if (fThread.joinable()) {
        fThread.join();
    }
    fConsole.ShowProgress("");
}

std::string TProgress::Describe(unsigned int elapsed) const
{
    const std::string amount = fAmount ? fAmount() : std::string();
    return fDoing + (amount.empty() ? "" : " " + amount) + " (" + std::to_string(elapsed) + " s)";
}

void TProgress::Wait() noexcept
{
    std::unique_lock<std::mutex> lock(fMutex);
    unsigned int elapsed = 0;
    while (!fWake.wait_for(lock, fPatience, [this] { return fDone; })) {
        ++elapsed;
        try {
            fConsole.ShowProgress(Describe(elapsed));
        } catch (const std::bad_alloc&) {
            // This second is skipped; in the next there may be memory again.
        }
    }
}

}  // namespace NORVZEL20
