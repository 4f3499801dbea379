#include "tests/engine/NaiveComparison.h"

#include <algorithm>
#include <cctype>
#include <set>

#include "tests/engine/NaiveRules.h"

namespace NORVZEL20 {

namespace {

using EKind = TNaiveValue::EKind;
using TInstances = std::vector<TNaiveInstance*>;

std::string Escaped(const std::string& text)
{
    std::string result;
    for (const char c : text) {
        result += (c == '"' || c == '\\') ? std::string("\\") + c : std::string(1, c);
    }
    return "\"" + result + "\"";
}

std::string Lower(std::string text)
{
    std::transform(text.begin(), text.end(), text.begin(), [](unsigned char c) { return static_cast<char>(std::tolower(c)); });
    return text;
}

// A path's text from its parts; the values are written already.
std::string PathText(const std::string& ns, const std::string& className,
                     const std::vector<std::pair<std::string, std::string>>& keys)
{
    std::map<std::string, std::string> sorted;
    for (const auto& [name, value] : keys) {
        sorted[Lower(name)] = name + "=" + value;
    }
    std::string text = (ns.empty() ? "" : ns + ":") + className;
    std::string separator = ".";
    for (const auto& [name, binding] : sorted) {
        text += separator + binding;
        separator = ",";
    }
    return text;
}

std::string PathOf(const TNaiveValue& value, const TNaiveRules& rules)
{
    std::vector<std::pair<std::string, std::string>> keys;
    for (const auto& [name, key] : value.pathKeys) {
        if (!rules.IsExcludedKey(name)) {
            keys.emplace_back(name, Escaped(key));
        }
    }
    return PathText(rules.excludedKeys.empty() && !value.list.empty() ? value.list[0] : "", value.text, keys);
}

std::string KeyText(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    return value.kind == EKind::kNumber ? std::to_string(value.number) : Escaped(value.text);
}

std::string ShownValue(const TNaiveValue& value)
{
    if (value.isNull) {
        return "NULL";
    }
    if (value.kind == EKind::kNumber) {
        return std::to_string(value.number);
    }
    if (value.kind == EKind::kPath) {
        return PathOf(value, TNaiveRules());
    }
    if (value.kind == EKind::kText) {
        return "\"" + value.text + "\"";
    }
    std::string text;
    for (const auto& element : value.list) {
        text += (text.empty() ? "" : ", ") + ("\"" + element + "\"");
    }
    return "{" + text + "}";
}

// The run over one set, class by class.
class TRun {
  public:
    explicit TRun(TNaiveSet& set) : fSet(set) {}

    void Go();
    std::string Records() const { return fRecords; }
    std::string Aliases() const;
    std::string Instances() const;

  private:
    using TIndices = std::map<std::string, std::vector<int>>;

    TNaiveNamespace& First() { return fSet.namespaces[0]; }
    bool AreTwo() const { return fSet.namespaces.size() == 2; }
    void CheckSystems() const;
    void NotePaths();
    void Visit(const std::string& className);
    void CompareClass(const std::string& className, const std::vector<std::string>& properties);
    void CompareWith(std::size_t index, const std::string& className, const TInstances& masters,
                     const std::vector<std::string>& properties);
    void ComparePair(std::size_t index, TNaiveInstance& master, TNaiveInstance& other, const std::vector<std::string>& properties);
    bool AreEqual(const TNaiveValue& master, const TNaiveValue& other) const;
    void Write(const std::string& className, const TInstances& masters);
    void WriteRecord(int type, const std::string& instance, const std::string& property, const std::vector<int>& indices);
    void Copy(const std::string& className, const std::string& key);
    std::vector<std::string> PropertiesToCompare(const std::string& className) const;
    std::string PathOfInstance(const TNaiveNamespace& ns, const TNaiveInstance& instance, const TNaiveRules& rules) const;
    std::string KeyOf(std::size_t index, const TNaiveInstance& instance) const;
    static TNaiveValue& ValueOf(TNaiveInstance& instance, const std::string& name) { return instance.values[name]; }
    void NeedProperty(std::size_t index, const std::string& className, const std::string& name) const;
    void NoteAlias(std::size_t index, const TNaiveInstance& instance, const std::string& key);
    TInstances InstancesOf(std::size_t index, const std::string& className);

    TNaiveSet& fSet;
    std::map<std::string, TNaiveRules> fAllRules;
    TNaiveRules fRules;                                        // of the class at hand
    std::map<const TNaiveInstance*, std::string> fMasterKeys;  // of the class at hand, as they were before it was compared
    TIndices fAbsent;
    TIndices fMissing;
    std::map<std::string, TIndices> fDifferent;
    std::string fRecords;
    std::map<std::pair<std::size_t, std::string>, std::map<std::string, std::string>> fAliases;
};

void TRun::Go()
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

void TRun::CheckSystems() const
{
    for (const auto& ns : fSet.namespaces) {
        if (!FindNaiveClass(ns, "KALMO_OperatingSystem")) {
            throw TNaiveFailure{3};
        }
    }
}

void TRun::NotePaths()
{
    for (auto& ns : fSet.namespaces) {
        for (auto& instance : ns.instances) {
            instance.path = PathOfInstance(ns, instance, TNaiveRules());
        }
    }
}

void TRun::Visit(const std::string& className)
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

std::vector<std::string> TRun::PropertiesToCompare(const std::string& className) const
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

void TRun::CompareClass(const std::string& className, const std::vector<std::string>& properties)
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

void TRun::CompareWith(std::size_t index, const std::string& className, const TInstances& masters,
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

void TRun::ComparePair(std::size_t index, TNaiveInstance& master, TNaiveInstance& other, const std::vector<std::string>& properties)
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

bool TRun::AreEqual(const TNaiveValue& master, const TNaiveValue& other) const
{
    if (master.isNull || other.isNull) {
        return master.isNull == other.isNull;
    }
    if (master.kind == EKind::kPath) {
        return PathOf(master, fRules) == PathOf(other, fRules);
    }
    if (master.kind == EKind::kList && fSet.areListsBags) {
        return std::is_permutation(master.list.begin(), master.list.end(), other.list.begin(), other.list.end());
    }
    return master.number == other.number && master.text == other.text && master.list == other.list;
}

void TRun::Write(const std::string& className, const TInstances& masters)
{
    if (fAbsent.empty() && fMissing.empty() && fDifferent.empty()) {
        return;
    }
    fRecords += className + "\n";
    for (const auto& [key, indices] : fAbsent) {
        const auto hasKey = [&, &wanted = key](const TNaiveInstance* master) { return fMasterKeys[master] == wanted; };
        const TNaiveInstance& master = **std::find_if(masters.begin(), masters.end(), hasKey);
        NoteAlias(0, master, key);
        WriteRecord(1, fRules.excludedKeys.empty() ? key : "root/cimv2:" + master.path, "", indices);
    }
    for (const auto& [key, indices] : fMissing) {
        WriteRecord(2, key, "", indices);
        if (AreTwo()) {
            Copy(className, key);
        }
    }
    for (const auto& [key, names] : fDifferent) {
        for (const auto& [name, indices] : names) {
            WriteRecord(4, key, name, indices);
        }
    }
}

void TRun::WriteRecord(int type, const std::string& instance, const std::string& property, const std::vector<int>& indices)
{
    fRecords += "  " + std::to_string(type) + " " + instance + (property.empty() ? "" : " " + property) + " [";
    for (std::size_t i = 0; i < indices.size(); ++i) {
        fRecords += (i == 0 ? "" : " ") + std::to_string(indices[i]);
    }
    fRecords += "]\n";
}

void TRun::Copy(const std::string& className, const std::string& key)
{
    for (TNaiveInstance* instance : InstancesOf(1, className)) {
        if (KeyOf(1, *instance) == key) {
            TNaiveInstance copy{className, {}, ""};
            for (const auto& property : AllNaiveProperties(fSet.namespaces[1], className)) {
                if (!ValueOf(*instance, property.name).isNull) {
                    NeedProperty(0, className, property.name);
                    copy.values[property.name] = ValueOf(*instance, property.name);
                }
            }
            copy.path = PathOfInstance(First(), copy, TNaiveRules());
            First().instances.push_back(copy);
            return;
        }
    }
}

std::string TRun::PathOfInstance(const TNaiveNamespace& ns, const TNaiveInstance& instance, const TNaiveRules& rules) const
{
    std::vector<std::pair<std::string, std::string>> keys;
    for (const auto& property : AllNaiveProperties(ns, instance.className)) {
        if (property.isKey && !rules.IsExcludedKey(property.name)) {
            const auto value = instance.values.find(property.name);
            keys.emplace_back(property.name, value == instance.values.end() ? "NULL" : KeyText(value->second));
        }
    }
    return PathText("", instance.className, keys);
}

std::string TRun::KeyOf(std::size_t index, const TNaiveInstance& instance) const
{
    return PathOfInstance(fSet.namespaces[index], instance, fRules);
}

void TRun::NeedProperty(std::size_t index, const std::string& className, const std::string& name) const
{
    for (const auto& property : AllNaiveProperties(fSet.namespaces[index], className)) {
        if (property.name == name) {
            return;
        }
    }
    throw TNaiveFailure{15};
}

void TRun::NoteAlias(std::size_t index, const TNaiveInstance& instance, const std::string& key)
{
    if (!fRules.excludedKeys.empty()) {
        fAliases[{index, instance.className}].insert({key, "root/cimv2:" + instance.path});
    }
}

TInstances TRun::InstancesOf(std::size_t index, const std::string& className)
{
    TInstances found;
    for (auto& instance : fSet.namespaces[index].instances) {
        if (instance.className == className) {
            found.push_back(&instance);
        }
    }
    return found;
}

std::string TRun::Aliases() const
{
    std::string text;
    for (const auto& [place, aliases] : fAliases) {
        for (const auto& [alias, path] : aliases) {
            text += std::to_string(place.first) + ":" + place.second + " " + alias + " -> " + path + "\n";
        }
    }
    return text;
}

std::string TRun::Instances() const
{
    std::string text;
    for (const auto& cls : fSet.namespaces[0].classes) {
        for (const auto& instance : fSet.namespaces[0].instances) {
            if (instance.className != cls.name) {
                continue;
            }
            text += instance.path;
            for (const auto& property : AllNaiveProperties(fSet.namespaces[0], cls.name)) {
                const auto value = instance.values.find(property.name);
                text += " " + property.name + "=" + (value == instance.values.end() ? "NULL" : ShownValue(value->second));
            }
            text += "\n";
        }
    }
    return text;
}

}  // namespace

std::string CompareNaively(TNaiveSet set)
{
    TRun run(set);
    std::string status;
    try {
        run.Go();
    } catch (const TNaiveFailure& failure) {
        status = "status " + std::to_string(failure.status) + "\n";
    }
    return run.Records() + run.Aliases() + status + run.Instances();
}

}  // namespace NORVZEL20
