#include "engine/TCIMDiffEngine.h"
#include "host/TAddKeyBindingsToMapCallback.h"
#include "host/TAddKeyNamesToVectorCallback.h"
#include "spec/TDiffClassRules.h"

// Instances are matched by the text of their key, so the key must be the same text in every namespace:
//
//     Disk.Name="sda",System="web01"      class and keys, as the path of TCIMReference writes them
//     Disk.Name="sda"                     the same, if the rules exclude the key System
//
// The path has no namespace, because that differs between the namespaces compared.
//
// The values of reference properties are compared by text too. If the rules exclude keys, the text is made in the same way.
// Otherwise it is the text of the path itself, with the namespace that it names.

namespace NORVZEL20 {

namespace {

constexpr std::size_t kUsualKeyCount = 4;  // a class with more keys is no error

}  // namespace

std::string TCIMDiffEngine::buildPath(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> instance)
{
    // Keeps the class alive, because the pointers to its key names are used below.
    const boost::shared_ptr<ICIMClass> cls = instance->GetClass(TCallContext());
    std::vector<const std::string*> names;
    names.reserve(kUsualKeyCount);
    cls->EnumerateKeyNames(TAddKeyNamesToVectorCallback(&names), TCallContext());

    TCIMReference path(boost::shared_ptr<ICIMNamespace>{}, std::map<std::string, TCIMValue>{});
    path.SetClass(instance->GetClass(TCallContext()));
    for (const std::string* name : names) {
        if (!rules->isKeyExcluded(*name)) {
            path.AddKeyValue(*name, instance->GetProperty(*name, TCallContext())->GetValue(TCallContext()));
        }
    }
    return path.GetPath();
}

std::string TCIMDiffEngine::buildPath(boost::shared_ptr<TDiffClassRules> rules, const TCIMReference& path)
{
    if (!rules->hasExcludedKeys()) {
        return path.GetPath();
    }
    TCIMReference rebuilt(boost::shared_ptr<ICIMNamespace>{}, std::map<std::string, TCIMValue>{});
    rebuilt.SetClass(path.GetClass());
    std::map<std::string, TCIMValue> bindings;
    path.EnumerateKeyBindings(TAddKeyBindingsToMapCallback(&bindings));
    for (const auto& [name, value] : bindings) {
        if (!rules->isKeyExcluded(name)) {
            rebuilt.AddKeyValue(name, value);
        }
    }
    return rebuilt.GetPath();
}

}  // namespace NORVZEL20
