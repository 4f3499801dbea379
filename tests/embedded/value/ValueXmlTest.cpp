#include "embedded/value/TValueXml.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <limits>

#include "tests/embedded/value/ValuePrinter.h"

namespace NORVZEL20 {
namespace {

using TType = TCIMValue::TCIMType;

std::string Xml(const TCIMValue& value)
{
    std::string out;
    TValueXml::AppendValue(out, value);
    return out;
}

std::string Xml(const TCIMReference& path)
{
    std::string out;
    TValueXml::AppendReference(out, path);
    return out;
}

std::string Escaped(std::string_view text)
{
    std::string out;
    TValueXml::AppendEscaped(out, text);
    return out;
}

TEST(ValueXmlTest, MarkupIsEscaped)
{
    EXPECT_EQ("a &lt;b&gt; &amp; \"c\" 'd'\n\t&#13;", Escaped("a <b> & \"c\" 'd'\n\t\r"));
    EXPECT_EQ("\xC3\xA4 \xE2\x82\xAC \xF0\x9F\x98\x80", Escaped("\xC3\xA4 \xE2\x82\xAC \xF0\x9F\x98\x80"));
    std::string out;
    TValueXml::AppendAttribute(out, "NAME", "a\"b\n<\t\xC3\xA4");
    EXPECT_EQ(" NAME=\"a&quot;b&#10;&lt;&#9;\xC3\xA4\"", out);
}

TEST(ValueXmlTest, WhatXmlCannotCarryBecomesTheReplacementCharacter)
{
    const std::string replacement = "\xEF\xBF\xBD";
    for (const std::string& text : {std::string(1, '\0'), std::string("\x01"), std::string("\x1F"), std::string("\x80"),
                                    std::string("\xFF"), std::string("\xC3"), std::string("\xF5")}) {
        EXPECT_EQ("a" + replacement + "b", Escaped("a" + text + "b"));
    }
    EXPECT_EQ(replacement + replacement, Escaped("\xC0\x80")) << "overlong";
    EXPECT_EQ(replacement + replacement + replacement, Escaped("\xE0\x80\x80")) << "overlong";
    EXPECT_EQ(replacement + replacement + replacement, Escaped("\xED\xA0\x80")) << "a surrogate";
    EXPECT_EQ(replacement + replacement + replacement, Escaped("\xEF\xBF\xBF")) << "no character";
    EXPECT_EQ(4 * replacement.size(), Escaped("\xF4\x90\x80\x80").size()) << "beyond Unicode";
    EXPECT_EQ("\xEF\xBF\xBD", Escaped("\xEF\xBF\xBD"));
    EXPECT_EQ("\x7F", Escaped("\x7F"));
}

TEST(ValueXmlTest, EachKindOfValueHasItsElement)
{
    EXPECT_EQ("", Xml(TCIMValue::Null(TType::kString)));
    EXPECT_EQ("<VALUE>a&amp;b</VALUE>", Xml(TCIMValue("a&b")));
    EXPECT_EQ("<VALUE></VALUE>", Xml(TCIMValue("")));
    EXPECT_EQ("<VALUE>TRUE</VALUE>", Xml(TCIMValue(true)));
    EXPECT_EQ("<VALUE>-5</VALUE>", Xml(TCIMValue(-5)));
    EXPECT_EQ("<VALUE>&lt;</VALUE>", Xml(TCIMValue(u'<')));
    EXPECT_EQ("<VALUE.ARRAY><VALUE>1</VALUE><VALUE.NULL/></VALUE.ARRAY>",
              Xml(TCIMValue(TType::kSint32, 2, {TCIMValue(1), TCIMValue()})));
    EXPECT_EQ("<VALUE.ARRAY></VALUE.ARRAY>", Xml(TCIMValue(TType::kSint32, 0, {})));
    EXPECT_EQ("<VALUE.REFERENCE><CLASSNAME NAME=\"Disk\"/></VALUE.REFERENCE>", Xml(TCIMValue(TCIMReference::Parse("Disk"))));
    EXPECT_EQ("<VALUE.REFARRAY><VALUE.REFERENCE><CLASSNAME NAME=\"Disk\"/></VALUE.REFERENCE><VALUE.NULL/></VALUE.REFARRAY>",
              Xml(TCIMValue(TType::kReference, 2, {TCIMValue(TCIMReference::Parse("Disk")), TCIMValue()})));
}

TEST(ValueXmlTest, RealsCarryADecimalPoint)
{
    EXPECT_EQ("<VALUE>5.0</VALUE>", Xml(TCIMValue(5.0)));
    EXPECT_EQ("<VALUE>1.0e+300</VALUE>", Xml(TCIMValue(1e300)));
    EXPECT_EQ("<VALUE>0.1</VALUE>", Xml(TCIMValue(0.1f)));
    EXPECT_EQ("<VALUE>-INF</VALUE>", Xml(TCIMValue(-std::numeric_limits<double>::infinity())));
    EXPECT_EQ("<VALUE>NaN</VALUE>", Xml(TCIMValue(std::numeric_limits<double>::quiet_NaN())));
}

TEST(ValueXmlTest, PathsHaveTheElementForWhatTheyKnow)
{
    const std::string place = "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"cimv2\"/></LOCALNAMESPACEPATH>";
    const std::string name =
        "<INSTANCENAME CLASSNAME=\"Disk\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"string\">sda"
        "</KEYVALUE></KEYBINDING></INSTANCENAME>";
    EXPECT_EQ(name, Xml(TCIMReference::Parse("Disk.Id=\"sda\"")));
    EXPECT_EQ("<LOCALINSTANCEPATH>" + place + name + "</LOCALINSTANCEPATH>",
              Xml(TCIMReference::Parse("root/cimv2:Disk.Id=\"sda\"")));
    EXPECT_EQ("<INSTANCEPATH><NAMESPACEPATH><HOST>web01</HOST>" + place + "</NAMESPACEPATH>" + name + "</INSTANCEPATH>",
              Xml(TCIMReference::Parse("//web01/root/cimv2:Disk.Id=\"sda\"")));
    EXPECT_EQ("<LOCALCLASSPATH>" + place + "<CLASSNAME NAME=\"Disk\"/></LOCALCLASSPATH>",
              Xml(TCIMReference::Parse("root/cimv2:Disk")));
    EXPECT_EQ("<CLASSPATH><NAMESPACEPATH><HOST>web01</HOST>" + place + "</NAMESPACEPATH><CLASSNAME NAME=\"Disk\"/></CLASSPATH>",
              Xml(TCIMReference::Parse("//web01/root/cimv2:Disk")));
}

TEST(ValueXmlTest, KeysHaveTheirKind)
{
    TCIMReference path = TCIMReference::Parse("C.a=5,b=TRUE,c='x',d=NULL,e=-1.5");
    path.AddKeyValue("f", TCIMValue(TCIMReference::Parse("D")));
    EXPECT_EQ("<INSTANCENAME CLASSNAME=\"C\">"
              "<KEYBINDING NAME=\"a\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint64\">5</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"b\"><KEYVALUE VALUETYPE=\"boolean\" TYPE=\"boolean\">TRUE</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"c\"><KEYVALUE VALUETYPE=\"string\" TYPE=\"char16\">x</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"e\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"real64\">-1.5</KEYVALUE></KEYBINDING>"
              "<KEYBINDING NAME=\"f\"><VALUE.REFERENCE><CLASSNAME NAME=\"D\"/></VALUE.REFERENCE></KEYBINDING>"
              "</INSTANCENAME>",
              Xml(path));
}

TEST(ValueXmlTest, AnEmbeddedInstanceIsEscapedTextInItsValue)
{
    auto inner = boost::make_shared<TEmbeddedObject>("Inner");
    inner->AddProperty({"N", TCIMValue(1), "", 0, "", false, {}});
    auto outer = boost::make_shared<TEmbeddedObject>("Outer");
    outer->AddProperty({"I", TCIMValue(boost::shared_ptr<const TEmbeddedObject>(inner)), "", 0, "", false, {}});
    EXPECT_EQ("<INSTANCE CLASSNAME=\"Outer\"><PROPERTY NAME=\"I\" TYPE=\"string\" EmbeddedObject=\"instance\"><VALUE>"
              "&lt;INSTANCE CLASSNAME=\"Inner\"&gt;&lt;PROPERTY NAME=\"N\" TYPE=\"sint32\"&gt;&lt;VALUE&gt;1&lt;/VALUE&gt;"
              "&lt;/PROPERTY&gt;&lt;/INSTANCE&gt;</VALUE></PROPERTY></INSTANCE>",
              outer->ToText());
}

TEST(ValueXmlTest, AClassIsWrittenWhole)
{
    using TDecl = ICIMQualifierDecl;
    TEmbeddedObject cls("Disk", true);
    cls.SetSuperClassName("Device");
    cls.AddQualifier({"Version", TCIMValue("1"), TDecl::EFlavor(TDecl::kFlavorTranslatable | TDecl::kFlavorOverridable), true});
    cls.AddProperty(
        {"Id", TCIMValue::Null(TType::kString), "", 0, "Device", true, {{"Key", TCIMValue(true), TDecl::kFlavorDefault, false}}});
    cls.AddProperty({"Sizes", TCIMValue::Null(TType::kArrayUint8), "", 4, "", false, {}});
    cls.AddProperty({"Owner", TCIMValue::Null(TType::kReference), "Host", 0, "", false, {}});
    cls.AddMethod({"Reset",
                   TType::kUint32,
                   "Device",
                   false,
                   {{"To", TType::kReference, "Disk", 0, {}}, {"How", TType::kArrayString, "", 2, {}}},
                   {}});
    EXPECT_EQ(
        "<CLASS NAME=\"Disk\" SUPERCLASS=\"Device\">"
        "<QUALIFIER NAME=\"Version\" TYPE=\"string\" PROPAGATED=\"true\" TOSUBCLASS=\"false\" "
        "TRANSLATABLE=\"true\"><VALUE>1</VALUE></QUALIFIER>"
        "<PROPERTY NAME=\"Id\" TYPE=\"string\" CLASSORIGIN=\"Device\" PROPAGATED=\"true\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\">"
        "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>"
        "<PROPERTY.ARRAY NAME=\"Sizes\" TYPE=\"uint8\" ARRAYSIZE=\"4\"></PROPERTY.ARRAY>"
        "<PROPERTY.REFERENCE NAME=\"Owner\" REFERENCECLASS=\"Host\"></PROPERTY.REFERENCE>"
        "<METHOD NAME=\"Reset\" TYPE=\"uint32\" CLASSORIGIN=\"Device\"><PARAMETER.REFERENCE NAME=\"To\" REFERENCECLASS=\"Disk\">"
        "</PARAMETER.REFERENCE><PARAMETER.ARRAY NAME=\"How\" TYPE=\"string\" ARRAYSIZE=\"2\"></PARAMETER.ARRAY></METHOD>"
        "</CLASS>",
        cls.ToText());
}

}  // namespace
}  // namespace NORVZEL20
