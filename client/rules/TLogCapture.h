#pragma once

#include <string>
#include <vector>

#include "host/ILogger.h"

namespace NORVZEL20 {

/// Takes the core log's entries while it lives, so that a person is told once, in the client's words, what the log tells twice.
///
/// One at a time in a process, and not while another thread may be writing to the log.
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
