#pragma once

#include <mutex>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Standard output and standard error of this process.
class TStandardConsole : public IConsole {
  public:
    TStandardConsole();

    void WriteResult(std::string_view piece) override;
    void Say(std::string_view line) noexcept override;
    bool IsColored() const override { return fColored; }
    std::size_t GetWidth() const override;
    bool IsTerminal() const override { return fTerminal; }
    void ShowProgress(std::string_view text) noexcept override;

  private:
    std::mutex fMutex;
    bool fTerminal;
    bool fColored;
    bool fProgress;
    bool fProgressShown = false;
};

}  // namespace NORVZEL20
