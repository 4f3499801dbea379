#pragma once

#include <string>

#include "client/collect/TCollectionOptions.h"
#include "client/process/IConsole.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta collect`.
struct TCollectOptions {
    TCollectionOptions collection;
    std::string output;  ///< empty: standard output
};

/// Checks the options and whether the output can be written. Errors: TClientError.
void CheckCollect(const TCollectOptions& options);

/// Collects the inventory of this system. Returns kExitSuccess (0), also if something was left out, which is said on the console.
/// Errors: TClientError.
int RunCollect(const TCollectOptions& options, IConsole& console);

}  // namespace NORVZEL20
