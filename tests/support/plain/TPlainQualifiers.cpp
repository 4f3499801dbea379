#include "tests/support/plain/TPlainQualifiers.h"

#include "host/TZELException.h"

namespace NORVZEL20 {

boost::shared_ptr<ICIMQualifier> TPlainQualifiers::Find(const std::string& name, TCallContext context) const
{
    for (const auto& qualifier : fQualifiers) {
        if (qualifier->GetName(context) == name) {
            return qualifier;
        }
    }
    return nullptr;
}

boost::shared_ptr<ICIMQualifier> TPlainQualifiers::Get(const std::string& name, TCallContext context) const
{
    const auto qualifier = Find(name, context);
    if (!qualifier) {
        throw TZELException(TZELStatusCode::kNotFound);
    }
    return qualifier;
}

void TPlainQualifiers::Enumerate(const boost::function<bool(boost::shared_ptr<ICIMQualifier>)>& callback) const
{
    for (const auto& qualifier : fQualifiers) {
        if (!callback(qualifier)) {
            return;
        }
    }
}

}  // namespace NORVZEL20
