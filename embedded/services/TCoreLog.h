#pragma once

#include "host/ILogger.h"

namespace NORVZEL20 {

/// Which logger the core log is: TSpdLogger, unless somebody puts another one in its place.
class TCoreLog {
  public:
    TCoreLog() = delete;

    /// Never null.
    static ILogger* Get();

    /// From now on the core log is `logger`, which is not owned; null restores the one on standard error. Returns the one before.
    /// Threads: any, but whoever removes a logger sees to it that nobody is still writing to it.
    static ILogger* Set(ILogger* logger);
};

}  // namespace NORVZEL20
