#pragma once

#include <string>
#include <vector>

#include "host/ILogger.h"

namespace NORVZEL20 {

/// Keeps the core log's entries to itself while it lives. The client reports a failure once and in its own words; the log would
/// report it again, often twice.
///
/// Use one at a time in a process, and only while no other thread writes to the log.
class TLogCapture : public ILogger {
  public:
    TLogCapture();
    TLogCapture(const TLogCapture&) = delete;
    TLogCapture& operator=(const TLogCapture&) = delete;
    ~TLogCapture() override;

    void Log(int level, const std::string& message) override;

    /// The messages so far, without line ends.
    const std::vector<std::string>& GetMessages() const { return fMessages; }

  private:
    ILogger* fPrevious;
    std::vector<std::string> fMessages;
};

}  // namespace NORVZEL20
