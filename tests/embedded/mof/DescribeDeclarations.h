#pragma once

#include <string>

#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Compares all declarations of two namespaces: qualifier declarations, classes, and their properties, methods and parameters with
/// type, default, array size, reference class, key, and each qualifier with value and flavor. What a class inherits counts as the
/// class shows it, so it does not matter whether a document repeats it. Returns a line for each difference, "-" in front of what
/// `left` has and "+" in front of what `right` has, sorted without the sign. The characters of `ignored` count nowhere.
std::string DiffDeclarations(TInMemNamespace& left, TInMemNamespace& right, const std::string& ignored = std::string());

}  // namespace NORVZEL20
