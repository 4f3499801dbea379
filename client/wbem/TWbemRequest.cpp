#include "client/wbem/TWbemRequest.h"

#include <algorithm>
#include <boost/algorithm/hex.hpp>
#include <cctype>
#include <string_view>

#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

namespace {

std::string ValueParameter(const char* name, std::string_view value)
{
    std::string xml = "<IPARAMVALUE";
    TValueXml::AppendAttribute(xml, "NAME", name);
    xml += "><VALUE>";
    TValueXml::AppendEscaped(xml, value);
    return xml + "</VALUE></IPARAMVALUE>";
}

std::string ClassParameter(std::string_view className)
{
    std::string xml = "<IPARAMVALUE NAME=\"ClassName\"><CLASSNAME";
    TValueXml::AppendAttribute(xml, "NAME", className);
    return xml + "/></IPARAMVALUE>";
}

}  // namespace

TWbemRequest EnumerateQualifiers(const std::string& namespaceName)
{
    return {"EnumerateQualifiers", namespaceName, "", ""};
}

TWbemRequest EnumerateClasses(const std::string& namespaceName)
{
    return {"EnumerateClasses", namespaceName, "",
            ValueParameter("DeepInheritance", "TRUE") + ValueParameter("LocalOnly", "FALSE") +
                ValueParameter("IncludeQualifiers", "TRUE") + ValueParameter("IncludeClassOrigin", "FALSE")};
}

TWbemRequest EnumerateInstances(const std::string& namespaceName, const std::string& className)
{
    return {"EnumerateInstances", namespaceName, className,
            ClassParameter(className) + ValueParameter("LocalOnly", "FALSE") + ValueParameter("DeepInheritance", "TRUE") +
                ValueParameter("IncludeQualifiers", "FALSE") + ValueParameter("IncludeClassOrigin", "FALSE")};
}

TWbemRequest EnumerateInstanceNames(const std::string& namespaceName, const std::string& className)
{
    return {"EnumerateInstanceNames", namespaceName, className, ClassParameter(className)};
}

TWbemRequest OpenEnumerateInstances(const std::string& namespaceName, const std::string& className, std::size_t most)
{
    return {"OpenEnumerateInstances", namespaceName, className,
            ClassParameter(className) + ValueParameter("DeepInheritance", "TRUE") + ValueParameter("IncludeClassOrigin", "FALSE") +
                ValueParameter("MaxObjectCount", std::to_string(most))};
}

TWbemRequest PullInstancesWithPath(const std::string& namespaceName, const std::string& subject, const std::string& context,
                                   std::size_t most)
{
    return {"PullInstancesWithPath", namespaceName, subject,
            ValueParameter("EnumerationContext", context) + ValueParameter("MaxObjectCount", std::to_string(most)), false};
}

TWbemRequest CloseEnumeration(const std::string& namespaceName, const std::string& subject, const std::string& context)
{
    return {"CloseEnumeration", namespaceName, subject, ValueParameter("EnumerationContext", context), false};
}

std::string WriteWbemRequest(const TWbemRequest& request)
{
    std::string xml =
        "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n"
        "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" PROTOCOLVERSION=\"1.0\"><SIMPLEREQ><IMETHODCALL";
    TValueXml::AppendAttribute(xml, "NAME", request.operation);
    xml += "><LOCALNAMESPACEPATH>";
    const std::string& name = request.namespaceName;
    for (std::size_t start = 0; start <= name.size();) {
        const std::size_t end = std::min(name.find('/', start), name.size());
        xml += "<NAMESPACE";
        TValueXml::AppendAttribute(xml, "NAME", std::string_view{name}.substr(start, end - start));
        xml += "/>";
        start = end + 1;
    }
    return xml + "</LOCALNAMESPACEPATH>" + request.parameters + "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>\n";
}

std::string EncodeForHeader(const std::string& namespaceName)
{
    constexpr std::string_view kPlain = "-._~/";
    std::string encoded;
    for (const char c : namespaceName) {
        const auto byte = static_cast<unsigned char>(c);
        if (std::isalnum(byte) != 0 || kPlain.find(c) != std::string_view::npos) {
            encoded += c;
        } else {
            encoded += "%" + boost::algorithm::hex(std::string(1, c));
        }
    }
    return encoded;
}

}  // namespace NORVZEL20
