#pragma once

#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The whole program: reads the arguments (the first is the program's name), runs the command and returns the exit status.
///
/// 0 for success (for compare: no differences), 1 for differences, 2 for any trouble, wrong usage included: then one message has
/// been said and no result written. Never throws.
int RunClient(int argc, const char* const* argv, IConsole& console) noexcept;

}  // namespace NORVZEL20
