#include "tests/client/TPairFixture.h"

namespace NORVZEL20 {
namespace {

/// What `show -o cimxml` writes is equal to the inventory.
class WholeCopyTest : public TPairFixture {
  protected:
    /// The first line of the comparison of the document with its copy.
    std::string CompareWithCopy(const std::string& document, const std::string& cls = std::string())
    {
        const std::string original = Scratch("original.xml", document);
        const std::vector<std::string> ofClass = {"show", original, cls, "-o", "cimxml"};
        Run(cls.empty() ? std::vector<std::string>{"show", original, "-o", "cimxml"} : ofClass);
        EXPECT_EQ(0, fStatus) << fErr;
        const std::string copy = fOut;
        const std::string report = Compare(document, copy);
        return report.substr(0, report.find('\n'));
    }
};

const char kEqual[] = "No differences between a and b.";

std::string Reference(const std::string& host, const std::string& ns)
{
    std::string path = "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"" + ns + "\"/></LOCALNAMESPACEPATH>";
    path = host.empty() ? path : "<NAMESPACEPATH><HOST>" + host + "</HOST>" + path + "</NAMESPACEPATH>";
    const std::string element = host.empty() ? "LOCALINSTANCEPATH" : "INSTANCEPATH";
    return "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><" + element + ">" + path + Path("Disk", "Id", "9") + "</" + element +
           "></VALUE.REFERENCE></PROPERTY.REFERENCE>";
}

std::string Disk(const std::string& reference, const std::string& ns)
{
    return Document(Class("Disk", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"R\"/>") +
                        Instance("Disk", Value("Id", "1") + reference) + System(),
                    ns);
}

TEST_F(WholeCopyTest, AReferenceIntoAnotherNamespaceStaysOne)
{
    const std::string own = "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"interop\"/></LOCALNAMESPACEPATH>";
    EXPECT_EQ(kEqual, CompareWithCopy(Disk(Reference("", "cimv2"), own)));
    EXPECT_EQ(kEqual, CompareWithCopy(Disk(Reference("", "interop"), own)));
    EXPECT_EQ(kEqual, CompareWithCopy(Disk(Reference("there", "interop"), "")));
    const std::string original = Scratch("ns.xml", Disk(Reference("", "cimv2"), own));
    const std::string copy = Scratch("copy.xml", Result({"show", original, "Disk", "-o", "cimxml"}));
    EXPECT_EQ(Result({"show", original, "Disk"}), Result({"show", copy, "Disk"}));
}

TEST_F(WholeCopyTest, AReferenceToAnotherHostStaysOne)
{
    const std::string own = "<NAMESPACEPATH><HOST>a&amp;b</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE "
                            "NAME=\"cimv2\"/></LOCALNAMESPACEPATH></NAMESPACEPATH>";
    const std::string document = Disk(Reference("there", "cimv2"), own);
    EXPECT_EQ(kEqual, CompareWithCopy(document));
    EXPECT_EQ(kEqual, CompareWithCopy(Disk(Reference("a&amp;b", "cimv2"), own)));
    const std::string original = Scratch("host.xml", document);
    EXPECT_EQ("Disk.Id=\"1\"\n    Id: 1\n    R: //there/root/cimv2:Disk.Id=\"9\"\n", Result({"show", original, "Disk"}));
}

TEST_F(WholeCopyTest, ANamespaceThatOnlyReferencesNameIsNamed)
{
    const auto disks = [](const std::string& first, const std::string& second) {
        return Document(Class("Disk", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"R\"/>") +
                        Instance("Disk", Value("Id", "1") + first) + Instance("Disk", Value("Id", "2") + second) + System());
    };
    EXPECT_EQ(kEqual, CompareWithCopy(disks(Reference("", "cimv2"), Reference("", "interop"))));
    EXPECT_EQ(kEqual, CompareWithCopy(disks(Reference("here", "interop"), Reference("there", "interop"))));
    EXPECT_EQ(kEqual, CompareWithCopy(disks(Reference("", "interop"), Reference("", "interop"))));
}

TEST_F(WholeCopyTest, ReferencesToTwoHostsThatAreExchangedDiffer)
{
    const auto disks = [](const std::string& first, const std::string& second) {
        return Document(Class("Disk", "", KeyProperty("Id") + "<PROPERTY.REFERENCE NAME=\"R\"/>") +
                        Instance("Disk", Value("Id", "1") + Reference(first, "cimv2")) +
                        Instance("Disk", Value("Id", "2") + Reference(second, "cimv2")) + System());
    };
    const std::string report = Compare(disks("h1", "h2"), disks("h2", "h1"));
    EXPECT_EQ("2 differences between a and b: 2 changed values in 2 instances", report.substr(0, report.find('\n')));
    EXPECT_EQ(kEqual, CompareWithCopy(disks("h1", "h2")));
}

TEST_F(WholeCopyTest, ObjectsBesidePlainTextInAnArrayAreObjectsAgain)
{
    const std::string object = "<VALUE><![CDATA[<INSTANCE CLASSNAME=\"Foo\"></INSTANCE>]]></VALUE>";
    const auto box = [](const std::string& values) {
        return Document(Class("Box", "",
                              KeyProperty("Id") +
                                  "<PROPERTY.ARRAY NAME=\"In\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedInstance\" "
                                  "TYPE=\"string\"><VALUE>Foo</VALUE></QUALIFIER></PROPERTY.ARRAY>") +
                        Instance("Box", Value("Id", "1") + "<PROPERTY.ARRAY NAME=\"In\" TYPE=\"string\"><VALUE.ARRAY>" + values +
                                            "</VALUE.ARRAY></PROPERTY.ARRAY>") +
                        System());
    };
    EXPECT_EQ(kEqual, CompareWithCopy(box(object + "<VALUE>plain</VALUE>")));
    EXPECT_EQ(kEqual, CompareWithCopy(box(object + "<VALUE/><VALUE.NULL/>" + object)));
}

}  // namespace
}  // namespace NORVZEL20
