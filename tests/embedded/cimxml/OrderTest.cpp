#include <gtest/gtest.h>

#include <algorithm>
#include <set>

#include "host/TZELException.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

const char kKey[] = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><VALUE>TRUE</VALUE></QUALIFIER>";

std::string Object(const std::string& element)
{
    return "<VALUE.OBJECT>" + element + "</VALUE.OBJECT>\n";
}

/// A path as careless writers write it: names in another letter case, numbers as text.
std::string DiskPath(const std::string& id)
{
    return "<VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"disk\"><KEYBINDING NAME=\"id\"><KEYVALUE VALUETYPE=\"string\">" + id +
           "</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
}

std::string PartPath(const std::string& id)
{
    return "<VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"PART\"><KEYBINDING NAME=\"ON\">" + DiskPath(id) +
           "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
}

std::string ReferenceTo(const std::string& name, const std::string& path)
{
    return "<PROPERTY.REFERENCE NAME=\"" + name + "\">" + path + "</PROPERTY.REFERENCE>";
}

std::string Escaped(const std::string& xml)
{
    std::string text;
    for (const char c : xml) {
        text += c == '<' ? "&lt;" : std::string(1, c);
    }
    return text;
}

std::string Quoted(const std::string& text)
{
    std::string quoted;
    TCIMValue(text).AppendKeyText(quoted);
    return quoted;
}

/// Every value of the namespace, a line for each, sorted.
std::string ContentsOf(const TLoading& loading)
{
    std::set<std::string> lines;
    for (const boost::shared_ptr<TInMemClass>& cls : loading.GetNamespace()->GetClasses()) {
        cls->EnumerateInstances(
            [&lines](boost::shared_ptr<ICIMInstance> instance) {
                const std::string path = instance->GetReference(TCallContext()).GetPath();
                instance->EnumerateProperties(
                    [&](boost::shared_ptr<ICIMProperty> property) {
                        lines.insert(path + " " + property->GetPropertyDecl(TCallContext())->GetName(TCallContext()) + " " +
                                     property->GetValue(TCallContext()).ToText() + "\n");
                        return true;
                    },
                    TCallContext());
                return true;
            },
            false, TCallContext());
    }
    std::string text;
    for (const std::string& line : lines) {
        text += line;
    }
    return text;
}

/// The contents after loading the elements in every order. If they are not always the same: all that occurred, with "or" between.
std::string ContentsInEveryOrder(std::vector<std::string> elements)
{
    std::sort(elements.begin(), elements.end());
    std::set<std::string> contents;
    do {
        std::string group;
        for (const std::string& element : elements) {
            group += element;
        }
        TLoading loading;
        loading.Load(TLoading::Group(group));
        contents.insert(ContentsOf(loading));
    } while (std::next_permutation(elements.begin(), elements.end()));
    std::string text;
    for (const std::string& one : contents) {
        text += (&one == &*contents.begin() ? "" : "or\n") + (one.empty() ? "nothing\n" : one);
    }
    return text;
}

const std::string kDisk =
    Object(std::string("<CLASS NAME=\"Disk\"><PROPERTY NAME=\"Id\" TYPE=\"uint32\">") + kKey + "</PROPERTY></CLASS>");

TEST(OrderTest, AReferenceIsWrittenAsItsClassIsDeclaredWhereverThatStands)
{
    const std::string use = Object(std::string("<CLASS NAME=\"Use\"><PROPERTY NAME=\"Id\" TYPE=\"string\">") + kKey +
                                   "</PROPERTY><PROPERTY.REFERENCE NAME=\"On\"/><PROPERTY.REFARRAY NAME=\"All\"/></CLASS>");
    const std::string all = "<PROPERTY.REFARRAY NAME=\"All\"><VALUE.REFARRAY>" + DiskPath("6") + DiskPath("7") +
                            "</VALUE.REFARRAY></PROPERTY.REFARRAY>";
    EXPECT_EQ("root/cimv2:Use.Id=\"a\" All {Disk.Id=6, Disk.Id=7}\n"
              "root/cimv2:Use.Id=\"a\" Id a\n"
              "root/cimv2:Use.Id=\"a\" On Disk.Id=5\n",
              ContentsInEveryOrder({kDisk, use, TLoading::Instance("Use", "a", ReferenceTo("On", DiskPath("5")) + all)}));
}

TEST(OrderTest, SoIsOneThatIsAKeyAndOneWithinAKey)
{
    const std::string part = Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey +
                                    "</PROPERTY.REFERENCE><PROPERTY.REFERENCE NAME=\"Next\"/></CLASS>");
    const std::string instance = Object("<INSTANCE CLASSNAME=\"Part\">" + ReferenceTo("On", DiskPath("1")) +
                                        ReferenceTo("Next", PartPath("2")) + "</INSTANCE>");
    EXPECT_EQ("root/cimv2:Part.On=\"Disk.Id=1\" Next Part.On=\"Disk.Id=2\"\n"
              "root/cimv2:Part.On=\"Disk.Id=1\" On Disk.Id=1\n",
              ContentsInEveryOrder({kDisk, part, instance}));
}

TEST(OrderTest, AKeyLeftOutAndTakenFromTheNameInFrontIsWrittenSoToo)
{
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    const std::string instance = "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"Part\"><KEYBINDING NAME=\"On\">" + DiskPath("1") +
                                 "</KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"Part\"/></VALUE.NAMEDINSTANCE>\n";
    EXPECT_EQ("root/cimv2:Part.On=\"Disk.Id=1\" On Disk.Id=1\n", ContentsInEveryOrder({kDisk, part, instance}));
}

TEST(OrderTest, WhatADeclarationSaysIsAnObjectIsOneWhereverTheDeclarationStands)
{
    const std::string box = Object(std::string("<CLASS NAME=\"Box\"><PROPERTY NAME=\"Id\" TYPE=\"string\">") + kKey +
                                   "</PROPERTY><PROPERTY NAME=\"In\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedInstance\" "
                                   "TYPE=\"string\"><VALUE>Thing</VALUE></QUALIFIER></PROPERTY><PROPERTY.ARRAY NAME=\"Also\" "
                                   "TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedObject\" TYPE=\"boolean\"><VALUE>TRUE</VALUE>"
                                   "</QUALIFIER></PROPERTY.ARRAY></CLASS>");
    const std::string thing = Escaped("<INSTANCE CLASSNAME=\"Thing\">" + ReferenceTo("On", DiskPath("3")) + "</INSTANCE>");
    const std::string also = "<PROPERTY.ARRAY NAME=\"Also\" TYPE=\"string\"><VALUE.ARRAY><VALUE>plain</VALUE><VALUE>" + thing +
                             "</VALUE></VALUE.ARRAY></PROPERTY.ARRAY>";
    const std::string object = "<INSTANCE CLASSNAME=\"Thing\"><PROPERTY.REFERENCE NAME=\"On\"><VALUE.REFERENCE><INSTANCENAME "
                               "CLASSNAME=\"Disk\"><KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint32\">3"
                               "</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>";
    EXPECT_EQ("root/cimv2:Box.Id=\"a\" Also {\"plain\", " + object +
                  "}\nroot/cimv2:Box.Id=\"a\" Id a\nroot/cimv2:Box.Id=\"a\" In " + object + "\n",
              ContentsInEveryOrder({kDisk, box, TLoading::Instance("Box", "a", TLoading::Property("In", "string", thing) + also)}));
}

TEST(OrderTest, ATextThatIsAReferenceAsDeclaredLosesTheOwnNamespaceInAnObjectToo)
{
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    const std::string use = Object(std::string("<CLASS NAME=\"Use\"><PROPERTY NAME=\"Id\" TYPE=\"string\">") + kKey +
                                   "</PROPERTY><PROPERTY.REFERENCE NAME=\"R\"/><PROPERTY NAME=\"In\" TYPE=\"string\"/></CLASS>");
    const std::string path = "<VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"part\"><KEYBINDING NAME=\"on\">"
                             "<KEYVALUE>root/cimv2:disk.id=7</KEYVALUE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE>";
    const std::string in = "<PROPERTY NAME=\"In\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>" +
                           Escaped("<INSTANCE CLASSNAME=\"X\">" + ReferenceTo("R", path) + "</INSTANCE>") + "</VALUE></PROPERTY>";
    const std::string object = "<INSTANCE CLASSNAME=\"X\"><PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE><INSTANCENAME "
                               "CLASSNAME=\"Part\"><KEYBINDING NAME=\"On\"><VALUE.REFERENCE><INSTANCENAME CLASSNAME=\"Disk\">"
                               "<KEYBINDING NAME=\"Id\"><KEYVALUE VALUETYPE=\"numeric\" TYPE=\"uint32\">7</KEYVALUE>"
                               "</KEYBINDING></INSTANCENAME></VALUE.REFERENCE></KEYBINDING></INSTANCENAME></VALUE.REFERENCE>"
                               "</PROPERTY.REFERENCE></INSTANCE>";
    EXPECT_EQ("root/cimv2:Use.Id=\"a\" Id a\nroot/cimv2:Use.Id=\"a\" In " + object +
                  "\nroot/cimv2:Use.Id=\"a\" R Part.On=\"Disk.Id=7\"\n",
              ContentsInEveryOrder({kDisk, part, use, TLoading::Instance("Use", "a", ReferenceTo("R", path) + in)}));
}

TEST(OrderTest, PathsInTextThatNestTooDeeplyStayTextInEveryOrder)
{
    const std::string use = Object(std::string("<CLASS NAME=\"Use\"><PROPERTY NAME=\"Id\" TYPE=\"string\">") + kKey +
                                   "</PROPERTY><PROPERTY.REFERENCE NAME=\"R\"/></CLASS>");
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    for (const int depth : {11, 12, 13, 14}) {
        std::string written = "disk.id=5";
        std::string stored = "Disk.Id=5";
        for (int level = 0; level < depth; ++level) {
            written = "part.on=" + Quoted(written);
            stored = "Part.On=" + Quoted(stored);
        }
        EXPECT_EQ(
            "root/cimv2:Use.Id=\"a\" Id a\nroot/cimv2:Use.Id=\"a\" R " + stored + "\n",
            ContentsInEveryOrder({kDisk, part, use, TLoading::Instance("Use", "a", TLoading::Property("R", "string", written))}))
            << depth;
    }
}

const std::string kState =
    Object(std::string("<CLASS NAME=\"State\"><PROPERTY NAME=\"S\" TYPE=\"string\">") + kKey +
           "<QUALIFIER NAME=\"EmbeddedObject\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER></PROPERTY></CLASS>");

std::string StateName(const std::string& text)
{
    return "<INSTANCENAME CLASSNAME=\"State\"><KEYBINDING NAME=\"S\"><KEYVALUE>" + Escaped(text) +
           "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

TEST(OrderTest, AKeyThatIsAnObjectHasOneTextInEveryOrderAndSpelling)
{
    const std::string use =
        Object(std::string("<CLASS NAME=\"Use\"><PROPERTY.REFERENCE NAME=\"R\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    const std::string text = "<INSTANCE CLASSNAME=\"Se\"><PROPERTY NAME=\"B\" TYPE=\"string\"><VALUE>2</VALUE></PROPERTY>"
                             "<PROPERTY NAME=\"A\" TYPE=\"string\"><VALUE>1</VALUE></PROPERTY></INSTANCE>";
    const std::string instance =
        Object("<INSTANCE CLASSNAME=\"Use\">" + ReferenceTo("R", "<VALUE.REFERENCE>" + StateName(text) + "</VALUE.REFERENCE>") +
               "</INSTANCE>");
    const std::string key = "<INSTANCE CLASSNAME=\"se\"><PROPERTY NAME=\"a\" TYPE=\"string\"><VALUE>1</VALUE></PROPERTY>"
                            "<PROPERTY NAME=\"b\" TYPE=\"string\"><VALUE>2</VALUE></PROPERTY></INSTANCE>";
    const std::string contents = ContentsInEveryOrder({kState, use, instance});
    EXPECT_EQ("root/cimv2:Use.R=" + Quoted("State.S=" + Quoted(key)), contents.substr(0, contents.find(" R ")));
    EXPECT_EQ(std::string::npos, contents.find("or\n"));
    const std::string named = "<VALUE.NAMEDINSTANCE>" + StateName(text) + "<INSTANCE CLASSNAME=\"State\"/></VALUE.NAMEDINSTANCE>\n";
    const std::string fromName = ContentsInEveryOrder({kState, use, named});
    EXPECT_EQ("root/cimv2:State.S=" + Quoted(key), fromName.substr(0, fromName.find(" S ")));
    EXPECT_EQ(std::string::npos, fromName.find("or\n"));
}

TEST(OrderTest, AKeyThatOnlyLooksLikeAnObjectStaysText)
{
    for (const char* const text : {"<", "<INSTANCE>", "<INSTANCE CLASSNAME=\"a.b\"", "<!DOCTYPE x><INSTANCE CLASSNAME=\"A\"/>"}) {
        TLoading loading;
        loading.Load(TLoading::Group(kState + "<VALUE.NAMEDINSTANCE>" + StateName(text) +
                                     "<INSTANCE CLASSNAME=\"State\"/></VALUE.NAMEDINSTANCE>\n"));
        EXPECT_EQ("root/cimv2:State.S=" + Quoted(text) + "\n", loading.PathsOf("State"));
    }
}

TEST(OrderTest, APathIsFoundHoweverItsReferencesAndObjectsAreWritten)
{
    TLoading loading;
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    loading.Load(TLoading::Group(kDisk + part + kState +
                                 Object("<INSTANCE CLASSNAME=\"Part\">" + ReferenceTo("On", DiskPath("7")) + "</INSTANCE>") +
                                 "<VALUE.NAMEDINSTANCE>" + StateName("<INSTANCE CLASSNAME=\"Se\"/>") +
                                 "<INSTANCE CLASSNAME=\"State\"/></VALUE.NAMEDINSTANCE>\n"));
    for (const char* const inner : {"Disk.Id=7", "disk.id=7", "disk.id=\"7\"", "root/cimv2:disk.ID=7", "/ROOT/cimv2:Disk.Id=7"}) {
        EXPECT_EQ("Disk.Id=7", loading.ValueOf("part.on=" + Quoted(inner), "On")) << inner;
    }
    EXPECT_NE(nullptr, loading.Find("State.S=" + Quoted("<INSTANCE  CLASSNAME=\"SE\"></INSTANCE>")));
    EXPECT_THROW(loading.Find("part.on=" + Quoted("root/other:Disk.Id=7")), TZELException);
    EXPECT_THROW(loading.Find("State.S=" + Quoted("<INSTANCE CLASSNAME=\"other\"/>")), TZELException);
}

TEST(OrderTest, InstancesOfAClassStayInTheDocumentsOrder)
{
    TLoading loading;
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    const auto instance = [](const std::string& path) {
        return Object("<INSTANCE CLASSNAME=\"Part\">" + ReferenceTo("On", path) + "</INSTANCE>");
    };
    loading.Load(TLoading::Group(TLoading::Class("Room") + part + instance(DiskPath("2")) +
                                 instance("<VALUE.REFERENCE><CLASSNAME NAME=\"Room\"/></VALUE.REFERENCE>") +
                                 instance(DiskPath("1")) + kDisk));
    EXPECT_EQ("root/cimv2:Part.On=\"Disk.Id=2\"\nroot/cimv2:Part.On=\"Room\"\nroot/cimv2:Part.On=\"Disk.Id=1\"\n",
              loading.PathsOf("Part"));
}

TEST(OrderTest, TwoInstancesWhoseKeysAreOneAsDeclaredAreOne)
{
    TLoading loading;
    const std::string part =
        Object(std::string("<CLASS NAME=\"Part\"><PROPERTY.REFERENCE NAME=\"On\">") + kKey + "</PROPERTY.REFERENCE></CLASS>");
    const std::string instance = Object("<INSTANCE CLASSNAME=\"Part\">" + ReferenceTo("On", DiskPath("1")) + "</INSTANCE>");
    const std::string other = Object("<INSTANCE CLASSNAME=\"Part\">" + ReferenceTo("On", DiskPath("01")) + "</INSTANCE>");
    const TLoadReport report = loading.Load(TLoading::Group(part + instance + other + kDisk));
    EXPECT_EQ("root/cimv2:Part.On=\"Disk.Id=1\"\n", loading.PathsOf("Part"));
    EXPECT_EQ("4: instance root/cimv2:Part.On=\"Disk.Id=1\" is there again with the same values; taken as one (1)\n",
              TLoading::Tolerated(report));
}

TEST(OrderTest, ASecondInstanceIsNamedAsItIsWrittenOnItsLine)
{
    TLoading loading;
    const auto event = [](const char* when, const char* what) {
        return Object("<INSTANCE CLASSNAME=\"Event\"><PROPERTY NAME=\"When\" TYPE=\"datetime\"><VALUE>" + std::string(when) +
                      "</VALUE></PROPERTY>" + TLoading::Property("What", "string", what) + "</INSTANCE>");
    };
    const std::string cls = Object(std::string("<CLASS NAME=\"Event\"><PROPERTY NAME=\"When\" TYPE=\"datetime\">") + kKey +
                                   "</PROPERTY><PROPERTY NAME=\"What\" TYPE=\"string\"/></CLASS>");
    EXPECT_EQ(
        "doc.xml:4:195: found a second instance root/cimv2:Event.When=\"20240229120000.000000+060\" with \"b\" in property"
        " \"What\", but the one at doc.xml:3:195 has \"a\"; remove one of the two",
        loading.ErrorOf(TLoading::Group(cls + event("20240229110000.000000+000", "a") + event("20240229120000.000000+060", "b"))));
}

}  // namespace
}  // namespace NORVZEL20
