#include "client/commands/SaveRules.h"

#include "client/process/TClientError.h"
#include "client/report/TResultOutput.h"
#include "client/rules/DescribeSelection.h"
#include "client/rules/TRulesDraft.h"

namespace NORVZEL20 {

void CheckSavedRules(const std::string& path, const std::vector<std::string>& inputs)
{
    if (path.empty()) {
        return;
    }
    if (IsStandardOutput(path)) {
        throw TClientError("--save-rules writes a file, since the result goes to standard output; name a file");
    }
    CheckPlainOutput(path, inputs);
}

void SaveRules(const std::string& path, const TComparisonReport& report, const TSelection& selection, IConsole& console)
{
    if (path.empty()) {
        return;
    }
    std::vector<std::string> heading{"Saved by cimdelta compare."};
    heading.push_back(report.areRulesMade
                          ? "Everything is compared" + std::string(selection.IsEmpty() ? "." : ", except as these options say:")
                          : "The same as " + report.rules + (selection.IsEmpty() ? "." : ", narrowed by these options:"));
    for (const std::string& option : ListSelection(selection)) {
        heading.push_back("  " + option.substr(option.find_first_not_of('-')));
    }
    const TRulesDraft draft((*report.inventories)[0].ns, *report.meaning, report.areRulesMade && selection.IsEmpty());
    DeliverResult(console, path, draft.Write(heading));
}

}  // namespace NORVZEL20
