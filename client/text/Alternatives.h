#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// The names as a choice: "text, json or cimxml". `names` has two or more. Errors: std::bad_alloc.
std::string Alternatives(std::vector<std::string> names);

}  // namespace NORVZEL20
