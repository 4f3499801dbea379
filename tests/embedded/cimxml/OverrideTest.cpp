#include <gtest/gtest.h>

#include <string>
#include <vector>

#include "embedded/load/TStoredObjects.h"
#include "embedded/store/TInMemClass.h"
#include "tests/embedded/cimxml/TLoading.h"

namespace NORVZEL20 {
namespace {

std::string Qualifier(const std::string& name, const std::string& value, const std::string& attributes = std::string())
{
    const std::string type = value == "TRUE" ? "boolean" : "string";
    return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"" + type + "\" " + attributes + "><VALUE>" + value + "</VALUE></QUALIFIER>";
}

const char kPropagated[] = " PROPAGATED=\"true\"";

/// A superclass and a class below it. The class repeats elements of the superclass, marked as propagated, and the superclass comes
/// last, so the class waits for it.
class OverrideTest : public testing::Test {
  protected:
    /// What the class Sub declares itself, if it is declared with `elements` below Base.
    std::string OwnOf(const std::string& elements)
    {
        const std::string sub = "<VALUE.OBJECT><CLASS NAME=\"Sub\" SUPERCLASS=\"Base\">" + elements + "</CLASS></VALUE.OBJECT>";
        fLoading.Load(TLoading::Group(sub + Base()));
        return Describe(*fLoading.GetNamespace()->FindClass("Sub"));
    }

    struct TMarkedRow {
        std::string elements;
        const char* own;  ///< what the class then declares itself
    };

    void ExpectOwn(const std::vector<TMarkedRow>& rows)
    {
        for (const TMarkedRow& row : rows) {
            fLoading = TLoading();
            EXPECT_EQ(row.own, OwnOf(row.elements)) << row.elements;
        }
    }

    static std::string Base()
    {
        return "<VALUE.OBJECT><CLASS NAME=\"Base\">"
               "<PROPERTY NAME=\"Name\" TYPE=\"string\">" +
               Qualifier("Description", "the name") + Qualifier("Override", "Old", "TOSUBCLASS=\"false\"") +
               "<VALUE>none</VALUE></PROPERTY>"
               "<PROPERTY.ARRAY NAME=\"Tags\" TYPE=\"string\" ARRAYSIZE=\"4\"></PROPERTY.ARRAY>"
               "<PROPERTY.REFERENCE NAME=\"Of\" REFERENCECLASS=\"Any\"></PROPERTY.REFERENCE>"
               "<METHOD NAME=\"Stop\" TYPE=\"uint32\">" +
               Qualifier("Description", "stops") + "<PARAMETER NAME=\"How\" TYPE=\"uint16\">" + Qualifier("In", "TRUE") +
               "</PARAMETER></METHOD></CLASS></VALUE.OBJECT>";
    }

    /// The own elements of the class with their own qualifiers, an element a line.
    static std::string Describe(const TInMemClass& cls)
    {
        const TEmbeddedObject own = TStoredObjects::FromClass(cls);
        std::string text;
        for (const TEmbeddedObject::TProperty& property : own.GetProperties()) {
            text += property.name + " " + property.referenceClass + "[" + std::to_string(property.arraySize) +
                    "] = " + (property.value.IsNull() ? "NULL" : property.value.ToText()) + Describe(property.qualifiers) + "\n";
        }
        for (const TEmbeddedObject::TMethod& method : own.GetMethods()) {
            text += method.name + "(";
            for (const TEmbeddedObject::TParameter& parameter : method.parameters) {
                text += parameter.name + Describe(parameter.qualifiers);
            }
            text += ")" + Describe(method.qualifiers) + "\n";
        }
        return text;
    }

    static std::string Describe(const std::vector<TEmbeddedObject::TQualifier>& qualifiers)
    {
        std::string text;
        for (const TEmbeddedObject::TQualifier& qualifier : qualifiers) {
            text += " " + qualifier.name + "(" + qualifier.value.ToText() + ")";
        }
        return text;
    }

    static std::string Name(const std::string& contents)
    {
        return "<PROPERTY NAME=\"Name\" TYPE=\"string\" PROPAGATED=\"true\">" + contents + "</PROPERTY>";
    }
    static std::string Stop(const std::string& contents)
    {
        return "<METHOD NAME=\"Stop\" TYPE=\"uint32\" PROPAGATED=\"true\">" + contents + "</METHOD>";
    }
    static std::string How(const std::string& type, const std::string& contents)
    {
        return "<PARAMETER NAME=\"How\" TYPE=\"" + type + "\">" + contents + "</PARAMETER>";
    }

    TLoading fLoading;
};

TEST_F(OverrideTest, AKeyThatOnlyTheSubclassDeclaresIsItsKey)
{
    EXPECT_EQ("Name [0] = NULL Key(TRUE)\n", OwnOf(Name(Qualifier("Key", "TRUE"))));
    EXPECT_TRUE(fLoading.GetNamespace()->FindClass("Sub")->FindPropertyDecl("Name")->IsKey());
    EXPECT_FALSE(fLoading.GetNamespace()->FindClass("Base")->FindPropertyDecl("Name")->IsKey());
}

TEST_F(OverrideTest, AMarkedPropertyIsAnOverrideIfItSaysSomethingElse)
{
    ExpectOwn({
        {Name(""), ""},
        {Name("<VALUE>none</VALUE>"), ""},
        {Name("<VALUE>other</VALUE>"), "Name [0] = other\n"},
        {Name(Qualifier("Description", "the name")), ""},
        {Name(Qualifier("DESCRIPTION", "the name", kPropagated)), ""},
        {Name(Qualifier("Description", "another")), "Name [0] = NULL Description(another)\n"},
        {Name(Qualifier("Description", "another", kPropagated)), "Name [0] = NULL Description(another)\n"},
        {Name(Qualifier("Description", "the name", "TOSUBCLASS=\"false\"")), "Name [0] = NULL Description(the name)\n"},
        {Name(Qualifier("Description", "the name", std::string("TOSUBCLASS=\"false\"") + kPropagated)), ""},
        {Name(Qualifier("Override", "Old", kPropagated)), ""},
        {Name(Qualifier("Override", "Old", "TOSUBCLASS=\"false\"")), ""},
        {Name(Qualifier("MaxLen", "9") + Qualifier("Override", "Old", std::string("TOSUBCLASS=\"false\"") + kPropagated)),
         "Name [0] = NULL MaxLen(9) Override(Old)\n"},
        {Name(Qualifier("MaxLen", "9") + "<VALUE>none</VALUE>"), "Name [0] = none MaxLen(9)\n"},
        {Name(Qualifier("Override", "Name")), "Name [0] = NULL Override(Name)\n"},
        {Name(Qualifier("MaxLen", "9") + Qualifier("Description", "the name", kPropagated)), "Name [0] = NULL MaxLen(9)\n"},
        {"<PROPERTY NAME=\"New\" TYPE=\"string\" PROPAGATED=\"true\"></PROPERTY>", "New [0] = NULL\n"},
    });
}

TEST_F(OverrideTest, AMarkedArrayOrReferenceIsAnOverrideIfItSaysSomethingElse)
{
    const std::string array = "<PROPERTY.ARRAY NAME=\"Tags\" TYPE=\"string\" PROPAGATED=\"true\"";
    const std::string reference = "<PROPERTY.REFERENCE NAME=\"Of\" PROPAGATED=\"true\"";
    ExpectOwn({
        {array + "></PROPERTY.ARRAY>", ""},
        {array + " ARRAYSIZE=\"4\"></PROPERTY.ARRAY>", ""},
        {array + " ARRAYSIZE=\"5\"></PROPERTY.ARRAY>", "Tags [5] = NULL\n"},
        {array + ">" + Qualifier("Key", "TRUE") + "</PROPERTY.ARRAY>", "Tags [4] = NULL Key(TRUE)\n"},
        {reference + "></PROPERTY.REFERENCE>", ""},
        {reference + " REFERENCECLASS=\"ANY\"></PROPERTY.REFERENCE>", ""},
        {reference + " REFERENCECLASS=\"Disk\"></PROPERTY.REFERENCE>", "Of Disk[0] = NULL\n"},
        {reference + ">" + Qualifier("Key", "TRUE") + "</PROPERTY.REFERENCE>", "Of Any[0] = NULL Key(TRUE)\n"},
    });
}

TEST_F(OverrideTest, AMarkedMethodIsAnOverrideIfItSaysSomethingElse)
{
    ExpectOwn({
        {Stop(""), ""},
        {Stop(Qualifier("Description", "stops") + How("uint16", Qualifier("In", "TRUE"))), ""},
        {Stop(How("uint16", "")), ""},
        {Stop(How("uint32", "")), "Stop(How)\n"},
        {Stop(How("uint16", Qualifier("Out", "TRUE"))), "Stop(How Out(TRUE))\n"},
        {Stop(How("uint16", "") + How("uint16", "")), "Stop(HowHow)\n"},
        {Stop(Qualifier("Description", "halts")), "Stop(How In(TRUE)) Description(halts)\n"},
        {"<METHOD NAME=\"Stop\" TYPE=\"uint16\" PROPAGATED=\"true\"></METHOD>", "Stop(How In(TRUE))\n"},
    });
}

TEST_F(OverrideTest, InstancesOfTheSubclassAreKeptApartByTheKeyItDeclares)
{
    const auto instance = [](const std::string& name) {
        return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"Sub\">" + TLoading::Property("Name", "string", name) +
               "</INSTANCE></VALUE.OBJECT>";
    };
    OwnOf(Name(Qualifier("Key", "TRUE")));
    fLoading.Load(TLoading::Group(instance("one") + instance("two")));
    EXPECT_EQ("root/cimv2:Sub.Name=\"one\"\nroot/cimv2:Sub.Name=\"two\"\n", fLoading.PathsOf("Sub"));
}

/// A class that was declared before is compared with what the document says beyond the superclass.
TEST_F(OverrideTest, AKnownClassIsTheSameWithAndWithoutWhatItInherits)
{
    const std::string key = Name(Qualifier("Key", "TRUE"));
    OwnOf(key);
    const auto again = [](const std::string& elements) {
        return TLoading::Group("<VALUE.OBJECT><CLASS NAME=\"Sub\" SUPERCLASS=\"Base\">" + elements + "</CLASS></VALUE.OBJECT>");
    };
    const std::string array = "<PROPERTY.ARRAY NAME=\"Tags\" TYPE=\"string\" PROPAGATED=\"true\"></PROPERTY.ARRAY>";
    const std::string method = Stop(Qualifier("Description", "stops", kPropagated));
    EXPECT_EQ("", fLoading.ErrorOf(again(key + array + method)));
    EXPECT_EQ("doc.xml:2:15: found class \"Sub\", which the namespace declares differently; load into an empty namespace",
              fLoading.ErrorOf(again(array)));
    EXPECT_EQ("doc.xml:2:15: found class \"Sub\", which the namespace declares differently; load into an empty namespace",
              fLoading.ErrorOf(again(key + Stop(Qualifier("Description", "halts")))));
}

}  // namespace
}  // namespace NORVZEL20
