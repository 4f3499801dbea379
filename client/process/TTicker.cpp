#include "client/process/TTicker.h"

#include <exception>
#include <utility>

#include "client/process/TSignalsHeld.h"

namespace NORVZEL20 {

TTicker::TTicker(std::chrono::milliseconds period, std::function<void()> tick) : fTick(std::move(tick))
{
    const TSignalsHeld held;
    try {
        fThread = std::thread([this, period] { Run(period); });
    } catch (const std::exception&) {
        // There is no thread, or no memory for one; the work itself needs neither.
    }
}

void TTicker::Stop() noexcept
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

void TTicker::Run(std::chrono::milliseconds period) noexcept
{
    std::unique_lock<std::mutex> lock(fMutex);
    while (!fWake.wait_for(lock, period, [this] { return fDone; })) {
        fTick();
    }
}

}  // namespace NORVZEL20
