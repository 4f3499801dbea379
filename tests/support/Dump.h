#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "engine/TCIMDiffEngine.h"

namespace NORVZEL20 {

/// Text forms for what tests compare.

/// A class with its rules: `Disk include final A:EXCLUDE B:INCLUDE -Key1 -Key2`, a line for each.
std::string DumpRules(const TCIMDiffEngine::TRuleset& ruleset);
std::string DumpRules(const TCIMDiffEngine::TDiffClassRules& rules);

/// The delta records of a store, class record by class record, in the order they were added:
///
///     Disk
///       4 Disk.Id="sda" Size [1]
///
/// Reads each record through the association that ties it to its class. Records without an association are marked "loose".
std::string DumpRecords(boost::shared_ptr<ICIMNamespace> store);

/// The instances of exactly this class, `Disk.Id="sda" Size=5` for each, in the host's order.
std::string DumpInstances(boost::shared_ptr<ICIMNamespace> ns, const std::string& className);

/// The aliases that the delta namespace's wrappers hold: `1:Disk alias -> path` for each.
std::string DumpAliases(const TDeltaNamespace& ns);

}  // namespace NORVZEL20
