#pragma once

#include <cstddef>
#include <string_view>

namespace NORVZEL20 {

/// Takes the result and the messages of a command. Tests replace it.
///
/// Threads: Say and ShowProgress may be called from any thread, WriteResult from one.
class IConsole {
  public:
    virtual ~IConsole() = default;

    /// Writes the next piece of a result to standard output. Errors: TReaderGone if the reader has closed the pipe or standard
    /// output is closed; TClientError if it cannot be written for another reason.
    virtual void WriteResult(std::string_view piece) = 0;

    /// Writes a line to standard error, escaped as by EscapeForDisplay; `line` comes without its end. Works without memory too:
    /// then "?" stands for everything that is not printable ASCII.
    virtual void Say(std::string_view line) noexcept = 0;

    /// Whether a result on standard output is to be coloured: it is a terminal or CLICOLOR_FORCE is set and not 0, and NO_COLOR is
    /// not set.
    virtual bool IsColored() const = 0;

    /// How many columns a result on standard output has: those of the terminal, otherwise COLUMNS; 0 if neither says so.
    virtual std::size_t GetWidth() const = 0;

    /// Whether results on standard output go to a terminal.
    virtual bool IsTerminal() const = 0;

    /// Replaces the line of progress on standard error, if that is a terminal. An empty text removes the line.
    virtual void ShowProgress(std::string_view text) noexcept = 0;
};

}  // namespace NORVZEL20
