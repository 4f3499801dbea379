#include <gmock/gmock.h>

#include <boost/smart_ptr/make_shared.hpp>
#include <sstream>

#include "embedded/services/TAssertionFailure.h"
#include "spec/TDiffClassRules.h"
#include "tests/spec/PropertyRules.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TOddLocale.h"

namespace NORVZEL20 {
namespace {

using testing::ElementsAre;
using TRules = TCIMDiffEngine::TDiffClassRules;

TEST(PropTypeTest, NumbersAndTextsAreFixed)
{
    EXPECT_EQ(0, INCLUDE);
    EXPECT_EQ(1, EXCLUDE);
    EXPECT_EQ("INCLUDE", TCIMDiffEngine::strPropType(INCLUDE));
    EXPECT_EQ("EXCLUDE", TCIMDiffEngine::strPropType(EXCLUDE));
}

TEST(ClassRulesTest, NewRulesExcludeEverything)
{
    const TRules rules;
    EXPECT_EQ("", rules.fClassName);
    EXPECT_FALSE(rules.fFinal);
    EXPECT_EQ("exclude\n", DumpRules(rules));
}

TEST(ClassRulesTest, RulesKeepWhatTheyAreMadeWith)
{
    const TRules rules(INCLUDE, {{"B", EXCLUDE}, {"A", INCLUDE}}, {"K2", "K1", "K2"});
    EXPECT_EQ("", rules.fClassName);
    EXPECT_EQ("include A:INCLUDE B:EXCLUDE -K2 -K1 -K2\n", DumpRules(rules));
}

TEST(ClassRulesTest, UpdateTakesDefaultAndListedPropertiesAlone)
{
    TRules rules(INCLUDE, {{"A", INCLUDE}, {"B", INCLUDE}}, {"K"});
    rules.fClassName = "Disk";
    rules.fFinal = true;
    const auto other = boost::make_shared<TRules>(
        EXCLUDE, std::map<std::string, TCIMDiffEngine::propType>{{"B", EXCLUDE}, {"C", INCLUDE}}, std::vector<std::string>{"L"});
    other->fClassName = "Other";
    rules.updateRules(other);
    EXPECT_EQ("exclude final A:INCLUDE B:EXCLUDE C:INCLUDE -K\n", DumpRules(rules));
    EXPECT_EQ("Disk", rules.fClassName);
    EXPECT_EQ("exclude B:EXCLUDE C:INCLUDE -L\n", DumpRules(*other));
}

TEST(ClassRulesTest, ExcludedKeysAreSeparatedAlikeInEveryLocale)
{
    const TOddLocale odd;
    TRules rules;
    rules.excludeKeys("A;B \tC;");
    EXPECT_EQ("exclude -A;B -C;\n", DumpRules(rules));
}

TEST(ClassRulesTest, UpdateWithNothingFailsTheAssertion)
{
    TCapturingLogger log;
    TRules rules;
    EXPECT_THROW(rules.updateRules(nullptr), TAssertionFailure);
}

TEST(ExcludedKeysTest, AnyWhiteSpaceSeparatesNames)
{
    TRules rules;
    rules.excludeKeys("  KeyA\t\tKeyB\n KeyC \r\n");
    EXPECT_THAT(rules.fExcludedKeys, ElementsAre("KeyA", "KeyB", "KeyC"));
    EXPECT_TRUE(rules.hasExcludedKeys());
}

/// The words of a text, split by formatted reads.
std::vector<std::string> WordsOf(const std::string& text)
{
    std::istringstream in(text);
    std::vector<std::string> words;
    for (std::string word; in >> word;) {
        words.push_back(word);
    }
    return words;
}

TEST(ExcludedKeysTest, EveryCharacterSeparatesOrNotAsInAFormattedRead)
{
    for (int code = 0; code < 256; ++code) {
        const std::string character(1, static_cast<char>(code));
        TRules rules;
        rules.excludeKeys(character + "KeyA" + character + character + "KeyB" + character);
        EXPECT_EQ(WordsOf(character + "KeyA" + character + character + "KeyB" + character), rules.fExcludedKeys) << code;
    }
}

TEST(ExcludedKeysTest, NamesAreAddedAndRepeatedOnesKept)
{
    TRules rules;
    rules.excludeKeys("A B");
    rules.excludeKeys("B C");
    EXPECT_THAT(rules.fExcludedKeys, ElementsAre("A", "B", "B", "C"));
}

TEST(ExcludedKeysTest, EmptyOrBlankTextAddsNothing)
{
    TRules rules;
    rules.excludeKeys("");
    rules.excludeKeys(" \t\n ");
    EXPECT_FALSE(rules.hasExcludedKeys());
    EXPECT_FALSE(rules.isKeyExcluded(""));
}

TEST(ExcludedKeysTest, LetterCaseCounts)
{
    TRules rules;
    rules.excludeKeys("Name Id");
    EXPECT_TRUE(rules.isKeyExcluded("Name"));
    EXPECT_TRUE(rules.isKeyExcluded("Id"));
    EXPECT_FALSE(rules.isKeyExcluded("NAME"));
    EXPECT_FALSE(rules.isKeyExcluded("Nam"));
    EXPECT_FALSE(rules.isKeyExcluded("Name Id"));
}

}  // namespace
}  // namespace NORVZEL20
