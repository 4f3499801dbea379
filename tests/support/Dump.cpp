// Texts for comparing. They hold everything that a test may depend on, in an order that does not depend on addresses, so a test can
// compare one text instead of many values.

#include "tests/support/Dump.h"

#include <set>

#include "spec/TDiffClassRules.h"
#include "tests/support/CallText.h"
#include "tests/support/InstanceAccess.h"
#include "tests/support/TTestAccess.h"

namespace NORVZEL20 {

namespace {

std::string IndicesText(const TCIMValue& indices)
{
    std::string text;
    for (const auto& index : indices.GetElements()) {
        text += (text.empty() ? "" : " ") + std::to_string(static_cast<unsigned short>(index));
    }
    return "[" + text + "]";
}

std::string RecordText(const ICIMInstance& record)
{
    const TCIMValue property = ValueOf(record, "Property");
    std::string text = "  " + ValueOf(record, "Type").ToText() + " " + ValueOf(record, "InstanceName").ToText();
    if (property.IsNull()) {
        text += " NULL";
    } else if (!property.GetString().empty()) {
        text += " " + property.ToText();
    }
    return text + " " + IndicesText(ValueOf(record, "NamespaceIndices")) + "\n";
}

}  // namespace

std::string DumpRules(const TCIMDiffEngine::TDiffClassRules& rules)
{
    std::string text = rules.fDefault == TCIMDiffEngine::INCLUDE ? "include" : "exclude";
    text += rules.fFinal ? " final" : "";
    for (const auto& [name, type] : rules.fProperties) {
        text += " " + name + ":" + TCIMDiffEngine::strPropType(type);
    }
    for (const auto& key : rules.fExcludedKeys) {
        text += " -" + key;
    }
    return text + "\n";
}

std::string DumpRules(const TCIMDiffEngine::TRuleset& ruleset)
{
    std::string text;
    for (const auto& [name, rules] : ruleset.fRules) {
        text += name + " " + DumpRules(*rules);
    }
    return text;
}

std::string DumpRecords(boost::shared_ptr<ICIMNamespace> store)
{
    const TCallContext none;
    std::string text;
    std::set<std::string> tied;
    for (const auto& classRecord : InstancesOf(store, "KALMO_DeltaClass")) {
        text += ValueOf(*classRecord, "ClassName").ToText() + "\n";
        const std::string classPath = classRecord->GetReference(none).GetPath();
        for (const auto& association : InstancesOf(store, "KALMO_DeltaClassAssocToDelta")) {
            if (TCIMReference(ValueOf(*association, "Class")).GetPath() == classPath) {
                const auto record = store->GetInstance(TCIMReference(ValueOf(*association, "Delta")), none);
                text += RecordText(*record);
                tied.insert(record->GetReference(none).GetPath());
            }
        }
    }
    for (const auto& record : InstancesOf(store, "KALMO_Delta")) {
        if (tied.count(record->GetReference(none).GetPath()) == 0) {
            text += "loose" + RecordText(*record);
        }
    }
    return text;
}

std::string DumpInstances(boost::shared_ptr<ICIMNamespace> ns, const std::string& className)
{
    const TCallContext none;
    std::string text;
    for (const auto& instance : InstancesOf(ns, className)) {
        TCIMReference path = instance->GetReference(none);
        path.SetNamespaceName("");
        text += path.GetPath();
        const auto append = [&](boost::shared_ptr<ICIMProperty> property) {
            text += " " + property->GetPropertyDecl(none)->GetName(none) + "=" + ValueText(property->GetValue(none));
            return true;
        };
        instance->EnumerateProperties(append, none);
        text += "\n";
    }
    return text;
}

std::string DumpAliases(const TDeltaNamespace& ns)
{
    std::string text;
    std::size_t index = 0;
    for (const auto& wrappers : TTestAccess::ClassCache(ns)) {
        for (const auto& [className, wrapper] : wrappers) {
            for (const auto& [alias, path] : TTestAccess::Aliases(*wrapper)) {
                text += std::to_string(index) + ":" + className + " " + alias + " -> " + path.GetPath() + "\n";
            }
        }
        ++index;
    }
    return text;
}

}  // namespace NORVZEL20
