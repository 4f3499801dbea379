#include "client/comparison/TPropertyOrder.h"

#include "client/inventory/FindDeclarations.h"

namespace NORVZEL20 {

const std::map<std::string, std::size_t>& TPropertyOrder::Of(const std::string& className)
{
    if (className == fClassName) {
        return fOrder;
    }
    fClassName.clear();
    fOrder.clear();
    if (const boost::shared_ptr<ICIMClass> cls = FindClass(*fInventory.ns, className)) {
        const auto add = [this](const boost::shared_ptr<ICIMPropertyDecl>& declaration) {
            fOrder.emplace(declaration->GetName(TCallContext()), fOrder.size());
            return true;
        };
        cls->EnumeratePropertyDecls(add, TCallContext());
    }
    fClassName = className;
    return fOrder;
}

}  // namespace NORVZEL20
