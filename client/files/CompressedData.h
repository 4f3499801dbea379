#pragma once

#include <string>

namespace NORVZEL20 {

/// Ends the reading of the file `name`: its data, compressed with `kind`, is not what was compressed. Throws TClientError.
[[noreturn]] void FailDamaged(const std::string& name, const std::string& kind, const std::string& reason);

/// Ends the reading of the file `name` because there is no memory to decompress it. Throws TClientError.
[[noreturn]] void FailForMemory(const std::string& name);

}  // namespace NORVZEL20
