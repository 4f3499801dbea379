#pragma once

#include <string>
#include <vector>

#include "embedded/services/TCoreLog.h"
#include "host/ILogger.h"

namespace NORVZEL20 {

/// Receives the entries of the core log while it lives. Nothing is printed, and a target can check what was logged.
class TLogRecorder : public ILogger {
  public:
    TLogRecorder() : fBefore(TCoreLog::Set(this)) {}
    TLogRecorder(const TLogRecorder&) = delete;
    TLogRecorder& operator=(const TLogRecorder&) = delete;
    ~TLogRecorder() override { TCoreLog::Set(fBefore); }

    void Log(int, const std::string& message) override { fMessages.push_back(message); }

    const std::vector<std::string>& GetMessages() const { return fMessages; }

  private:
    ILogger* fBefore;
    std::vector<std::string> fMessages;
};

}  // namespace NORVZEL20
