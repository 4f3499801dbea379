#pragma once

#include <csignal>

namespace NORVZEL20 {

/// Blocks the signals of EndingSignals() in the calling thread while this object lives; they are delivered afterwards.
///
/// A thread that is started meanwhile keeps them blocked until it ends. Helper threads are started this way. Then signals arrive in
/// the main thread, and TUnfinishedFile can hold them back there.
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
