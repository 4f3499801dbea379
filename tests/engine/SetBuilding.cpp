#include "tests/engine/SetBuilding.h"

#include "tests/engine/NaiveRules.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"

namespace NORVZEL20 {

namespace {

using EKind = TNaiveValue::EKind;
using EType = TCIMValue::TCIMType;

EType::ECIMType TypeOf(EKind kind)
{
    switch (kind) {
    case EKind::kNumber:
        return EType::kUint32;
    case EKind::kText:
        return EType::kString;
    case EKind::kList:
        return EType::kArrayString;
    case EKind::kPath:
        return EType::kReference;
    }
    return EType::kNone;
}

TCIMValue ValueOf(const TNaiveValue& value)
{
    if (value.isNull) {
        return TCIMValue::Null(TypeOf(value.kind));
    }
    if (value.kind == EKind::kNumber) {
        return TCIMValue(value.number);
    }
    if (value.kind == EKind::kText) {
        return TCIMValue(value.text);
    }
    if (value.kind == EKind::kList) {
        const std::vector<TCIMValue> elements(value.list.begin(), value.list.end());
        return TCIMValue(EType(EType::kArrayString), static_cast<unsigned int>(elements.size()), elements);
    }
    TCIMReference path;
    path.SetNamespaceName(value.list.empty() ? "" : value.list[0]);
    path.SetClassName(value.text);
    for (const auto& [name, key] : value.pathKeys) {
        path.AddKeyValue(name, TCIMValue(key));
    }
    return TCIMValue(path);
}

void Build(const TNaiveNamespace& plain, TNamespaceBuilder& builder)
{
    for (const auto& cls : plain.classes) {
        std::vector<TNamespaceBuilder::TProperty> properties;
        for (const auto& property : cls.properties) {
            properties.push_back({property.name, TypeOf(property.kind), property.isKey});
        }
        builder.Class(cls.name, cls.superName, properties);
    }
    for (const auto& instance : plain.instances) {
        TNamespaceBuilder::TValues values;
        for (const auto& [name, value] : instance.values) {
            values.emplace_back(name, ValueOf(value));
        }
        builder.Instance(instance.className, values);
    }
}

std::string ListOf(const TNaiveElement& element, bool isIncluded)
{
    std::string text;
    for (const auto& [name, included] : element.listed) {
        text += included == isIncluded ? "<value>" + name + "</value>" : "";
    }
    const std::string tag = isIncluded ? "includelist" : "excludelist";
    return text.empty() ? "" : "<" + tag + ">" + text + "</" + tag + ">";
}

}  // namespace

std::string RulesOf(const TNaiveSet& set)
{
    std::string text = "<DifftoolSpec version=\"1.0\">\n";
    for (const auto& element : set.rules) {
        text += "<class name=\"" + element.className + "\"";
        if (element.def != TNaiveElement::EDefault::kNone) {
            text += element.def == TNaiveElement::EDefault::kInclude ? " default=\"include\"" : " default=\"exclude\"";
        }
        std::string keys;
        for (const auto& key : element.excludedKeys) {
            keys += " " + key;
        }
        text += keys.empty() ? ">" : " excludekeys=\"" + keys + "\">";
        text += ListOf(element, true) + ListOf(element, false) + "</class>\n";
    }
    return text + "</DifftoolSpec>\n";
}

std::string CompareByPlugIn(const TNaiveSet& set, EHost host)
{
    TCapturingLogger log;
    TComparisonRun comparison(host);
    comparison.SetWithOperatingSystem(false);
    for (std::size_t index = 0; index < set.namespaces.size(); ++index) {
        Build(set.namespaces[index], comparison.Namespace(index));
    }
    comparison.Rules(RulesOf(set));
    const std::string status = comparison.Run();
    std::string text = comparison.Records() + DumpAliases(comparison.Delta()) + status;
    for (const auto& cls : set.namespaces[0].classes) {
        text += DumpInstances(comparison.Namespace(0).GetNamespace(), cls.name);
    }
    return text;
}

}  // namespace NORVZEL20
