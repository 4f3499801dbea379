#pragma once

#include <cstddef>
#include <string>

#include "client/findings/TFindings.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// If over half of all differences, but not all, are of one property, or are in a class and mostly instances that not all
/// inventories have: a line that says so and names the option that leaves out exactly these. Otherwise, and if they are few, empty.
/// `schema` declares the classes. Cost: quadratic in the classes with findings.
std::string DescribeLargestGroup(const TInMemNamespace& schema, const TFindings& findings, std::size_t total);

}  // namespace NORVZEL20
