#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>

#include "host/ICIMClass.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

// Look-ups that return null if the host throws kNotFound (15). Errors: every other failure of the host.

/// The class of that name, or null.
boost::shared_ptr<ICIMClass> FindClass(ICIMNamespace& ns, const std::string& name);

/// The declaration of that name, own or inherited, or null.
boost::shared_ptr<ICIMPropertyDecl> FindPropertyDecl(const ICIMClass& cls, const std::string& name);

}  // namespace NORVZEL20
