#pragma once

#include <string>

namespace NORVZEL20 {

/// Throws TClientError: the file `name`, compressed with `kind`, is damaged for that reason.
[[noreturn]] void FailDamaged(const std::string& name, const std::string& kind, const std::string& reason);

/// Throws TClientError: there is no memory to decompress the file `name`.
[[noreturn]] void FailForMemory(const std::string& name);

}  // namespace NORVZEL20
