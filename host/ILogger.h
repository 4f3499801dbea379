#pragma once

#include <string>

#include "host/Export.h"

namespace NORVZEL20 {

/// The host's log.
class CIMDELTA_EXPORT ILogger {
  public:
    virtual ~ILogger() = default;

    /// Writes one entry. Level 0 is an error; a higher level is less urgent. The message may end with a line break.
    virtual void Log(int level, const std::string& message) = 0;
};

}  // namespace NORVZEL20
