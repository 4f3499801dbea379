#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "client/files/TByteCount.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/process/IConsole.h"
#include "embedded/load/TLoadOptions.h"
#include "embedded/load/TLoadReport.h"
#include "embedded/store/TInMemNamespace.h"

namespace NORVZEL20 {

/// Files that are loaded together.
struct TFilesToLoad {
    std::string name;  ///< what messages call them together
    std::vector<std::string> files;
    boost::shared_ptr<TInMemNamespace> ns;  ///< what they are loaded into
    TByteCount* count = nullptr;            ///< increased by the bytes that are read; null if nobody asks
};

/// Loads the files into their namespace, all of them or nothing. Messages about what an option could remedy name it as `options`
/// do. Errors: TClientError that names file, line and column, as far as they are known.
TLoadReport LoadFiles(const TFilesToLoad& files, const TLoadOptions& load, const TLoadingOptions& options);

/// A message for each kind of fault that was tolerated.
void SayTolerated(const TLoadReport& report, IConsole& console);

/// A warning for each property with values that do not fit, up to ten.
void SayBadValues(const TLoadReport& report, IConsole& console);

}  // namespace NORVZEL20
