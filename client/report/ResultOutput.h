#pragma once

#include <string>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Whether results for that path go to standard output: it is empty or "-".
bool IsStandardOutput(const std::string& path);

/// Brings a whole result to where the person wants it: the named file, or standard output where IsStandardOutput(path).
///
/// The file appears whole or not at all: the text is written beside it, then renamed; what was there before stays until then. Links
/// are followed and stay. A device, a pipe or an open descriptor (/dev/stdout) is written to, not replaced.
/// Errors: TReaderGone if the reader has closed the pipe, else TClientError.
void DeliverResult(IConsole& console, const std::string& path, const std::string& text);

}  // namespace NORVZEL20
