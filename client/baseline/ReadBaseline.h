#pragma once

#include <string>
#include <string_view>

#include "client/baseline/TBaseline.h"

namespace NORVZEL20 {

/// Reads the text of a baseline; nothing or only comments is one without entries. Lines may come in any order. Entries that say the
/// same become one, and so do files that were joined. `file` is what messages call it.
/// Errors: TClientError that names file, line and column: another version, a line that is no entry, two entries that contradict.
TBaseline ParseBaseline(std::string_view text, const std::string& file);

/// The same for a file. Errors: also TClientError if it cannot be read.
TBaseline ReadBaseline(const std::string& path);

/// The same for a file that need not be there; then it has no entries. Errors: also TClientError if it is no ordinary file.
TBaseline ReadBaselineIfAny(const std::string& path);

}  // namespace NORVZEL20
