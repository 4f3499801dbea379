#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// A key that is text in one inventory, because only the other one declares the key's class: after the completion it is a
/// reference, and the same one.
class LateReferencesTest : public TPairFixture {
  protected:
    /// Reads as "equal" for no differences, else as the whole report.
    std::string Outcome(const std::string& a, const std::string& b)
    {
        const std::string report = Compare(a, b);
        return report.rfind("No differences between a and b.\n", 0) == 0 ? "equal" : report;
    }
};

std::string InQuotes(const std::string& text)
{
    std::string escaped;
    for (const char c : text) {
        escaped += c == '"' || c == '\\' ? std::string("\\") + c : std::string(1, c);
    }
    return escaped;
}

/// The path of a Link to a Link and so on to Use.Id="x".
std::string NestedLinks(int links)
{
    std::string path = "Use.Id=\"x\"";
    for (; links > 0; --links) {
        path = "Link.On=\"" + InQuotes(path) + "\"";
    }
    return path;
}

const std::string kLinkClass = Class("Link", "", "<PROPERTY.REFERENCE NAME=\"On\">" + kKey + "</PROPERTY.REFERENCE>");
const std::string kOwnHostPlace =
    "<NAMESPACEPATH><HOST>web01</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"hw\"/>"
    "</LOCALNAMESPACEPATH></NAMESPACEPATH>";

std::string LateReference(const std::string& name, const std::string& path)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\"><VALUE.REFERENCE>" + path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
}

/// References to the link with that key in every place where a reference may stand.
std::string LinkUses(const std::string& key)
{
    const std::string path = Path("Link", "On", key);
    const std::string outer = "<INSTANCENAME CLASSNAME=\"Pair\"><KEYBINDING NAME=\"To\"><VALUE.REFERENCE>" + path +
                              "</VALUE.REFERENCE></KEYBINDING></INSTANCENAME>";
    return Class("Pair", "", "<PROPERTY.REFERENCE NAME=\"To\">" + kKey + "</PROPERTY.REFERENCE>") +
           Class("Use", "",
                 KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"Plain\"/><PROPERTY.REFERENCE NAME=\"Outer\"/>" +
                     "<PROPERTY.REFARRAY NAME=\"All\"/><PROPERTY.REFERENCE NAME=\"Common\">" + Qualifier("Static") +
                     "</PROPERTY.REFERENCE>" + Declaration("In", "string")) +
           Instance("Pair", LateReference("To", path)) +
           Instance("Use", Value("Id", "1") + LateReference("Plain", path) + LateReference("Outer", outer) +
                               LateReference("Common", path) + "<PROPERTY.REFARRAY NAME=\"All\"><VALUE.REFARRAY><VALUE.REFERENCE>" +
                               path +
                               "</VALUE.REFERENCE></VALUE.REFARRAY></PROPERTY.REFARRAY>"
                               "<PROPERTY NAME=\"In\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE><![CDATA[<INSTANCE "
                               "CLASSNAME=\"X\">" +
                               LateReference("Deep", outer) + "</INSTANCE>]]></VALUE></PROPERTY>") +
           System();
}

TEST_F(LateReferencesTest, TheOwnNamespaceDoesNotCountWhereverTheReferenceStands)
{
    for (const char* const own : {"root/hw:Use.Id=\"x\"", "ROOT/HW:Use.Id=\"x\"", "//Web01/root/hw:Use.Id=\"x\"", "Use.Id=\"x\""}) {
        EXPECT_EQ("equal", Outcome(Document(LinkUses(own), kOwnHostPlace),
                                   Document(kLinkClass + LinkUses("root/hw:Use.Id=\"x\""), kOwnHostPlace)))
            << own;
        EXPECT_EQ("equal",
                  Outcome(Document(kLinkClass + LinkUses("Use.Id=\"x\""), kOwnHostPlace), Document(LinkUses(own), kOwnHostPlace)))
            << own;
    }
}

TEST_F(LateReferencesTest, AForeignNamespaceOrHostCounts)
{
    for (const char* const foreign : {"root/other:Use.Id=\"x\"", "//web02/root/hw:Use.Id=\"x\""}) {
        const std::string report =
            Outcome(Document(LinkUses(foreign), kOwnHostPlace), Document(kLinkClass + LinkUses("Use.Id=\"x\""), kOwnHostPlace));
        EXPECT_EQ("7 differences between a and b: 1 instance only in a, 1 instance only in b, 5 changed values in 1 instance",
                  report.substr(0, report.find('\n')))
            << foreign;
        EXPECT_EQ("equal",
                  Outcome(Document(LinkUses(foreign), kOwnHostPlace), Document(kLinkClass + LinkUses(foreign), kOwnHostPlace)))
            << foreign;
    }
}

TEST_F(LateReferencesTest, WhatNestsTooDeeplyStaysText)
{
    for (const int links : {10, 11, 12, 13, 15}) {
        const std::string late = Document(LinkUses(NestedLinks(links)));
        EXPECT_EQ("equal", Outcome(late, Document(kLinkClass + LinkUses(NestedLinks(links))))) << links;
        EXPECT_EQ("equal", Outcome(Document(LinkUses(NestedLinks(links)) + kLinkClass), late)) << links;
        EXPECT_NE("equal", Outcome(late, Document(kLinkClass + LinkUses(NestedLinks(links + 1))))) << links;
    }
}

}  // namespace
}  // namespace NORVZEL20
