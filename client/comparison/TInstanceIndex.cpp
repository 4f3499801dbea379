#include "client/comparison/TInstanceIndex.h"

#include "client/inventory/CollectObjects.h"
#include "client/inventory/FindDeclarations.h"

namespace NORVZEL20 {

TInstanceIndex::TInstanceIndex(ICIMNamespace& ns, const std::string& className, TRules& rules)
{
    const boost::shared_ptr<ICIMClass> cls = FindClass(ns, className);
    if (!cls) {
        return;
    }
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(*cls)) {
        fInstances[rules.KeyOf(className, instance)].push_back(instance);
    }
}

const TInstanceIndex::TInstances& TInstanceIndex::Find(const std::string& key) const
{
    static const TInstances none;
    const auto found = fInstances.find(key);
    return found == fInstances.end() ? none : found->second;
}

}  // namespace NORVZEL20
