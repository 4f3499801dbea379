#pragma once

#include <string>
#include <string_view>

namespace NORVZEL20 {

/// Bytes in base64 (RFC 4648, section 4), with padding and without line ends. At most 1 GiB of them. Errors: std::bad_alloc.
std::string EncodeBase64(std::string_view bytes);

}  // namespace NORVZEL20
