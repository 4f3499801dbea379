#pragma once

#include <chrono>
#include <condition_variable>
#include <functional>
#include <mutex>
#include <string>
#include <thread>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Shows a waiting person what is being done, how far it is and for how many seconds, from the first second on until this object is
/// destroyed: `loading web17.xml 62 % (112 of 180 MB), 3 of 40 (12 s)`.
///
/// A thread of its own writes to the console. If none can be started, nothing is shown.
class TProgress {
  public:
    /// Says how far the work is; empty if that is not known. It is called on the thread that writes.
    using TAmount = std::function<std::string()>;

    /// `console`, and what `amount` reads, must outlive this. `patience` is the time between two lines; only tests shorten it.
    TProgress(IConsole& console, std::string doing, TAmount amount = TAmount(),
              std::chrono::milliseconds patience = std::chrono::milliseconds(1000));
    TProgress(const TProgress&) = delete;
    TProgress& operator=(const TProgress&) = delete;
    ~TProgress();

  private:
    void Wait() noexcept;
    std::string Describe(unsigned int elapsed) const;

    IConsole& fConsole;
    const std::string fDoing;
    const TAmount fAmount;
    const std::chrono::milliseconds fPatience;
    std::mutex fMutex;
    std::condition_variable fWake;
    bool fDone = false;
    std::thread fThread;
};

}  // namespace NORVZEL20
