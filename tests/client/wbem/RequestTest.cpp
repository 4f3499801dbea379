#include <gtest/gtest.h>

#include "client/wbem/TWbemRequest.h"

namespace NORVZEL20 {
namespace {

std::string Message(const std::string& operation, const std::string& parameters)
{
    return "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"1\" "
           "PROTOCOLVERSION=\"1.0\">"
           "<SIMPLEREQ><IMETHODCALL NAME=\"" +
           operation + "\"><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"a&amp;b\"/></LOCALNAMESPACEPATH>" +
           parameters + "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>\n";
}

std::string Value(const std::string& name, const std::string& value)
{
    return "<IPARAMVALUE NAME=\"" + name + "\"><VALUE>" + value + "</VALUE></IPARAMVALUE>";
}

TEST(WbemRequestTest, EachOperationAsksForEverything)
{
    const std::string ns = "root/a&b";
    const std::string cls = "<IPARAMVALUE NAME=\"ClassName\"><CLASSNAME NAME=\"CIM_&quot;Disk&quot;\"/></IPARAMVALUE>";
    const std::string name = "CIM_\"Disk\"";
    EXPECT_EQ(Message("EnumerateQualifiers", ""), WriteWbemRequest(EnumerateQualifiers(ns)));
    EXPECT_EQ(Message("EnumerateClasses", Value("DeepInheritance", "TRUE") + Value("LocalOnly", "FALSE") +
                                              Value("IncludeQualifiers", "TRUE") + Value("IncludeClassOrigin", "FALSE")),
              WriteWbemRequest(EnumerateClasses(ns)));
    EXPECT_EQ(Message("EnumerateInstances", cls + Value("LocalOnly", "FALSE") + Value("DeepInheritance", "TRUE") +
                                                Value("IncludeQualifiers", "FALSE") + Value("IncludeClassOrigin", "FALSE")),
              WriteWbemRequest(EnumerateInstances(ns, name)));
    EXPECT_EQ(Message("EnumerateInstanceNames", cls), WriteWbemRequest(EnumerateInstanceNames(ns, name)));
    EXPECT_EQ(Message("OpenEnumerateInstances", cls + Value("DeepInheritance", "TRUE") + Value("IncludeClassOrigin", "FALSE") +
                                                    Value("MaxObjectCount", "1000")),
              WriteWbemRequest(OpenEnumerateInstances(ns, name, 1000)));
    EXPECT_EQ(Message("PullInstancesWithPath", Value("EnumerationContext", "a&lt;b&gt;&amp;") + Value("MaxObjectCount", "7")),
              WriteWbemRequest(PullInstancesWithPath(ns, name, "a<b>&", 7)));
    EXPECT_EQ(Message("CloseEnumeration", Value("EnumerationContext", "c")), WriteWbemRequest(CloseEnumeration(ns, name, "c")));
}

TEST(WbemRequestTest, OnlyReadsThatGiveTheSameAgainAreRepeatable)
{
    EXPECT_TRUE(EnumerateInstances("root", "C").isRepeatable);
    EXPECT_TRUE(OpenEnumerateInstances("root", "C", 1).isRepeatable);
    EXPECT_FALSE(PullInstancesWithPath("root", "C", "1", 1).isRepeatable);
    EXPECT_FALSE(CloseEnumeration("root", "C", "1").isRepeatable);
}

TEST(WbemRequestTest, AHeaderHoldsNothingButPlainCharacters)
{
    EXPECT_EQ("root/cimv2", EncodeForHeader("root/cimv2"));
    EXPECT_EQ("root/a%20b%0D%0AX%3A%20%C3%BC%25", EncodeForHeader("root/a b\r\nX: \xc3\xbc%"));
}

}  // namespace
}  // namespace NORVZEL20
