#include <utility>

#include "engine/TCIMDiffEngine.h"
#include "spec/TDiffClassRules.h"

// Two matched instances are compared property by property, in the order of the list of properties:
//
//     reference    the texts of both paths (see InstanceKeys.cpp); two null references are equal
//     all others   TCIMValue::operator==
//
// Each difference is entered into the map of the class. With exactly two namespaces the reference takes over the other value at
// once. If keys are excluded, both instances also get an alias, because the record cannot name them by their paths.

namespace NORVZEL20 {

bool TCIMDiffEngine::IsDifferent(const boost::shared_ptr<TDiffClassRules>& rules, const TCIMValue& master, const TCIMValue& other)
{
    if (master.GetType() != TCIMValue::TCIMType::kReference) {
        return !(master == other);
    }
    if (master.IsNull() || other.IsNull()) {
        return master.IsNull() != other.IsNull();
    }
    const TCIMReference masterPath = master;
    const TCIMReference otherPath = other;
    return buildPath(rules, masterPath) != buildPath(rules, otherPath);
}

void TCIMDiffEngine::compare(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> master,
                             boost::shared_ptr<ICIMInstance> other, std::string key, std::vector<std::string>& properties,
                             std::map<std::string, std::map<std::string, std::vector<int>>>& differences,
                             unsigned int namespaceIndex)
{
    // The entry of this key, from the first difference on. Keys usually come in ascending order, so it is likely to be the last.
    auto changed = differences.end();
    for (const std::string& name : properties) {
        const boost::shared_ptr<ICIMProperty> masterProperty = master->GetProperty(name, TCallContext());
        const boost::shared_ptr<ICIMProperty> otherProperty = other->GetProperty(name, TCallContext());
        const TCIMValue& masterValue = masterProperty->GetValue(TCallContext());
        const TCIMValue& otherValue = otherProperty->GetValue(TCallContext());
        if (!IsDifferent(rules, masterValue, otherValue)) {
            continue;
        }
        if (changed == differences.end()) {
            changed = differences.try_emplace(changed, std::move(key));
        }
        changed->second[name].push_back(static_cast<int>(namespaceIndex));
        if (namespaces.size() == 2) {
            masterProperty->MarkChanged(otherValue);
        }
    }
    if (changed != differences.end() && rules->hasExcludedKeys()) {
        AliasInstance(*master, changed->first, 0);
        AliasInstance(*other, changed->first, namespaceIndex);
    }
}

void TCIMDiffEngine::AliasInstance(ICIMInstance& instance, const std::string& key, unsigned int namespaceIndex)
{
    const boost::shared_ptr<ICIMClass> cls = instance.GetClass(TCallContext());
    const std::string& className = cls->GetName(TCallContext());
    createObjectPathAlias(className, key, instance.GetReference(TCallContext()), namespaceIndex);
}

}  // namespace NORVZEL20
