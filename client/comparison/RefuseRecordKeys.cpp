#include "client/comparison/RefuseRecordKeys.h"

#include <algorithm>

#include "client/process/TClientError.h"
#include "client/rules/RecordClasses.h"
#include "client/rules/TRuleTrace.h"

namespace NORVZEL20 {

namespace {

bool HasInstances(const std::vector<TInventory>& inventories, const std::string& className)
{
    return std::any_of(inventories.begin(), inventories.end(), [&className](const TInventory& inventory) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        return cls && cls->GetInstanceCount() > 0;
    });
}

}  // namespace

void RefuseRecordKeys(const std::vector<TInventory>& inventories, TRules& rules, const std::string& name, bool hasLines)
{
    for (const boost::shared_ptr<TInMemClass>& cls : inventories[0].ns->GetClasses()) {
        if (IsRecordClass(cls->GetName()) && !rules.ExcludedKeysOf(cls->GetName()).empty() && !rules.PropertiesOf(cls).empty() &&
            HasInstances(inventories, cls->GetName())) {
            const TRuleTrace trace(rules.GetDocument(), inventories[0].ns);
            const std::string line = ":" + std::to_string(trace.Find(cls->GetName()).excludedKeysLine);
            throw TClientError(name + (hasLines ? line : "") + ": " + DescribeRecordKeys(cls->GetName()));
        }
    }
}

}  // namespace NORVZEL20
