// The columns, each a list of numbers; what ends with (text), (set) or the like is the number of one:
//
//   row         instance, set (of the inventories that differ), content (a change, or of an instance that came or went a content),
//               difference (its place among all: parts of one have the same)
//   instance    name (text), key (text), lacking (the set of the inventories without it), sharing (list: how many instances of each
//               inventory have the key), path (text)
//   change      reference (text), short (text), groups (the first of its groups; they end where those of the next change begin)
//   group       value (text), set, counts (list)
//   content     pairs (the first), disagreements (the first)
//   pair        property (text), value (text)
//   disagreement  property (text), change
//   list        numbers (the first)
//
// The rows of a finding stand together, and so do the findings of a class. Texts, sets and lists 0 are empty.
#include "client/report/html/CollectPageData.h"

#include <optional>

#include "client/findings/TShortNames.h"
#include "client/report/html/TPageClassRows.h"

namespace NORVZEL20 {

namespace {

// A table of values must not show the reference's value for an inventory that lacks the instance, even if that difference itself is
// left out.
TPageClassRows::TLacking FindLacking(const TComparisonReport& report)
{
    TPageClassRows::TLacking lacking;
    if (report.allDifferences != report.differences) {
        report.allDifferences->ForEach([&lacking](const TDifference& difference) {
            if (difference.kind == TDifference::kOnlyInReference) {
                lacking[difference.instance] = difference.inventories;
            }
        });
    }
    return lacking;
}

}  // namespace

void CollectPageData(const TComparisonReport& report, TPageData& data)
{
    const TPageClassRows::TLacking lacking = FindLacking(report);
    TShortNames names(*report.inventories);
    std::optional<TPageClassRows> rows;  // of the class that is read
    std::size_t number = 0;
    report.differences->ForEach([&](const TDifference& difference) {
        if (!rows || rows->GetClassName() != difference.className) {
            if (rows) {
                rows->Write();
            }
            rows.emplace(report, lacking, names, data, difference.className);
        }
        rows->Add(difference, number);
        ++number;
    });
    if (rows) {
        rows->Write();
    }
}

}  // namespace NORVZEL20
