#include "tests/engine/TNaiveRun.h"

#include <algorithm>
#include <set>

#include "tests/engine/NaiveText.h"

namespace NORVZEL20 {

using EKind = TNaiveValue::EKind;

void TNaiveRun::Go()
{
    NotePaths();
    if (fSet.namespaces.size() > 1) {
        CheckSystems();
        fAllRules = NaiveRulesOf(fSet);
    }
    const auto classes = First().classes;
    for (const auto& cls : classes) {
        if (cls.superName.empty()) {
            Visit(cls.name);
        }
    }
}

void TNaiveRun::CheckSystems() const
{
    for (const auto& ns : fSet.namespaces) {
        if (!FindNaiveClass(ns, "KALMO_OperatingSystem")) {
            throw TNaiveFailure{3};
        }
    }
}

void TNaiveRun::NotePaths()
{
    for (auto& ns : fSet.namespaces) {
        for (auto& instance : ns.instances) {
            instance.path = PathOfInstance(ns, instance, TNaiveRules());
        }
    }
}

void TNaiveRun::Visit(const std::string& className)
{
    fRules = fAllRules.count(className) != 0 ? fAllRules[className] : TNaiveRules();
    const auto properties = PropertiesToCompare(className);
    if (!properties.empty()) {
        CompareClass(className, properties);
    }
    const auto classes = First().classes;
    for (const auto& cls : classes) {
        if (cls.superName == className) {
            Visit(cls.name);
        }
    }
}

std::vector<std::string> TNaiveRun::PropertiesToCompare(const std::string& className) const
{
    std::vector<std::string> names;
    if (!fRules.isIncluded) {
        for (const auto& [name, isIncluded] : fRules.listed) {
            if (isIncluded) {
                names.push_back(name);
            }
        }
        return names;
    }
    for (const auto& property : AllNaiveProperties(fSet.namespaces[0], className)) {
        const auto listed = fRules.listed.find(property.name);
        const bool isExcluded = listed != fRules.listed.end() && !listed->second;
        if (property.name != "DateTimeOfCollection" && !isExcluded) {
            names.push_back(property.name);
        }
    }
    return names;
}

void TNaiveRun::CompareClass(const std::string& className, const std::vector<std::string>& properties)
{
    fAbsent.clear();
    fMissing.clear();
    fDifferent.clear();
    fMasterKeys.clear();
    First().instances.reserve(1000);  // copies are added while these are looked at
    TInstances masters;
    const auto all = InstancesOf(0, className);
    for (TNaiveInstance* instance : all) {
        const std::string key = KeyOf(0, *instance);
        const auto hasKey = [&](const TNaiveInstance* master) { return fMasterKeys[master] == key; };
        if (std::none_of(masters.begin(), masters.end(), hasKey)) {
            fMasterKeys[instance] = key;
            masters.push_back(instance);
        }
    }
    for (std::size_t index = 1; index < fSet.namespaces.size(); ++index) {
        if (FindNaiveClass(fSet.namespaces[index], className)) {
            CompareWith(index, className, masters, properties);
        } else if (!all.empty()) {
            throw TNaiveFailure{37};
        }
    }
    Write(className, masters);
}

void TNaiveRun::CompareWith(std::size_t index, const std::string& className, const TInstances& masters,
                            const std::vector<std::string>& properties)
{
    std::set<const TNaiveInstance*> found;
    for (TNaiveInstance* instance : InstancesOf(index, className)) {
        const std::string key = KeyOf(index, *instance);
        const auto hasKey = [&](const TNaiveInstance* master) { return fMasterKeys[master] == key; };
        const auto master = std::find_if(masters.begin(), masters.end(), hasKey);
        if (master == masters.end()) {
            fMissing[key].push_back(static_cast<int>(index));
            NoteAlias(index, *instance, key);
        } else {
            found.insert(*master);
            ComparePair(index, **master, *instance, properties);
        }
    }
    for (const TNaiveInstance* master : masters) {
        if (found.count(master) == 0) {
            fAbsent[fMasterKeys[master]].push_back(static_cast<int>(index));
        }
    }
}

void TNaiveRun::ComparePair(std::size_t index, TNaiveInstance& master, TNaiveInstance& other,
                            const std::vector<std::string>& properties)
{
    const std::string key = fMasterKeys[&master];
    bool isChanged = false;
    for (const auto& name : properties) {
        NeedProperty(0, master.className, name);
        NeedProperty(index, other.className, name);
        if (!AreEqual(ValueOf(master, name), ValueOf(other, name))) {
            isChanged = true;
            fDifferent[key][name].push_back(static_cast<int>(index));
            if (AreTwo()) {
                ValueOf(master, name) = ValueOf(other, name);
            }
        }
    }
    if (isChanged) {
        NoteAlias(0, master, key);
        NoteAlias(index, other, key);
    }
}

bool TNaiveRun::AreEqual(const TNaiveValue& master, const TNaiveValue& other) const
{
    if (master.isNull || other.isNull) {
        return master.isNull == other.isNull;
    }
    if (master.kind == EKind::kPath) {
        return NaivePathOf(master, fRules) == NaivePathOf(other, fRules);
    }
    if (master.kind == EKind::kList && fSet.areListsBags) {
        return std::is_permutation(master.list.begin(), master.list.end(), other.list.begin(), other.list.end());
    }
    return master.kind == EKind::kList ? master.list == other.list : NaiveKeyText(master) == NaiveKeyText(other);
}

std::string TNaiveRun::PathOfInstance(const TNaiveNamespace& ns, const TNaiveInstance& instance, const TNaiveRules& rules) const
{
    std::vector<std::pair<std::string, std::string>> keys;
    for (const auto& property : AllNaiveProperties(ns, instance.className)) {
        if (property.isKey && !rules.IsExcludedKey(property.name)) {
            const auto value = instance.values.find(property.name);
            keys.emplace_back(property.name, value == instance.values.end() ? "NULL" : NaiveKeyText(value->second));
        }
    }
    return NaivePathText("", instance.className, keys);
}

std::string TNaiveRun::KeyOf(std::size_t index, const TNaiveInstance& instance) const
{
    return PathOfInstance(fSet.namespaces[index], instance, fRules);
}

void TNaiveRun::NeedProperty(std::size_t index, const std::string& className, const std::string& name) const
{
    for (const auto& property : AllNaiveProperties(fSet.namespaces[index], className)) {
        if (property.name == name) {
            return;
        }
    }
    throw TNaiveFailure{15};
}

TNaiveRun::TInstances TNaiveRun::InstancesOf(std::size_t index, const std::string& className)
{
    TInstances found;
    for (auto& instance : fSet.namespaces[index].instances) {
        if (instance.className == className) {
            found.push_back(&instance);
        }
    }
    return found;
}

}  // namespace NORVZEL20
