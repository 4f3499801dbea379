#pragma once

#include <csignal>

namespace NORVZEL20 {

/// The signals by which another process usually ends this one, as far as it can handle them: SIGHUP, SIGINT, SIGQUIT, SIGTERM,
/// SIGXCPU.
sigset_t EndingSignals() noexcept;

/// From now on `cleanUp` is called before such a signal ends the process. To the parent the process still ends by that signal. A
/// signal that is ignored, as nohup does with SIGHUP, stays ignored.
/// `cleanUp` runs in a signal handler: it may only call async-signal-safe functions. Call this once, before there are other
/// threads.
void CleanUpOnEndingSignals(void (*cleanUp)()) noexcept;

}  // namespace NORVZEL20
