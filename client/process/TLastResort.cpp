#include "client/process/TLastResort.h"

#include <unistd.h>

#include <utility>

#include "client/process/ExitStatus.h"

namespace NORVZEL20 {

TLastResort::TLastResort(IConsole& console, std::chrono::milliseconds patience, std::string message, void (*cleanUp)() noexcept)
    : fConsole(console), fMessage(std::move(message)), fCleanUp(cleanUp), fTicker(patience, [this] { End(); })
{}

void TLastResort::End() noexcept
{
    fConsole.Say(fMessage);
    fCleanUp();
    _exit(kExitTrouble);
}

}  // namespace NORVZEL20
