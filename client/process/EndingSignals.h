#pragma once

#include <csignal>

namespace NORVZEL20 {

/// The signals that end a process from outside and that a process can act upon: SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGXCPU.
sigset_t EndingSignals() noexcept;

/// From now on such a signal calls `cleanUp` before it ends the process as it would anyway. A signal that is ignored stays ignored.
/// `cleanUp` may only call what a signal handler may. Call this once, before there are other threads.
void CleanUpOnEndingSignals(void (*cleanUp)()) noexcept;

}  // namespace NORVZEL20
