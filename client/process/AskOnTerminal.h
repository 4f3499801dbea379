#pragma once

#include <optional>
#include <string>

namespace NORVZEL20 {

/// Whether there is a terminal to ask the person on: one that the process controls, whatever its standard input is.
bool HasTerminal() noexcept;

/// Writes `question` to that terminal and returns the line that is typed, without its end; nothing if there is no terminal, or no
/// line comes. A hidden line does not show while it is typed.
/// Threads: one at a time. Errors: std::bad_alloc.
std::optional<std::string> AskOnTerminal(const std::string& question, bool isHidden);

/// Lets what is typed show again if it is hidden just now. A signal handler may call it.
void ShowTypingAgain() noexcept;

}  // namespace NORVZEL20
