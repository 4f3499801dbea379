#pragma once

#include <string>

#include "host/ILogger.h"

namespace NORVZEL20 {

/// Replaces the core log while it lives. Keeps each entry as `level|message|`, with its line ends.
class TCapturingLogger : public ILogger {
  public:
    TCapturingLogger();
    TCapturingLogger(const TCapturingLogger&) = delete;
    TCapturingLogger& operator=(const TCapturingLogger&) = delete;
    ~TCapturingLogger() override;

    void Log(int level, const std::string& message) override;

    /// Everything written since the last call.
    std::string Take();

  private:
    ILogger* fBefore;
    std::string fText;
};

}  // namespace NORVZEL20
