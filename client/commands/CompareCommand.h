#pragma once

#include <string>
#include <vector>

#include "client/baseline/ApplyBaseline.h"
#include "client/commands/EColorChoice.h"
#include "client/comparison/TOnlyKinds.h"
#include "client/inventory/TInventorySources.h"
#include "client/inventory/TLoadingOptions.h"
#include "client/inventory/TReferenceChoice.h"
#include "client/inventory/TSystemNames.h"
#include "client/process/IConsole.h"
#include "client/report/EOutputFormat.h"
#include "client/report/TTextOptions.h"
#include "client/rules/TSelection.h"

namespace NORVZEL20 {

/// Which kinds of differences are shown.
struct TOnlyShown {
    TOnlyKinds::TKinds kinds;  ///< none: all of them
    std::string option;        ///< as it was typed
};

/// The arguments of `cimdelta compare`.
struct TCompareOptions {
    std::vector<TInventorySources> inventories;  ///< at least two, in the order of the command line
    TReferenceChoice reference;
    std::string rules;  ///< empty: everything is compared
    EOutputFormat format = EOutputFormat::kText;
    TTextOptions text;  ///< colour and width are found out by the command
    EColorChoice color = EColorChoice::kAuto;
    bool isQuiet = false;  ///< whether nothing is written to standard output
    TBaselineOptions baseline;
    std::string output;  ///< empty: standard output
    bool strictSchema = false;
    bool allowEmpty = false;  ///< whether it is no error if nothing was compared
    TLoadingOptions loading;
    TSystemNames systems;
    TSelection selection;
    TOnlyShown only;
    std::string savedRules;  ///< empty: the rules are not saved
};

/// Compares inventories. Returns kExitSuccess (0) for no differences, or for none that are not accepted, otherwise kExitDifferences
/// (1). Rules and accepted differences are written once the report is made, in this order, and then the report is delivered.
/// Errors: TClientError, also if nothing was compared, unless that is allowed. What comes later in that order is as it was then; a
/// device or a pipe may have part of the report.
int RunCompare(const TCompareOptions& options, IConsole& console);

}  // namespace NORVZEL20
