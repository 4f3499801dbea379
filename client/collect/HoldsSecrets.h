#pragma once

#include <string>

namespace NORVZEL20 {

/// Whether a file with that path is one for keys or passwords, by its name. Such a file is never opened.
bool HoldsSecrets(const std::string& path);

}  // namespace NORVZEL20
