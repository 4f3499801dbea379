// The elements are merged one after the other, as marks that say which element decides what in a class (TRuleMarks). Warnings come
// from looking at the marks around each merge:
//
//     before   rules of the class are complete             the element has no effect
//              the class has rules already                 its excluded keys have no effect
//     after    a class below has this element's default,   that element came too early
//              but an element of its own came before
//
// When all elements are merged, each class knows its excluded keys, and whether they change how its references are compared.
// What is odd in an element by itself (letter case, repeated names, keys that are none) needs only the schema.
#include "client/rules/TRuleTrace.h"

#include <algorithm>
#include <map>
#include <set>
#include <tuple>
#include <utility>

#include "client/inventory/CollectObjects.h"
#include "client/rules/DescribeReducedReferences.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

// Excluded keys reach the classes below with the first rules that those get, so a key that only a class below has is not a mistake.
bool HasKeyThereOrBelow(const boost::shared_ptr<ICIMClass>& cls, const std::string& key)
{
    std::vector<boost::shared_ptr<ICIMClass>> open{cls};
    while (!open.empty()) {
        const boost::shared_ptr<ICIMClass> next = open.back();
        open.pop_back();
        const std::vector<std::string> keys = KeyNamesOf(*next);
        if (std::find(keys.begin(), keys.end(), key) != keys.end()) {
            return true;
        }
        const std::vector<boost::shared_ptr<ICIMClass>> below = SubclassesOf(*next);
        open.insert(open.end(), below.begin(), below.end());
    }
    return false;
}

}  // namespace

TRuleTrace::TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema)
    : fElements(document.elements), fSchema(schema), fMarks(document.elements, schema)
{
    for (std::size_t index = 0; index < fElements.size(); ++index) {
        CheckNames(index);
        Apply(index);
    }
    WarnOfReducedReferences();
    std::stable_sort(fWarnings.begin(), fWarnings.end(), [](const TWarning& a, const TWarning& b) {
        return std::tie(a.element, a.line) < std::tie(b.element, b.line);
    });
}

TRuleTrace::TClass TRuleTrace::Find(const std::string& className) const
{
    TClass entry;
    const std::optional<std::size_t> byDefault = fMarks.FindDefault(className);
    if (!byDefault) {
        return entry;
    }
    entry.byDefault = MakeDefault(*byDefault);
    for (const auto& [property, index] : fMarks.FindListed(className)) {
        entry.listed[property] = MakeListed(index, property);
    }
    const TRulesDocument::TElement& keys = fElements[*fMarks.FindKeys(className)];
    entry.excludedKeys = keys.excludedKeys;
    entry.excludedKeysLine = keys.line;
    return entry;
}

TRuleTrace::TDecision TRuleTrace::Decide(const std::string& className, const std::string& property) const
{
    const TClass entry = Find(className);
    const auto exact = entry.listed.find(property);
    if (exact != entry.listed.end()) {
        return exact->second;
    }
    // Instances find an included property in any letter case. An excluded one is compared byte for byte with the declared names.
    for (const auto& [name, decision] : entry.listed) {
        if (entry.byDefault.treatment == TCIMDiffEngine::EXCLUDE && decision.treatment == TCIMDiffEngine::INCLUDE &&
            TNameText::Equal(name, property)) {
            return decision;
        }
    }
    return entry.byDefault;
}

std::vector<std::string> TRuleTrace::FindReducedReferences(const ICIMClass& cls) const
{
    const std::string& className = cls.GetName(TCallContext());
    std::vector<std::string> names;
    if (Find(className).excludedKeys.empty()) {
        return names;
    }
    const auto enumerate = [&cls](const auto& callback) { cls.EnumeratePropertyDecls(callback, TCallContext()); };
    for (const boost::shared_ptr<ICIMPropertyDecl>& decl : Collect<ICIMPropertyDecl>(enumerate)) {
        const std::string& name = decl->GetName(TCallContext());
        if (decl->GetType(TCallContext()) == TCIMValue::TCIMType::kReference &&
            Decide(className, name).treatment == TCIMDiffEngine::INCLUDE) {
            names.push_back(name);
        }
    }
    return names;
}

void TRuleTrace::Apply(std::size_t index)
{
    WarnOfLateness(index);
    fMarks.Merge(index);
    WarnOfOverruled(index);
    // insert keeps the first element of a class.
    fFirst.insert({fElements[index].className, index});
}

void TRuleTrace::WarnOfLateness(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    const std::optional<std::size_t> decider = fMarks.FindDefault(element.className);
    // No rules have reached the class, so this element has its full effect.
    if (!decider) {
        return;
    }
    const auto first = fFirst.find(element.className);
    if (fMarks.IsFinal(element.className)) {
        Warn(index, element.line,
             "this element for class " + element.className +
                 " has no effect: the class's rules were complete before it (its first element is at " + LineOf(first->second) +
                 "); put everything into one element");
    } else if (!element.excludedKeys.empty()) {
        const std::string reason = first == fFirst.end()
                                       ? "the class already has the rules of its ancestor " + fElements[*decider].className + " (" +
                                             LineOf(*decider) + "); put this element before that one"
                                       : "the class already has an element at " + LineOf(first->second) + "; name the keys there";
        Warn(index, element.line, "excludekeys of class " + element.className + " has no effect: " + reason);
    }
}

void TRuleTrace::WarnOfOverruled(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    const boost::shared_ptr<ICIMClass> top = fSchema->GetClass(element.className, TCallContext());
    const auto enumerate = [&top](const auto& callback) { top->EnumerateSubClasses(callback, true, TCallContext()); };
    for (const boost::shared_ptr<ICIMClass>& cls : Collect<ICIMClass>(enumerate)) {
        const auto own = fFirst.find(cls->GetName(TCallContext()));
        if (own != fFirst.end() && fMarks.FindDefault(own->first) == index) {
            Warn(own->second, fElements[own->second].line,
                 "the element for class " + own->first + " is read before that of its ancestor " + element.className + " (" +
                     LineOf(index) + "), whose default and lists replace its own; put the ancestor first");
        }
    }
}

void TRuleTrace::CheckNames(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    const boost::shared_ptr<ICIMClass> cls = fSchema->GetClass(element.className, TCallContext());
    const std::string& declared = cls->GetName(TCallContext());
    if (declared != element.className) {
        Warn(index, element.line,
             "class " + element.className + " is declared as " + declared +
                 "; letter case counts in rules, so this element does not apply to that class");
    }
    std::set<std::string> seen;
    for (const TRulesDocument::TListed& listed : element.listed) {
        const std::string& name = cls->GetPropertyDecl(listed.property, TCallContext())->GetName(TCallContext());
        if (name != listed.property) {
            Warn(index, listed.line,
                 "property " + listed.property + " of class " + element.className + " is declared as " + name +
                     "; letter case counts in rules");
        }
        if (!seen.insert(listed.property).second) {
            Warn(index, listed.line,
                 "property " + listed.property + " of class " + element.className +
                     " is already listed in this element; the first listing counts");
        }
    }
    CheckKeys(index, cls);
}

void TRuleTrace::CheckKeys(std::size_t index, const boost::shared_ptr<ICIMClass>& cls)
{
    const TRulesDocument::TElement& element = fElements[index];
    for (const std::string& key : element.excludedKeys) {
        if (!HasKeyThereOrBelow(cls, key)) {
            Warn(index, element.line, "excluded key " + key + " is not a key of class " + element.className);
        }
    }
}

// One warning for each element: its keys may reach many classes below its class.
void TRuleTrace::WarnOfReducedReferences()
{
    std::map<std::size_t, std::vector<std::string>> references;
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fSchema)) {
        const std::string& className = cls->GetName(TCallContext());
        for (const std::string& property : FindReducedReferences(*cls)) {
            references[*fMarks.FindKeys(className)].push_back(className + "." + property);
        }
    }
    for (const auto& [index, properties] : references) {
        Warn(index, fElements[index].line,
             "excludekeys also applies to references: those in " + SomeOf(properties) + " are compared " +
                 DescribeReducedReferences(fElements[index].excludedKeys));
    }
}

void TRuleTrace::Warn(std::size_t index, unsigned int line, const std::string& text)
{
    fWarnings.push_back({index, line, text});
}

TRuleTrace::TDecision TRuleTrace::MakeDefault(std::size_t index) const
{
    const TRulesDocument::TElement& element = fElements[index];
    return {element.defaultTreatment, element.className, element.line, false};
}

// The first listing counts, as in the plug-in.
TRuleTrace::TDecision TRuleTrace::MakeListed(std::size_t index, const std::string& property) const
{
    const TRulesDocument::TElement& element = fElements[index];
    const auto first = std::find_if(element.listed.begin(), element.listed.end(),
                                    [&property](const TRulesDocument::TListed& listed) { return listed.property == property; });
    return {first->treatment, element.className, first->line, true};
}

std::string TRuleTrace::LineOf(std::size_t index) const
{
    return "line " + std::to_string(fElements[index].line);
}

}  // namespace NORVZEL20
