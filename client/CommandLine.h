#pragma once

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The whole program: reads the arguments (the first is the program's name), runs the command and returns the exit status.
///
/// kExitSuccess (0); for compare, this means no differences. kExitDifferences (1) for compare alone. kExitTrouble (2) for anything
/// else, wrong usage included: nothing has been written then but one message, or no message if the reader has closed the pipe.
/// Never throws.
int RunClient(int argc, const char* const* argv, IConsole& console) noexcept;

}  // namespace NORVZEL20
