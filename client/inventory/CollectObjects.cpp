#include "client/inventory/CollectObjects.h"

#include <algorithm>

#include "host/RootClassName.h"

namespace NORVZEL20 {

std::vector<boost::shared_ptr<ICIMClass>> SubclassesOf(ICIMClass& cls)
{
    return Collect<ICIMClass>([&cls](const auto& callback) { cls.EnumerateSubClasses(callback, false, TCallContext()); });
}

std::vector<boost::shared_ptr<ICIMClass>> AllClassesOf(ICIMNamespace& ns)
{
    // A list instead of recursion: a tall tree then takes memory and not the stack of the process. It holds the classes still to
    // visit, the next one last.
    std::vector<boost::shared_ptr<ICIMClass>> open = SubclassesOf(*ns.GetClass(kRootClassName, TCallContext()));
    std::reverse(open.begin(), open.end());
    std::vector<boost::shared_ptr<ICIMClass>> classes;
    while (!open.empty()) {
        classes.push_back(open.back());
        open.pop_back();
        const std::vector<boost::shared_ptr<ICIMClass>> subclasses = SubclassesOf(*classes.back());
        open.insert(open.end(), subclasses.rbegin(), subclasses.rend());
    }
    return classes;
}

std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(ICIMClass& cls)
{
    return Collect<ICIMInstance>([&cls](const auto& callback) { cls.EnumerateInstances(callback, false, TCallContext()); });
}

std::vector<boost::shared_ptr<ICIMInstance>> InstancesOfTree(ICIMClass& cls)
{
    return Collect<ICIMInstance>([&cls](const auto& callback) { cls.EnumerateInstances(callback, true, TCallContext()); });
}

std::vector<boost::shared_ptr<ICIMProperty>> PropertiesOf(const ICIMInstance& instance)
{
    return Collect<ICIMProperty>([&instance](const auto& callback) { instance.EnumerateProperties(callback, TCallContext()); });
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

}  // namespace NORVZEL20
