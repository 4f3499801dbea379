#include "client/comparison/SeeFromMajority.h"

#include <memory>

#include "client/comparison/TMajorityView.h"
#include "client/inventory/TReferenceChoice.h"

namespace NORVZEL20 {

namespace {

void InsertNone(std::vector<std::size_t>& counts)
{
    counts.insert(counts.begin(), 0);
}

void PutMajorityInFront(TCoverage& coverage)
{
    for (TCoverage::TClass& cls : coverage.classes) {
        for (std::vector<std::size_t>* const counts : {&cls.instances, &cls.compared, &cls.sharing, &cls.sharingAlone}) {
            InsertNone(*counts);
        }
        for (std::size_t& inventory : cls.madeIn) {
            ++inventory;
        }
    }
    for (TSchemaNote& note : coverage.notes) {
        ++note.inventory;
        ++note.source;
    }
    for (TCoverage::TLack& lack : coverage.lacks) {
        ++lack.inventory;
    }
    for (TCoverage::TBadValues& bad : coverage.badValues) {
        ++bad.inventory;
    }
    for (TCoverage::TName& name : coverage.names) {
        ++name.inventory;
    }
    if (coverage.hint) {
        InsertNone(coverage.hint->instances);
    }
}

// The majority is declared as the run's reference is.
TInventory MakeMajority(const TInventory& reference)
{
    TInventory majority = reference;
    majority.path.clear();
    majority.files.clear();
    majority.label = kMajorityLabel;
    majority.loaded.inferred.clear();
    majority.ownNames.clear();
    return majority;
}

}  // namespace

TComparisonReport SeeFromMajority(const TComparisonReport& report)
{
    TComparisonReport seen = report;
    const auto inventories = std::make_shared<std::vector<TInventory>>(*report.inventories);
    inventories->insert(inventories->begin(), MakeMajority(report.inventories->front()));
    seen.labels.insert(seen.labels.begin(), inventories->front().label);
    seen.paths.insert(seen.paths.begin(), inventories->front().path);
    seen.loads.insert(seen.loads.begin(), inventories->front().loaded);
    PutMajorityInFront(seen.coverage);
    seen.majority = inventories;
    seen.inventories = seen.majority.get();
    seen.run = std::make_shared<const TComparisonReport>(report);
    seen.differences = std::make_shared<TMajorityView>(report.differences, *report.inventories, report.coverage);
    seen.allDifferences = seen.differences;
    return seen;
}

}  // namespace NORVZEL20
