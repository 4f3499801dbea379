#include "client/inventory/FindDeclarations.h"

#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

template <class TLookUp>
auto FindOrNull(TLookUp lookUp) -> decltype(lookUp())
{
    try {
        return lookUp();
    } catch (const TZELException& error) {
        if (error.GetStatusCode() != TZELStatusCode::kNotFound) {
            throw;
        }
        return {};
    }
}

}  // namespace

boost::shared_ptr<ICIMClass> FindClass(ICIMNamespace& ns, const std::string& name)
{
    return FindOrNull([&] { return ns.GetClass(name, TCallContext()); });
}

boost::shared_ptr<ICIMPropertyDecl> FindPropertyDecl(const ICIMClass& cls, const std::string& name)
{
    return FindOrNull([&] { return cls.GetPropertyDecl(name, TCallContext()); });
}

}  // namespace NORVZEL20
