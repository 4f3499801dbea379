#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

/// Loads documents whose references name namespaces and hosts, and says how the references are stored.
class OwnPlaceTest : public testing::Test {
  protected:
    using L = TLoading;

    /// A namespace root/`ns`, after a host unless `host` is empty.
    static std::string Place(const std::string& host, const std::string& ns)
    {
        const std::string path =
            "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"" + ns + "\"/></LOCALNAMESPACEPATH>";
        return host.empty() ? path : "<NAMESPACEPATH><HOST>" + host + "</HOST>" + path + "</NAMESPACEPATH>";
    }

    static std::string Name(const std::string& id)
    {
        return "<INSTANCENAME CLASSNAME=\"C\"><KEYBINDING NAME=\"Id\"><KEYVALUE>" + id + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
    }

    /// A reference to C.Id="z" there.
    static std::string Path(const std::string& host, const std::string& ns)
    {
        const std::string element = host.empty() ? "LOCALINSTANCEPATH" : "INSTANCEPATH";
        return "<VALUE.REFERENCE><" + element + ">" + Place(host, ns) + Name("z") + "</" + element + "></VALUE.REFERENCE>";
    }

    static std::string Reference(const std::string& host, const std::string& ns)
    {
        return "<PROPERTY.REFERENCE NAME=\"R\">" + Path(host, ns) + "</PROPERTY.REFERENCE>";
    }

    /// An instance of C whose R is that reference.
    static std::string Nameless(const std::string& id)
    {
        return L::Instance(
            "C", id, "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE>" + Name("z") + "</VALUE.REFERENCE></PROPERTY.REFERENCE>");
    }

    static std::string Pointing(const std::string& id, const std::string& host, const std::string& ns = "cimv2")
    {
        return L::Instance("C", id, Reference(host, ns));
    }

    static std::string Link(const std::string& reference)
    {
        return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Link\">" + reference + "</INSTANCE></VALUE.OBJECT>\n";
    }

    static std::string Classes()
    {
        return L::Class("C", "<PROPERTY.REFERENCE NAME=\"R\" REFERENCECLASS=\"C\"/><PROPERTY.REFARRAY NAME=\"A\"/>"
                             "<PROPERTY NAME=\"E\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedObject\" TYPE=\"boolean\">"
                             "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>") +
               "<VALUE.OBJECT><CLASS NAME=\"Link\"><PROPERTY.REFERENCE NAME=\"R\" REFERENCECLASS=\"C\"><QUALIFIER NAME=\"Key\" "
               "TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE></CLASS></VALUE.OBJECT>\n";
    }

    void Load(const std::string& contents) { fReport = fLoading.Load(L::Group(contents)); }

    std::string ValueOf(const std::string& id, const std::string& property = "R")
    {
        return fLoading.ValueOf("C.Id=\"" + id + "\"", property);
    }

    /// The values of R of the instances with the names 1, 2 and so on, as long as there are any.
    std::vector<std::string> Stored(const std::string& contents, int count)
    {
        Load(contents);
        std::vector<std::string> values;
        for (int id = 1; id <= count; ++id) {
            values.push_back(ValueOf(std::to_string(id)));
        }
        return values;
    }

    using TTexts = std::vector<std::string>;
    const std::string fLocal = "C.Id=\"z\"";
    TLoading fLoading;
    TLoadReport fReport;
};

TEST_F(OwnPlaceTest, TheOnlyHostBesideTheNamespaceIsTheOwnOne)
{
    EXPECT_EQ((TTexts{fLocal, fLocal, fLocal, "//g/root/other:C.Id=\"z\""}),
              Stored(Place("", "cimv2") + Classes() + Pointing("1", "h") + Pointing("2", "H") + Pointing("3", "") +
                         Pointing("4", "g", "other"),
                     4));
}

TEST_F(OwnPlaceTest, SeveralHostsStayInThePaths)
{
    const std::string contents = Classes() + Pointing("1", "h1") + Pointing("2", "h2") + Pointing("3", "");
    const TTexts expected = {"//h1/root/cimv2:C.Id=\"z\"", "//h2/root/cimv2:C.Id=\"z\"", fLocal};
    EXPECT_EQ(expected, Stored(contents, 3));
    fLoading = TLoading();
    EXPECT_EQ(expected, Stored(Place("", "cimv2") + contents, 3));
    EXPECT_EQ("", fReport.host);
}

TEST_F(OwnPlaceTest, AssociationsToTheSameNameOnSeveralHostsAreSeveral)
{
    Load(Classes() + Link(Reference("h1", "cimv2")) + Link(Reference("h2", "cimv2")) + Link(Reference("", "cimv2")));
    EXPECT_EQ("root/cimv2:Link.R=\"//h1/root/cimv2:C.Id=\\\"z\\\"\"\n"
              "root/cimv2:Link.R=\"//h2/root/cimv2:C.Id=\\\"z\\\"\"\n"
              "root/cimv2:Link.R=\"C.Id=\\\"z\\\"\"\n",
              fLoading.PathsOf("Link"));
}

TEST_F(OwnPlaceTest, AssociationsThatTurnOutToBeOneAreOne)
{
    Load(Classes() + Link(Reference("h1", "cimv2")) + Link(Reference("", "cimv2")));
    EXPECT_EQ("root/cimv2:Link.R=\"C.Id=\\\"z\\\"\"\n", fLoading.PathsOf("Link"));
    EXPECT_EQ(1u, fReport.instances);
}

// One reference names h1. The second host stands in another kind of place each time, and still keeps h1 from being the own one.
TEST_F(OwnPlaceTest, AHostCountsWhereverAReferenceNamesIt)
{
    const std::string object = "&lt;INSTANCE CLASSNAME=\"X\"&gt;&lt;PROPERTY.REFERENCE NAME=\"R\"&gt;&lt;VALUE.REFERENCE&gt;"
                               "&lt;INSTANCEPATH&gt;&lt;NAMESPACEPATH&gt;&lt;HOST&gt;h2&lt;/HOST&gt;&lt;LOCALNAMESPACEPATH&gt;"
                               "&lt;NAMESPACE NAME=\"root/cimv2\"/&gt;&lt;/LOCALNAMESPACEPATH&gt;&lt;/NAMESPACEPATH&gt;"
                               "&lt;INSTANCENAME CLASSNAME=\"C\"/&gt;&lt;/INSTANCEPATH&gt;&lt;/VALUE.REFERENCE&gt;"
                               "&lt;/PROPERTY.REFERENCE&gt;&lt;/INSTANCE&gt;";
    const auto named = [](const std::string& key) {
        return "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Link\"><KEYBINDING NAME=\"R\">" + key +
               "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE>";
    };
    const struct {
        const char* property;
        std::string element;
        std::string stored;
    } rows[] = {
        {"R", Reference("h2", "cimv2"), "//h2/root/cimv2:C.Id=\"z\""},
        {"R", L::Property("R", "string", "//h2/root/cimv2:C.Id=\"z\""), "//h2/root/cimv2:C.Id=\"z\""},
        {"R", named(Path("h2", "cimv2")), "Link.R=\"//h2/root/cimv2:C.Id=\\\"z\\\"\""},
        {"R", named("<KEYVALUE>//h2/root/cimv2:C.Id=\"z\"</KEYVALUE>"), "Link.R=\"//h2/root/cimv2:C.Id=\\\"z\\\"\""},
        {"A",
         "<PROPERTY.REFARRAY NAME=\"A\"><VALUE.REFARRAY>" + Path("h2", "cimv2") + Path("h1", "cimv2") +
             "</VALUE.REFARRAY></PROPERTY.REFARRAY>",
         "{//h2/root/cimv2:C.Id=\"z\", //h1/root/cimv2:C.Id=\"z\"}"},
        {"E", L::Property("E", "string", object),
         "<INSTANCE CLASSNAME=\"X\"><PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><CLASSPATH><NAMESPACEPATH><HOST>h2</HOST>"
         "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"cimv2\"/></LOCALNAMESPACEPATH></NAMESPACEPATH>"
         "<CLASSNAME NAME=\"C\"/></CLASSPATH></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>"},
    };
    for (const auto& row : rows) {
        const std::string instances = Pointing("1", "h1") + L::Instance("C", "2", row.element);
        // The second time, the instances come before their class.
        for (const std::string& contents : {Classes() + instances, instances + Classes()}) {
            fLoading = TLoading();
            EXPECT_EQ(TTexts{"//h1/root/cimv2:C.Id=\"z\""}, Stored(contents, 1)) << row.element;
            EXPECT_EQ(row.stored, ValueOf("2", row.property)) << contents;
        }
    }
}

TEST_F(OwnPlaceTest, AnOwnHostLosesItsNameInEveryKindOfValue)
{
    const std::string array =
        "<PROPERTY.REFARRAY NAME=\"A\"><VALUE.REFARRAY>" + Path("h", "cimv2") + "</VALUE.REFARRAY></PROPERTY.REFARRAY>";
    const std::string object =
        "&lt;INSTANCE CLASSNAME=\"X\"&gt;&lt;PROPERTY NAME=\"P\" TYPE=\"uint8\"/&gt;&lt;PROPERTY.REFERENCE "
        "NAME=\"R\"&gt;&lt;VALUE.REFERENCE&gt;&lt;INSTANCEPATH&gt;&lt;NAMESPACEPATH&gt;&lt;HOST&gt;h&lt;/HOST&gt;"
        "&lt;LOCALNAMESPACEPATH&gt;&lt;NAMESPACE NAME=\"root/cimv2\"/&gt;&lt;/LOCALNAMESPACEPATH&gt;"
        "&lt;/NAMESPACEPATH&gt;&lt;INSTANCENAME CLASSNAME=\"C\"/&gt;&lt;/INSTANCEPATH&gt;"
        "&lt;/VALUE.REFERENCE&gt;&lt;/PROPERTY.REFERENCE&gt;&lt;/INSTANCE&gt;";
    const std::string instances = L::Instance("C", "1", array + L::Property("E", "string", object));
    for (const std::string& contents : {Classes() + instances, instances + Classes()}) {
        fLoading = TLoading();
        Load(contents);
        EXPECT_EQ("{C.Id=\"z\"}", ValueOf("1", "A"));
        EXPECT_EQ("<INSTANCE CLASSNAME=\"X\"><PROPERTY NAME=\"P\" TYPE=\"uint8\"></PROPERTY><PROPERTY.REFERENCE NAME=\"R\">"
                  "<VALUE.REFERENCE><CLASSNAME NAME=\"C\"/></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>",
                  ValueOf("1", "E"));
    }
}

TEST_F(OwnPlaceTest, DefaultsOfClassesAreStoredLikeValues)
{
    const std::string holder = L::Class("D", Reference("h1", "cimv2"));
    const auto defaultOf = [this] {
        return fLoading.GetNamespace()->FindClass("D")->FindPropertyDecl("R")->GetDefaultValue().ToText();
    };
    Load(Classes() + holder);
    EXPECT_EQ(fLocal, defaultOf());
    fLoading = TLoading();
    Load(Classes() + holder + Pointing("1", "h2"));
    EXPECT_EQ("//h1/root/cimv2:C.Id=\"z\"", defaultOf());
    EXPECT_EQ("//h2/root/cimv2:C.Id=\"z\"", ValueOf("1"));
}

// The document names its host only in front of the last object.
TEST_F(OwnPlaceTest, AHostThatIsNamedLaterIsTheOwnOneAndNoOther)
{
    const std::string named = "<VALUE.OBJECTWITHPATH><INSTANCEPATH>" + Place("h1", "cimv2") + Name("9") +
                              "</INSTANCEPATH><INSTANCE CLASSNAME=\"C\">" + L::Property("Id", "string", "9") +
                              "</INSTANCE></VALUE.OBJECTWITHPATH>";
    EXPECT_EQ((TTexts{"//h2/root/cimv2:C.Id=\"z\"", "//h2/root/cimv2:C.Id=\"z\""}),
              Stored(Classes() + Pointing("1", "h2") + named + Pointing("2", "h2"), 2));
    fLoading = TLoading();
    EXPECT_EQ((TTexts{fLocal, "//h2/root/cimv2:C.Id=\"z\""}),
              Stored(Classes() + Pointing("1", "h1") + Pointing("2", "h2") + named, 2));
    EXPECT_EQ("h1", fReport.host);
}

TEST_F(OwnPlaceTest, ANamespaceThatIsNamedLaterIsTheOwnOne)
{
    const std::string named = "<VALUE.OBJECTWITHLOCALPATH><LOCALINSTANCEPATH>" + Place("", "here") + Name("9") +
                              "</LOCALINSTANCEPATH><INSTANCE CLASSNAME=\"C\">" + L::Property("Id", "string", "9") +
                              "</INSTANCE></VALUE.OBJECTWITHLOCALPATH>";
    EXPECT_EQ((TTexts{fLocal, "root/cimv2:C.Id=\"z\"", fLocal}),
              Stored(Classes() + Pointing("1", "", "here") + Pointing("2", "", "cimv2") + named + Pointing("3", "", "here"), 3));
    EXPECT_EQ("root/here", fReport.namespaceName);
}

TEST_F(OwnPlaceTest, ANamespaceThatIsNeverNamedIsTheOneThatAllReferencesName)
{
    EXPECT_EQ((TTexts{fLocal, fLocal, fLocal}),
              Stored(Classes() + Pointing("1", "", "other") + Pointing("2", "", "OTHER") + Pointing("3", "h", "other"), 3));
    EXPECT_EQ("root/other", fReport.namespaceName);
    EXPECT_FALSE(fReport.namesNamespace);
    EXPECT_TRUE(fReport.referencesNameNamespace);
}

TEST_F(OwnPlaceTest, IfReferencesNameSeveralNamespacesTheDefaultIsTheOwnOne)
{
    EXPECT_EQ((TTexts{"root/a:C.Id=\"z\"", "root/b:C.Id=\"z\"", fLocal}),
              Stored(Classes() + Pointing("1", "", "a") + Pointing("2", "", "b") + Pointing("3", "", "cimv2"), 3));
    EXPECT_EQ("root/cimv2", fReport.namespaceName);
}

TEST_F(OwnPlaceTest, IfSomeNameNoneANamespaceIsForeignThatLeadsToNothingHere)
{
    EXPECT_EQ((TTexts{"root/hw:C.Id=\"z\"", fLocal}), Stored(Classes() + Pointing("1", "", "hw") + Nameless("2"), 2));
    EXPECT_EQ("root/cimv2", fReport.namespaceName);
}

TEST_F(OwnPlaceTest, IfSomeNameNoneANamespaceIsTheOwnOneThatLeadsToAnInstance)
{
    EXPECT_EQ((TTexts{fLocal, fLocal}), Stored(Classes() + Pointing("1", "", "hw") + Nameless("2") + L::Instance("C", "z"), 2));
    EXPECT_EQ("root/hw", fReport.namespaceName);
}

/// Such instances are added only after it is decided. The same holds for those whose own name is open.
TEST_F(OwnPlaceTest, TheInstanceThatANamespaceLeadsToMayComeBeforeItsClass)
{
    const std::string instances = Pointing("1", "", "hw") + Nameless("2") + L::Instance("C", "z");
    EXPECT_EQ((TTexts{fLocal, fLocal}), Stored(instances + Classes(), 2));
    EXPECT_EQ("root/hw", fReport.namespaceName);
    fLoading = TLoading();
    EXPECT_EQ((TTexts{"root/hw:C.Id=\"z\"", fLocal}), Stored(Pointing("1", "", "hw") + Nameless("2") + Classes(), 2));
    EXPECT_EQ("root/cimv2", fReport.namespaceName);

    const std::string link = "<VALUE.REFERENCE><LOCALINSTANCEPATH>" + Place("", "hw") +
                             "<INSTANCENAME CLASSNAME=\"Link\"><KEYBINDING NAME=\"R\">" + Path("", "hw") +
                             "</KEYBINDING></INSTANCENAME></LOCALINSTANCEPATH></VALUE.REFERENCE>";
    const std::string toLink = L::Instance("C", "1", "<PROPERTY.REFERENCE NAME=\"R\">" + link + "</PROPERTY.REFERENCE>");
    fLoading = TLoading();
    EXPECT_EQ((TTexts{"Link.R=\"C.Id=\\\"z\\\"\""}), Stored(Classes() + toLink + Link(Reference("", "hw")) + Nameless("2"), 1));
}

TEST_F(OwnPlaceTest, WithoutReferencesNothingIsKnownOfTheNamespace)
{
    Load(Classes() + L::Instance("C", "1"));
    EXPECT_EQ("root/cimv2", fReport.namespaceName);
    EXPECT_FALSE(fReport.referencesNameNamespace);
}

}  // namespace
}  // namespace NORVZEL20
