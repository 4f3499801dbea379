#pragma once

#include <mutex>
#include <string>

#include "client/IConsole.h"

namespace NORVZEL20 {

/// Keeps what a command writes.
class TFakeConsole : public IConsole {
  public:
    void WriteResult(const std::string& text) override { fOut += text; }
    void Say(const std::string& line) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fErr += line + "\n";
    }
    bool IsColored() const override { return fColored; }
    void ShowProgress(const std::string& text) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fProgress += text + "|";
    }

    std::string fOut;
    std::string fErr;
    std::string fProgress;
    bool fColored = false;

  private:
    std::mutex fMutex;
};

}  // namespace NORVZEL20
