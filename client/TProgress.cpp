#include "client/TProgress.h"

#include <utility>

namespace NORVZEL20 {

TProgress::TProgress(IConsole& console, std::string doing, std::chrono::milliseconds patience)
    : fConsole(console), fDoing(std::move(doing)), fPatience(patience), fThread([this] { Wait(); })
{}

TProgress::~TProgress()
{
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fDone = true;
    }
    fWake.notify_one();
    fThread.join();
    fConsole.ShowProgress("");
}

void TProgress::Wait()
{
    std::unique_lock<std::mutex> lock(fMutex);
    unsigned int elapsed = 0;
    while (!fWake.wait_for(lock, fPatience, [this] { return fDone; })) {
        ++elapsed;
        fConsole.ShowProgress(fDoing + " (" + std::to_string(elapsed) + " s)");
    }
}

}  // namespace NORVZEL20
