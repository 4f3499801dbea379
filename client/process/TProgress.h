#pragma once

#include <chrono>
#include <condition_variable>
#include <mutex>
#include <string>
#include <thread>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Tells a waiting person what is being done, once it has taken longer than a moment; wiped away when the object goes.
class TProgress {
  public:
    /// `console` must outlive this.
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
