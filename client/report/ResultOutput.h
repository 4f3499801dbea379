#pragma once

#include <string>
#include <vector>

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// Whether a result for that path goes to standard output: the path is empty or "-".
bool IsStandardOutput(const std::string& path);

/// Checks, without changing anything, whether a result can be delivered to that path and would not replace one of the `inputs`,
/// which are paths too, with "-" for standard input. A device may still turn out to be full.
/// Errors: TClientError.
void CheckOutput(const std::string& path, const std::vector<std::string>& inputs);

/// Writes a whole result to the file of that path, or to the console's standard output if IsStandardOutput(path).
///
/// A file appears whole or not at all: what was there stays until the new text is on the disk. Links are followed and stay. A
/// device, a pipe or an open descriptor (/dev/stdout) is written to, not replaced.
/// Errors: TReaderGone if the reader has closed the pipe, else TClientError.
void DeliverResult(IConsole& console, const std::string& path, const std::string& text);

}  // namespace NORVZEL20
