#pragma once

#include <string>
#include <string_view>

#include "client/baseline/TBaseline.h"

namespace NORVZEL20 {

/// Reads the text of a baseline. Lines may come in any order. Entries that say the same become one, and so do files that were
/// joined. `file` is what messages call it.
/// Errors: TClientError that names file, line and column: a first line that is not that of a baseline, another version, a line that
/// is no entry, two entries that contradict, bytes that are no UTF-8, control characters.
TBaseline ParseBaseline(std::string_view text, const std::string& file);

/// Finds a file that cannot be read before anything takes time. Errors: TClientError.
void CheckBaseline(const std::string& path);

/// The same as ParseBaseline for a file. Errors: also TClientError if it cannot be read.
TBaseline ReadBaseline(const std::string& path);

/// The same for a file that need not be there, or may be empty; then it has no entries. Errors: also TClientError if it is no
/// ordinary file.
TBaseline ReadBaselineIfAny(const std::string& path);

}  // namespace NORVZEL20
