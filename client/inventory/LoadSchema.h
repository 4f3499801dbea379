#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// The files that give declarations to all inventories, each once; see ReadSourceList. Errors: those of that function.
std::vector<std::string> ListSchemaFiles(const TLoadingOptions& options, IConsole& console);

/// Loads what options.schemaFiles declare, without their instances; null if there are none. Faults that are tolerated get a
/// message. Errors: TClientError.
boost::shared_ptr<const TInMemNamespace> LoadSchema(const TLoadingOptions& options, IConsole& console);

}  // namespace NORVZEL20
