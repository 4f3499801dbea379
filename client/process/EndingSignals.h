#pragma once

#include <csignal>

namespace NORVZEL20 {

/// The signals that end a process by default and that the process can handle, real-time signals included. SIGPIPE and SIGXFSZ,
/// which the program ignores, and the signals of its own faults, such as SIGSEGV and SIGABRT, are not among them.
sigset_t EndingSignals() noexcept;

/// From now on `cleanUp` is called before such a signal ends the process. To the parent the process still ends by that signal. A
/// signal whose action is not the default, such as SIGHUP under nohup, keeps that action.
/// `cleanUp` runs in a signal handler: it may only call async-signal-safe functions. Call this once, before there are other
/// threads.
void CleanUpOnEndingSignals(void (*cleanUp)()) noexcept;

}  // namespace NORVZEL20
