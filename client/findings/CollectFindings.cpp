#include "client/findings/CollectFindings.h"

#include <optional>

#include "client/findings/TClassCollector.h"

namespace NORVZEL20 {

TFindings CollectFindings(const TComparisonReport& report, std::size_t most, bool hasWholeKeys)
{
    TFindings findings;
    findings.differences.assign(report.labels.size(), 0);
    TShortNames names(*report.inventories, hasWholeKeys);
    std::optional<TClassCollector> collector;  // of the class that is read
    report.differences->ForEach([&](const TDifference& difference) {
        if (!collector || collector->GetClassName() != difference.className) {
            if (collector) {
                findings.classes.push_back(collector->Take());
            }
            collector.emplace(*report.inventories, names, difference.className, most);
        }
        collector->Add(difference);
        for (const std::size_t inventory : difference.inventories) {
            ++findings.differences[inventory];
        }
    });
    if (collector) {
        findings.classes.push_back(collector->Take());
    }
    return findings;
}

}  // namespace NORVZEL20
