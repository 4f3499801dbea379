#include "engine/TCIMDiffEngine.h"
#include "host/TAddKeyBindingsToMapCallback.h"
#include "host/TAddKeyNamesToVectorCallback.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {

namespace {

TCIMReference MakeKeylessPath(boost::shared_ptr<ICIMClass> cls)
{
    TCIMReference path(boost::shared_ptr<ICIMNamespace>{}, std::map<std::string, TCIMValue>{});
    path.SetClass(cls);
    return path;
}

}  // namespace

std::string TCIMDiffEngine::buildPath(boost::shared_ptr<TDiffClassRules> rules, boost::shared_ptr<ICIMInstance> instance)
{
    // Held to the end: the names are the class's own.
    const boost::shared_ptr<ICIMClass> cls = instance->GetClass(TCallContext());
    std::vector<const std::string*> names;
    cls->EnumerateKeyNames(TAddKeyNamesToVectorCallback(&names), TCallContext());

    TCIMReference path = MakeKeylessPath(instance->GetClass(TCallContext()));
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
    TCIMReference rebuilt = MakeKeylessPath(path.GetClass());
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
