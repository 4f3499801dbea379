#pragma once

#include <string>

#include "embedded/load/TLoadSession.h"

namespace NORVZEL20 {

/// Reads a file, or standard input for "-", into a load. What its first bytes are decides how it is read, not its name.
/// Errors: TPopulateError, and TClientError if the file cannot be read or its compressed data is damaged.
void ReadSource(const std::string& path, TLoadSession& session);

}  // namespace NORVZEL20
