#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Where a command's results and its remarks go; a test puts its own in place of the terminal.
///
/// Threads: Say from any; WriteResult from one.
class IConsole {
  public:
    virtual ~IConsole() = default;

    /// Writes a whole result to standard output. Errors: TReaderGone if the reader has closed the pipe or standard output is
    /// closed; TClientError if it cannot be written for another reason.
    virtual void WriteResult(const std::string& text) = 0;

    /// Writes one line, without its end, to standard error, with escapes in place of what could move a terminal. Never throws, not
    /// even where there is no memory.
    virtual void Say(std::string_view line) noexcept = 0;

    /// Whether results are to be coloured: standard output is a terminal and NO_COLOR is not set.
    virtual bool IsColored() const = 0;

    /// Standard error, for a line that is overwritten: shown only where it is a terminal. An empty text wipes it away. Never
    /// throws.
    virtual void ShowProgress(std::string_view text) noexcept = 0;
};

}  // namespace NORVZEL20
