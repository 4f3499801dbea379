// Which classes a comparison covers. The plug-in walks the class tree of the reference, so a class that has instances anywhere is
//
//   unknown to the reference    if that does not declare it;
//   made                        if it is KALMO_OperatingSystem and IsNoSystemCompared, whatever the rules say;
//   not compared                if there is no property to compare: because no element reaches the class, because it has none, or
//                               because its rules exclude them;
//   compared                    otherwise.
//
// Of a compared class some things may still escape the comparison, and are listed: properties that the rules or the reference's
// declaration leave out, and what is lost if the rules exclude keys (see DescribeExcludedKeys.cpp). An instance of the class
// counts as compared if the plug-in looks for it in another inventory or in the reference, whether or not it is found there.
#include "client/comparison/TCoverageBuilder.h"

#include <algorithm>
#include <set>

#include "client/comparison/DescribeExcludedKeys.h"
#include "client/inventory/NotCollected.h"
#include "client/inventory/UncomparedSystems.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

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
    for (std::size_t i = 0; i < fInventories.size(); ++i) {
        for (const TBadProperty& found : fInventories[i].loaded.badProperties) {
            coverage.badValues.push_back({i, found});
        }
        for (const TNotCollected& what : FindNotCollected(*fInventories[i].ns)) {
            coverage.lacks.push_back({i, what});
        }
        for (const TOwnName& name : fInventories[i].ownNames) {
            const bool isUnused = !name.isInKeys && !TNameText::Equal(name.name, name.comparedAs);
            if (name.replaced + name.marked > 0 || isUnused || name.isCommon) {
                coverage.names.push_back({i, name});
            }
        }
    }
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
    if (TNameText::Equal(className, kOperatingSystemClass)) {
        cls.madeIn = FindMadeSystems(fNotes);
    }
    for (const std::size_t inventory : cls.madeIn) {
        --cls.instances[inventory];
    }
    if (!cls.HasOwnInstances() && cls.madeIn.empty()) {
        ++coverage.classesWithout;
        return;
    }
    const std::vector<std::size_t> none(fInventories.size(), 0);
    cls.compared = cls.sharing = cls.sharingAlone = none;
    cls.state = Describe(cls);
    if (cls.state == TCoverage::kCompared) {
        CountCompared(cls);
    }
    coverage.classes.push_back(cls);
    AddSuperClasses(coverage, className);
}

// A class has the superclass that the first inventory with the class declares. The tree has no circle: that inventory declares the
// classes above as well, so the walk never comes back to a later inventory.
void TCoverageBuilder::AddSuperClasses(TCoverage& coverage, const std::string& className) const
{
    std::string name = className;
    while (coverage.superClasses.count(name) == 0) {
        boost::shared_ptr<TInMemClass> declared;
        for (std::size_t i = 0; i < fInventories.size() && !declared; ++i) {
            declared = fInventories[i].ns->FindClass(name);
        }
        const boost::shared_ptr<TInMemClass>& super = declared->GetSuperInMemClass();
        if (!super) {
            return;
        }
        coverage.superClasses[name] = super->GetName();
        name = super->GetName();
    }
}

TCoverage::EState TCoverageBuilder::Describe(TCoverage::TClass& cls)
{
    const boost::shared_ptr<TInMemClass> declared = fInventories[0].ns->FindClass(cls.name);
    if (!declared) {
        return TCoverage::kUnknownToReference;
    }
    const std::vector<std::string> compared = fRules.PropertiesOf(declared);
    if (!cls.madeIn.empty() && IsNoSystemCompared(fNotes, fInventories.size())) {
        return TCoverage::kOperatingSystemMade;
    }
    if (compared.empty()) {
        return WhyNothingIsCompared(cls, *declared);
    }
    cls.leftOut = LeftOut(*declared, compared);
    DescribeExcludedKeys(cls, fInventories, fRules, compared);
    return TCoverage::kCompared;
}

TCoverage::EState TCoverageBuilder::WhyNothingIsCompared(const TCoverage::TClass& cls, const TInMemClass& declared) const
{
    if (!fRules.Reach(cls.name)) {
        return TCoverage::kReachedByNoElement;
    }
    const std::vector<std::uint32_t>& slots = declared.GetLayout().GetOrder();
    const bool hasOthers = std::any_of(slots.begin(), slots.end(), [&declared](std::uint32_t slot) {
        return declared.GetLayout().GetDecl(slot).GetName() != kCollectionTime;
    });
    return hasOthers ? TCoverage::kExcludedByRules : TCoverage::kNothingToCompare;
}

// Of the reference's instances with the same key only the first is compared.
void TCoverageBuilder::CountCompared(TCoverage::TClass& cls) const
{
    cls.compared = cls.instances;
    cls.compared[0] -= cls.sharing[0];
}

// The properties of all inventories count: with --strict-schema, others may declare some that the reference does not.
std::vector<TCoverage::TLeftOut> TCoverageBuilder::LeftOut(const TInMemClass& declared, const std::vector<std::string>& compared)
{
    const std::set<std::string, TNameText::TLess> taken(compared.begin(), compared.end());
    std::set<std::string, TNameText::TLess> names;
    for (const TInventory& inventory : fInventories) {
        if (const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(declared.GetName())) {
            for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
                if (taken.count(cls->GetLayout().GetDecl(slot).GetName()) == 0) {
                    names.insert(cls->GetLayout().GetDecl(slot).GetName());
                }
            }
        }
    }
    std::vector<TCoverage::TLeftOut> leftOut;
    for (const std::string& name : names) {
        leftOut.push_back({name, WhyLeftOut(declared, name)});
    }
    std::sort(leftOut.begin(), leftOut.end(),
              [](const TCoverage::TLeftOut& a, const TCoverage::TLeftOut& b) { return a.property < b.property; });
    return leftOut;
}

TCoverage::EReason TCoverageBuilder::WhyLeftOut(const TInMemClass& declared, const std::string& property)
{
    if (IsUsedAsKey(declared.GetName(), property)) {
        return TCoverage::EReason::kUsedAsKey;
    }
    if (!declared.FindPropertyDecl(property)) {
        return TCoverage::EReason::kNotDeclared;
    }
    const bool isIncluded = fTrace.Decide(declared.GetName(), property).treatment == TCIMDiffEngine::INCLUDE;
    return isIncluded && property == kCollectionTime ? TCoverage::EReason::kTimeOfCollection : TCoverage::EReason::kLeftOutByRules;
}

// Whether the property is among the keys by which instances of any inventory are matched.
bool TCoverageBuilder::IsUsedAsKey(const std::string& className, const std::string& property)
{
    return std::any_of(fInventories.begin(), fInventories.end(), [&](const TInventory& inventory) {
        const boost::shared_ptr<TInMemClass> cls = inventory.ns->FindClass(className);
        const boost::shared_ptr<TInMemPropertyDecl> decl = cls ? cls->FindPropertyDecl(property) : nullptr;
        return decl && decl->IsKey() && !fRules.ExcludesKey(className, decl->GetName());
    });
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

}  // namespace NORVZEL20
