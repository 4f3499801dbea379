#pragma once

#include <string>

namespace NORVZEL20 {

/// The text of a document in UTF-8, without its byte order mark. The document is in UTF-8, or in UTF-16 with a byte order mark or
/// ASCII in front. UTF-8 is not checked. If the document is something else, says what in `problem`, which is empty otherwise.
std::string DecodeMof(std::string bytes, std::string& problem);

}  // namespace NORVZEL20
