#pragma once

#include "host/Export.h"
#include "host/ILogger.h"

namespace NORVZEL20 {

/// The logger behind the core log: a TSpdLogger, or another one that was set.
class CIMDELTA_EXPORT TCoreLog {
  public:
    TCoreLog() = delete;

    /// Never null.
    static ILogger* Get();

    /// Makes `logger`, which is not owned, the core log; null restores the one on standard error. Returns the previous one.
    /// Threads: any, at any time. Before a logger is destroyed, the caller must make sure that no thread still writes to it.
    static ILogger* Set(ILogger* logger);
};

}  // namespace NORVZEL20
