#include "tests/engine/SetBuilding.h"

#include <boost/smart_ptr/make_shared.hpp>
#include <map>
#include <stdexcept>

#include "embedded/value/TEmbeddedObject.h"
#include "embedded/value/TValueText.h"
#include "tests/engine/NaiveRules.h"
#include "tests/support/Dump.h"
#include "tests/support/TCapturingLogger.h"

namespace NORVZEL20 {

namespace {

using EKind = TNaiveValue::EKind;
using EType = TCIMValue::TCIMType;

EType::ECIMType TypeOf(EKind kind)
{
    static const std::map<EKind, EType::ECIMType> kTypes = {
        {EKind::kBoolean, EType::kBoolean}, {EKind::kUint8, EType::kUint8},   {EKind::kSint8, EType::kSint8},
        {EKind::kUint16, EType::kUint16},   {EKind::kSint16, EType::kSint16}, {EKind::kUint32, EType::kUint32},
        {EKind::kSint32, EType::kSint32},   {EKind::kUint64, EType::kUint64}, {EKind::kSint64, EType::kSint64},
        {EKind::kReal32, EType::kReal32},   {EKind::kReal64, EType::kReal64}, {EKind::kChar, EType::kChar16},
        {EKind::kText, EType::kString},     {EKind::kTime, EType::kDateTime}, {EKind::kList, EType::kArrayString},
        {EKind::kPath, EType::kReference},  {EKind::kObject, EType::kString},
    };
    return kTypes.at(kind);
}

TCIMValue ValueOf(const TNaiveValue& value);

TCIMValue ListOf(const TNaiveValue& value)
{
    const std::vector<TCIMValue> elements(value.list.begin(), value.list.end());
    return TCIMValue(EType(EType::kArrayString), static_cast<unsigned int>(elements.size()), elements);
}

TCIMValue PathOf(const TNaiveValue& value)
{
    TCIMReference path;
    path.SetNamespaceName(value.list.empty() ? "" : value.list[0]);
    path.SetClassName(value.text);
    for (const auto& [name, key] : value.members) {
        path.AddKeyValue(name, ValueOf(key));
    }
    return TCIMValue(path);
}

TCIMValue ObjectOf(const TNaiveValue& value)
{
    const auto object = boost::make_shared<TEmbeddedObject>(value.text);
    for (const auto& [name, member] : value.members) {
        object->AddProperty({name, ValueOf(member), "", 0, "", false, {}});
    }
    return TCIMValue(boost::shared_ptr<const TEmbeddedObject>(object));
}

TCIMValue ValueOf(const TNaiveValue& value)
{
    if (value.isNull) {
        return TCIMValue::Null(TypeOf(value.kind));
    }
    switch (value.kind) {
    case EKind::kList:
        return ListOf(value);
    case EKind::kPath:
        return PathOf(value);
    case EKind::kObject:
        return ObjectOf(value);
    default:
        break;
    }
    TCIMValue simple;
    if (!TValueText::Parse(TypeOf(value.kind), value.text, simple)) {
        throw std::logic_error(value.text + " is no value of its type");
    }
    return simple;
}

std::string ListTextOf(const TNaiveElement& element, bool isIncluded)
{
    std::string text;
    for (const auto& [name, included] : element.listed) {
        text += included == isIncluded ? "<value>" + name + "</value>" : "";
    }
    const std::string tag = isIncluded ? "includelist" : "excludelist";
    return text.empty() ? "" : "<" + tag + ">" + text + "</" + tag + ">";
}

}  // namespace

void BuildNamespace(const TNaiveNamespace& plain, TNamespaceBuilder& builder)
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
        text += ListTextOf(element, true) + ListTextOf(element, false) + "</class>\n";
    }
    return text + "</DifftoolSpec>\n";
}

std::string CompareByPlugIn(const TNaiveSet& set, EHost host)
{
    TCapturingLogger log;
    TComparisonRun comparison(host);
    comparison.SetWithOperatingSystem(false);
    for (std::size_t index = 0; index < set.namespaces.size(); ++index) {
        BuildNamespace(set.namespaces[index], comparison.Namespace(index));
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
