#include "client/process/TProgress.h"

#include <new>
#include <utility>

namespace NORVZEL20 {

TProgress::TProgress(IConsole& console, std::string doing, TAmount amount, std::chrono::milliseconds patience)
    : fConsole(console), fDoing(std::move(doing)), fAmount(std::move(amount)), fTicker(patience, [this] { Show(); })
{}

TProgress::~TProgress()
{
    fTicker.Stop();
    fConsole.ShowProgress("");
}

std::string TProgress::Describe() const
{
    const std::string amount = fAmount ? fAmount() : std::string();
    return fDoing + (amount.empty() ? "" : " " + amount) + " (" + std::to_string(fElapsed) + " s)";
}

void TProgress::Show() noexcept
{
    ++fElapsed;
    try {
        fConsole.ShowProgress(Describe());
    } catch (const std::bad_alloc&) {
        // This second is skipped; in the next there may be memory again.
    }
}

}  // namespace NORVZEL20
