#include "client/inventory/CimWalk.h"

#include <algorithm>

#include "host/RootClassName.h"
#include "host/TAddToVectorCallback.h"
#include "host/TZELException.h"

namespace NORVZEL20 {

namespace {

// Looks something up; null for status 15, every other failure passes.
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

std::vector<boost::shared_ptr<ICIMClass>> SubclassesOf(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    cls.EnumerateSubClasses(TAddToVectorCallback<ICIMClass>(&classes), false, TCallContext());
    return classes;
}

std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(ICIMClass& cls)
{
    std::vector<boost::shared_ptr<ICIMInstance>> instances;
    cls.EnumerateInstances(TAddToVectorCallback<ICIMInstance>(&instances), false, TCallContext());
    return instances;
}

std::vector<boost::shared_ptr<ICIMProperty>> PropertiesOf(const ICIMInstance& instance)
{
    std::vector<boost::shared_ptr<ICIMProperty>> properties;
    instance.EnumerateProperties(TAddToVectorCallback<ICIMProperty>(&properties), TCallContext());
    return properties;
}

std::vector<std::string> KeyNamesOf(const ICIMClass& cls)
{
    std::vector<std::string> names;
    cls.EnumerateKeyNames(
        [&names](const std::string* name) {
            names.push_back(*name);
            return true;
        },
        TCallContext());
    return names;
}

std::vector<boost::shared_ptr<ICIMClass>> AllClassesOf(ICIMNamespace& ns)
{
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    std::vector<boost::shared_ptr<ICIMClass>> open = SubclassesOf(*ns.GetClass(kRootClassName, TCallContext()));
    std::reverse(open.begin(), open.end());
    while (!open.empty()) {
        classes.push_back(open.back());
        open.pop_back();
        const std::vector<boost::shared_ptr<ICIMClass>> subclasses = SubclassesOf(*classes.back());
        open.insert(open.end(), subclasses.rbegin(), subclasses.rend());
    }
    return classes;
}

boost::shared_ptr<ICIMClass> FindClass(ICIMNamespace& ns, const std::string& name)
{
    return FindOrNull([&] { return ns.GetClass(name, TCallContext()); });
}

boost::shared_ptr<ICIMPropertyDecl> FindPropertyDecl(const ICIMClass& cls, const std::string& name)
{
    return FindOrNull([&] { return cls.GetPropertyDecl(name, TCallContext()); });
}

}  // namespace NORVZEL20
