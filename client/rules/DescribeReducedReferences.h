#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

/// How the references of a class are compared if its rules exclude keys: "without key Name and without their namespace".
///
/// `keys` are those left out of the references; none, one or more.
std::string DescribeReducedReferences(const std::vector<std::string>& keys);

}  // namespace NORVZEL20
