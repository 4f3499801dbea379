#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <stdexcept>
#include <string>

#include "embedded/cimxml/TCimXmlPopulator.h"
#include "embedded/services/TCoreLog.h"
#include "embedded/value/TEmbeddedObject.h"
#include "host/TNamespacePopulator.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

const std::string kPropertyS = "<PROPERTY NAME=\"S\" TYPE=\"string\"><VALUE>default</VALUE></PROPERTY>";
const std::string kReferenceR = "<PROPERTY.REFERENCE NAME=\"R\" REFERENCECLASS=\"A\"/>";

std::string Reference(const std::string& path)
{
    return "<PROPERTY.REFERENCE NAME=\"R\"><VALUE.REFERENCE>" + path + "</VALUE.REFERENCE></PROPERTY.REFERENCE>";
}

std::string InstanceName(const std::string& className, const std::string& id)
{
    return "<INSTANCENAME CLASSNAME=\"" + className + "\"><KEYBINDING NAME=\"Id\"><KEYVALUE>" + id +
           "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

std::string LocalNamespace(const std::string& first, const std::string& second)
{
    return "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + first + "\"/><NAMESPACE NAME=\"" + second + "\"/></LOCALNAMESPACEPATH>";
}

class PopulatorTest : public testing::Test {
  protected:
    TLoading fLoading;
};

TEST_F(PopulatorTest, APropertyThatIsNotMentionedIsNullWhateverItsDefault)
{
    fLoading.Load(L::Group(L::Class("A", kPropertyS) + L::Instance("A", "1")));
    EXPECT_EQ("NULL", fLoading.ValueOf("A.Id=\"1\"", "S"));
}

TEST_F(PopulatorTest, NullEmptyTextEmptyArrayAndBlanksDiffer)
{
    const std::string array = "<PROPERTY.ARRAY NAME=\"T\" TYPE=\"string\"/>";
    fLoading.Load(L::Group(
        L::Class("A", kPropertyS + array) + L::Instance("A", "null") + L::Instance("A", "empty", L::Property("S", "string", "")) +
        L::Instance("A", "blanks", L::Property("S", "string", "  x ")) +
        L::Instance("A", "array", "<PROPERTY.ARRAY NAME=\"T\" TYPE=\"string\"><VALUE.ARRAY/></PROPERTY.ARRAY>")));
    EXPECT_EQ("NULL", fLoading.ValueOf("A.Id=\"null\"", "S"));
    EXPECT_EQ("", fLoading.ValueOf("A.Id=\"empty\"", "S"));
    EXPECT_EQ("  x ", fLoading.ValueOf("A.Id=\"blanks\"", "S"));
    EXPECT_EQ("{}", fLoading.ValueOf("A.Id=\"array\"", "T"));
    EXPECT_EQ("NULL", fLoading.ValueOf("A.Id=\"null\"", "T"));
}

TEST_F(PopulatorTest, ReferencesIntoTheOwnNamespaceAreStoredWithoutIt)
{
    const struct {
        const char* id;
        std::string path;
        const char* stored;
    } rows[] = {
        {"plain", InstanceName("A", "x"), "A.Id=\"x\""},
        {"own", "<LOCALINSTANCEPATH>" + LocalNamespace("ROOT", "here") + InstanceName("A", "x") + "</LOCALINSTANCEPATH>",
         "A.Id=\"x\""},
        {"own host",
         "<INSTANCEPATH><NAMESPACEPATH><HOST>h</HOST>" + LocalNamespace("root", "here") + "</NAMESPACEPATH>" +
             InstanceName("A", "x") + "</INSTANCEPATH>",
         "A.Id=\"x\""},
        {"other", "<LOCALINSTANCEPATH>" + LocalNamespace("root", "there") + InstanceName("A", "x") + "</LOCALINSTANCEPATH>",
         "root/there:A.Id=\"x\""},
        {"other host",
         "<INSTANCEPATH><NAMESPACEPATH><HOST>g</HOST>" + LocalNamespace("root", "here") + "</NAMESPACEPATH>" +
             InstanceName("A", "x") + "</INSTANCEPATH>",
         "//g/root/here:A.Id=\"x\""},
        {"class", "<CLASSNAME NAME=\"Unknown\"/>", "Unknown"},
        {"spelling", "<INSTANCENAME CLASSNAME=\"a\"><KEYBINDING NAME=\"ID\"><KEYVALUE>x</KEYVALUE></KEYBINDING></INSTANCENAME>",
         "A.Id=\"x\""},
        {"only key", "<INSTANCENAME CLASSNAME=\"A\"><KEYVALUE>x</KEYVALUE></INSTANCENAME>", "A.Id=\"x\""},
    };
    std::string contents =
        "<NAMESPACEPATH><HOST>h</HOST>" + LocalNamespace("root", "here") + "</NAMESPACEPATH>" + L::Class("A", kReferenceR);
    for (const auto& row : rows) {
        contents += L::Instance("A", row.id, Reference(row.path));
    }
    const TLoadReport report = fLoading.Load(L::Group(contents));
    EXPECT_EQ("root/here", report.namespaceName);
    EXPECT_EQ("h", report.host);
    for (const auto& row : rows) {
        EXPECT_EQ(row.stored, fLoading.ValueOf("A.Id=\"" + std::string(row.id) + "\"", "R")) << row.id;
    }
}

TEST_F(PopulatorTest, TheOwnNamespaceIsKnownInAnyLetterCaseAndWithSlashes)
{
    const auto pathIn = [](const std::string& place) {
        return Reference("<INSTANCEPATH><NAMESPACEPATH><HOST>H</HOST>" + place + "</NAMESPACEPATH>" + InstanceName("A", "x") +
                         "</INSTANCEPATH>");
    };
    fLoading.Load(L::Group("<NAMESPACEPATH><HOST>h</HOST>" + LocalNamespace("/root", "here") + "</NAMESPACEPATH>" +
                           L::Class("A", kReferenceR) + L::Instance("A", "letter case", pathIn(LocalNamespace("Root", "HERE"))) +
                           L::Instance("A", "slashes", pathIn(LocalNamespace("/root/", "/here/"))) +
                           L::Instance("A", "one element", pathIn(LocalNamespace("/", "/root/here"))) +
                           L::Instance("A", "other", pathIn(LocalNamespace("root", "here2")))));
    for (const char* const id : {"letter case", "slashes", "one element"}) {
        EXPECT_EQ("A.Id=\"x\"", fLoading.ValueOf("A.Id=\"" + std::string(id) + "\"", "R")) << id;
    }
    EXPECT_EQ("//H/root/here2:A.Id=\"x\"", fLoading.ValueOf("A.Id=\"other\"", "R"));
}

TEST_F(PopulatorTest, ReferencesWrittenAsTextAreStoredLikeAllOthers)
{
    const std::pair<const char*, const char*> rows[] = {
        {"A.Id=\"x\"", "A.Id=\"x\""},
        {"/ROOT/here:a.ID=\"x\"", "A.Id=\"x\""},
        {"//H/root/here:A.Id=\"x\"", "A.Id=\"x\""},
        {"root/there:A.Id=\"x\"", "root/there:A.Id=\"x\""},
        {"//g/root/here:A.Id=\"x\"", "//g/root/here:A.Id=\"x\""},
        {"root/here:LATE.id=\"x\"", "Late.Id=\"x\""},
        {"root/here:LINK.TO=\"/root/here:late.ID=\\\"x\\\"\"", "Link.To=\"Late.Id=\\\"x\\\"\""},
        {"root/here:Nobody.Id=1", "Nobody.Id=1"},
    };
    const std::string link = "<CLASS NAME=\"Link\"><PROPERTY.REFERENCE NAME=\"To\"><QUALIFIER NAME=\"Key\" TYPE=\"boolean\">"
                             "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY.REFERENCE></CLASS>";
    std::string contents =
        "<NAMESPACEPATH><HOST>h</HOST>" + LocalNamespace("root", "here") + "</NAMESPACEPATH>" + L::Class("A", kReferenceR) + link;
    for (std::size_t i = 0; i < std::size(rows); ++i) {
        const std::string text = rows[i].first;
        contents += L::Instance("A", "value" + std::to_string(i), L::Property("R", "string", text));
        contents += L::Instance("A", "key" + std::to_string(i),
                                Reference("<INSTANCENAME CLASSNAME=\"Link\"><KEYBINDING NAME=\"to\"><KEYVALUE>" + text +
                                          "</KEYVALUE></KEYBINDING></INSTANCENAME>"));
    }
    fLoading.Load(L::Group(contents + L::Class("Late")));
    for (std::size_t i = 0; i < std::size(rows); ++i) {
        EXPECT_EQ(rows[i].second, fLoading.ValueOf("A.Id=\"value" + std::to_string(i) + "\"", "R")) << rows[i].first;
        TCIMReference linked;
        linked.SetClassName("Link");
        linked.AddKeyValue("To", TCIMValue(TCIMReference::Parse(rows[i].second)));
        EXPECT_EQ(linked.GetPath(), fLoading.ValueOf("A.Id=\"key" + std::to_string(i) + "\"", "R")) << rows[i].first;
    }
}

TEST_F(PopulatorTest, WithoutANameTheNamespaceIsTheDefaultAndTheOnlyHostItsOwn)
{
    const TLoadReport report = fLoading.Load(
        L::Group(L::Class("A", kReferenceR) +
                 L::Instance("A", "1",
                             Reference("<INSTANCEPATH><NAMESPACEPATH><HOST>any</HOST>" + LocalNamespace("root", "cimv2") +
                                       "</NAMESPACEPATH>" + InstanceName("A", "x") + "</INSTANCEPATH>"))));
    EXPECT_EQ("root/cimv2", report.namespaceName);
    EXPECT_FALSE(report.namesNamespace);
    EXPECT_EQ("A.Id=\"x\"", fLoading.ValueOf("A.Id=\"1\"", "R"));
}

TEST_F(PopulatorTest, ClassesAndInstancesComeInAnyOrder)
{
    const TLoadReport report =
        fLoading.Load(L::Group(L::Instance("B", "1", L::Property("S", "string", "x") + Reference(InstanceName("C", "y"))) +
                               "<VALUE.OBJECT><CLASS NAME=\"B\" SUPERCLASS=\"A\">" + kReferenceR + "</CLASS></VALUE.OBJECT>\n" +
                               L::Instance("B", "2") + L::Class("A", kPropertyS) + L::Class("C")));
    EXPECT_EQ(3u, report.classes);
    EXPECT_EQ("root/cimv2:B.Id=\"1\"\nroot/cimv2:B.Id=\"2\"\n", fLoading.PathsOf("B"));
    EXPECT_EQ("x", fLoading.ValueOf("B.Id=\"1\"", "S"));
    const TCIMReference path = fLoading.Find("B.Id=\"1\"")->GetProperty("R", TCallContext())->GetValue(TCallContext());
    EXPECT_EQ(fLoading.GetNamespace()->GetClass("C", TCallContext()), path.GetClass());
}

TEST_F(PopulatorTest, AReferenceToAClassDeclaredAfterItGetsThatClass)
{
    fLoading.Load(L::Group(L::Class("A", kReferenceR) + L::Instance("A", "1", Reference(InstanceName("C", "y"))) + L::Class("C")));
    const TCIMReference path = fLoading.Find("A.Id=\"1\"")->GetProperty("R", TCallContext())->GetValue(TCallContext());
    EXPECT_EQ(fLoading.GetNamespace()->GetClass("C", TCallContext()), path.GetClass());
}

TEST_F(PopulatorTest, NamesInAnotherLetterCaseAreTheSame)
{
    fLoading.Load(L::Group(L::Class("Abc", kPropertyS) + L::Instance("ABC", "1", L::Property("s", "string", "x"))));
    EXPECT_EQ("x", fLoading.ValueOf("Abc.Id=\"1\"", "S"));
}

TEST_F(PopulatorTest, KeysThatAnInstanceLeavesOutComeFromItsName)
{
    const TLoadReport report = fLoading.Load(L::Group(L::Class("A") + "<VALUE.NAMEDINSTANCE>" + InstanceName("A", "k") +
                                                      "<INSTANCE CLASSNAME=\"A\"/></VALUE.NAMEDINSTANCE>\n"));
    EXPECT_EQ("root/cimv2:A.Id=\"k\"\n", fLoading.PathsOf("A"));
    EXPECT_EQ("3: an instance of class \"A\" leaves out its key \"Id\"; taken from the name in front of it (1)\n",
              L::Tolerated(report));
}

TEST_F(PopulatorTest, AnotherTypeThatLosesNothingIsTolerated)
{
    const TLoadReport report = fLoading.Load(L::Group(L::Class("A", "<PROPERTY NAME=\"N\" TYPE=\"uint16\"/>") +
                                                      L::Instance("A", "1", L::Property("N", "uint32", "7")) +
                                                      L::Instance("A", "2", L::Property("N", "uint32", "8"))));
    EXPECT_EQ("7", fLoading.ValueOf("A.Id=\"1\"", "N"));
    EXPECT_THAT(L::Tolerated(report),
                testing::EndsWith("property \"N\" of class \"A\" is written as uint32; taken as the declared uint16 (2)\n"));
}

TEST_F(PopulatorTest, ARepeatedClassIsTolerated)
{
    const TLoadReport report = fLoading.Load(L::Group(L::Class("A") + L::Class("A")));
    EXPECT_EQ(1u, report.classes);
    EXPECT_THAT(L::Tolerated(report), testing::StartsWith("3: class \"A\" is declared again; the first declaration stands (1)\n"));
}

TEST_F(PopulatorTest, AClassThatIsThereAlreadyIsToleratedIfItIsTheSame)
{
    fLoading.Load(L::Group(L::Class("A", kPropertyS)));
    const TLoadReport report = fLoading.Load(L::Group(L::Class("A", kPropertyS) + L::Instance("A", "1")));
    EXPECT_EQ("2: class \"A\" is in the namespace already, declared the same (1)\n", L::Tolerated(report));
    EXPECT_EQ("doc.xml:2:15: found class \"A\", which the namespace declares differently; load into an empty namespace",
              fLoading.ErrorOf(L::Group(L::Class("A"))));
}

TEST_F(PopulatorTest, WhatASuperclassHasIsInheritedIfADocumentRepeatsIt)
{
    const std::string repeating =
        "<VALUE.OBJECT><CLASS NAME=\"B\" SUPERCLASS=\"A\"><PROPERTY NAME=\"S\" TYPE=\"string\" PROPAGATED=\"true\"/>"
        "</CLASS></VALUE.OBJECT>\n";
    fLoading.Load(L::Group(L::Class("A", kPropertyS) + repeating));
    EXPECT_TRUE(fLoading.GetNamespace()->FindClass("B")->GetLayout().GetOwnDecls().empty());
    EXPECT_EQ("", fLoading.ErrorOf(L::Group(repeating)));
}

TEST_F(PopulatorTest, EmbeddedObjectsAreReadByTheirMarkOrTheirDeclaration)
{
    const std::string declared = "<PROPERTY NAME=\"E\" TYPE=\"string\"><QUALIFIER NAME=\"EmbeddedInstance\" TYPE=\"string\">"
                                 "<VALUE>X</VALUE></QUALIFIER></PROPERTY>";
    const std::string text = "&lt;INSTANCE CLASSNAME=&quot;X&quot;&gt;&lt;/INSTANCE&gt;";
    fLoading.Load(L::Group(
        L::Class("A", declared + kPropertyS) + L::Instance("A", "declared", L::Property("E", "string", text)) +
        L::Instance("A", "marked",
                    "<PROPERTY NAME=\"S\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>" + text + "</VALUE></PROPERTY>") +
        L::Instance("A", "plain", L::Property("S", "string", text) + L::Property("E", "string", "words"))));
    const auto valueOf = [&](const char* path, const char* name) {
        return fLoading.Find(path)->GetProperty(name, TCallContext())->GetValue(TCallContext());
    };
    EXPECT_EQ("X", valueOf("A.Id=\"declared\"", "E").GetEmbeddedObject()->GetClassName());
    EXPECT_EQ("X", valueOf("A.Id=\"marked\"", "S").GetEmbeddedObject()->GetClassName());
    EXPECT_FALSE(valueOf("A.Id=\"plain\"", "S").GetEmbeddedObject());
    EXPECT_EQ("words", valueOf("A.Id=\"plain\"", "E").GetString());
}

/// The text of embedded objects, one inside of the other.
std::string Nested(int levels)
{
    std::string text = "<INSTANCE CLASSNAME=\"X\"></INSTANCE>";
    for (int level = 0; level < levels; ++level) {
        std::string escaped;
        for (const char c : text) {
            escaped += c == '<' ? "&lt;" : c == '&' ? "&amp;" : std::string(1, c);
        }
        text = "<INSTANCE CLASSNAME=\"A\">" + (level + 1 == levels ? L::Property("Id", "string", "1") : std::string()) +
               "<PROPERTY NAME=\"S\" TYPE=\"string\" EmbeddedObject=\"object\"><VALUE>" + escaped +
               "</VALUE></PROPERTY></INSTANCE>";
    }
    return text;
}

TEST_F(PopulatorTest, EmbeddedObjectsDoNotNestForEver)
{
    EXPECT_EQ("", fLoading.ErrorOf(L::Group(L::Class("A", kPropertyS) + Nested(32))));
    EXPECT_THAT(TLoading().ErrorOf(L::Group(L::Class("A", kPropertyS) + Nested(33))),
                testing::EndsWith(": in an embedded object: embedded objects are nested too deeply"));
}

TEST_F(PopulatorTest, WhatHoldsNoObjectsIsReportedOnce)
{
    const TLoadReport report = fLoading.Load(
        "<CIM><MESSAGE><SIMPLERSP><IMETHODRESPONSE><IRETURNVALUE><INSTANCENAME CLASSNAME=\"A\"/>"
        "<INSTANCENAME CLASSNAME=\"A\"/><CLASS NAME=\"A\"/></IRETURNVALUE></IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>");
    EXPECT_EQ("1: <INSTANCENAME> holds no class or instance; left out (2)\n", L::Tolerated(report));
}

TEST_F(PopulatorTest, ASourceMayDeliverSingleBytes)
{
    const std::string document = L::Group(L::Class("A") + L::Instance("A", "\xC3\xBC"));
    std::size_t position = 0;
    const auto source = [&](char* buffer, std::size_t) -> std::size_t {
        if (position == document.size()) {
            return 0;
        }
        *buffer = document[position++];
        return 1;
    };
    TCimXmlPopulator(fLoading.GetNamespace()).LoadFromSource(source, "bytes");
    EXPECT_EQ("root/cimv2:A.Id=\"\xC3\xBC\"\n", fLoading.PathsOf("A"));
}

TEST_F(PopulatorTest, AnErrorOfTheSourcePassesAndNothingStays)
{
    const std::string document = L::Group(L::Class("A"));
    bool isFirst = true;
    const auto source = [&](char* buffer, std::size_t) -> std::size_t {
        if (!std::exchange(isFirst, false)) {
            throw std::runtime_error("disk on fire");
        }
        return document.copy(buffer, document.size() - 5);
    };
    TCimXmlPopulator populator(fLoading.GetNamespace());
    EXPECT_THROW(populator.LoadFromSource(source, "s"), std::runtime_error);
    EXPECT_TRUE(fLoading.GetNamespace()->GetClasses().empty());
}

TEST_F(PopulatorTest, AStaticValueIsAsItWasAfterAFailure)
{
    fLoading.Load(L::Group(L::Class("A", "<PROPERTY NAME=\"V\" TYPE=\"string\"><QUALIFIER NAME=\"Static\" TYPE=\"boolean\">"
                                         "<VALUE>TRUE</VALUE></QUALIFIER></PROPERTY>") +
                           L::Instance("A", "1", L::Property("V", "string", "old"))));
    EXPECT_NE("", fLoading.ErrorOf(L::Group(L::Instance("A", "2", L::Property("V", "string", "new")) + "<oops/>")));
    EXPECT_EQ("old", fLoading.ValueOf("A.Id=\"1\"", "V"));
    fLoading.Load(L::Group(L::Instance("A", "2", L::Property("V", "string", "new"))));
    EXPECT_EQ("new", fLoading.ValueOf("A.Id=\"1\"", "V"));
}

TEST_F(PopulatorTest, ElementsAreThoseOfTheLastLoadThatDidNotFail)
{
    TCimXmlPopulator populator(fLoading.GetNamespace());
    const auto load = [&populator](const std::string& text) { populator.LoadFromMemory(text.data(), text.size(), "doc.xml"); };
    const auto take = [&populator] {
        std::string names;
        for (const boost::shared_ptr<ICIMElement>& element : populator.TakeElements()) {
            const auto cls = boost::dynamic_pointer_cast<ICIMClass>(element);
            names += (cls ? cls->GetName(TCallContext()) : "instance") + " ";
        }
        return names;
    };
    load(L::Group(L::Class("Unkept")));
    EXPECT_EQ("", take());
    populator.KeepElements();
    load(L::Group(L::Class("One")));
    load(L::Group(L::Instance("Two", "1") + L::Class("Two") + L::Class("Three")));
    EXPECT_THROW(load(L::Group(L::Class("Four") + L::Instance("Nobody", "1"))), TPopulateError);
    EXPECT_EQ("Two Three instance ", take());
    EXPECT_EQ("", take());
}

TEST_F(PopulatorTest, TheDeltaSchemaLoadsWithGeneratedKeys)
{
    const auto elements =
        TNamespacePopulator::PopulateFromXMLFile(fLoading.GetNamespace(), CIMDELTA_DATA "/deltaclasses.properties.xml");
    ASSERT_EQ(3u, elements.size());
    const boost::shared_ptr<ICIMClass> cls = fLoading.GetNamespace()->GetClass("KALMO_Delta", TCallContext());
    cls->AllocateInstance(TCallContext())->AddToNamespace(TCallContext());
    cls->AllocateInstance(TCallContext())->AddToNamespace(TCallContext());
    EXPECT_EQ("root/cimv2:KALMO_Delta.DeltaID=1\nroot/cimv2:KALMO_Delta.DeltaID=2\n", fLoading.PathsOf("KALMO_Delta"));
    EXPECT_TRUE(fLoading.GetNamespace()->GetClass("KALMO_DeltaClassAssocToDelta", TCallContext())->IsAssociation(TCallContext()));
}

class TLastEntry : public ILogger {
  public:
    void Log(int level, const std::string& message) override { fText += std::to_string(level) + " " + message + "\n"; }
    std::string fText;
};

TEST_F(PopulatorTest, AFailureOfTheServiceIsLoggedOnce)
{
    TLastEntry log;
    ILogger* before = TCoreLog::Set(&log);
    EXPECT_THROW(TNamespacePopulator::PopulateFromXMLFile(fLoading.GetNamespace(), "/nowhere.xml"), TZELException);
    TCoreLog::Set(before);
    EXPECT_EQ("0 /nowhere.xml: cannot open the file: No such file or directory\n", log.fText);
}

}  // namespace
}  // namespace NORVZEL20
