#include "client/findings/CollectOutliers.h"

#include <algorithm>
#include <map>
#include <string>
#include <utility>

#include "client/comparison/EmbeddedParts.h"
#include "client/findings/CollectFindings.h"
#include "client/findings/TClassCollector.h"

namespace NORVZEL20 {

namespace {

class TOutlierCollector {
  public:
    TOutlierCollector(const TComparisonReport& report, bool hasWholeKeys)
        : fReport(report), fNames(*report.inventories, hasWholeKeys)
    {}

    void Add(const TDifference& difference)
    {
        if (fClassName != difference.className) {
            EndClass();
            fClassName = difference.className;
        }
        if (difference.kind != TDifference::kChanged) {
            AddTo(difference.inventories, difference);
            return;
        }
        const TValueDifference& change = difference.values.front();
        for (const TValueDifference::TGroup& group : change.others) {
            TDifference ofGroup = difference;
            ofGroup.inventories = group.inventories;
            ofGroup.values = {{change.property, change.reference, {group}, {}}};
            AddEmbeddedParts(ofGroup.values.front(), true);
            AddTo(group.inventories, ofGroup);
        }
    }

    std::vector<TOutliers> Take()
    {
        EndClass();
        std::vector<TOutliers> all;
        for (auto& [inventories, outliers] : fOutliers) {
            outliers.inventories = inventories;
            all.push_back(std::move(outliers));
        }
        std::stable_sort(all.begin(), all.end(), [](const TOutliers& one, const TOutliers& other) {
            return one.inventories.size() < other.inventories.size();
        });
        return all;
    }

  private:
    using TWho = std::vector<std::size_t>;

    void AddTo(const TWho& who, const TDifference& difference)
    {
        fCollectors.try_emplace(who, *fReport.inventories, fNames, fClassName, kMostExamples).first->second.Add(difference);
        ++fOutliers[who].differences;
    }

    void EndClass()
    {
        for (auto& [who, collector] : fCollectors) {
            fOutliers[who].classes.push_back(collector.Take());
        }
        fCollectors.clear();
    }

    const TComparisonReport& fReport;
    TShortNames fNames;
    std::string fClassName;
    std::map<TWho, TClassCollector> fCollectors;  // of the class that is read
    std::map<TWho, TOutliers> fOutliers;
};

}  // namespace

std::vector<TOutliers> CollectOutliers(const TComparisonReport& report, bool hasWholeKeys)
{
    TOutlierCollector collector(report, hasWholeKeys);
    report.differences->ForEach([&collector](const TDifference& difference) { collector.Add(difference); });
    return collector.Take();
}

}  // namespace NORVZEL20
