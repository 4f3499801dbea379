#pragma once

#include <string>
#include <vector>

#include "client/process/IConsole.h"
#include "client/report/EOutputFormat.h"

namespace NORVZEL20 {

/// What `cimdelta compare` was asked.
struct TCompareOptions {
    std::string reference;
    std::vector<std::string> others;  ///< at least one
    std::string rules;                ///< empty: everything is compared
    EOutputFormat format = EOutputFormat::kText;
    std::string output;  ///< empty: standard output
    bool strictSchema = false;
};

/// Compares inventories. Returns 0 for no differences, 1 for differences. Errors: TClientError; nothing has been written then.
int RunCompare(const TCompareOptions& options, IConsole& console);

}  // namespace NORVZEL20
