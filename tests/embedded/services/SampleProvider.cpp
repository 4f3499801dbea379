#include <boost/smart_ptr/make_shared.hpp>

#include "host/ICIMNamespace.h"
#include "host/TRootObject.h"

namespace NORVZEL20 {
namespace {

class TSampleProvider : public INamespaceProvider {
  public:
    const std::string& GetName(TCallContext) const override { return fName; }
    boost::shared_ptr<ICIMNamespace> AllocateNamespace(TCallContext, bool, std::string) const override { return nullptr; }
    int GetType(TCallContext) const override { return 0; }
    bool IsIndicationsSupported(TCallContext) const override { return false; }

  private:
    std::string fName = "sample";
};

const TZELStatusCode gRegistered =
    TRootObject::GetNamespaceProviderManager()->RegisterProvider(boost::make_shared<TSampleProvider>());

}  // namespace
}  // namespace NORVZEL20
