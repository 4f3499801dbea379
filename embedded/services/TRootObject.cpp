#include "host/TRootObject.h"

#include "embedded/services/TCoreLog.h"
#include "host/TNamespaceProviderManager.h"

namespace NORVZEL20 {

boost::shared_ptr<INamespaceProviderManager> TRootObject::GetNamespaceProviderManager()
{
    return TNamespaceProviderManager::GetInstance();
}

ILogger* TRootObject::GetCoreLogger()
{
    return TCoreLog::Get();
}

}  // namespace NORVZEL20
