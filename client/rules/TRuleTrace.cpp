#include "client/rules/TRuleTrace.h"

#include <algorithm>
#include <set>

#include "client/inventory/CollectObjects.h"
#include "embedded/value/TNameText.h"

namespace NORVZEL20 {

namespace {

std::string Line(unsigned int line)
{
    return "line " + std::to_string(line);
}

TRuleTrace::TClass MakeEntry(const TRulesDocument::TElement& element)
{
    TRuleTrace::TClass entry;
    entry.byDefault = {element.defaultTreatment, element.className, element.line, false};
    for (const TRulesDocument::TListed& listed : element.listed) {
        entry.listed.insert({listed.property, {listed.treatment, element.className, listed.line, true}});
    }
    entry.excludedKeys = element.excludedKeys;
    entry.excludedKeysLine = element.line;
    return entry;
}

// A class that rules flow down to, and whose they are.
struct TClassBelow {
    boost::shared_ptr<ICIMClass> cls;
    std::string parent;
};

// The plug-in's merge: the other's default and listed properties prevail, excluded keys stay as they are.
void Merge(TRuleTrace::TClass& entry, const TRuleTrace::TClass& other)
{
    entry.byDefault = other.byDefault;
    for (const auto& listed : other.listed) {
        entry.listed[listed.first] = listed.second;
    }
}

}  // namespace

TRuleTrace::TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema) : fSchema(schema)
{
    for (const TRulesDocument::TElement& element : document.elements) {
        CheckNames(element);
        Apply(element);
    }
    std::stable_sort(fWarnings.begin(), fWarnings.end(), [](const TWarning& a, const TWarning& b) { return a.line < b.line; });
}

TRuleTrace::TClass TRuleTrace::Find(const std::string& className) const
{
    const auto found = fClasses.find(className);
    return found == fClasses.end() ? TClass() : found->second;
}

TRuleTrace::TDecision TRuleTrace::Decide(const std::string& className, const std::string& property) const
{
    const TClass entry = Find(className);
    const auto exact = entry.listed.find(property);
    if (exact != entry.listed.end()) {
        return exact->second;
    }
    // An included name is asked of the instances as it is spelled, and they do not mind letter case; an excluded one is compared
    // with the declarations, which do.
    for (const auto& listed : entry.listed) {
        if (entry.byDefault.treatment == TCIMDiffEngine::EXCLUDE && listed.second.treatment == TCIMDiffEngine::INCLUDE &&
            TNameText::Equal(listed.first, property)) {
            return listed.second;
        }
    }
    return entry.byDefault;
}

void TRuleTrace::Apply(const TRulesDocument::TElement& element)
{
    const auto known = fClasses.find(element.className);
    if (known == fClasses.end()) {
        fClasses.insert({element.className, MakeEntry(element)});
    } else {
        MergeOwn(known->second, element);
    }
    fOwnLines.insert({element.className, element.line});
    PushDown(element.className, element);
}

void TRuleTrace::MergeOwn(TClass& entry, const TRulesDocument::TElement& element)
{
    const auto own = fOwnLines.find(element.className);
    if (entry.isFinal) {
        Warn(element.line, "this element for class " + element.className +
                               " has no effect: the class's rules were complete before it (its first element is at " +
                               Line(own->second) + "); put everything into one element");
        return;
    }
    if (!element.excludedKeys.empty()) {
        const std::string reason = own == fOwnLines.end()
                                       ? "the class already has the rules of its ancestor " + entry.byDefault.fromClass + " (" +
                                             Line(entry.byDefault.line) + "); put this element before that one"
                                       : "the class already has an element at " + Line(own->second) + "; name the keys there";
        Warn(element.line, "excludekeys of class " + element.className + " has no effect: " + reason);
    }
    Merge(entry, MakeEntry(element));
    entry.isFinal = true;
}

void TRuleTrace::PushDown(const std::string& className, const TRulesDocument::TElement& origin)
{
    std::vector<TClassBelow> open;
    const auto addSubclasses = [&open](ICIMClass& cls, const std::string& name) {
        const std::vector<boost::shared_ptr<ICIMClass>> subclasses = SubclassesOf(cls);
        for (auto sub = subclasses.rbegin(); sub != subclasses.rend(); ++sub) {
            open.push_back({*sub, name});
        }
    };
    addSubclasses(*fSchema->GetClass(className, TCallContext()), className);
    while (!open.empty()) {
        const TClassBelow below = open.back();
        open.pop_back();
        const std::string name = below.cls->GetName(TCallContext());
        Inherit(name, fClasses.at(below.parent), origin);
        addSubclasses(*below.cls, name);
    }
}

void TRuleTrace::Inherit(const std::string& className, const TClass& parent, const TRulesDocument::TElement& origin)
{
    const auto known = fClasses.find(className);
    if (known == fClasses.end()) {
        fClasses.insert({className, parent});
        return;
    }
    if (known->second.isFinal) {
        return;
    }
    const auto own = fOwnLines.find(className);
    if (own != fOwnLines.end() && own->second < origin.line) {
        Warn(own->second, "the element for class " + className + " is read before that of its ancestor " + origin.className + " (" +
                              Line(origin.line) + "), whose default and lists replace its own; put the ancestor first");
    }
    Merge(known->second, parent);
}

void TRuleTrace::CheckNames(const TRulesDocument::TElement& element)
{
    const boost::shared_ptr<ICIMClass> cls = fSchema->GetClass(element.className, TCallContext());
    const std::string& declared = cls->GetName(TCallContext());
    if (declared != element.className) {
        Warn(element.line, "class " + element.className + " is declared as " + declared +
                               "; letter case counts in rules, so this element reaches no class of that name");
    }
    std::set<std::string> seen;
    for (const TRulesDocument::TListed& listed : element.listed) {
        const std::string& name = cls->GetPropertyDecl(listed.property, TCallContext())->GetName(TCallContext());
        if (name != listed.property) {
            Warn(listed.line, "property " + listed.property + " of class " + element.className + " is declared as " + name +
                                  "; letter case counts in rules");
        }
        if (!seen.insert(listed.property).second) {
            Warn(listed.line, "property " + listed.property + " of class " + element.className +
                                  " is listed before in this element; the first listing counts");
        }
    }
    CheckKeys(element, *cls);
}

void TRuleTrace::CheckKeys(const TRulesDocument::TElement& element, ICIMClass& cls)
{
    const std::vector<std::string> keys = KeyNamesOf(cls);
    for (const std::string& key : element.excludedKeys) {
        if (std::find(keys.begin(), keys.end(), key) == keys.end()) {
            Warn(element.line, "excluded key " + key + " is no key of class " + element.className);
        }
    }
}

void TRuleTrace::Warn(unsigned int line, const std::string& text)
{
    fWarnings.push_back({line, text});
}

}  // namespace NORVZEL20
