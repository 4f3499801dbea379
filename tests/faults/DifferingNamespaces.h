#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstddef>
#include <string>
#include <vector>

#include "tests/support/TNamespaceBuilder.h"

namespace NORVZEL20 {

/// Small namespaces that differ in every way that a run records.

/// Declares the classes Disk, Ssd (below Disk), Slot and, in namespace 0 alone, Ghost, and fills them as namespace `index` has
/// them.
void FillDiffering(TNamespaceBuilder& builder, std::size_t index);

/// A specification that compares all of it; with excluded keys, slots are matched by their number whatever their bus.
std::string RulesForDiffering(bool excludesKeys);

/// What the namespace has of each class, as text.
std::string DumpDiffering(boost::shared_ptr<ICIMNamespace> ns);

/// The records of a store, one text for each in the order in which they were written: `class Disk`, `4 Disk.Id="a" Size [1]`, and
/// `tie` for the association of the record before. Tells where an association ties no record, or one that it does not follow.
std::vector<std::string> TraceRecords(boost::shared_ptr<ICIMNamespace> store);

}  // namespace NORVZEL20
