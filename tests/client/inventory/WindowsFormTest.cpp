// Documents in the text form of Windows (MI_XML), as data/collect/windows_inventory.ps1 writes them, and as they come without it.
#include "tests/client/TClientFixture.h"

namespace NORVZEL20 {
namespace {

const char kService[] = "<CLASS NAME=\"CIM_Service\"><QUALIFIER NAME=\"Abstract\" TYPE=\"boolean\" OVERRIDABLE=\"true\" "
                        "TOSUBCLASS=\"false\"><VALUE>TRUE</VALUE></QUALIFIER>"
                        "<PROPERTY NAME=\"Name\" CLASSORIGIN=\"CIM_Service\" TYPE=\"string\"><QUALIFIER NAME=\"key\" "
                        "TYPE=\"boolean\" OVERRIDABLE=\"false\"><VALUE>TRUE"
                        "</VALUE></QUALIFIER></PROPERTY></CLASS>";
const char kWindowsService[] =
    "<CLASS NAME=\"Win32_Service\" SUPERCLASS=\"CIM_Service\"><QUALIFIER NAME=\"dynamic\" "
    "TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>"
    "<QUALIFIER NAME=\"Locale\" TYPE=\"sint32\"><VALUE>1033</VALUE></QUALIFIER>"
    "<PROPERTY NAME=\"StartMode\" CLASSORIGIN=\"Win32_Service\" TYPE=\"string\"><QUALIFIER NAME=\"ValueMap\" "
    "TYPE=\"string\"><VALUE.ARRAY><VALUE>Auto"
    "</VALUE><VALUE>Manual</VALUE></VALUE.ARRAY></QUALIFIER></PROPERTY>"
    "<PROPERTY NAME=\"ProcessId\" CLASSORIGIN=\"Win32_Service\" TYPE=\"uint32\"></PROPERTY>"
    "<PROPERTY.ARRAY NAME=\"Dependencies\" CLASSORIGIN=\"Win32_Service\" TYPE=\"string\"></PROPERTY.ARRAY>"
    "<METHOD NAME=\"StartService\" CLASSORIGIN=\"Win32_Service\" TYPE=\"uint32\"></METHOD></CLASS>";
const char kInstance[] =
    "<INSTANCE CLASSNAME=\"Win32_Service\"><PROPERTY NAME=\"Name\" CLASSORIGIN=\"CIM_Service\" PROPAGATED=\"true\" TYPE=\"string\" "
    "MODIFIED=\"TRUE\">"
    "<VALUE>W32Time</VALUE></PROPERTY><PROPERTY NAME=\"StartMode\" TYPE=\"string\" MODIFIED=\"TRUE\"><VALUE>Auto</VALUE></PROPERTY>"
    "<PROPERTY NAME=\"ProcessId\" TYPE=\"uint32\"></PROPERTY><PROPERTY.ARRAY NAME=\"Dependencies\" TYPE=\"string\" "
    "MODIFIED=\"TRUE\"><VALUE.ARRAY>"
    "<VALUE>rpcss</VALUE></VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>";
const char kShown[] =
    "Win32_Service.Name=\"W32Time\"\n    Name: W32Time\n    StartMode: Auto\n    ProcessId: NULL\n    Dependencies: {\"rpcss\"}\n";

std::string Wrap(const std::string& objects)
{
    return "\xef\xbb\xbf<?xml version=\"1.0\" encoding=\"utf-8\"?>\r\n<CIM CIMVERSION=\"2.0\" "
           "DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>"
           "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"cimv2\"/></LOCALNAMESPACEPATH>\r\n" +
           objects + "</DECLGROUP></DECLARATION></CIM>\r\n";
}

std::string Object(const std::string& xml)
{
    return "<VALUE.OBJECT>" + xml + "</VALUE.OBJECT>\r\n";
}

std::string InUtf16(const std::string& text)
{
    std::string wide = "\xff\xfe";
    for (const char c : text) {
        wide += c;
        wide += '\0';
    }
    return wide;
}

class WindowsFormTest : public TClientFixture {};

TEST_F(WindowsFormTest, AWrappedDocumentIsAnInventory)
{
    // The script meets the class of an instance first, then those above it.
    const std::string path = Scratch("windows.xml", Wrap(Object(kWindowsService) + Object(kService) + Object(kInstance)));
    EXPECT_EQ(kShown, Result({"show", path, "Win32_Service"}));
}

TEST_F(WindowsFormTest, SoIsARowOfObjectsAsTheyCome)
{
    const std::string row = std::string(kService) + kWindowsService + kInstance;
    EXPECT_EQ(kShown, Result({"show", Scratch("row.xml", row), "Win32_Service"}));
}

TEST_F(WindowsFormTest, ADocumentMayBeInUtf16)
{
    const std::string whole = Wrap(Object(kService) + Object(kWindowsService) + Object(kInstance));
    const std::string plain = whole.substr(whole.find("<CIM"));  // the declaration would name another encoding
    EXPECT_EQ(kShown, Result({"show", Scratch("wide.xml", InUtf16(plain)), "Win32_Service"}));
}

TEST_F(WindowsFormTest, WhatCouldNotBeReadIsNamed)
{
    const std::string key = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
    const std::string missing = "<CLASS NAME=\"KALMO_NotCollected\"><PROPERTY NAME=\"Kind\" TYPE=\"string\">" + key +
                                "</PROPERTY><PROPERTY NAME=\"Reason\" TYPE=\"string\">" + key +
                                "</PROPERTY><PROPERTY NAME=\"Count\" TYPE=\"uint32\"></PROPERTY><PROPERTY.ARRAY NAME=\"Subjects\" "
                                "TYPE=\"string\"></PROPERTY.ARRAY></CLASS>";
    const std::string instance =
        "<INSTANCE CLASSNAME=\"KALMO_NotCollected\"><PROPERTY NAME=\"Kind\" "
        "TYPE=\"string\"><VALUE>instances</VALUE></PROPERTY><PROPERTY NAME=\"Reason\""
        " TYPE=\"string\"><VALUE>Win32_Share: Access denied</VALUE></PROPERTY><PROPERTY NAME=\"Count\" "
        "TYPE=\"uint32\"><VALUE>1</VALUE></PROPERTY>"
        "<PROPERTY.ARRAY NAME=\"Subjects\" "
        "TYPE=\"string\"><VALUE.ARRAY><VALUE>Win32_Share</VALUE></VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>";
    const std::string objects = Object(missing) + Object(kService) + Object(kWindowsService) + Object(kInstance);
    Run({"compare", "a=" + Scratch("a.xml", Wrap(objects)), "b=" + Scratch("b.xml", Wrap(objects + Object(instance)))});
    EXPECT_NE(std::string::npos,
              fOut.find("\nb was collected without instances: Win32_Share (Win32_Share: Access denied) (--coverage)\n"))
        << fOut << fErr;
}

}  // namespace
}  // namespace NORVZEL20
