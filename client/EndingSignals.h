#pragma once

#include <csignal>

namespace NORVZEL20 {

/// The signals that end a process from outside and that a process can act upon: SIGHUP, SIGINT, SIGQUIT, SIGTERM, SIGXCPU.
sigset_t EndingSignals() noexcept;

/// From now on such a signal removes the unfinished files (TUnfinishedFile) before it ends the process as it would anyway. One that
/// is ignored stays so. To be called once, before there are other threads.
void RemoveUnfinishedFilesOnSignals() noexcept;

}  // namespace NORVZEL20
