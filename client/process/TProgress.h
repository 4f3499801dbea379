#pragma once

#include <chrono>
#include <functional>
#include <string>

#include "client/process/IConsole.h"
#include "client/process/TTicker.h"

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
    void Show() noexcept;
    std::string Describe() const;

    IConsole& fConsole;
    const std::string fDoing;
    const TAmount fAmount;
    unsigned int fElapsed = 0;
    TTicker fTicker;  // the last one, because it calls Show
};

}  // namespace NORVZEL20
