// What the parser notes while the plug-in reads. Documents are written as text here, and lines count from 1.

#include "client/rules/TRulesParser.h"

#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "client/rules/TLogCapture.h"
#include "embedded/store/TInMemNamespace.h"
#include "host/TZELException.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

const char* Verb(TCIMDiffEngine::propType treatment)
{
    return treatment == TCIMDiffEngine::INCLUDE ? "include" : "exclude";
}

std::string Dump(const TRulesDocument& document)
{
    std::string text;
    for (const TRulesDocument::TElement& element : document.elements) {
        text += std::to_string(element.line) + " " + element.className + " " + Verb(element.defaultTreatment);
        for (const std::string& key : element.excludedKeys) {
            text += " -" + key;
        }
        text += "\n";
        for (const TRulesDocument::TListed& listed : element.listed) {
            text += "  " + std::to_string(listed.line) + " " + Verb(listed.treatment) + " " + listed.property + "\n";
        }
    }
    return text;
}

/// Reads documents against two classes: A (p, q) and B (r).
class RulesParserTest : public ::testing::Test {
  protected:
    RulesParserTest()
    {
        Declare("A", {"p", "q"});
        Declare("B", {"r"});
    }

    /// What the parser notes of a document that it accepts.
    std::string Noted(std::string document) const
    {
        TRulesParser parser(fSchema);
        parser.Parse(document.data(), document.size());
        return Dump(parser.GetDocument());
    }

    /// The fault of a document that it refuses.
    static std::string Fault(const boost::shared_ptr<ICIMNamespace>& schema, std::string document)
    {
        const TLogCapture log;
        TRulesParser parser(schema);
        try {
            parser.Parse(document.data(), document.size());
        } catch (const TZELException&) {
            return parser.GetFault().Describe("R");
        }
        return "accepted";
    }

    boost::shared_ptr<TInMemNamespace> fSchema = TInMemNamespace::Create("root/cimv2");

  private:
    void Declare(const char* name, const std::vector<const char*>& properties)
    {
        const boost::shared_ptr<TInMemClass> cls = fSchema->AllocateInMemClass(name, nullptr);
        cls->AddToNamespace(TCallContext());
        for (const char* property : properties) {
            cls->AddPropertyDecl(cls->AllocatePropertyDecl(property, TCIMValue(""), TCallContext()));
        }
    }
};

TEST_F(RulesParserTest, ElementsAreNotedWithTheirLines)
{
    EXPECT_EQ("2 A include -p -q\n"
              "  4 include p\n"
              "  4 include q\n"
              "  5 exclude p\n"
              "6 B exclude\n",
              Noted("<DifftoolSpec>\n<class name='A' default='include' excludekeys=' p\tq '>\n<includelist>\n"
                    "<value>p</value><value>q</value></includelist>\n<excludelist><value>p</value></excludelist></class>\n"
                    "<class name='B'/></DifftoolSpec>"));
}

TEST_F(RulesParserTest, ElementsOfOneLineStayApart)
{
    EXPECT_EQ("1 A include\n"
              "1 B exclude\n"
              "  1 include r\n"
              "1 A exclude\n",
              Noted("<DifftoolSpec><class name='A' default='include'/><class name='B'><includelist><value>r</value></includelist>"
                    "</class><class name='A'/></DifftoolSpec>"));
}

TEST_F(RulesParserTest, ElementsInAValueAreNone)
{
    const struct {
        const char* value;
        const char* noted;
    } rows[] = {
        {"p<b/>", "1 A exclude\n  1 include p\n"},
        {"p<b/>q", "1 A exclude\n  1 include p\n"},
        {"<b>p</b>", "1 A exclude\n  1 include p\n"},
        {"p<value/>", "1 A exclude\n  1 include p\n"},
        {"p<excludelist/>", "1 A exclude\n  1 include p\n"},
        {"p<class name='B' default='include'/>", "1 A exclude\n  1 include p\n"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.noted, Noted(std::string("<DifftoolSpec><class name='A'><includelist><value>") + row.value +
                                   "</value></includelist></class></DifftoolSpec>"))
            << row.value;
    }
}

/// The end tag of the inner element ends the value, so each further one ends more than it says.
TEST_F(RulesParserTest, WhatFollowsAnElementInAValueIsOneLevelHigher)
{
    EXPECT_EQ("1 A exclude\n"
              "  1 include p\n"
              "1 B exclude\n",
              Noted("<DifftoolSpec><class name='A'><includelist><value>p<b/></value></includelist><class name='B'/></class>"
                    "</DifftoolSpec>"));
    EXPECT_EQ("R:1: element value is not expected here; a file is DifftoolSpec > class > includelist or excludelist > value",
              Fault(fSchema, "<DifftoolSpec><class name='A'><includelist><value>p<b/></value><value>q</value></includelist></class>"
                             "</DifftoolSpec>"));
}

TEST_F(RulesParserTest, AFaultNamesTheClassThatItIsIn)
{
    const struct {
        const char* rules;
        const char* fault;
    } rows[] = {
        {"<class name='A'><includelist><value>x</value></includelist></class><class name='B'/>",
         "R:1: class A has no property \"x\"; the name counts as it stands between the tags, blanks included"},
        {"<class name='A'/><class name='%t'/>",
         "R:1: class %t is not declared in the reference; correct the name or remove the element"},
        {"<class name='A'><includelist><value>%c</value></includelist></class>",
         "R:1: class A has no property \"%c\"; the name counts as it stands between the tags, blanks included"},
    };
    for (const auto& row : rows) {
        EXPECT_EQ(row.fault, Fault(fSchema, std::string("<DifftoolSpec>") + row.rules + "</DifftoolSpec>")) << row.rules;
    }
}

TEST_F(RulesParserTest, OfSeveralFaultyAttributesThePlugInsFirstIsNamed)
{
    EXPECT_EQ("R:1: default \"x\" is neither \"include\" nor \"exclude\"; letter case counts",
              Fault(fSchema, "<DifftoolSpec><class name='A' zoo='' default='x'/></DifftoolSpec>"));
    EXPECT_EQ("R:1: element class has an unknown attribute Zoo; its attributes are name, default and excludekeys",
              Fault(fSchema, "<DifftoolSpec><class name='' Zoo='' default='x'/></DifftoolSpec>"));
    EXPECT_EQ("R:1: element DifftoolSpec has an unknown attribute Zoo; its only attribute is version, at most \"1.0\"",
              Fault(fSchema, "<DifftoolSpec version='1.0' Zoo=''/>"));
}

TEST_F(RulesParserTest, ASchemaThatFailsIsNoFaultOfTheFile)
{
    const struct {
        const char* call;
        TZELStatusCode::EStatusCode status;
    } rows[] = {
        {"ns.GetClass", TZELStatusCode::kNamespaceGone},
        {"ns.GetClass", TZELStatusCode::kParseError},
        {"ns:A.GetPropertyDecl", TZELStatusCode::kParseError},
        {"ns:A.EnumerateSubClasses", TZELStatusCode::kParseError},
    };
    for (const auto& row : rows) {
        const auto watch = boost::make_shared<TCallWatch>();
        watch->FailCallsOf(row.call, row.status);
        EXPECT_EQ(std::string("R: cannot be used as rules: ") + TZELException(row.status).what(),
                  Fault(boost::make_shared<TWatchedNamespace>(fSchema, watch, "ns"),
                        "<DifftoolSpec><class name='A'><includelist><value>p</value></includelist></class></DifftoolSpec>"))
            << row.call;
    }
}

}  // namespace
}  // namespace NORVZEL20
