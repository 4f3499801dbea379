#include "tests/support/InstanceAccess.h"

#include "host/TAddToVectorCallback.h"

namespace NORVZEL20 {

TInstances InstancesOf(boost::shared_ptr<ICIMNamespace> ns, const std::string& className)
{
    TInstances instances;
    ns->GetClass(className, TCallContext())
        ->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, TCallContext());
    return instances;
}

TCIMValue ValueOf(const ICIMInstance& instance, const std::string& name)
{
    return instance.GetProperty(name, TCallContext())->GetValue(TCallContext());
}

}  // namespace NORVZEL20
