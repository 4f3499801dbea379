#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <thread>

namespace NORVZEL20 {

/// Calls a function, on a thread of its own, each time that a period has passed, until this object is stopped or destroyed.
///
/// If no thread can be started, nothing is called. A call that has begun is waited for.
class TTicker {
  public:
    /// `tick` must not throw, nor stop this.
    TTicker(std::chrono::milliseconds period, std::function<void()> tick);
    TTicker(const TTicker&) = delete;
    TTicker& operator=(const TTicker&) = delete;
    ~TTicker() { Stop(); }

    /// From then on nothing is called.
    void Stop() noexcept;

  private:
    void Run(std::chrono::milliseconds period) noexcept;

    const std::function<void()> fTick;
    std::mutex fMutex;
    std::condition_variable fWake;
    bool fDone = false;
    std::thread fThread;
};

}  // namespace NORVZEL20
