#pragma once

#include <memory>

#include "host/Export.h"
#include "host/ILogger.h"

namespace spdlog {
class logger;
}

namespace NORVZEL20 {

/// The log on standard error: one line for each entry, with time, severity and process. One line break at the end of an entry is
/// removed. Level 0 is an error, 1 a warning, 2 information. Entries from level 3 on are details and not shown. Never throws.
///
/// Threads: any, at any time.
class CIMDELTA_INTERNAL_EXPORT TSpdLogger : public ILogger {
  public:
    TSpdLogger();
    ~TSpdLogger() override;

    void Log(int level, const std::string& message) override;

  private:
    std::shared_ptr<spdlog::logger> fLogger;
};

}  // namespace NORVZEL20
