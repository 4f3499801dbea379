#pragma once

#include <string>

#include "host/ICIMInstance.h"
#include "host/ICIMProperty.h"

namespace NORVZEL20 {

/// The value of a property, by its name in any letter case. Errors: TZELException with kNotFound (15) if the class has no such
/// property.
inline TCIMValue ValueOf(const ICIMInstance& instance, const std::string& property)
{
    return instance.GetProperty(property, TCallContext())->GetValue(TCallContext());
}

}  // namespace NORVZEL20
