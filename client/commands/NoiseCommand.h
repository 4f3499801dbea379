#pragma once

#include <string>
#include <vector>

#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/inventory/TSystemNames.h"
#include "client/process/IConsole.h"
#include "client/report/EOutputFormat.h"
#include "client/report/TTextOptions.h"

namespace NORVZEL20 {

/// The arguments of `cimdelta noise`.
struct TNoiseOptions {
    std::vector<TInventorySources> inventories;  ///< at least two, the reference first
    std::string rules;                           ///< empty: everything is compared
    std::string savedRules;                      ///< empty: the rules that are found are not saved
    EOutputFormat format = EOutputFormat::kText;
    TTextOptions text;   ///< whether it is coloured is found out by the command
    std::string output;  ///< empty: standard output
    bool strictSchema = false;
    TLoadingOptions loading;
    TSystemNames systems;
};

/// Finds rules that leave out what differs between inventories of one system. Returns kExitSuccess (0) if nothing differs,
/// otherwise kExitDifferences (1). Errors: TClientError, also if nothing was compared.
int RunNoise(const TNoiseOptions& options, IConsole& console);

}  // namespace NORVZEL20
