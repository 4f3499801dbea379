#pragma once

#include <string>

#include "tests/engine/NaiveSet.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {

/// Adds the classes and instances to the builder's namespace.
void BuildNamespace(const TNaiveNamespace& plain, TNamespaceBuilder& builder);

/// The specification of a set, as a document.
std::string RulesOf(const TNaiveSet& set);

/// Builds the set in namespaces of that host and runs the plug-in over it. Returns the result in the form of CompareNaively.
std::string CompareByPlugIn(const TNaiveSet& set, EHost host);

}  // namespace NORVZEL20
