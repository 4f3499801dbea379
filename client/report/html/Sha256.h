#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// The SHA-256 digest of a text (FIPS 180-4): 32 bytes. Errors: std::bad_alloc.
std::string Sha256(std::string_view text);

/// The same as 64 hexadecimal digits.
std::string Sha256Hex(std::string_view text);

}  // namespace NORVZEL20
