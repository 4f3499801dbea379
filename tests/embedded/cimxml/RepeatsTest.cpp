// Classes and instances that a load has twice, and names that contradict their instances.
#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "embedded/cimxml/TCimXmlDocuments.h"
#include "embedded/load/TLoadSession.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

using L = TLoading;

/// Loads documents a.xml, b.xml ... as one load.
class RepeatsTest : public testing::Test {
  protected:
    /// Counts and tolerated lines, or the message.
    std::string Outcome(const std::vector<std::string>& documents)
    {
        fNamespace = TInMemNamespace::Create("root/cimv2");
        try {
            TLoadSession session(fNamespace, "");
            session.KeepElements();
            TCimXmlDocuments reader(session);
            char name = 'a';
            for (const std::string& document : documents) {
                reader.ReadMemory(document.data(), document.size(), std::string(1, name++) + ".xml");
            }
            const TLoadReport report = session.Commit();
            EXPECT_EQ(report.classes + report.instances, session.TakeElements().size());
            return std::to_string(report.classes) + " classes, " + std::to_string(report.instances) + " instances\n" +
                   L::Tolerated(report);
        } catch (const TPopulateError& error) {
            EXPECT_TRUE(fNamespace->GetClasses().empty());
            return error.what();
        }
    }

    static std::string Sub(const std::string& elements)
    {
        return "<CLASS NAME=\"Sub\" SUPERCLASS=\"Disk\">" + elements + "</CLASS>\n";
    }
    static std::string Disk(const std::string& id, const std::string& size)
    {
        return L::Instance("Disk", id, L::Property("Size", "uint64", size));
    }
    /// An instance with a name in front of it.
    static std::string Named(const std::string& keyValue, const std::string& property)
    {
        return "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"Port\"><KEYBINDING NAME=\"Key\">" + keyValue +
               "</KEYBINDING></INSTANCENAME><INSTANCE CLASSNAME=\"Port\">" + property + "</INSTANCE></VALUE.NAMEDINSTANCE>\n";
    }
    static std::string Port(const std::string& property) { return "<CLASS NAME=\"Port\">" + property + "</CLASS>\n"; }

    /// A class whose key is of this type, and an instance of it with a name in front.
    struct TNamedKey {
        std::string type;
        std::string name;      ///< the key in the name
        std::string property;  ///< the key in the instance
        const char* message;   ///< what is wrong, or empty
    };

    void ExpectKeys(const std::vector<TNamedKey>& rows)
    {
        for (const TNamedKey& row : rows) {
            const std::string declared = row.type == "reference"
                                             ? "<PROPERTY.REFERENCE NAME=\"Key\">" + fKey + "</PROPERTY.REFERENCE>"
                                             : "<PROPERTY NAME=\"Key\" TYPE=\"" + row.type + "\">" + fKey + "</PROPERTY>";
            const std::string named = Named(row.name, row.property);
            for (const std::string& document : {Port(declared) + named, named + Port(declared)}) {
                const std::string outcome = Outcome({document});
                const std::size_t found = outcome.find("found ");
                EXPECT_EQ(row.message, found == std::string::npos ? "" : outcome.substr(found)) << row.name << row.property;
            }
        }
    }

    const std::string fDisk = L::Class("Disk", "<PROPERTY NAME=\"Size\" TYPE=\"uint64\"/>");
    const std::string fKey = "<QUALIFIER NAME=\"Key\" TYPE=\"boolean\" OVERRIDABLE=\"false\"><VALUE>TRUE</VALUE></QUALIFIER>";
    boost::shared_ptr<TInMemNamespace> fNamespace;
};

TEST_F(RepeatsTest, TheSameInstanceInTwoDocumentsIsOne)
{
    EXPECT_EQ("1 classes, 3 instances\n"
              "2: instance root/cimv2:Disk.Id=\"a\" is there again with the same values; taken as one (2)\n",
              Outcome({fDisk + Disk("a", "1") + Disk("b", "2"), "\n" + Disk("a", "1") + Disk("c", "3"), Disk("a", "1")}));
}

TEST_F(RepeatsTest, TheSameInstanceBeforeItsClassIsOneToo)
{
    EXPECT_EQ("1 classes, 1 instances\n"
              "1: instance root/cimv2:Disk.Id=\"a\" is there again with the same values; taken as one (1)\n",
              Outcome({Disk("a", "1"), Disk("a", "1"), fDisk}));
}

TEST_F(RepeatsTest, AnotherValueIsAnErrorThatNamesBothPlaces)
{
    EXPECT_EQ("b.xml:3:166: found a second instance root/cimv2:Disk.Id=\"a\" with \"2\" in property \"Size\", but the one at"
              " a.xml:2:166 has \"1\"; remove one of the two",
              Outcome({fDisk + Disk("a", "1"), "\n" + Disk("b", "2") + Disk("a", "2")}));
    EXPECT_EQ("c.xml:1:166: found a second instance root/cimv2:Disk.Id=\"a\" with \"2\" in property \"Size\", but the one at"
              " b.xml:1:166 has \"1\"; remove one of the two",
              Outcome({fDisk + Disk("0", "1"), Disk("a", "1"), Disk("a", "2")}));
}

/// An answer with a list of properties leaves some out. They are NULL in it, which is another value.
TEST_F(RepeatsTest, AnInstanceWithFewerPropertiesIsAnotherOne)
{
    EXPECT_EQ("b.xml:1:103: found a second instance root/cimv2:Disk.Id=\"a\" with NULL in property \"Size\", but the one at"
              " a.xml:2:166 has \"1\"; remove one of the two",
              Outcome({fDisk + Disk("a", "1"), L::Instance("Disk", "a")}));
}

TEST_F(RepeatsTest, WhatTheNamespaceHadBeforeIsNoRepetition)
{
    TLoading loading;
    loading.Load(L::Group(fDisk + Disk("a", "1")));
    EXPECT_EQ("doc.xml:2:166: found a second instance root/cimv2:Disk.Id=\"a\"; instances of class \"Disk\" must differ in their"
              " keys",
              loading.ErrorOf(L::Group(Disk("a", "1"))));
    EXPECT_EQ("doc.xml:3:166: found a second instance root/cimv2:Disk.Id=\"b\" with \"2\" in property \"Size\", but the one at"
              " doc.xml:2:166 has \"1\"; remove one of the two",
              loading.ErrorOf(L::Group(Disk("b", "1") + Disk("b", "2"))));
}

TEST_F(RepeatsTest, TheFirstPlaceIsFoundBehindInstancesThatAreGone)
{
    TLoading loading;
    loading.Load(L::Group(fDisk + Disk("a", "1") + Disk("b", "1") + Disk("c", "1")));
    loading.GetNamespace()->DeleteInstance(TCIMReference::Parse("Disk.Id=\"b\""), TCallContext());
    EXPECT_EQ("doc.xml:4:166: found a second instance root/cimv2:Disk.Id=\"b\" with \"3\" in property \"Size\", but the one at"
              " doc.xml:3:166 has \"2\"; remove one of the two",
              loading.ErrorOf(L::Group(Disk("d", "2") + Disk("b", "2") + Disk("b", "3"))));
    EXPECT_EQ("doc.xml:3:166: found a second instance root/cimv2:Disk.Id=\"c\"; instances of class \"Disk\" must differ in their"
              " keys",
              loading.ErrorOf(L::Group(Disk("b", "2") + Disk("c", "1"))));
}

/// A server may be asked for what a class declares, or for all that it has. Which answer comes first does not matter.
TEST_F(RepeatsTest, AClassIsTheSameWithAndWithoutWhatItInherits)
{
    const std::string own = "<PROPERTY NAME=\"Speed\" TYPE=\"uint32\"/>";
    const std::string inherited = "<PROPERTY NAME=\"Id\" TYPE=\"string\" PROPAGATED=\"true\">" + fKey +
                                  "</PROPERTY><PROPERTY NAME=\"Size\" TYPE=\"uint64\" PROPAGATED=\"true\"/>";
    const std::string tolerated = "2 classes, 0 instances\n"
                                  "1: class \"Sub\" is declared again; the first declaration stands (1)\n";
    EXPECT_EQ(tolerated, Outcome({fDisk, Sub(own), Sub(inherited + own)}));
    EXPECT_EQ(tolerated, Outcome({fDisk, Sub(inherited + own), Sub(own)}));
    EXPECT_EQ(tolerated, Outcome({Sub(inherited + own), Sub(own), fDisk}));
    EXPECT_EQ("c.xml:1:1: found class \"Sub\" a second time, declared differently at b.xml:1:1; remove one of the two",
              Outcome({fDisk, Sub(own), Sub(inherited)}));
    EXPECT_EQ("c.xml:1:1: found class \"Sub\" a second time, declared differently at b.xml:1:1; remove one of the two",
              Outcome({fDisk, Sub(own),
                       Sub("<PROPERTY NAME=\"Size\" TYPE=\"uint64\" PROPAGATED=\"true\"><VALUE>5</VALUE></PROPERTY>" + own)}));
}

TEST_F(RepeatsTest, ANameOfAnotherClassIsRefused)
{
    const std::string document = fDisk + "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"Device\"/>" +
                                 "<INSTANCE CLASSNAME=\"Disk\">" + L::Property("Id", "string", "a") +
                                 "</INSTANCE></VALUE.NAMEDINSTANCE>";
    EXPECT_EQ("a.xml:2:56: found class \"Disk\" behind the name of \"Device\", expected the same class in both",
              Outcome({document}));
    EXPECT_EQ("a.xml:1:82: found class \"B\" behind the name of \"A\", expected the same class in both",
              Outcome({"<VALUE.OBJECTWITHLOCALPATH><LOCALCLASSPATH><CLASSNAME NAME=\"A\"/></LOCALCLASSPATH><CLASS NAME=\"B\"/>"
                       "</VALUE.OBJECTWITHLOCALPATH>"}));
}

TEST_F(RepeatsTest, AKeyInTheNameThatContradictsTheInstanceIsRefused)
{
    const auto number = [](const std::string& text) { return "<KEYVALUE VALUETYPE=\"numeric\">" + text + "</KEYVALUE>"; };
    const auto text = [](const std::string& value) { return "<KEYVALUE VALUETYPE=\"string\">" + value + "</KEYVALUE>"; };
    const auto property = [](const std::string& type, const std::string& value) { return L::Property("Key", type, value); };
    ExpectKeys({
        {"string", text("a"), property("string", "a"), ""},
        {"string", text("a"), property("string", "A"),
         "found \"A\" in the key \"Key\" of an instance of class \"Port\", but the name"
         " in front of it says \"a\"; correct one of the two"},
        {"string", text("a"), property("string", "a "),
         "found \"a \" in the key \"Key\" of an instance of class \"Port\", but the"
         " name in front of it says \"a\"; correct one of the two"},
        {"string", text("a"), "", ""},
        {"uint16", number("5"), property("uint16", "5"), ""},
        {"uint16", number("0x5"), property("uint16", "5"), ""},
        {"uint16", text("5"), property("uint16", "5"), ""},
        {"uint16", number("6"), property("uint16", "5"),
         "found \"5\" in the key \"Key\" of an instance of class \"Port\", but the"
         " name in front of it says \"6\"; correct one of the two"},
        {"datetime", text("20240229110000.000000+000"), property("datetime", "20240229120000.000000+060"), ""},
        {"boolean", "<KEYVALUE VALUETYPE=\"boolean\">TRUE</KEYVALUE>", property("boolean", "true"), ""},
    });
}

TEST_F(RepeatsTest, AReferenceInTheNameThatContradictsTheInstanceIsRefused)
{
    const auto path = [](const std::string& place, const std::string& id) {
        const std::string name =
            "<INSTANCENAME CLASSNAME=\"Disk\"><KEYBINDING NAME=\"Id\"><KEYVALUE>" + id + "</KEYVALUE></KEYBINDING></INSTANCENAME>";
        const std::string local =
            "<LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"" + place + "\"/></LOCALNAMESPACEPATH>";
        return "<VALUE.REFERENCE>" + (place.empty() ? name : "<LOCALINSTANCEPATH>" + local + name + "</LOCALINSTANCEPATH>") +
               "</VALUE.REFERENCE>";
    };
    const auto reference = [](const std::string& value) {
        return "<PROPERTY.REFERENCE NAME=\"Key\">" + value + "</PROPERTY.REFERENCE>";
    };
    ExpectKeys({
        {"reference", path("", "a"), reference(path("", "a")), ""},
        {"reference", path("here", "a"), reference(path("", "a")), ""},
        {"reference", path("here", "a"), reference(path("there", "a")), ""},
        {"reference", path("", "a"), reference(path("", "b")),
         "found \"Disk.Id=\"b\"\" in the key \"Key\" of an instance of class \"Port\", but the name in front of it says"
         " \"Disk.Id=\"a\"\"; correct one of the two"},
    });
}

/// The names of the keys in the name, and what is wrong.
TEST_F(RepeatsTest, ANameWithOtherKeysThanItsClassIsRefused)
{
    const std::string behind = " in the name in front of an instance of class \"Port\"";
    const struct {
        std::vector<std::string> names;
        std::string message;
    } rows[] = {
        {{"A", "b"}, ""},
        {{"B", "A"}, ""},
        {{}, ""},
        {{"A"}, "found no value for the key \"B\"" + behind + "; give it there too, or leave the name out"},
        {{"A", "B", "Bogus"},
         "found the key \"Bogus\"" + behind + ", which has no such key; remove it there, or correct the declaration"},
        {{"A", "B", "Plain"},
         "found the key \"Plain\"" + behind + ", which has no such key; remove it there, or correct the declaration"},
    };
    const auto property = [this](const std::string& name, bool isKey) {
        return "<PROPERTY NAME=\"" + name + "\" TYPE=\"string\">" + (isKey ? fKey : "") + "</PROPERTY>";
    };
    for (const auto& row : rows) {
        std::string bindings;
        for (const std::string& name : row.names) {
            bindings += "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE>1</KEYVALUE></KEYBINDING>";
        }
        const std::string named = "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"Port\">" + bindings +
                                  "</INSTANCENAME><INSTANCE CLASSNAME=\"Port\">" + L::Property("A", "string", "1") +
                                  L::Property("B", "string", "1") + L::Property("Plain", "string", "1") +
                                  "</INSTANCE></VALUE.NAMEDINSTANCE>\n";
        for (const bool hasKeys : {true, false}) {
            const std::string cls = Port(property("A", hasKeys) + property("B", hasKeys) + property("Plain", false));
            for (const std::string& document : {cls + named, named + cls}) {
                const std::string outcome = Outcome({document});
                const std::size_t found = outcome.find("found ");
                EXPECT_EQ(hasKeys ? row.message : "", found == std::string::npos ? "" : outcome.substr(found)) << document;
            }
        }
    }
}

/// The key may be left unnamed if there is only one.
TEST_F(RepeatsTest, AKeyWithoutANameIsTheOnlyOne)
{
    const auto document = [this](const std::string& value) {
        return fDisk + "<VALUE.NAMEDINSTANCE><INSTANCENAME CLASSNAME=\"Disk\"><KEYVALUE>" + value +
               "</KEYVALUE></INSTANCENAME><INSTANCE CLASSNAME=\"Disk\">" + L::Property("Id", "string", "a") +
               "</INSTANCE></VALUE.NAMEDINSTANCE>";
    };
    EXPECT_EQ(0U, Outcome({document("a")}).find("1 classes, 1 instances\n"));
    EXPECT_NE(std::string::npos, Outcome({document("b")}).find("found \"a\" in the key \"Id\""));
}

TEST_F(RepeatsTest, AnotherNamespaceOrHostInAnotherDocumentNamesBothPlaces)
{
    const auto named = [](const std::string& host, const std::string& ns) {
        return "<NAMESPACEPATH><HOST>" + host + "</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME=\"" + ns +
               "\"/></LOCALNAMESPACEPATH></NAMESPACEPATH>";
    };
    const auto document = [&](const std::string& host, const std::string& ns) {
        return "<CIM><DECLARATION><DECLGROUP.WITHPATH><VALUE.OBJECTWITHPATH><INSTANCEPATH>" + named(host, ns) +
               "<INSTANCENAME CLASSNAME=\"Disk\"/></INSTANCEPATH><INSTANCE CLASSNAME=\"Disk\">" + L::Property("Id", "string", ns) +
               "</INSTANCE></VALUE.OBJECTWITHPATH></DECLGROUP.WITHPATH></DECLARATION></CIM>";
    };
    const auto expect = [](const std::string& what, const std::string& found) {
        EXPECT_NE(std::string::npos, found.find("c.xml:1:")) << found;
        EXPECT_NE(std::string::npos,
                  found.find("found " + what + "2\", but \"" + what.substr(what.find('"') + 1) + "1\" at b.xml:1:"))
            << found;
        EXPECT_NE(std::string::npos, found.find("; an inventory holds one " + what.substr(0, what.find(' ')) +
                                                ", so load the two documents as two inventories"))
            << found;
    };
    expect("namespace \"n", Outcome({fDisk, document("h1", "n1"), document("h1", "n2")}));
    expect("host \"h", Outcome({fDisk, document("h1", "n1"), document("h2", "n1")}));
}

}  // namespace
}  // namespace NORVZEL20
