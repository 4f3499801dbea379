#include "client/text/TextOfQualifier.h"

#include "host/ICIMQualifier.h"

namespace NORVZEL20 {

TCIMValue ValueOfQualifier(const ICIMPropertyDecl& declaration, const char* name)
{
    bool isFound = false;
    const boost::shared_ptr<ICIMQualifier> qualifier = declaration.GetQualifier(name, isFound, TCallContext());
    return isFound ? qualifier->GetValue(TCallContext()) : TCIMValue();
}

std::string TextOfQualifier(const ICIMPropertyDecl& declaration, const char* name)
{
    const TCIMValue value = ValueOfQualifier(declaration, name);
    return value.IsNull() || value.GetType() != TCIMValue::TCIMType::kString ? std::string() : std::string(value.GetString());
}

}  // namespace NORVZEL20
