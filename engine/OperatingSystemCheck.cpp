#include <string>

#include "engine/TCIMDiffEngine.h"
#include "host/TAddToVectorCallback.h"
#include "host/TRootObject.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

/// Appends the namespace's operating systems to `systems` and returns the type of the first one of all.
///
/// That first one is always the reference's, so that inventories of different operating systems are compared all the same.
unsigned short AppendOperatingSystems(ICIMNamespace& ns, std::vector<boost::shared_ptr<ICIMInstance>>& systems)
{
    const boost::shared_ptr<ICIMClass> cls = ns.GetClass(kOperatingSystemClass, TCallContext());
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&systems), false, TCallContext());
    return systems.at(0)->GetProperty(kOperatingSystemType, TCallContext())->GetValue(TCallContext());
}

}  // namespace

void TCIMDiffEngine::CheckOperatingSystems()
{
    // Made beforehand, so that a check that fails for lack of memory can still be told.
    const std::string failed = "TCIMDiffEngine: Failed to get all properties to check Schema match\n";
    try {
        std::vector<boost::shared_ptr<ICIMInstance>> systems;
        const unsigned short referenceType = AppendOperatingSystems(*namespaces.at(0), systems);
        for (const boost::shared_ptr<ICIMNamespace>& ns : namespaces) {
            if (AppendOperatingSystems(*ns, systems) != referenceType) {
                TRootObject::GetCoreLogger()->Log(0, "TCIMDiffEngine: These containers being compared are not equal\n");
                throw TZELException(TZELStatusCode::kSchemaMismatch);
            }
        }
    } catch (...) {
        TRootObject::GetCoreLogger()->Log(0, failed);
        throw TZELException(TZELStatusCode::kInitializationFailed);
    }
}

}  // namespace NORVZEL20
