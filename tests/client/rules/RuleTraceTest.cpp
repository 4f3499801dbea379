// The trace is checked in two ways that share no code with it: it must agree with the plug-in's own merge on random rules, and the
// element that it names must be the one whose change makes a difference.

#include "client/rules/TRuleTrace.h"

#include <gtest/gtest.h>

#include <random>

#include "client/inventory/CollectObjects.h"
#include "embedded/store/TInMemNamespace.h"
#include "spec/TDiffClassRules.h"

namespace NORVZEL20 {
namespace {

const char* const kClasses[] = {"A", "B", "C", "D", "E"};

// A small tree: A above B and C, B above D and E; each declares p, q and r through A.
boost::shared_ptr<TInMemNamespace> MakeSchema()
{
    const boost::shared_ptr<TInMemNamespace> ns = TInMemNamespace::Create("root/cimv2");
    const auto add = [&ns](const char* name, const char* super) {
        const boost::shared_ptr<TInMemClass> cls = ns->AllocateInMemClass(name, ns->FindClass(super));
        cls->AddToNamespace(TCallContext());
        return cls;
    };
    const boost::shared_ptr<TInMemClass> top = add("A", "");
    for (const char* property : {"p", "q", "r"}) {
        top->AddPropertyDecl(top->AllocatePropertyDecl(property, TCIMValue(""), TCallContext()));
    }
    add("B", "A");
    add("C", "A");
    add("D", "B");
    add("E", "B");
    return ns;
}

TRulesDocument MakeRandomDocument(std::mt19937& random, unsigned int mostElements)
{
    const auto choose = [&random](unsigned int count) { return static_cast<unsigned int>(random() % count); };
    const auto treatment = [&choose] { return choose(2) == 0 ? TCIMDiffEngine::INCLUDE : TCIMDiffEngine::EXCLUDE; };
    TRulesDocument document;
    unsigned int line = 1;
    for (unsigned int i = choose(mostElements + 1); i > 0; --i) {
        TRulesDocument::TElement element;
        element.className = std::string(1, static_cast<char>('A' + choose(5)));
        element.defaultTreatment = treatment();
        element.line = ++line;
        for (unsigned int j = choose(4); j > 0; --j) {
            element.listed.push_back({std::string(1, static_cast<char>('p' + choose(3))), treatment(), ++line});
        }
        if (choose(3) == 0) {
            element.excludedKeys.push_back(std::string(1, static_cast<char>('p' + choose(3))));
        }
        document.elements.push_back(element);
    }
    return document;
}

// What the plug-in makes of the same elements.
TCIMDiffEngine::TRuleset MakeRuleset(const TRulesDocument& document, const boost::shared_ptr<ICIMNamespace>& schema)
{
    TCIMDiffEngine::TRuleset ruleset;
    for (const TRulesDocument::TElement& element : document.elements) {
        std::map<std::string, TCIMDiffEngine::propType> listed;
        for (const TRulesDocument::TListed& entry : element.listed) {
            listed.insert({entry.property, entry.treatment});
        }
        const boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> rules(
            new TCIMDiffEngine::TDiffClassRules(element.defaultTreatment, listed, element.excludedKeys));
        ruleset.addToRuleset(element.className, rules, true);
        ruleset.updateRuleset(element.className, "", schema);
    }
    return ruleset;
}

TEST(RuleTrace, AgreesWithThePlugInOnRandomRules)
{
    const boost::shared_ptr<TInMemNamespace> schema = MakeSchema();
    for (unsigned int seed = 0; seed < 3000; ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        std::mt19937 random(seed);
        const TRulesDocument document = MakeRandomDocument(random, 6);
        TCIMDiffEngine::TRuleset ruleset = MakeRuleset(document, schema);
        const TRuleTrace trace(document, schema);
        for (const char* name : kClasses) {
            const boost::shared_ptr<TCIMDiffEngine::TDiffClassRules> rules = ruleset.getClassRules(name);
            ASSERT_EQ(rules->fDefault, trace.Find(name).byDefault.treatment) << name;
            ASSERT_EQ(rules->fExcludedKeys, trace.Find(name).excludedKeys) << name;
            for (const char* property : {"p", "q", "r"}) {
                const auto listed = rules->fProperties.find(property);
                const TCIMDiffEngine::propType expected = listed == rules->fProperties.end() ? rules->fDefault : listed->second;
                ASSERT_EQ(expected, trace.Decide(name, property).treatment) << name << "." << property;
            }
        }
    }
}

TCIMDiffEngine::propType Other(TCIMDiffEngine::propType treatment)
{
    return treatment == TCIMDiffEngine::INCLUDE ? TCIMDiffEngine::EXCLUDE : TCIMDiffEngine::INCLUDE;
}

// The lines of what decides the defaults, found by turning the default of one element after the other into its opposite.
std::map<std::string, unsigned int> FindDefaultLines(TRulesDocument document, const boost::shared_ptr<ICIMNamespace>& schema)
{
    std::map<std::string, unsigned int> lines;
    TCIMDiffEngine::TRuleset before = MakeRuleset(document, schema);
    for (TRulesDocument::TElement& element : document.elements) {
        element.defaultTreatment = Other(element.defaultTreatment);
        TCIMDiffEngine::TRuleset after = MakeRuleset(document, schema);
        element.defaultTreatment = Other(element.defaultTreatment);
        for (const char* name : kClasses) {
            if (before.getClassRules(name)->fDefault != after.getClassRules(name)->fDefault) {
                lines[name] = element.line;
            }
        }
    }
    return lines;
}

// The same for the listing of one property.
std::map<std::string, unsigned int> FindListedLines(TRulesDocument document, const std::string& property,
                                                    const boost::shared_ptr<ICIMNamespace>& schema)
{
    std::map<std::string, unsigned int> lines;
    TCIMDiffEngine::TRuleset before = MakeRuleset(document, schema);
    for (TRulesDocument::TElement& element : document.elements) {
        for (TRulesDocument::TListed& listed : element.listed) {
            listed.treatment = Other(listed.treatment);
            TCIMDiffEngine::TRuleset after = MakeRuleset(document, schema);
            listed.treatment = Other(listed.treatment);
            for (const char* name : kClasses) {
                const auto rules = before.getClassRules(name);
                if (listed.property == property && rules->fProperties.count(property) != 0 &&
                    rules->fProperties.at(property) != after.getClassRules(name)->fProperties.at(property)) {
                    lines[name] = listed.line;
                }
            }
        }
    }
    return lines;
}

TEST(RuleTrace, WhatDecidesIsWhatMakesADifference)
{
    const boost::shared_ptr<TInMemNamespace> schema = MakeSchema();
    for (unsigned int seed = 0; seed < 150; ++seed) {
        SCOPED_TRACE("seed " + std::to_string(seed));
        std::mt19937 random(seed);
        const TRulesDocument document = MakeRandomDocument(random, 20);
        const TRuleTrace trace(document, schema);
        auto defaultLines = FindDefaultLines(document, schema);
        for (const char* name : kClasses) {
            ASSERT_EQ(defaultLines[name], trace.Find(name).byDefault.line) << name;
        }
        for (const char* property : {"p", "q", "r"}) {
            auto listedLines = FindListedLines(document, property, schema);
            for (const char* name : kClasses) {
                ASSERT_EQ(listedLines[name], trace.Find(name).listed[property].line) << name << "." << property;
            }
        }
    }
}

}  // namespace
}  // namespace NORVZEL20
