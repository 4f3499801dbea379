#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <vector>

#include "host/ICIMClass.h"
#include "host/ICIMInstance.h"
#include "host/ICIMNamespace.h"
#include "host/TAddToVectorCallback.h"

namespace NORVZEL20 {

// The elements of the host's enumerations as vectors, in the order of the callbacks, repeated elements included.
// All calls are made with an empty call context. Errors: those of the enumeration.

/// The elements of any enumeration; `enumerate` is called once, with the callback to hand on.
template <class TElement, class TEnumerate>
std::vector<boost::shared_ptr<TElement>> Collect(TEnumerate enumerate)
{
    std::vector<boost::shared_ptr<TElement>> elements;
    enumerate(TAddToVectorCallback<TElement>(&elements));
    return elements;
}

/// The classes directly below `cls`.
std::vector<boost::shared_ptr<ICIMClass>> SubclassesOf(ICIMClass& cls);

/// Every class of the namespace: a class before its subclasses, and a whole subtree before the next class beside it.
std::vector<boost::shared_ptr<ICIMClass>> AllClassesOf(ICIMNamespace& ns);

/// The instances of `cls` itself.
std::vector<boost::shared_ptr<ICIMInstance>> InstancesOf(ICIMClass& cls);

/// The instances of `cls` and of all classes below it.
std::vector<boost::shared_ptr<ICIMInstance>> InstancesOfTree(ICIMClass& cls);

/// The properties of an instance, inherited ones included.
std::vector<boost::shared_ptr<ICIMProperty>> PropertiesOf(const ICIMInstance& instance);

/// The names of the key properties, inherited ones included.
std::vector<std::string> KeyNamesOf(const ICIMClass& cls);

}  // namespace NORVZEL20
