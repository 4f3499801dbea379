#include <string>

#include "engine/TCIMDiffEngine.h"
#include "host/TAddToVectorCallback.h"
#include "host/TRootObject.h"
#include "host/TZELException.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

/// Appends the namespace's operating systems to `systems` and returns the type of the first element of `systems`.
///
/// The first element always comes from the reference, so the check compares the reference's type with itself. Inventories of
/// different operating systems pass it; a namespace without the class fails it.
unsigned short AppendOperatingSystems(ICIMNamespace& ns, std::vector<boost::shared_ptr<ICIMInstance>>& systems)
{
    const boost::shared_ptr<ICIMClass> cls = ns.GetClass(kOperatingSystemClass, TCallContext());
    cls->EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&systems), false, TCallContext());
    return systems.at(0)->GetProperty(kOperatingSystemType, TCallContext())->GetValue(TCallContext());
}

}  // namespace

void TCIMDiffEngine::CheckOperatingSystems()
{
    // Made in advance: if the check fails because memory ran out, the message exists already.
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
