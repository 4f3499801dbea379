#include <boost/smart_ptr/make_shared.hpp>
#include <stdexcept>
#include <typeinfo>

#include "embedded/services/TAssertionFailure.h"
#include "host/TZELException.h"
#include "spec/TDiffXMLParser.h"
#include "tests/spec/TSpecFixture.h"
#include "tests/support/TOddLocale.h"
#include "tests/support/watched/TWatchedClass.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

enum class EEvent { kStart, kEnd };

// A document with one error. Each tag has its own line, so the line of the message shows which tag is meant.
struct TBadSpec {
    std::string document;
    unsigned int line;
    std::string message;  // '#' stands for the line
    EEvent event = EEvent::kStart;
};

std::string WithLine(const std::string& message, unsigned int line)
{
    std::string text;
    for (const char c : message) {
        text += c == '#' ? std::to_string(line) : std::string(1, c);
    }
    return text;
}

std::string BarrierEntry(EEvent event, TZELStatusCode::EStatusCode status, unsigned int line)
{
    const std::string start = event == EEvent::kStart ? "TDiffXMLParser: Thrown exception in StartElement "
                                                      : "TDiffXMLParser: Threw exception in EndElement";
    return "0|" + start + TextOf(status) + " on line " + std::to_string(line) + "|";
}

std::string BothEntries(const TBadSpec& bad)
{
    return "0|Diff-XML Parser line " + std::to_string(bad.line) + ":" + WithLine(bad.message, bad.line) + "|" +
           BarrierEntry(bad.event, TZELStatusCode::kParseError, bad.line);
}

const std::string kVersion = "Unknown TCIMDiffEngineSpec version";
const std::string kParameter = "Unknown parameter specified on line #\n";
const std::string kDefault = "Invalid default specified on line #\n";
const std::string kNoName = "Class specified on line #has no name\n";
const std::string kNoClass = "Class specified on line # was not found in the schema\n";

std::string InClass(const std::string& inner)
{
    return "<DifftoolSpec>\n<class name=\"Other\">\n" + inner + "\n</class>\n</DifftoolSpec>";
}

std::string InValue(const std::string& text)
{
    return InClass("<includelist>\n<value>" + text + "</value>\n</includelist>");
}

const std::vector<TBadSpec> kBadRoots = {
    {"<difftoolspec/>", 1, "Unexpected element difftoolspec"},
    {"\n\n<DiffToolSpec>\n</DiffToolSpec>", 3, "Unexpected element DiffToolSpec"},
    {"<class name=\"Other\"/>", 1, "Unexpected element class"},
    {"<x:DifftoolSpec xmlns:x=\"u\"/>", 1, "Unexpected element x:DifftoolSpec"},
    {"<DifftoolSpec version=\"1.1\"/>", 1, kVersion},
    {"<?xml version=\"1.0\"?>\n<DifftoolSpec version=\"1.00\"/>", 2, kVersion},
    {"<DifftoolSpec foo=\"1.0\"/>", 1, kVersion},
    {"<DifftoolSpec Version=\"1.0\"/>", 1, kVersion},
    {"<DifftoolSpec version=\"1.0\" zoo=\"\"/>", 1, kVersion},
    {"<DifftoolSpec>\n<Class name=\"Other\"/>\n</DifftoolSpec>", 2, "Unexpected element Class"},
    {"<DifftoolSpec>\n\n<includelist/>\n</DifftoolSpec>", 3, "Unexpected element includelist"},
    {"<DifftoolSpec>\n<DifftoolSpec/>\n</DifftoolSpec>", 2, "Unexpected element DifftoolSpec"},
};

const std::vector<TBadSpec> kBadClasses = {
    {"<DifftoolSpec>\n<class name=\"Other\" Default=\"include\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n\n\n<class name=\"Other\" zoo=\"1\"/>\n</DifftoolSpec>", 4, kParameter},
    {"<DifftoolSpec>\n<class excludeKeys=\"Id\" name=\"Other\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n<class default=\"Include\" name=\"Other\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class default=\"\" name=\"Other\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class default=\"include \" name=\"Other\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class default=\"includes\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class zoo=\"\" default=\"x\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class aaa=\"\" default=\"x\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n<class default=\"x\" Zoo=\"\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n<class default=\"x\" d=\"\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n<class \xC3\xA4=\"\" default=\"x\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class default.=\"\" default=\"x\"/>\n</DifftoolSpec>", 2, kDefault},
    {"<DifftoolSpec>\n<class name=\"Nowhere\" zoo=\"\"/>\n</DifftoolSpec>", 2, kParameter},
    {"<DifftoolSpec>\n<class/>\n</DifftoolSpec>", 2, kNoName},
    {"<DifftoolSpec>\n<class name=\"\"/>\n</DifftoolSpec>", 2, kNoName},
    {"<DifftoolSpec>\n<class default=\"include\"/>\n</DifftoolSpec>", 2, kNoName},
    {"<DifftoolSpec>\n<class name=\"Nowhere\"/>\n</DifftoolSpec>", 2, kNoClass},
    {"<DifftoolSpec>\n<class name=\" Other\"/>\n</DifftoolSpec>", 2, kNoClass},
    {"<DifftoolSpec>\n<class name=\"Other\"/>\n<class name=\"Nowhere\"/>\n</DifftoolSpec>", 3, kNoClass},
};

const std::vector<TBadSpec> kBadLists = {
    {InClass("<value>A</value>"), 3, "Unexpected element value"},
    {InClass("<class name=\"Other\"/>"), 3, "Unexpected element class"},
    {InClass("<IncludeList/>"), 3, "Unexpected element IncludeList"},
    {InClass("<includelist>\n<Value>A</Value>\n</includelist>"), 4, "Unexpected element Value"},
    {InClass("<excludelist>\n<includelist/>\n</excludelist>"), 4, "Unexpected element includelist"},
    {InClass("<excludelist>\n<excludelist/>\n</excludelist>"), 4, "Unexpected element excludelist"},
    {InClass("<includelist>\n<value>A<x/></value>\n<value>A</value>\n</includelist>"), 5, "Unexpected element value"},
    {InValue("Z"), 4, "Invalid property \"Z\" specified on line #\n", EEvent::kEnd},
    {InValue(""), 4, "Invalid property \"\" specified on line #\n", EEvent::kEnd},
    {InValue(" A "), 4, "Invalid property \" A \" specified on line #\n", EEvent::kEnd},
    {InValue("\nA"), 5, "Invalid property \"\nA\" specified on line #\n", EEvent::kEnd},
    {InClass("<excludelist>\n<value>Z</value>\n</excludelist>"), 4, "Invalid property \"Z\" specified on line #\n", EEvent::kEnd},
    {InValue("Z<x/>"), 4, "Invalid property \"Z\" specified on line #\n", EEvent::kEnd},
};

// Names in another letter case than the schema's. The host decides whether it finds them.
const std::vector<TBadSpec> kOtherCase = {
    {"<DifftoolSpec>\n<class name=\"other\"/>\n</DifftoolSpec>", 2, kNoClass},
    {"<DifftoolSpec>\n<class name=\"OTHER\"/>\n</DifftoolSpec>", 2, kNoClass},
    {InValue("a"), 4, "Invalid property \"a\" specified on line #\n", EEvent::kEnd},
};

class SpecErrorsTest : public TSpecFixture, public testing::WithParamInterface<EHost> {
  protected:
    SpecErrorsTest() : TSpecFixture(GetParam()) {}

    void ExpectBothEntries(const std::vector<TBadSpec>& table)
    {
        for (const auto& bad : table) {
            EXPECT_EQ("status 9", Read(bad.document)) << bad.document;
            EXPECT_EQ(BothEntries(bad), TakeLog()) << bad.document;
        }
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, SpecErrorsTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(SpecErrorsTest, WrongRootsAreLoggedTwiceWithTheirLine)
{
    ExpectBothEntries(kBadRoots);
}

TEST_P(SpecErrorsTest, WrongClassesAreLoggedTwiceWithTheirLine)
{
    ExpectBothEntries(kBadClasses);
}

TEST_P(SpecErrorsTest, WrongListsAreLoggedTwiceWithTheirLine)
{
    ExpectBothEntries(kBadLists);
}

class ExactNamesTest : public SpecErrorsTest {};

INSTANTIATE_TEST_SUITE_P(Hosts, ExactNamesTest, testing::Values(EHost::kPlain), testing::PrintToStringParamName());

TEST_P(ExactNamesTest, NamesInAnotherLetterCaseAreUnknown)
{
    ExpectBothEntries(kOtherCase);
}

class TolerantHostTest : public SpecErrorsTest {};

INSTANTIATE_TEST_SUITE_P(Hosts, TolerantHostTest, testing::Values(EHost::kInmem), testing::PrintToStringParamName());

TEST_P(TolerantHostTest, NamesInAnotherLetterCaseAreKeptAsTheFileSpellsThem)
{
    EXPECT_EQ("Other exclude a:INCLUDE\n", Read(InValue("a")));
    EXPECT_EQ("Sub include A:EXCLUDE\n"
              "base include A:EXCLUDE\n",
              Read("<DifftoolSpec><class name=\"base\" default=\"include\"><excludelist><value>A</value></excludelist></class>"
                   "</DifftoolSpec>"));
    EXPECT_EQ("", TakeLog());
}

TEST_P(TolerantHostTest, TwoSpellingsOfAClassAreTwoEntries)
{
    EXPECT_EQ("Other exclude\n"
              "other include\n",
              Read("<DifftoolSpec><class name=\"Other\"/><class name=\"other\" default=\"include\"/></DifftoolSpec>"));
}

TEST_P(SpecErrorsTest, TheFullTextOfAnErrorOnLineTwelve)
{
    std::string document = "<DifftoolSpec>\n";
    document.append(10, '\n');
    EXPECT_EQ("status 9", Read(document + "<class name=\"Nowhere\"/></DifftoolSpec>"));
    const std::string log = TakeLog();
    EXPECT_EQ("0|Diff-XML Parser line 12:Class specified on line 12 was not found in the schema\n|"
              "0|TDiffXMLParser: Thrown exception in StartElement " +
                  TextOf(TZELStatusCode::kParseError) + " on line 12|",
              log);
    EXPECT_EQ(std::string::npos, log.find("Previous error"));
}

TEST_P(SpecErrorsTest, LinesAreWrittenAlikeInEveryLocale)
{
    const TOddLocale odd;
    const std::string lines(1233, '\n');
    const TBadSpec bad{lines + "<DifftoolSpec><class name=\"Nowhere\"/></DifftoolSpec>", 1234, kNoClass};
    EXPECT_EQ("status 9", Read(bad.document));
    EXPECT_EQ(BothEntries(bad), TakeLog());
    EXPECT_EQ("status 9", Read(lines));
    EXPECT_EQ("0|Diff-XML Parser line 1234:no element found|", TakeLog());
}

TEST_P(SpecErrorsTest, AnotherFailureOfTheClassLookUpKeepsItsStatus)
{
    fComparison.GetWatch().FailCallsOf("ns0.GetClass(\"Other\")", TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", Read("<DifftoolSpec>\n<class name=\"Other\"/></DifftoolSpec>"));
    EXPECT_EQ(BarrierEntry(EEvent::kStart, TZELStatusCode::kNamespaceGone, 2), TakeLog());
}

TEST_P(SpecErrorsTest, AnotherFailureOfThePropertyLookUpKeepsItsStatus)
{
    fComparison.GetWatch().FailCallsOf("ns0:Other.GetPropertyDecl(\"A\")", TZELStatusCode::kTypeMismatch);
    EXPECT_EQ("status 13", Read(InValue("A")));
    EXPECT_EQ(BarrierEntry(EEvent::kEnd, TZELStatusCode::kTypeMismatch, 4), TakeLog());
}

TEST_P(SpecErrorsTest, AClassThatIsGoneWhenItsPropertyIsLookedUpMakesThePropertyInvalid)
{
    fComparison.GetWatch().FailCall(2, TZELStatusCode::kNotFound);
    EXPECT_EQ("status 9", Read(InValue("A")));
    EXPECT_EQ(BothEntries({InValue("A"), 4, "Invalid property \"A\" specified on line #\n", EEvent::kEnd}), TakeLog());
}

TEST_P(SpecErrorsTest, AnotherFailureOfThePropertysClassLookUpKeepsItsStatus)
{
    fComparison.GetWatch().FailCall(2, TZELStatusCode::kNamespaceGone);
    EXPECT_EQ("status 18", Read(InValue("A")));
    EXPECT_EQ(BarrierEntry(EEvent::kEnd, TZELStatusCode::kNamespaceGone, 4), TakeLog());
}

struct TSpecialException : TZELException {
    using TZELException::TZELException;
};

// A schema that answers a number of calls and then throws.
template <typename TFailure>
class TFadingSchema : public TWatchedNamespace {
  public:
    TFadingSchema(boost::shared_ptr<ICIMNamespace> ns, int answers, const TFailure& failure)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "fading"), fAnswers(answers), fFailure(failure)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        if (--fAnswers < 0) {
            throw fFailure;
        }
        return TWatchedNamespace::GetClass(name, context);
    }

  private:
    int fAnswers;
    TFailure fFailure;
};

class FadingSchemaTest : public SpecErrorsTest {
  protected:
    // From now on the schema answers for that many classes.
    template <typename TFailure>
    void FadeAfter(int answers, const TFailure& failure)
    {
        fNamespaces[0] = boost::make_shared<TFadingSchema<TFailure>>(fComparison.Namespace(0).GetNamespace(), answers, failure);
    }
};

INSTANTIATE_TEST_SUITE_P(Hosts, FadingSchemaTest, testing::Values(EHost::kPlain, EHost::kInmem), testing::PrintToStringParamName());

TEST_P(FadingSchemaTest, AFailureIsThrownAnew)
{
    FadeAfter(1, TSpecialException(TZELStatusCode::kNamespaceGone));
    TCIMDiffEngine::TDiffXMLParser parser(fNamespaces[0]);
    std::map<std::string, std::string> attrs;
    parser.StartElement("DifftoolSpec", attrs);
    attrs["name"] = "Other";
    parser.StartElement("class", attrs);
    try {
        parser.EndElement("class");
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
        EXPECT_EQ(typeid(TZELException), typeid(error));
    }
}

TEST_P(FadingSchemaTest, WhatIsNoExceptionOfTheHostPassesWithoutAWordInTheLog)
{
    const std::string document = InValue("A");
    for (const int answers : {0, 1, 2}) {  // in the start tag of the class, the end tag of the value, the end tag of the class
        FadeAfter(answers, std::runtime_error("own"));
        EXPECT_THROW(Read(document), std::runtime_error) << answers;
        FadeAfter(answers, 5);
        EXPECT_THROW(Read(document), int) << answers;
        EXPECT_EQ("", TakeLog()) << answers;
    }
    FadeAfter(3, 5);
    EXPECT_EQ("Other exclude A:INCLUDE\n", Read(document));
}

// A schema that answers a number of calls and then returns a null class.
class TEmptyingSchema : public TWatchedNamespace {
  public:
    TEmptyingSchema(boost::shared_ptr<ICIMNamespace> ns, int answers)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "emptying"), fAnswers(answers)
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        return --fAnswers < 0 ? nullptr : TWatchedNamespace::GetClass(name, context);
    }

  private:
    int fAnswers;
};

TEST_P(SpecErrorsTest, ANullSchemaFailsTheAssertionAtTheFirstClass)
{
    fNamespaces[0] = nullptr;
    EXPECT_EQ("", Read("<DifftoolSpec/>"));
    EXPECT_THROW(Read("<DifftoolSpec><class name=\"Other\"/></DifftoolSpec>"), TAssertionFailure);
    EXPECT_EQ(0u, TakeLog().find("0|Assertion failed: px != 0"));
}

TEST_P(SpecErrorsTest, ANullClassFailsTheAssertionWhereItIsAskedForMore)
{
    for (const int answers : {0, 1, 2}) {  // a class element asks for no more than its class
        fNamespaces[0] = boost::make_shared<TEmptyingSchema>(fComparison.Namespace(0).GetNamespace(), answers);
        EXPECT_THROW(Read(InValue("A")), TAssertionFailure) << answers;
        const std::string log = TakeLog();
        EXPECT_EQ(0u, log.find("0|Assertion failed: px != 0")) << answers;
        EXPECT_EQ(std::string::npos, log.find("exception in")) << answers;
    }
}

// A schema whose class Other returns a null pointer for every declaration of a property.
class TUndeclaringSchema : public TWatchedNamespace {
  public:
    explicit TUndeclaringSchema(boost::shared_ptr<ICIMNamespace> ns)
        : TWatchedNamespace(ns, boost::make_shared<TCallWatch>(), "undeclaring")
    {}

    boost::shared_ptr<ICIMClass> GetClass(const std::string& name, TCallContext context) override
    {
        return boost::make_shared<TUndeclaringClass>(TWatchedNamespace::GetClass(name, context));
    }

  private:
    class TUndeclaringClass : public TWatchedClass {
      public:
        explicit TUndeclaringClass(boost::shared_ptr<ICIMClass> cls)
            : TWatchedClass(cls, boost::make_shared<TCallWatch>(), "undeclaring")
        {}

        boost::shared_ptr<ICIMPropertyDecl> GetPropertyDecl(const std::string&, TCallContext) const override { return nullptr; }
    };
};

TEST_P(SpecErrorsTest, OnlyAnExceptionMakesAPropertyInvalid)
{
    fNamespaces[0] = boost::make_shared<TUndeclaringSchema>(fComparison.Namespace(0).GetNamespace());
    EXPECT_EQ("Other exclude Z:INCLUDE\n", Read(InValue("Z")));
    EXPECT_EQ("", TakeLog());
}

TEST_P(SpecErrorsTest, AFailureOfThePushDownKeepsItsStatus)
{
    fComparison.GetWatch().FailCallsOf("ns0:Other.EnumerateSubClasses", TZELStatusCode::kNotFound);
    EXPECT_EQ("status 15", Read("<DifftoolSpec>\n<class name=\"Other\">\n</class></DifftoolSpec>"));
    EXPECT_EQ(BarrierEntry(EEvent::kEnd, TZELStatusCode::kNotFound, 3), TakeLog());
}

TEST_P(SpecErrorsTest, MalformedXmlIsLoggedOnceWithTheHostsMessage)
{
    EXPECT_EQ("status 9", Read("<DifftoolSpec>\n<class name=\"Other\"></DifftoolSpec>"));
    EXPECT_EQ("0|Diff-XML Parser line 2:mismatched tag|", TakeLog());
    EXPECT_EQ("status 9", Read("<DifftoolSpec>\n<class name=\"Other\"/>\n"));
    EXPECT_EQ("0|Diff-XML Parser line 3:no element found|", TakeLog());
}

TEST_P(SpecErrorsTest, FatalErrorLogsItsMessageAndThrows)
{
    TCIMDiffEngine::TDiffXMLParser parser(fNamespaces[0]);
    try {
        parser.FatalError("a message");
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kParseError, error.GetStatusCode().GetStatus());
    }
    EXPECT_EQ("0|Diff-XML Parser line " + std::to_string(parser.GetCurLine()) + ":a message|", TakeLog());
}

TEST_P(SpecErrorsTest, NothingOfABadDocumentIsLeftBehind)
{
    EXPECT_EQ("status 9", Read("<DifftoolSpec><class name=\"Base\"/><class/></DifftoolSpec>"));
    EXPECT_EQ("Other exclude\n", Read("<DifftoolSpec><class name=\"Other\"/></DifftoolSpec>"));
}

}  // namespace
}  // namespace NORVZEL20
