#include "host/TZELException.h"
#include "spec/TDiffClassRules.h"
#include "spec/TDiffXMLParser.h"
#include "tests/spec/TSpecFixture.h"
#include "tests/support/Dump.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {
namespace {

using TParser = TCIMDiffEngine::TDiffXMLParser;

// Calls the parser's events directly, without a document.
class StateMachineTest : public TSpecFixture {
  protected:
    StateMachineTest() : fParser(fNamespaces[0]) {}

    // The effect of a start tag: "accepted", "ignored", or the message with which it ends the parse.
    std::string Start(const std::string& name)
    {
        std::map<std::string, std::string> attrs;
        if (name == "class") {
            attrs["name"] = "Other";
        }
        const std::size_t depth = TTestAccess::StackSize(fParser);
        try {
            fParser.StartElement(name.c_str(), attrs);
        } catch (const TZELException&) {
            const std::string log = TakeLog();
            const std::size_t from = log.find(':') + 1;
            return log.substr(from, log.find('|', from) - from);
        }
        return TTestAccess::StackSize(fParser) == depth + 1 ? "accepted" : "ignored";
    }

    void Open(const std::vector<std::string>& names)
    {
        for (const auto& name : names) {
            ASSERT_EQ("accepted", Start(name));
        }
    }

    void Text(const std::string& text) { fParser.characters(text.c_str(), static_cast<unsigned int>(text.size())); }

    TParser fParser;
};

const std::vector<std::string> kElements = {"DifftoolSpec", "class", "includelist", "excludelist", "value", "other"};

struct TState {
    std::vector<std::string> open;
    std::vector<std::string> accepted;
};

class EveryStateTest : public StateMachineTest, public testing::WithParamInterface<TState> {};

TEST_P(EveryStateTest, AcceptsItsChildrenAndRefusesEverythingElse)
{
    for (const auto& element : kElements) {
        fParser.~TParser();
        new (&fParser) TParser(fNamespaces[0]);
        Open(GetParam().open);
        const auto& accepted = GetParam().accepted;
        const bool isAccepted = std::find(accepted.begin(), accepted.end(), element) != accepted.end();
        EXPECT_EQ(isAccepted ? "accepted" : "Unexpected element " + element, Start(element));
    }
}

INSTANTIATE_TEST_SUITE_P(States, EveryStateTest,
                         testing::Values(TState{{}, {"DifftoolSpec"}}, TState{{"DifftoolSpec"}, {"class"}},
                                         TState{{"DifftoolSpec", "class"}, {"includelist", "excludelist"}},
                                         TState{{"DifftoolSpec", "class", "includelist"}, {"value"}},
                                         TState{{"DifftoolSpec", "class", "excludelist"}, {"value"}}),
                         [](const auto& state) {
                             return state.param.open.empty() ? std::string("Document") : state.param.open.back();
                         });

TEST_F(StateMachineTest, AValueIgnoresEveryStartTag)
{
    Open({"DifftoolSpec", "class", "includelist", "value"});
    for (const auto& element : kElements) {
        EXPECT_EQ("ignored", Start(element));
    }
}

TEST_F(StateMachineTest, TheStackFollowsWhatIsOpen)
{
    EXPECT_EQ(1u, TTestAccess::StackSize(fParser));
    Open({"DifftoolSpec", "class", "includelist", "value"});
    EXPECT_EQ(5u, TTestAccess::StackSize(fParser));
    Text("A");
    for (const std::size_t depth : {4u, 3u, 2u}) {
        fParser.EndElement("any name");
        EXPECT_EQ(depth, TTestAccess::StackSize(fParser));
    }
}

TEST_F(StateMachineTest, TheRootIsNeverPopped)
{
    Open({"DifftoolSpec"});
    fParser.EndElement("DifftoolSpec");
    fParser.EndElement("DifftoolSpec");
    EXPECT_EQ(2u, TTestAccess::StackSize(fParser));
    EXPECT_EQ("accepted", Start("class"));
}

TEST_F(StateMachineTest, AStartTagOfAValueForgetsTheTextBefore)
{
    Open({"DifftoolSpec"});
    Text("a");
    Open({"class"});
    Text("b");
    Open({"includelist"});
    Text("c");
    EXPECT_EQ("abc", TTestAccess::CharData(fParser));
    Open({"value"});
    EXPECT_EQ("", TTestAccess::CharData(fParser));
}

TEST_F(StateMachineTest, AnEndTagOfAValueTakesItsTextAndForgetsIt)
{
    Open({"DifftoolSpec", "class", "excludelist", "value"});
    Text("A");
    fParser.EndElement("value");
    EXPECT_EQ("", TTestAccess::CharData(fParser));
    EXPECT_EQ("exclude A:EXCLUDE\n", DumpRules(*TTestAccess::CurrentRules(fParser)));
}

TEST_F(StateMachineTest, TextIsTakenUpToItsFirstNulWhateverTheLength)
{
    const char text[] = "ab\0cd";
    fParser.characters(text, 5);
    fParser.characters("xyz", 1);
    EXPECT_EQ("abxyz", TTestAccess::CharData(fParser));
}

TEST_F(StateMachineTest, RulesEnterTheRulesetWhenTheirClassCloses)
{
    EXPECT_EQ(nullptr, TTestAccess::CurrentRules(fParser));
    Open({"DifftoolSpec", "class"});
    EXPECT_EQ("Other", TTestAccess::CurrentRules(fParser)->fClassName);
    EXPECT_EQ("", DumpRules(fParser.getRuleset()));
    fParser.EndElement("class");
    EXPECT_EQ("Other exclude\n", DumpRules(fParser.getRuleset()));
    EXPECT_EQ("Other", TTestAccess::CurrentRules(fParser)->fClassName);
}

TEST_F(StateMachineTest, EachClassStartsNewRules)
{
    Open({"DifftoolSpec", "class"});
    const auto first = TTestAccess::CurrentRules(fParser);
    fParser.EndElement("class");
    Open({"class"});
    EXPECT_NE(first, TTestAccess::CurrentRules(fParser));
}

TEST_F(StateMachineTest, TheRulesetGivenOutSharesItsRules)
{
    Open({"DifftoolSpec", "class"});
    fParser.EndElement("class");
    EXPECT_EQ(fParser.getRuleset().getClassRules("Other"), fParser.getRuleset().getClassRules("Other"));
    EXPECT_EQ("", fParser.getRuleset().getClassRules("Other")->fClassName);
}

TEST_F(StateMachineTest, OtherEventsDoNothing)
{
    Open({"DifftoolSpec"});
    fParser.processingInstruction("target", "data");
    fParser.notationDecl("name", "public", "system");
    EXPECT_EQ(2u, TTestAccess::StackSize(fParser));
    EXPECT_EQ("", TTestAccess::CharData(fParser));
    EXPECT_EQ("", TakeLog());
}

}  // namespace
}  // namespace NORVZEL20
