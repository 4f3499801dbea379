#pragma once

#include <csignal>

namespace NORVZEL20 {

/// While it lives, signals that end the process wait, for this thread and those that it starts.
class TSignalsHeld {
  public:
    TSignalsHeld() noexcept;
    TSignalsHeld(const TSignalsHeld&) = delete;
    TSignalsHeld& operator=(const TSignalsHeld&) = delete;
    ~TSignalsHeld();

  private:
    sigset_t fBefore;
};

}  // namespace NORVZEL20
