#pragma once

#include <string>
#include <string_view>

#include "client/comparison/TAcceptedDifference.h"

namespace NORVZEL20 {

/// Reads the line of an entry, without its end; the grammar is in ParseEntry.cpp. Errors: TClientError that names the file, the
/// line, the column, what was found and what was expected.
TAcceptedDifference ParseEntry(std::string_view text, const std::string& file, std::size_t line);

}  // namespace NORVZEL20
