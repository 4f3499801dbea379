#pragma once

#include <string>

namespace NORVZEL20 {

/// The word as a person types it in a POSIX shell: in quotes if the shell would otherwise change it.
std::string QuoteForShell(const std::string& word);

}  // namespace NORVZEL20
