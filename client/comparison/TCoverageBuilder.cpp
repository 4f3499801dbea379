// Which classes a comparison covers. The plug-in walks the class tree of the reference, so a class that has instances anywhere is
//
//   unknown to the reference    if that does not declare it;
//   excluded                    if the rules leave it no property (kOperatingSystemMade if the client excluded it by itself);
//   compared                    otherwise.
//
// Of a compared class two things may still escape the comparison, and are listed: properties that the rules or the reference's
// declaration leave out, and, if the rules exclude keys, instances that share their key with an earlier one.
#include "client/comparison/TCoverageBuilder.h"

#include <algorithm>
#include <numeric>

#include "client/comparison/TInstanceIndex.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

TCoverage TCoverageBuilder::Build()
{
    // The set ignores letter case, so a class has the spelling of the first inventory that declares it.
    std::set<std::string, TNameText::TLess> names;
    for (const TInventory& inventory : fInventories) {
        for (const boost::shared_ptr<TInMemClass>& cls : inventory.ns->GetClasses()) {
            names.insert(cls->GetName());
        }
    }
    TCoverage coverage;
    coverage.notes = fNotes;
    for (const std::string& name : names) {
        AddClass(coverage, name);
    }
    std::sort(coverage.classes.begin(), coverage.classes.end(),
              [](const TCoverage::TClass& a, const TCoverage::TClass& b) { return a.name < b.name; });
    return coverage;
}

void TCoverageBuilder::AddClass(TCoverage& coverage, const std::string& className)
{
    TCoverage::TClass cls;
    cls.name = className;
    cls.instances = CountInstances(className);
    if (std::accumulate(cls.instances.begin(), cls.instances.end(), static_cast<std::size_t>(0)) == 0) {
        ++coverage.classesWithout;
        return;
    }
    cls.sharing.assign(fInventories.size(), 0);
    const boost::shared_ptr<TInMemClass> declared = fInventories[0].ns->FindClass(className);
    if (declared) {
        Describe(cls, declared);
    } else {
        cls.state = TCoverage::kUnknownToReference;
    }
    coverage.classes.push_back(cls);
}

void TCoverageBuilder::Describe(TCoverage::TClass& cls, const boost::shared_ptr<ICIMClass>& declared)
{
    const std::vector<std::string> compared = fRules.PropertiesOf(declared);
    if (compared.empty()) {
        cls.state = IsMade(cls.name) ? TCoverage::kOperatingSystemMade : TCoverage::kExcludedByRules;
        return;
    }
    cls.leftOut = LeftOut(cls.name, compared);
    cls.excludedKeys = fRules.ExcludedKeysOf(cls.name);
    if (!cls.excludedKeys.empty()) {
        for (std::size_t i = 0; i < fInventories.size(); ++i) {
            cls.sharing[i] = TInstanceIndex(*fInventories[i].ns, cls.name, fRules).CountSharing();
        }
    }
}

// The properties of all inventories count: with --strict-schema, others may declare some that the reference does not.
std::vector<std::string> TCoverageBuilder::LeftOut(const std::string& className, const std::vector<std::string>& compared) const
{
    const std::set<std::string, TNameText::TLess> taken(compared.begin(), compared.end());
    std::set<std::string, TNameText::TLess> leftOut;
    for (const TInventory& inventory : fInventories) {
        if (const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className)) {
            for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
                if (taken.count(cls->GetLayout().GetDecl(slot).GetName()) == 0) {
                    leftOut.insert(cls->GetLayout().GetDecl(slot).GetName());
                }
            }
        }
    }
    std::vector<std::string> names(leftOut.begin(), leftOut.end());
    std::sort(names.begin(), names.end());
    return names;
}

std::vector<std::size_t> TCoverageBuilder::CountInstances(const std::string& className) const
{
    std::vector<std::size_t> counts;
    for (const TInventory& inventory : fInventories) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        counts.push_back(cls ? cls->GetInstanceCount() : 0);
    }
    return counts;
}

bool TCoverageBuilder::IsMade(const std::string& className) const
{
    return std::any_of(fNotes.begin(), fNotes.end(), [&className](const TSchemaNote& note) {
        return note.kind == TSchemaNote::kOperatingSystemMade && TNameText::Equal(note.className, className);
    });
}

}  // namespace NORVZEL20
