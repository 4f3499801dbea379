#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// The names with commas between them: "a, b, c". Of more than twelve, the number stands for the rest: "a, b, ... and 3 more".
std::string SomeOf(const std::vector<std::string>& names);

}  // namespace NORVZEL20
