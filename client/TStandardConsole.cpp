#include "client/TStandardConsole.h"

#include <unistd.h>

#include <cerrno>
#include <cstdlib>
#include <cstring>

#include "client/StandardDescriptors.h"
#include "client/TClientError.h"
#include "client/WholeWrite.h"

namespace NORVZEL20 {

namespace {

const char kWipeLine[] = "\r\x1b[K";

bool IsTerminal(int descriptor)
{
    const char* term = std::getenv("TERM");
    return isatty(descriptor) != 0 && (term == nullptr || std::strcmp(term, "dumb") != 0);
}

bool IsSet(const char* variable)
{
    const char* value = std::getenv(variable);
    return value != nullptr && *value != '\0';
}

}  // namespace

TStandardConsole::TStandardConsole()
    : fColored(IsTerminal(STDOUT_FILENO) && !IsSet("NO_COLOR")), fProgress(IsTerminal(STDERR_FILENO))
{}

void TStandardConsole::WriteResult(const std::string& text)
{
    const int error = WriteWhole(STDOUT_FILENO, text);
    if (error == EPIPE || (error == EBADF && IsClosed(STDOUT_FILENO))) {
        throw TClientError("");
    }
    if (error != 0) {
        throw TClientError(std::string("standard output cannot be written: ") + std::strerror(error));
    }
}

void TStandardConsole::Say(std::string_view line) noexcept
{
    const std::lock_guard<std::mutex> lock(fMutex);
    if (fProgressShown) {
        WriteWhole(STDERR_FILENO, kWipeLine);
        fProgressShown = false;
    }
    WriteAtOnce(line, "\n");
}

void TStandardConsole::ShowProgress(std::string_view text) noexcept
{
    const std::lock_guard<std::mutex> lock(fMutex);
    if (fProgress && (fProgressShown || !text.empty())) {
        WriteAtOnce(kWipeLine, text);
        fProgressShown = !text.empty();
    }
}

// In one piece, so that no other process writes in between; without memory for that, in two.
void TStandardConsole::WriteAtOnce(std::string_view first, std::string_view second) noexcept
{
    try {
        WriteWhole(STDERR_FILENO, std::string(first).append(second));
    } catch (const std::exception&) {
        WriteWhole(STDERR_FILENO, first);
        WriteWhole(STDERR_FILENO, second);
    }
}

}  // namespace NORVZEL20
