#include <algorithm>

#include "tests/engine/NaiveText.h"
#include "tests/engine/TNaiveRun.h"

// The results of a run: records, copies and aliases.

namespace NORVZEL20 {

void TNaiveRun::Write(const std::string& className, const TInstances& masters)
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

void TNaiveRun::WriteRecord(int type, const std::string& instance, const std::string& property, const std::vector<int>& indices)
{
    fRecords += "  " + std::to_string(type) + " " + instance + (property.empty() ? "" : " " + property) + " [";
    for (std::size_t i = 0; i < indices.size(); ++i) {
        fRecords += (i == 0 ? "" : " ") + std::to_string(indices[i]);
    }
    fRecords += "]\n";
}

void TNaiveRun::Copy(const std::string& className, const std::string& key)
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

void TNaiveRun::NoteAlias(std::size_t index, const TNaiveInstance& instance, const std::string& key)
{
    if (!fRules.excludedKeys.empty()) {
        fAliases[{index, instance.className}].insert({key, "root/cimv2:" + instance.path});
    }
}

std::string TNaiveRun::Aliases() const
{
    std::string text;
    for (const auto& [place, aliases] : fAliases) {
        for (const auto& [alias, path] : aliases) {
            text += std::to_string(place.first) + ":" + place.second + " " + alias + " -> " + path + "\n";
        }
    }
    return text;
}

std::string TNaiveRun::Instances() const
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
                text += " " + property.name + "=" + (value == instance.values.end() ? "NULL" : NaiveValueText(value->second));
            }
            text += "\n";
        }
    }
    return text;
}

}  // namespace NORVZEL20
