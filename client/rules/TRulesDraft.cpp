#include "client/rules/TRulesDraft.h"

#include <algorithm>

#include "client/inventory/CollectObjects.h"
#include "client/rules/WriteRules.h"
#include "host/RootClassName.h"

namespace NORVZEL20 {

TRulesDraft::TRulesDraft(const boost::shared_ptr<TInMemNamespace>& schema, TRules& rules, bool areMade)
{
    const TRuleTrace trace(rules.GetDocument(), schema);
    const TRuleTrace::TClass root = trace.Find(kRootClassName);
    TClass top;
    top.name = kRootClassName;
    top.isByDefault = areMade || root.byDefault.treatment == TCIMDiffEngine::INCLUDE;
    top.excludedKeys = root.excludedKeys;
    fClasses.push_back(top);
    for (const boost::shared_ptr<ICIMClass>& cls : SubclassesOf(*schema->GetClass(kRootClassName, TCallContext()))) {
        Add(boost::dynamic_pointer_cast<TInMemClass>(cls), 0, rules, trace);
    }
    fClasses.front().treeEnd = fClasses.size();
}

void TRulesDraft::Add(const boost::shared_ptr<TInMemClass>& cls, std::size_t parent, TRules& rules, const TRuleTrace& trace)
{
    const std::size_t position = fClasses.size();
    TClass added;
    added.name = cls->GetName();
    added.parent = parent;
    added.isByDefault = trace.Find(added.name).byDefault.treatment == TCIMDiffEngine::INCLUDE;
    const std::vector<std::string> compared = rules.PropertiesOf(cls);
    added.compared.insert(compared.begin(), compared.end());
    for (const std::uint32_t slot : cls->GetLayout().GetOrder()) {
        added.declared.push_back(cls->GetLayout().GetDecl(slot).GetName());
    }
    for (const std::uint32_t slot : cls->GetLayout().GetKeys()) {
        added.keys.push_back(cls->GetLayout().GetDecl(slot).GetName());
    }
    added.excludedKeys = rules.ExcludedKeysOf(added.name);
    fClasses.push_back(std::move(added));
    for (const boost::shared_ptr<ICIMClass>& below : SubclassesOf(*cls)) {
        Add(boost::dynamic_pointer_cast<TInMemClass>(below), position, rules, trace);
    }
    fClasses[position].treeEnd = fClasses.size();
}

void TRulesDraft::LeaveOut(std::size_t position)
{
    fClasses[position].isByDefault = false;
    fClasses[position].compared.clear();
}

void TRulesDraft::LeaveOutProperties(std::size_t position, const TNames& names)
{
    TClass& cls = fClasses[position];
    const std::size_t before = cls.compared.size();
    for (auto name = cls.compared.begin(); name != cls.compared.end();) {
        name = names.count(*name) > 0 ? cls.compared.erase(name) : std::next(name);
    }
    if (before == 0 || !cls.compared.empty()) {
        return;
    }
    const auto key = std::find_if(cls.keys.begin(), cls.keys.end(), [&](const std::string& name) {
        return names.count(name) == 0 && std::count(cls.excludedKeys.begin(), cls.excludedKeys.end(), name) == 0;
    });
    if (key != cls.keys.end()) {
        cls.compared.insert(*key);
    }
}

void TRulesDraft::CompareOnly(std::size_t position, const TNames& names)
{
    TClass& cls = fClasses[position];
    cls.isByDefault = false;
    for (auto name = cls.compared.begin(); name != cls.compared.end();) {
        name = names.count(*name) > 0 ? std::next(name) : cls.compared.erase(name);
    }
}

void TRulesDraft::ExcludeKey(std::size_t position, const std::string& key)
{
    TClass& cls = fClasses[position];
    const auto declared =
        std::find_if(cls.keys.begin(), cls.keys.end(), [&key](const std::string& name) { return TNameText::Equal(name, key); });
    if (declared == cls.keys.end()) {
        return;
    }
    if (std::count(cls.excludedKeys.begin(), cls.excludedKeys.end(), *declared) == 0) {
        cls.excludedKeys.push_back(*declared);
    }
    LeaveOutProperties(position, {*declared});
}

std::string TRulesDraft::Write(const std::vector<std::string>& heading) const
{
    return WriteRules(fClasses, heading);
}

}  // namespace NORVZEL20
