#pragma once

#include <cstddef>
#include <string>

namespace NORVZEL20 {

/// A request of DSP0200 for an intrinsic operation. A plain value.
struct TWbemRequest {
    std::string operation;
    std::string namespaceName;
    std::string subject;       ///< the class that it is about; empty if it is about none
    std::string parameters;    ///< IPARAMVALUE elements
    bool isRepeatable = true;  ///< whether a server answers alike if it is asked again
};

// The operations that read a namespace. Instances come with all properties, those of subclasses included.
TWbemRequest EnumerateQualifiers(const std::string& namespaceName);
TWbemRequest EnumerateClasses(const std::string& namespaceName);
TWbemRequest EnumerateInstances(const std::string& namespaceName, const std::string& className);
TWbemRequest EnumerateInstanceNames(const std::string& namespaceName, const std::string& className);
TWbemRequest OpenEnumerateInstances(const std::string& namespaceName, const std::string& className, std::size_t most);
/// Each answer moves the enumeration on, so this is not repeatable. `subject` is for messages.
TWbemRequest PullInstancesWithPath(const std::string& namespaceName, const std::string& subject, const std::string& context,
                                   std::size_t most);
TWbemRequest CloseEnumeration(const std::string& namespaceName, const std::string& subject, const std::string& context);

/// The message of DSP0201.
std::string WriteWbemRequest(const TWbemRequest& request);

/// The namespace as the value of the header CIMObject: everything but letters, digits, - . _ ~ and the slashes is percent-encoded.
std::string EncodeForHeader(const std::string& namespaceName);

}  // namespace NORVZEL20
