// Changes are the same if all of it is: the property, the reference's value, each other value and the inventories that have it.
// They are compared by a text that leaves nothing out, since two values may look alike in a report.
#include "client/findings/TClassCollector.h"

#include <algorithm>
#include <set>
#include <tuple>
#include <utility>

#include "client/findings/CollectFindings.h"
#include "client/text/DisplayText.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

std::string WholeText(const TCIMValue& value)
{
    return TValueText::DescribeType(value.GetType()) + (value.IsBag() ? " bag " : " ") + DisplayValue(value);
}

std::string WholeText(const TValueDifference& change)
{
    std::string text = WholeText(change.reference);
    for (const TValueDifference::TGroup& group : change.others) {
        text += '\n' + WholeText(group.value);
        for (std::size_t i = 0; i < group.inventories.size(); ++i) {
            text += ' ' + std::to_string(group.inventories[i]) + 'x' + std::to_string(group.CountInstances(i));
        }
    }
    return text;
}

// Those whose value changed, ascending.
std::vector<std::size_t> InventoriesOf(const TValueDifference& change)
{
    std::set<std::size_t> inventories;
    for (const TValueDifference::TGroup& group : change.others) {
        inventories.insert(group.inventories.begin(), group.inventories.end());
    }
    return {inventories.begin(), inventories.end()};
}

bool SharesKey(const TDifference& difference)
{
    bool isShared = difference.CountSharing(0) > 0;
    for (const std::size_t inventory : difference.inventories) {
        isShared = isShared || difference.CountSharing(inventory) > 0;
    }
    return isShared;
}

}  // namespace

TClassCollector::TClassCollector(TShortNames& names, const std::string& className) : fNames(names)
{
    fFindings.className = className;
}

void TClassCollector::Add(const TDifference& difference)
{
    TDifferenceCounts& counts = fFindings.counts;
    if (difference.kind != TDifference::kChanged) {
        ++(difference.kind == TDifference::kOnlyInReference ? counts.onlyInReference : counts.onlyInOthers);
        return AddPresence(difference);
    }
    ++counts.changedValues;
    counts.changedInstances += fInstance == difference.instance ? 0 : 1;
    fInstance = difference.instance;
    AddChange(difference, difference.values.front());
}

void TClassCollector::AddPresence(const TDifference& difference)
{
    auto known = std::find_if(fFindings.presences.begin(), fFindings.presences.end(), [&](const TPresenceFinding& presence) {
        return presence.kind == difference.kind && presence.inventories == difference.inventories;
    });
    if (known == fFindings.presences.end()) {
        fFindings.presences.push_back({difference.kind, difference.inventories, 0, {}});
        known = std::prev(fFindings.presences.end());
    }
    known->instances += 1;
    if (known->examples.size() < kMostExamples) {
        known->examples.push_back({fNames.Of(difference), difference.contents});
    }
}

// The parts of a change stand for the whole.
void TClassCollector::AddChange(const TDifference& difference, const TValueDifference& change)
{
    if (!change.parts.empty()) {
        for (const TValueDifference& part : change.parts) {
            AddChange(difference, part);
        }
        return;
    }
    TProperty& property = fProperties[{change.property, InventoriesOf(change)}];
    ++property.instances;
    const auto [known, isNew] = property.positions.emplace(WholeText(change), property.changes.size());
    if (isNew) {
        property.changes.push_back({change, 0, {}, false});
    }
    TChangeFinding& finding = property.changes[known->second];
    ++finding.instances;
    finding.isShared = finding.isShared || SharesKey(difference);
    if (finding.names.size() < kMostExamples) {
        finding.names.push_back(fNames.Of(difference));
    }
}

TClassFindings TClassCollector::Take()
{
    std::stable_sort(fFindings.presences.begin(), fFindings.presences.end(),
                     [](const TPresenceFinding& one, const TPresenceFinding& other) { return one.kind < other.kind; });
    for (auto& [where, property] : fProperties) {
        std::vector<TChangeFinding>& changes = property.changes;
        std::stable_sort(changes.begin(), changes.end(),
                         [](const TChangeFinding& one, const TChangeFinding& other) { return one.instances > other.instances; });
        const std::size_t distinct = changes.size();
        changes.resize(std::min(distinct, kMostExamples));
        fFindings.properties.push_back({where.first, property.instances, distinct, where.second, std::move(changes)});
    }
    fProperties.clear();
    std::stable_sort(fFindings.properties.begin(), fFindings.properties.end(),
                     [](const TPropertyFinding& one, const TPropertyFinding& other) {
                         return std::tie(one.property, one.changes) < std::tie(other.property, other.changes);
                     });
    return std::move(fFindings);
}

}  // namespace NORVZEL20
