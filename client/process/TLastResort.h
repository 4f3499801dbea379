#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

#include "client/process/IConsole.h"

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
    TLastResort(const TLastResort&) = delete;
    TLastResort& operator=(const TLastResort&) = delete;
    ~TLastResort();

  private:
    void Wait(std::chrono::milliseconds patience) noexcept;

    IConsole& fConsole;
    const std::string fMessage;
    void (*const fCleanUp)() noexcept;
    std::mutex fMutex;
    std::condition_variable fWake;
    bool fDone = false;
    std::thread fThread;
};

}  // namespace NORVZEL20
