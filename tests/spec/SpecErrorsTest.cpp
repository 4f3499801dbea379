#include "host/TZELException.h"
#include "spec/TDiffXMLParser.h"
#include "tests/spec/SpecDocuments.h"
#include "tests/spec/TSpecFixture.h"
#include "tests/support/TOddLocale.h"

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
