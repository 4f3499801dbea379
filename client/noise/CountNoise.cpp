#include "client/noise/CountNoise.h"

namespace NORVZEL20 {

namespace {

void AddChange(TClassNoise& noise, const TDifference& difference)
{
    ++noise.counts.changedValues;
    const TValueDifference& change = difference.values.front();
    TClassNoise::TProperty& property = noise.properties[change.property];
    if (property.instances == 0) {
        const TValueDifference* first = &change;
        while (!first->parts.empty()) {
            first = &first->parts.front();
        }
        property.example = *first;
    }
    ++property.instances;
    property.inventories.insert(difference.inventories.begin(), difference.inventories.end());
}

}  // namespace

std::map<std::string, TClassNoise> CountNoise(const TComparisonReport& report)
{
    std::map<std::string, TClassNoise> classes;
    report.differences->ForEach([&](const TDifference& difference) {
        TClassNoise& noise = classes[difference.className];
        if (difference.kind == TDifference::kChanged) {
            return AddChange(noise, difference);
        }
        noise.inventories.insert(difference.inventories.begin(), difference.inventories.end());
        if (difference.kind == TDifference::kOnlyInOthers) {
            ++noise.counts.onlyInOthers;
            noise.counts.instancesOnlyInOthers += difference.CountInstances();
            return;
        }
        ++noise.counts.onlyInReference;
        noise.missingEverywhere += difference.inventories.size() + 1 == report.labels.size() ? 1 : 0;
    });
    return classes;
}

}  // namespace NORVZEL20
