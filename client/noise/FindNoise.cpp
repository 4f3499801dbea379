// (1) Compare. If instances come and go, find keys without which they match, or else leave out classes without a match;
//     repeat this with those rules until nothing more of the kind is found. Only then is it known which instances belong together.
// (2) Leave out the properties that differ.
// (3) Compare again: what differs now is not explained.
#include "client/noise/FindNoise.h"

#include <algorithm>
#include <tuple>

#include "client/noise/CountNoise.h"
#include "client/noise/FindTops.h"
#include "client/noise/FindVaryingKeys.h"
#include "client/rules/RecordClasses.h"

namespace NORVZEL20 {

namespace {

using TClass = TRulesDraft::TClass;

class TNoiseFinder {
  public:
    TNoiseFinder(TComparison& comparison, const std::vector<TInventory>& inventories)
        : fComparison(comparison), fInventories(inventories), fDraft(comparison.MakeDraft())
    {
        for (std::size_t position = 0; position < fDraft.GetClasses().size(); ++position) {
            fPositions[fDraft.GetClasses()[position].name] = position;
        }
    }

    TNoise Find()
    {
        const TComparisonReport before = fComparison.Try(nullptr);
        TComparisonReport report = before;
        while (report.differences->GetCounts().GetTotal() > 0) {
            const TCounts counts = Count(report);
            if (!ExcludeKeys(report, counts) && !LeaveOutClasses(report, counts)) {
                LeaveOutProperties(report, counts);
                report = fComparison.Try(&fDraft);
                break;
            }
            report = fComparison.Try(&fDraft);
        }
        std::sort(fRules.begin(), fRules.end(), [](const TNoiseRule& a, const TNoiseRule& b) {
            return std::tie(a.className, a.kind, a.name) < std::tie(b.className, b.kind, b.name);
        });
        return {before, report, fDraft, fRules, Rest(report)};
    }

  private:
    using TCounts = std::map<std::size_t, TClassNoise>;

    // The classes that a rule is for, and what it names.
    struct TPlace {
        std::size_t begin;
        std::size_t end;
        std::string name;
    };

    TCounts Count(const TComparisonReport& report) const
    {
        TCounts counts;
        for (auto& [className, noise] : CountNoise(report)) {
            counts[fPositions.at(className)] = std::move(noise);
        }
        return counts;
    }

    // The instances of the reference that were compared, class by class; and the classes that have any.
    std::map<std::size_t, std::size_t> CountInstances(const TComparisonReport& report) const
    {
        std::map<std::size_t, std::size_t> instances;
        for (const TCoverage::TClass& cls : report.coverage.classes) {
            const auto position = fPositions.find(cls.name);
            if (cls.IsCompared() && position != fPositions.end()) {
                instances[position->second] = cls.compared[0];
            }
        }
        return instances;
    }

    // The classes with instances that have the property or key.
    std::set<std::size_t> FindRelevant(const TComparisonReport& report, const std::vector<std::string> TClass::*members,
                                       const std::string& name) const
    {
        std::set<std::size_t> relevant;
        for (const auto& entry : CountInstances(report)) {
            if (entry.second > 0 && Has(entry.first, members, name)) {
                relevant.insert(entry.first);
            }
        }
        return relevant;
    }

    bool Has(std::size_t position, const std::vector<std::string> TClass::*members, const std::string& name) const
    {
        const std::vector<std::string>& names = fDraft.GetClasses()[position].*members;
        return std::any_of(names.begin(), names.end(), [&name](const std::string& one) { return TNameText::Equal(one, name); });
    }

    bool ExcludeKeys(const TComparisonReport& report, const TCounts& counts)
    {
        std::vector<std::size_t> changing;
        for (const auto& [position, noise] : counts) {
            if (noise.counts.onlyInReference > 0 && noise.counts.onlyInOthers > 0 &&
                !IsRecordClass(fDraft.GetClasses()[position].name)) {
                changing.push_back(position);
            }
        }
        const std::map<std::size_t, TVaryingKeys> found = FindVaryingKeys(fInventories, *report.meaning, fDraft, changing);
        std::map<std::string, std::set<std::size_t>, TNameText::TLess> byKey;
        for (const auto& [position, varying] : found) {
            for (const std::string& key : varying.keys) {
                byKey[key].insert(position);
            }
        }
        for (const auto& [key, showing] : byKey) {
            const auto declares = [&, name = key](std::size_t above) { return Has(above, &TClass::keys, name); };
            for (const auto& [top, end] :
                 FindTops(fDraft.GetClasses(), showing, FindRelevant(report, &TClass::keys, key), declares)) {
                AddKeyRule({top, end, key}, showing, found, counts);
            }
        }
        return !found.empty();
    }

    void AddKeyRule(const TPlace& place, const std::set<std::size_t>& showing, const std::map<std::size_t, TVaryingKeys>& found,
                    const TCounts& counts)
    {
        TNoiseRule rule = MakeRule(TNoiseRule::kKey, place);
        std::set<std::size_t> inventories;
        ForEachIn(place, showing, [&](std::size_t position) {
            rule.affected += found.at(position).matched;
            rule.of += found.at(position).unmatched;
            inventories.insert(counts.at(position).inventories.begin(), counts.at(position).inventories.end());
        });
        rule.comparisons = inventories.size();
        fRules.push_back(rule);
        for (std::size_t position = place.begin; position < place.end; ++position) {
            fDraft.ExcludeKey(position, place.name);
        }
    }

    bool LeaveOutClasses(const TComparisonReport& report, const TCounts& counts)
    {
        const std::map<std::size_t, std::size_t> instances = CountInstances(report);
        bool isAny = false;
        for (const auto& [position, noise] : counts) {
            const bool comesOrGoes = noise.counts.onlyInReference + noise.counts.onlyInOthers > 0;
            if (comesOrGoes && noise.missingEverywhere == instances.at(position)) {
                TNoiseRule rule = MakeRule(TNoiseRule::kClass, {position, position + 1, std::string()});
                rule.affected = noise.counts.onlyInReference + noise.counts.instancesOnlyInOthers;
                rule.of = rule.affected;
                rule.comparisons = noise.inventories.size();
                fRules.push_back(rule);
                fDraft.LeaveOut(position);
                isAny = true;
            }
        }
        return isAny;
    }

    void LeaveOutProperties(const TComparisonReport& report, const TCounts& counts)
    {
        std::map<std::string, std::set<std::size_t>, TNameText::TLess> byName;
        for (const auto& [position, noise] : counts) {
            for (const auto& entry : noise.properties) {
                byName[entry.first].insert(position);
            }
        }
        std::map<std::size_t, TRulesDraft::TNames> leftOut;  // all at once, see TRulesDraft::LeaveOutProperties
        for (const auto& [name, showing] : byName) {
            const auto declares = [&, property = name](std::size_t above) { return Has(above, &TClass::declared, property); };
            for (const auto& [top, end] :
                 FindTops(fDraft.GetClasses(), showing, FindRelevant(report, &TClass::declared, name), declares)) {
                AddPropertyRule({top, end, name}, showing, report, counts);
                for (std::size_t position = top; position < end; ++position) {
                    leftOut[position].insert(name);
                }
            }
        }
        for (const auto& [position, names] : leftOut) {
            fDraft.LeaveOutProperties(position, names);
        }
    }

    void AddPropertyRule(const TPlace& place, const std::set<std::size_t>& showing, const TComparisonReport& report,
                         const TCounts& counts)
    {
        const std::map<std::size_t, std::size_t> instances = CountInstances(report);
        TNoiseRule rule = MakeRule(TNoiseRule::kProperty, place);
        std::set<std::size_t> inventories;
        ForEachIn(place, showing, [&](std::size_t position) {
            const TClassNoise& noise = counts.at(position);
            const TClassNoise::TProperty& property = noise.properties.at(place.name);
            if (rule.affected == 0) {
                rule.example = property.example;
            }
            rule.affected += property.instances;
            rule.of += instances.at(position) - noise.missingEverywhere;
            inventories.insert(property.inventories.begin(), property.inventories.end());
        });
        rule.comparisons = inventories.size();
        fRules.push_back(rule);
    }

    template <class TCallback>
    static void ForEachIn(const TPlace& place, const std::set<std::size_t>& showing, const TCallback& callback)
    {
        std::for_each(showing.lower_bound(place.begin), showing.lower_bound(place.end), callback);
    }

    TNoiseRule MakeRule(TNoiseRule::EKind kind, const TPlace& place) const
    {
        TNoiseRule rule;
        rule.kind = kind;
        rule.position = place.begin;
        rule.isForTree = place.end == fDraft.GetClasses()[place.begin].treeEnd;
        rule.className = fDraft.GetClasses()[place.begin].name;
        rule.name = place.name;
        return rule;
    }

    std::vector<TUnexplained> Rest(const TComparisonReport& report) const
    {
        const std::map<std::size_t, std::size_t> instances = CountInstances(report);
        std::vector<TUnexplained> rest;
        for (const auto& [position, noise] : Count(report)) {
            rest.push_back({fDraft.GetClasses()[position].name, noise.counts, instances.at(position)});
        }
        std::sort(rest.begin(), rest.end(), [](const TUnexplained& a, const TUnexplained& b) { return a.className < b.className; });
        return rest;
    }

    TComparison& fComparison;
    const std::vector<TInventory>& fInventories;
    TRulesDraft fDraft;
    std::map<std::string, std::size_t> fPositions;
    std::vector<TNoiseRule> fRules;
};

}  // namespace

TNoise FindNoise(TComparison& comparison, const std::vector<TInventory>& inventories)
{
    return TNoiseFinder(comparison, inventories).Find();
}

}  // namespace NORVZEL20
