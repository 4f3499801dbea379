#pragma once

#include <mutex>
#include <string>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Keeps what a command writes, for the test to read.
class TFakeConsole : public IConsole {
  public:
    void WriteResult(std::string_view piece) override { fOut += piece; }
    void Say(std::string_view line) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fErr.append(line) += "\n";
    }
    bool IsColored() const override { return fColored; }
    std::size_t GetWidth() const override { return fWidth; }
    bool IsTerminal() const override { return fTerminal; }
    void ShowProgress(std::string_view text) noexcept override
    {
        const std::lock_guard<std::mutex> lock(fMutex);
        fProgress.append(text) += "|";
    }

    std::string fOut;
    std::string fErr;
    std::string fProgress;
    bool fColored = false;
    std::size_t fWidth = 0;
    bool fTerminal = false;

  private:
    std::mutex fMutex;
};

}  // namespace NORVZEL20
