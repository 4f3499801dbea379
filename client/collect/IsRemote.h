#pragma once

#include <string>

namespace NORVZEL20 {

/// Whether a file system of that type is on another system or in the hands of a program, so that asking it may take forever.
bool IsRemote(const std::string& fileSystemType);

}  // namespace NORVZEL20
