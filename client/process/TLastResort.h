#pragma once

#include <chrono>
#include <string>

#include "client/process/IConsole.h"
#include "client/process/TTicker.h"

namespace NORVZEL20 {

/// Ends the process with kExitTrouble (2) and a message if this object lives longer than it should: a call of the system that never
/// returns cannot be ended in any other way.
///
/// A thread of its own watches the time. If none can be started, nothing does. Destructors do not run at the end, so `cleanUp` must
/// do what cannot be left undone; it is called from that thread.
class TLastResort {
  public:
    /// `console` must outlive this.
    TLastResort(IConsole& console, std::chrono::milliseconds patience, std::string message, void (*cleanUp)() noexcept);

  private:
    [[noreturn]] void End() noexcept;

    IConsole& fConsole;
    const std::string fMessage;
    void (*const fCleanUp)() noexcept;
    TTicker fTicker;  // the last one, because it calls End
};

}  // namespace NORVZEL20
