#include <boost/smart_ptr/make_shared.hpp>

#include "host/TRootObject.h"
#include "tests/embedded/services/TNamedProvider.h"

namespace NORVZEL20 {
namespace {

const TZELStatusCode gRegistered =
    TRootObject::GetNamespaceProviderManager()->RegisterProvider(boost::make_shared<TNamedProvider>("sample"));

}  // namespace
}  // namespace NORVZEL20
