#pragma once

#include <string>

namespace NORVZEL20 {

/// What the paths of all temporary files begin with: `cimdelta-` in the folder that the environment variable TMPDIR names, or in
/// /tmp if it is not set or empty.
std::string BeginOfTemporaryFiles();

}  // namespace NORVZEL20
