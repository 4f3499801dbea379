#pragma once

#include <string>
#include <vector>

#include "client/rules/TSelection.h"

namespace NORVZEL20 {

/// The options as a person types them: `--class Disk`, `--exclude '*.Caption'`.
std::vector<std::string> ListSelection(const TSelection& selection);

/// The same in one text. Many are only counted: `--exclude (12 times)`.
std::string DescribeSelection(const TSelection& selection);

}  // namespace NORVZEL20
