#pragma once

#include <cstddef>
#include <map>
#include <string>
#include <vector>

#include "provider/TDeltaNamespace.h"

namespace NORVZEL20 {

/// One KALMO_Delta as a plain value.
struct TDeltaRecord {
    TDeltaNamespace::EDeltaType type;
    std::string instanceName;
    std::string property;
    std::vector<std::size_t> inventories;  ///< ascending, each once
};

/// The records of a delta namespace by the name of their class, in the order in which they were written.
///
/// Read with ExecuteQuery and GetInstance alone. Errors: TZELException of the namespace.
std::map<std::string, std::vector<TDeltaRecord>> ReadDeltaRecords(TDeltaNamespace& ns);

}  // namespace NORVZEL20
