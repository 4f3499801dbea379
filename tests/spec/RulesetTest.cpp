#include <gtest/gtest.h>

#include <boost/smart_ptr/make_shared.hpp>

#include "embedded/services/TAssertionFailure.h"
#include "host/TZELException.h"
#include "spec/TDiffClassRules.h"
#include "tests/spec/PropertyRules.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"
#include "tests/support/TComparisonRun.h"
#include "tests/support/watched/TWatchedNamespace.h"

namespace NORVZEL20 {
namespace {

using TRules = TCIMDiffEngine::TDiffClassRules;
using TProperties = std::map<std::string, TCIMDiffEngine::propType>;

boost::shared_ptr<TRules> Rules(TCIMDiffEngine::propType def, const TProperties& properties, const std::string& excludedKeys = "")
{
    const auto rules = boost::make_shared<TRules>(def, properties, std::vector<std::string>());
    rules->excludeKeys(excludedKeys);
    return rules;
}

// The class tree: Base > Mid > Leaf, and Base > Side. Other has no relatives.
class RulesetTest : public testing::Test {
  protected:
    RulesetTest() : fWatch(boost::make_shared<TCallWatch>()), fBuilder(MakeNamespace(EHost::kPlain, "root/cimv2"))
    {
        fBuilder.Class("Base", "", {}).Class("Mid", "Base", {}).Class("Leaf", "Mid", {}).Class("Side", "Base", {});
        fBuilder.Class("Other", "", {});
        fSchema = boost::make_shared<TWatchedNamespace>(fBuilder.GetNamespace(), fWatch, "schema");
    }

    void AddAsRead(const std::string& name, boost::shared_ptr<TRules> rules)
    {
        fRuleset.addToRuleset(name, rules, true);
        fRuleset.updateRuleset(name, "", fSchema);
    }

    boost::shared_ptr<TCallWatch> fWatch;
    TNamespaceBuilder fBuilder;
    boost::shared_ptr<ICIMNamespace> fSchema;
    TCIMDiffEngine::TRuleset fRuleset;
};

TEST_F(RulesetTest, AClassThatNothingReachedGetsNewRulesEachTime)
{
    const auto first = fRuleset.getClassRules("Disk");
    const auto second = fRuleset.getClassRules("Disk");
    EXPECT_EQ("exclude\n", DumpRules(*first));
    EXPECT_NE(first, second);
    EXPECT_EQ("", DumpRules(fRuleset));
}

TEST_F(RulesetTest, NamesAreComparedByteForByte)
{
    fRuleset.addToRuleset("Disk", Rules(INCLUDE, {}), true);
    EXPECT_EQ("include\n", DumpRules(*fRuleset.getClassRules("Disk")));
    EXPECT_EQ("exclude\n", DumpRules(*fRuleset.getClassRules("DISK")));
}

TEST_F(RulesetTest, TheFirstRulesAreCopiedAndNotFinalWhateverTheFlag)
{
    for (const bool isExplicit : {true, false}) {
        TCIMDiffEngine::TRuleset ruleset;
        const auto rules = Rules(INCLUDE, {{"A", EXCLUDE}}, "K");
        rules->fClassName = "Disk";
        rules->fFinal = true;
        ruleset.addToRuleset("Disk", rules, isExplicit);
        EXPECT_EQ("Disk include A:EXCLUDE -K\n", DumpRules(ruleset));
        EXPECT_NE(rules, ruleset.getClassRules("Disk"));
        EXPECT_EQ("", ruleset.getClassRules("Disk")->fClassName);
        rules->fProperties.clear();
        EXPECT_EQ("Disk include A:EXCLUDE -K\n", DumpRules(ruleset));
    }
}

TEST_F(RulesetTest, LaterRulesMergeAndExplicitOnesClose)
{
    fRuleset.addToRuleset("Disk", Rules(INCLUDE, {{"A", EXCLUDE}}, "K"), true);
    fRuleset.addToRuleset("Disk", Rules(EXCLUDE, {{"B", INCLUDE}}, "L"), false);
    EXPECT_EQ("Disk exclude A:EXCLUDE B:INCLUDE -K\n", DumpRules(fRuleset));
    fRuleset.addToRuleset("Disk", Rules(INCLUDE, {{"A", INCLUDE}}), true);
    EXPECT_EQ("Disk include final A:INCLUDE B:INCLUDE -K\n", DumpRules(fRuleset));
    fRuleset.addToRuleset("Disk", Rules(EXCLUDE, {{"C", INCLUDE}}), true);
    fRuleset.addToRuleset("Disk", Rules(EXCLUDE, {{"C", INCLUDE}}), false);
    EXPECT_EQ("Disk include final A:INCLUDE B:INCLUDE -K\n", DumpRules(fRuleset));
}

TEST_F(RulesetTest, AHandleOfAnEntrySeesLaterMerges)
{
    fRuleset.addToRuleset("Disk", Rules(INCLUDE, {}), true);
    const auto handle = fRuleset.getClassRules("Disk");
    const TCIMDiffEngine::TRuleset copy = fRuleset;
    fRuleset.addToRuleset("Disk", Rules(EXCLUDE, {}), true);
    EXPECT_EQ("exclude final\n", DumpRules(*handle));
    EXPECT_EQ("Disk exclude final\n", DumpRules(copy));
}

TEST_F(RulesetTest, NullRulesFailTheAssertion)
{
    TCapturingLogger log;
    EXPECT_THROW(fRuleset.addToRuleset("Disk", nullptr, true), TAssertionFailure);
}

TEST_F(RulesetTest, RulesFlowDownToAllSubclasses)
{
    AddAsRead("Base", Rules(INCLUDE, {{"A", EXCLUDE}}, "K"));
    EXPECT_EQ("Base include A:EXCLUDE -K\n"
              "Leaf include A:EXCLUDE -K\n"
              "Mid include A:EXCLUDE -K\n"
              "Side include A:EXCLUDE -K\n",
              DumpRules(fRuleset));
    EXPECT_NE(fRuleset.getClassRules("Base"), fRuleset.getClassRules("Mid"));
}

TEST_F(RulesetTest, ASubclassReadAfterItsAncestorPrevailsAndPassesOn)
{
    AddAsRead("Base", Rules(INCLUDE, {{"A", EXCLUDE}, {"X", EXCLUDE}}));
    AddAsRead("Mid", Rules(EXCLUDE, {{"X", INCLUDE}}));
    EXPECT_EQ("Base include A:EXCLUDE X:EXCLUDE\n"
              "Leaf exclude A:EXCLUDE X:INCLUDE\n"
              "Mid exclude final A:EXCLUDE X:INCLUDE\n"
              "Side include A:EXCLUDE X:EXCLUDE\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, AnAncestorReadAfterItsSubclassPrevails)
{
    AddAsRead("Mid", Rules(EXCLUDE, {{"X", INCLUDE}, {"Y", INCLUDE}}, "K"));
    AddAsRead("Base", Rules(INCLUDE, {{"A", EXCLUDE}, {"X", EXCLUDE}}));
    EXPECT_EQ("Base include A:EXCLUDE X:EXCLUDE\n"
              "Leaf include A:EXCLUDE X:EXCLUDE Y:INCLUDE -K\n"
              "Mid include A:EXCLUDE X:EXCLUDE Y:INCLUDE -K\n"
              "Side include A:EXCLUDE X:EXCLUDE\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, ExcludedKeysDoNotReachEntriesThatAreThere)
{
    AddAsRead("Mid", Rules(EXCLUDE, {}));
    AddAsRead("Base", Rules(EXCLUDE, {}, "K"));
    AddAsRead("Side", Rules(EXCLUDE, {}, "L"));
    EXPECT_EQ("Base exclude -K\n"
              "Leaf exclude\n"
              "Mid exclude\n"
              "Side exclude final -K\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, FinalRulesStopWhatComesFromAbove)
{
    AddAsRead("Base", Rules(EXCLUDE, {}));
    AddAsRead("Mid", Rules(INCLUDE, {}));
    AddAsRead("Base", Rules(EXCLUDE, {{"A", INCLUDE}}));
    EXPECT_EQ("Base exclude final A:INCLUDE\n"
              "Leaf include\n"
              "Mid include final\n"
              "Side exclude A:INCLUDE\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, TheParentsRulesAreAddedWhereAParentIsNamed)
{
    fRuleset.addToRuleset("Base", Rules(INCLUDE, {{"A", EXCLUDE}}), true);
    fRuleset.updateRuleset("Mid", "Base", fSchema);
    EXPECT_EQ("Base include A:EXCLUDE\n"
              "Leaf include A:EXCLUDE\n"
              "Mid include A:EXCLUDE\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, AParentWithoutRulesIsEnteredWithNone)
{
    TCapturingLogger log;
    EXPECT_THROW(fRuleset.updateRuleset("Mid", "Base", fSchema), TAssertionFailure);
    ASSERT_EQ(1u, fRuleset.fRules.count("Base"));
    EXPECT_EQ(nullptr, fRuleset.fRules["Base"]);
    EXPECT_EQ("", fWatch->TakeText());
}

TEST_F(RulesetTest, TheWalkAsksForEachClassAndItsDirectSubclassesDepthFirst)
{
    fRuleset.addToRuleset("Base", Rules(INCLUDE, {}), true);
    fRuleset.updateRuleset("Base", "", fSchema);
    EXPECT_EQ("schema.GetClass(\"Base\") {}\n"
              "schema:Base.EnumerateSubClasses(false) {}\n"
              "schema:Mid.GetName() {}\n"
              "schema.GetClass(\"Mid\") {}\n"
              "schema:Mid.EnumerateSubClasses(false) {}\n"
              "schema:Leaf.GetName() {}\n"
              "schema.GetClass(\"Leaf\") {}\n"
              "schema:Leaf.EnumerateSubClasses(false) {}\n"
              "schema:Side.GetName() {}\n"
              "schema.GetClass(\"Side\") {}\n"
              "schema:Side.EnumerateSubClasses(false) {}\n",
              fWatch->TakeText());
}

TEST_F(RulesetTest, ErrorsOfTheSchemaPassThrough)
{
    fRuleset.addToRuleset("Base", Rules(INCLUDE, {}), true);
    fWatch->FailCallsOf("schema.GetClass(\"Leaf\")", TZELStatusCode::kNamespaceGone);
    try {
        fRuleset.updateRuleset("Base", "", fSchema);
        FAIL() << "nothing was thrown";
    } catch (const TZELException& error) {
        EXPECT_EQ(TZELStatusCode::kNamespaceGone, error.GetStatusCode().GetStatus());
    }
    EXPECT_EQ("Base include\n"
              "Leaf include\n"
              "Mid include\n",
              DumpRules(fRuleset));
}

TEST_F(RulesetTest, PrintWritesNamesDefaultsAndListedProperties)
{
    fRuleset.addToRuleset("B", Rules(INCLUDE, {{"P", EXCLUDE}}, "K"), true);
    fRuleset.addToRuleset("A", Rules(EXCLUDE, {{"Z", EXCLUDE}, {"Y", INCLUDE}}), true);
    testing::internal::CaptureStdout();
    fRuleset.print();
    EXPECT_EQ("A\n"
              "\tDefault:\tEXCLUDE\n"
              "\tY\tINCLUDE\n"
              "\tZ\tEXCLUDE\n"
              "B\n"
              "\tDefault:\tINCLUDE\n"
              "\tP\tEXCLUDE\n",
              testing::internal::GetCapturedStdout());
}

}  // namespace
}  // namespace NORVZEL20
