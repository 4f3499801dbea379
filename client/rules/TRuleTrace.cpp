// The elements are merged one after the other, as marks that say which element decides what in a class (TRuleMarks). Before each
// merge, the marks of its class say whether the element still has its full effect.
#include "client/rules/TRuleTrace.h"

#include <algorithm>
#include <utility>

#include "client/inventory/CollectObjects.h"
#include "embedded/value/TNameText.h"
#include "host/TCIMReference.h"

namespace NORVZEL20 {

namespace {

// References may be to classes that no inventory declares.
void AddKeysInReferences(ICIMClass& cls, std::set<std::string>& keys)
{
    for (const boost::shared_ptr<ICIMInstance>& instance : InstancesOf(cls)) {
        for (const boost::shared_ptr<ICIMProperty>& property : PropertiesOf(*instance)) {
            const TCIMValue value = property->GetValue(TCallContext());
            if (!value.IsNull() && value.GetType() == TCIMValue::TCIMType::kReference) {
                const TCIMReference path = value;
                path.EnumerateKeyBindings([&keys](const std::pair<std::string, TCIMValue>& binding) {
                    keys.insert(binding.first);
                    return true;
                });
            }
        }
    }
}

}  // namespace

TRuleTrace::TRuleTrace(const TRulesDocument& document, boost::shared_ptr<ICIMNamespace> schema)
    : fElements(document.elements), fSchema(std::move(schema)), fMarks(document.elements, fSchema)
{
    for (std::size_t index = 0; index < fElements.size(); ++index) {
        Merge(index);
    }
    for (const boost::shared_ptr<ICIMClass>& cls : AllClassesOf(*fSchema)) {
        const std::vector<std::string> keys = KeyNamesOf(*cls);
        fDeclaredKeys.insert(keys.begin(), keys.end());
    }
}

TRuleTrace::TClass TRuleTrace::Make(const std::string& className) const
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

const TRuleTrace::TRecalled& TRuleTrace::Recall(const std::string& className) const
{
    if (!fRecalled || fRecalled->className != className) {
        auto recalled = std::make_unique<TRecalled>();
        recalled->className = className;
        recalled->rules = Make(className);
        for (const auto& [name, decision] : recalled->rules.listed) {
            if (decision.treatment == TCIMDiffEngine::INCLUDE) {
                recalled->included.emplace(name, &decision);  // of names that differ in letter case, the first one
            }
        }
        fRecalled = std::move(recalled);
    }
    return *fRecalled;
}

// As the plug-in lists what it compares. If the default is to exclude, it takes the included names; instances find a property in
// any letter case. Otherwise it takes the declared names and leaves out the excluded ones, byte for byte.
TRuleTrace::TDecision TRuleTrace::Decide(const std::string& className, const std::string& property) const
{
    const TRecalled& known = Recall(className);
    if (known.rules.byDefault.treatment == TCIMDiffEngine::EXCLUDE) {
        const auto included = known.included.find(std::string_view(property));
        if (included != known.included.end()) {
            return *included->second;
        }
    }
    const auto exact = known.rules.listed.find(property);
    return exact == known.rules.listed.end() ? known.rules.byDefault : exact->second;
}

std::vector<std::string> TRuleTrace::FindReducedReferences(const ICIMClass& cls) const
{
    const std::string& className = cls.GetName(TCallContext());
    const std::vector<std::string> excluded = Find(className).excludedKeys;
    std::vector<std::string> names;
    if (excluded.empty()) {
        return names;
    }
    const std::vector<std::string> keys = KeyNamesOf(cls);
    const auto has = [](const std::vector<std::string>& list, const std::string& name) {
        return std::find(list.begin(), list.end(), name) != list.end();
    };
    const auto enumerate = [&cls](const auto& callback) { cls.EnumeratePropertyDecls(callback, TCallContext()); };
    for (const boost::shared_ptr<ICIMPropertyDecl>& decl : Collect<ICIMPropertyDecl>(enumerate)) {
        const std::string& name = decl->GetName(TCallContext());
        const bool isReference = decl->GetType(TCallContext()) == TCIMValue::TCIMType::kReference;
        const bool isMatched = isReference && has(keys, name) && !has(excluded, name);
        if (isReference && !isMatched && Decide(className, name).treatment == TCIMDiffEngine::INCLUDE) {
            names.push_back(name);
        }
    }
    return names;
}

std::vector<std::string> TRuleTrace::FindKeysOfReferences(const std::string& className) const
{
    const std::vector<std::string> excluded = Find(className).excludedKeys;
    const auto isDeclared = [this](const std::string& key) { return fDeclaredKeys.count(key) != 0; };
    std::set<std::string> found;
    if (!std::all_of(excluded.begin(), excluded.end(), isDeclared)) {
        AddKeysInReferences(*fSchema->GetClass(className, TCallContext()), found);
    }
    std::vector<std::string> keys;
    for (const std::string& key : excluded) {
        if ((isDeclared(key) || found.count(key) != 0) && std::find(keys.begin(), keys.end(), key) == keys.end()) {
            keys.push_back(key);
        }
    }
    return keys;
}

void TRuleTrace::Merge(std::size_t index)
{
    const std::string& className = fElements[index].className;
    fListings.emplace_back();
    for (const TRulesDocument::TListed& listed : fElements[index].listed) {
        fListings.back().emplace(listed.property, &listed);  // the first listing counts, as in the plug-in
    }
    TArrival arrival;
    arrival.keys = fMarks.FindKeys(className);
    if (fMarks.IsFinal(className)) {
        arrival.complete = fCompleting.at(className);
    }
    fArrivals.push_back(arrival);
    fMarks.Merge(index);
    // insert keeps the first element after which the rules are complete.
    if (fMarks.IsFinal(className)) {
        fCompleting.insert({className, index});
    }
}

TRuleTrace::TDecision TRuleTrace::MakeDefault(std::size_t index) const
{
    const TRulesDocument::TElement& element = fElements[index];
    return {element.defaultTreatment, element.className, element.line, false};
}

TRuleTrace::TDecision TRuleTrace::MakeListed(std::size_t index, const std::string& property) const
{
    const TRulesDocument::TElement& element = fElements[index];
    const TRulesDocument::TListed& listing = GetListing(index, property);
    return {listing.treatment, element.className, listing.line, true};
}

}  // namespace NORVZEL20
