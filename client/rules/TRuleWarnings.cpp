// Each element is judged once, by what became of it when all were merged (TRuleTrace):
//
//     the class's rules were final before it                it has no effect; nothing else is said about it
//     the class had rules before it                         its excluded keys have no effect
//     a class above decides the default in the end          the element came too early
//     it decides the default, but names none                the class is left out, perhaps without intent
//     it lists the time of collection, default include      the listing has no effect
//
// What is odd in an element by itself (letter case, repeated names, keys that are none) needs only the schema.
//
// Excluded keys come from the first element that reaches a class, default and lists from the last. So a class below one that has
// rules needs two elements for both: one with the keys before the ancestor's, one with the rest after it. The advice of the two
// warnings about order leads there, whichever comes first.
#include "client/rules/TRuleWarnings.h"

#include <algorithm>
#include <map>
#include <set>
#include <tuple>
#include <utility>

#include "client/inventory/CollectObjects.h"
#include "client/rules/DescribeReducedReferences.h"
#include "client/rules/RecordClasses.h"
#include "client/rules/ShowText.h"
#include "client/text/SomeOf.h"
#include "embedded/value/TNameText.h"
#include "provider/DeltaNames.h"

namespace NORVZEL20 {

namespace {

// The class and all classes below it.
std::vector<boost::shared_ptr<ICIMClass>> TreeOf(const boost::shared_ptr<ICIMClass>& cls)
{
    std::vector<boost::shared_ptr<ICIMClass>> tree =
        Collect<ICIMClass>([&cls](const auto& callback) { cls->EnumerateSubClasses(callback, true, TCallContext()); });
    tree.push_back(cls);
    return tree;
}

}  // namespace

TRuleWarnings::TRuleWarnings(const TRulesDocument& document, const TRuleTrace& trace, boost::shared_ptr<ICIMNamespace> schema,
                             bool isSchemaKnown)
    : fElements(document.elements), fTrace(trace), fMarks(trace.GetMarks()), fSchema(std::move(schema)),
      fIsSchemaKnown(isSchemaKnown)
{
    CheckThatAnythingIsIncluded();
    for (std::size_t index = 0; index < fElements.size(); ++index) {
        Check(index);
    }
    if (fIsSchemaKnown) {
        CheckReferences();
        CheckRecordClasses();
    }
    std::stable_sort(fWarnings.begin(), fWarnings.end(), [](const TWarning& a, const TWarning& b) {
        return std::tie(a.element, a.line) < std::tie(b.element, b.line);
    });
}

void TRuleWarnings::Check(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    if (const std::optional<std::size_t> complete = fTrace.GetArrival(index).complete) {
        Warn(index, element.line,
             "this element for class " + ShowName(element.className) + " has no effect: the rules of the class were final after " +
                 LineOf(*complete) + "; put what is meant there");
        return;
    }
    CheckRepetition(index);
    if (!element.excludedKeys.empty() && fTrace.GetArrival(index).keys) {
        WarnOfLateKeys(index, *fTrace.GetArrival(index).keys);
    }
    if (fIsSchemaKnown) {
        const boost::shared_ptr<ICIMClass> cls = fSchema->GetClass(element.className, TCallContext());
        CheckNames(index, *cls);
        CheckKeys(index, cls);
        CheckOverruled(index);
        CheckDefault(index);
        CheckCollectionTime(index);
    }
}

void TRuleWarnings::CheckNames(std::size_t index, const ICIMClass& cls)
{
    const TRulesDocument::TElement& element = fElements[index];
    const std::string& declared = cls.GetName(TCallContext());
    if (declared != element.className) {
        Warn(index, element.line,
             "class " + ShowName(element.className) + " is declared as " + declared +
                 "; letter case counts in rules, so this element does not apply to that class");
    }
    for (const TRulesDocument::TListed& listed : element.listed) {
        const std::string& name = cls.GetPropertyDecl(listed.property, TCallContext())->GetName(TCallContext());
        if (name != listed.property) {
            Warn(index, listed.line,
                 "property " + ShowName(listed.property) + " of class " + ShowName(element.className) + " is declared as " + name +
                     "; letter case counts in rules");
        }
    }
}

void TRuleWarnings::CheckRepetition(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    std::map<std::string, std::size_t> counts;
    for (const TRulesDocument::TListed& listed : element.listed) {
        if (++counts[listed.property] == 2) {
            Warn(index, listed.line,
                 "property " + ShowName(listed.property) + " of class " + ShowName(element.className) +
                     " is already listed in this element; the first listing counts");
        }
    }
}

// The keys of an element take effect in its class and in those below that had no rules yet.
void TRuleWarnings::CheckKeys(std::size_t index, const boost::shared_ptr<ICIMClass>& cls)
{
    const TRulesDocument::TElement& element = fElements[index];
    if (element.excludedKeys.empty() || fTrace.GetArrival(index).keys) {
        return;
    }
    std::set<std::string> keys;
    for (const boost::shared_ptr<ICIMClass>& reached : TreeOf(cls)) {
        if (fMarks.FindKeys(reached->GetName(TCallContext())) == index || reached == cls) {
            const std::vector<std::string> names = KeyNamesOf(*reached);
            keys.insert(names.begin(), names.end());
        }
    }
    for (const std::string& key : element.excludedKeys) {
        if (keys.count(key) != 0) {
            continue;
        }
        const auto other =
            std::find_if(keys.begin(), keys.end(), [&key](const std::string& name) { return TNameText::Equal(name, key); });
        Warn(index, element.line,
             other == keys.end() ? "excluded key " + ShowName(key) + " is not a key of class " + ShowName(element.className)
                                 : "excluded key " + ShowName(key) + " of class " + ShowName(element.className) +
                                       " is declared as " + *other + "; letter case counts in rules, so it still counts as a key");
    }
}

void TRuleWarnings::WarnOfLateKeys(std::size_t index, std::size_t earlier)
{
    const TRulesDocument::TElement& element = fElements[index];
    const TRulesDocument::TElement& first = fElements[earlier];
    std::string reason;
    if (first.className == element.className) {
        reason = "the class has the keys of its first element, at " + LineOf(earlier) + "; name them there";
    } else {
        reason = "the class already has the rules of its ancestor " + ShowName(first.className) + " (" + LineOf(earlier) +
                 "); put " +
                 (element.hasDefault || !element.listed.empty()
                      ? "an element for " + ShowName(element.className) +
                            " with excludekeys alone before that one, and keep default and lists here"
                      : std::string("this element before that one"));
    }
    Warn(index, element.line, "excludekeys of class " + ShowName(element.className) + " has no effect: " + reason);
}

void TRuleWarnings::CheckOverruled(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    const std::size_t decider = *fMarks.FindDefault(element.className);
    // Without default and lists the element is there for its keys, which nothing replaces.
    if (decider <= index || fElements[decider].className == element.className || (!element.hasDefault && element.listed.empty())) {
        return;
    }
    Warn(index, element.line,
         "the element for class " + ShowName(element.className) + " is read before that of its ancestor " +
             ShowName(fElements[decider].className) + " (" + LineOf(decider) + "), whose default and lists replace its own; " +
             (element.excludedKeys.empty() ? "put it after that one"
                                           : "keep excludekeys alone here, and put default and lists into a second element for " +
                                                 ShowName(element.className) + " after that one"));
}

void TRuleWarnings::CheckDefault(std::size_t index)
{
    const TRulesDocument::TElement& element = fElements[index];
    if (element.hasDefault || fMarks.FindDefault(element.className) != index) {
        return;
    }
    for (const auto& [property, lister] : fMarks.FindListed(element.className)) {
        if (fTrace.GetListing(lister, property).treatment == TCIMDiffEngine::INCLUDE) {
            return;
        }
    }
    Warn(index, element.line,
         "class " + ShowName(element.className) +
             " is not compared: this element has no default, which means exclude, and no list includes a "
             "property; write default=\"include\" or default=\"exclude\"");
}

// An included time of collection has an effect only if the default is to exclude.
void TRuleWarnings::CheckCollectionTime(std::size_t index)
{
    const std::string& className = fElements[index].className;
    const std::map<std::string, std::size_t> listers = fMarks.FindListed(className);
    const auto lister = listers.find(kCollectionTime);
    const TRuleTrace::TClass rules = fTrace.Find(className);
    if (lister == listers.end() || lister->second != index || rules.byDefault.treatment != TCIMDiffEngine::INCLUDE ||
        rules.listed.at(kCollectionTime).treatment != TCIMDiffEngine::INCLUDE) {
        return;
    }
    Warn(index, rules.listed.at(kCollectionTime).line,
         "property " + std::string(kCollectionTime) + " of class " + ShowName(className) +
             " is never compared if the default is include, so this listing has no effect; write default=\"exclude\" and list "
             "all that is to be compared");
}

void TRuleWarnings::CheckThatAnythingIsIncluded()
{
    const bool includesAny = std::any_of(fElements.begin(), fElements.end(), [](const TRulesDocument::TElement& element) {
        return element.defaultTreatment == TCIMDiffEngine::INCLUDE ||
               std::any_of(element.listed.begin(), element.listed.end(),
                           [](const auto& listed) { return listed.treatment == TCIMDiffEngine::INCLUDE; });
    });
    if (!includesAny) {
        Warn(0, fElements.empty() ? 1 : fElements.front().line,
             "these rules compare nothing, because no element includes anything; write default=\"include\" or an includelist");
    }
}

// One warning for each element: its keys may reach many classes below its class.
void TRuleWarnings::CheckReferences()
{
    std::map<std::size_t, std::vector<std::string>> references;
    std::map<std::size_t, std::set<std::string>> keys;
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fSchema)) {
        const std::string& className = cls->GetName(TCallContext());
        const std::vector<std::string> reduced = fTrace.FindReducedReferences(*cls);
        if (reduced.empty()) {
            continue;
        }
        const std::size_t index = *fMarks.FindKeys(className);
        for (const std::string& property : reduced) {
            references[index].push_back(className + "." + property);
        }
        const std::vector<std::string> lost = fTrace.FindKeysOfReferences(className);
        keys[index].insert(lost.begin(), lost.end());
    }
    for (const auto& [index, properties] : references) {
        std::vector<std::string> lost;
        std::copy_if(fElements[index].excludedKeys.begin(), fElements[index].excludedKeys.end(), std::back_inserter(lost),
                     [&found = keys[index]](const std::string& key) { return found.erase(key) != 0; });
        Warn(index, fElements[index].line,
             "excludekeys also applies to references: those in " + SomeOf(properties) + " are compared " +
                 DescribeReducedReferences(lost));
    }
}

void TRuleWarnings::CheckRecordClasses()
{
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fSchema)) {
        const std::string& className = cls->GetName(TCallContext());
        const std::optional<std::size_t> index = fMarks.FindKeys(className);
        if (IsRecordClass(className) && index && !fElements[*index].excludedKeys.empty()) {
            Warn(*index, fElements[*index].line, DescribeRecordKeys(className));
        }
    }
}

void TRuleWarnings::Warn(std::size_t index, unsigned int line, const std::string& text)
{
    fWarnings.push_back({index, line, text});
}

std::string TRuleWarnings::LineOf(std::size_t index) const
{
    return "line " + std::to_string(fElements[index].line);
}

}  // namespace NORVZEL20
