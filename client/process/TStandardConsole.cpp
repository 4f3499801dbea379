#include "client/process/TStandardConsole.h"

#include <sys/ioctl.h>
#include <unistd.h>

#include <cstdlib>
#include <cstring>

#include "client/process/StandardDescriptors.h"
#include "client/process/TClientError.h"
#include "client/process/TReaderGone.h"
#include "client/process/WriteWhole.h"
#include "client/text/DisplayText.h"
#include "client/text/NumberIn.h"

namespace NORVZEL20 {

namespace {

// Moves to the begin of the line and erases to its end.
const char kWipeLine[] = "\r\x1b[K";

// A dumb terminal would show escape sequences as text.
bool IsTerminalAt(int descriptor)
{
    const char* term = std::getenv("TERM");
    return isatty(descriptor) != 0 && (term == nullptr || std::strcmp(term, "dumb") != 0);
}

bool IsSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value != nullptr && *value != '\0';
}

bool IsForced(const char* variable)
{
    return IsSet(variable) && std::strcmp(std::getenv(variable), "0") != 0;
}

// Writes a line without allocating. Escaping would need memory, so ? stands for everything that is not printable ASCII.
void SayPlainly(std::string_view line) noexcept
{
    for (const char character : line) {
        const bool isPlain = character >= ' ' && character <= '~';
        TryWriteWhole(STDERR_FILENO, std::string_view(isPlain ? &character : "?", 1));
    }
    TryWriteWhole(STDERR_FILENO, "\n");
}

}  // namespace

TStandardConsole::TStandardConsole()
    : fTerminal(IsTerminalAt(STDOUT_FILENO)), fColored((fTerminal || IsForced("CLICOLOR_FORCE")) && !IsSet("NO_COLOR")),
      fProgress(IsTerminalAt(STDERR_FILENO))
{}

void TStandardConsole::WriteResult(std::string_view piece)
{
    const std::error_code error = TryWriteWhole(STDOUT_FILENO, piece);
    // If standard output was closed from the start, nobody wants the result. If it is open for reading only, that is a mistake.
    if (error == std::errc::broken_pipe || (error == std::errc::bad_file_descriptor && IsClosed(STDOUT_FILENO))) {
        throw TReaderGone();
    }
    if (error) {
        throw TClientError("standard output cannot be written", error);
    }
}

std::size_t TStandardConsole::GetWidth() const
{
    winsize size{};
    if (isatty(STDOUT_FILENO) != 0 && ioctl(STDOUT_FILENO, TIOCGWINSZ, &size) == 0 && size.ws_col > 0) {
        return size.ws_col;
    }
    return IsSet("COLUMNS") ? NumberIn(std::getenv("COLUMNS")).value_or(0) : 0;
}

void TStandardConsole::Say(std::string_view line) noexcept
{
    const std::lock_guard<std::mutex> lock(fMutex);
    if (fProgressShown) {
        TryWriteWhole(STDERR_FILENO, kWipeLine);
        fProgressShown = false;
    }
    try {
        TryWriteWhole(STDERR_FILENO, EscapeForDisplay(line) + "\n");
    } catch (const std::exception&) {
        SayPlainly(line);
    }
}

void TStandardConsole::ShowProgress(std::string_view text) noexcept
{
    const std::lock_guard<std::mutex> lock(fMutex);
    if (fProgress && (fProgressShown || !text.empty())) {
        TryWriteWhole(STDERR_FILENO, kWipeLine);
        TryWriteWhole(STDERR_FILENO, text);
        fProgressShown = !text.empty();
    }
}

}  // namespace NORVZEL20
