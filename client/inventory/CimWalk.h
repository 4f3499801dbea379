#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"

namespace NORVZEL20 {

/// Enumerations of the object model as containers. Not deep, with an empty call context.

std::vector<boost::shared_ptr<ICIMClass>> SubclassesOf(ICIMClass& cls);
std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(ICIMClass& cls);
std::vector<boost::shared_ptr<ICIMProperty>> PropertiesOf(const ICIMInstance& instance);
std::vector<std::string> KeyNamesOf(const ICIMClass& cls);

/// Every class of the namespace, superclasses before their subclasses, in order of declaration otherwise.
std::vector<boost::shared_ptr<ICIMClass>> AllClassesOf(ICIMNamespace& ns);

/// The class of that name, or null.
boost::shared_ptr<ICIMClass> FindClass(ICIMNamespace& ns, const std::string& name);

/// The declaration of that name, own or inherited, or null.
boost::shared_ptr<ICIMPropertyDecl> FindPropertyDecl(const ICIMClass& cls, const std::string& name);

}  // namespace NORVZEL20
