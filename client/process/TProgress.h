#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Shows a waiting person what is being done and for how many seconds, from the first second on until this object is destroyed.
///
/// A thread of its own writes to the console. If none can be started, nothing is shown.
class TProgress {
  public:
    /// `console` must outlive this. `patience` is the time between two lines; only tests shorten it.
    TProgress(IConsole& console, std::string doing, std::chrono::milliseconds patience = std::chrono::milliseconds(1000));
    TProgress(const TProgress&) = delete;
    TProgress& operator=(const TProgress&) = delete;
    ~TProgress();

  private:
    void Wait() noexcept;

    IConsole& fConsole;
    const std::string fDoing;
    const std::chrono::milliseconds fPatience;
    std::mutex fMutex;
    std::condition_variable fWake;
    bool fDone = false;
    std::thread fThread;
};

}  // namespace NORVZEL20
