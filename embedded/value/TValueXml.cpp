// Values, paths and embedded objects as CIM-XML elements (DSP0201), appended to a text.
//
//     value            element
//     simple           VALUE
//     reference        VALUE.REFERENCE with the path's element
//     array            VALUE.ARRAY of VALUE and VALUE.NULL, or VALUE.REFARRAY of VALUE.REFERENCE and VALUE.NULL
//     null             nothing; inside of an array VALUE.NULL
//     embedded object  VALUE with its INSTANCE or CLASS element as escaped text
//
// A path's element says as much as the path knows: host and namespace (NAMESPACEPATH), the namespace alone (LOCALNAMESPACEPATH) or
// neither, and then an instance or, without keys, a class. Attributes that have their default value are left out.

#include "embedded/value/TValueXml.h"

#include <algorithm>
#include <cmath>

#include "embedded/value/TTypeKind.h"
#include "embedded/value/TValueAccess.h"
#include "embedded/value/TValueText.h"

namespace NORVZEL20 {

namespace {

using TAccess = TValueAccess;
using TType = TCIMValue::TCIMType;
using TObject = TEmbeddedObject;

/// CIM-XML requires a decimal point in every real.
void AppendRealWithPoint(std::string& out, const TCIMValue& value)
{
    const std::size_t start = out.size();
    TValueText::AppendPlain(out, value);
    if (std::isfinite(value.GetReal()) && out.find('.', start) == std::string::npos) {
        // The point goes in front of an exponent: 1e+30 becomes 1.0e+30.
        const std::size_t exponent = out.find('e', start);
        out.insert(exponent == std::string::npos ? out.size() : exponent, ".0");
    }
}

void AppendSimple(std::string& out, const TCIMValue& value)
{
    const TType::ECIMType type = value.GetType();
    if (TAccess::IsText(value)) {
        TValueXml::AppendEscaped(out, TAccess::GetText(value));
    } else if (TAccess::GetForm(value) == TAccess::kObject || type == TType::kChar16) {
        TValueXml::AppendEscaped(out, value.ToText());
    } else if (TTypeKind::IsReal(type)) {
        AppendRealWithPoint(out, value);
    } else {
        TValueText::AppendPlain(out, value);
    }
}

void AppendPathElement(std::string& out, const TCIMReference& path)
{
    out += "<VALUE.REFERENCE>";
    TValueXml::AppendReference(out, path);
    out += "</VALUE.REFERENCE>";
}

void AppendValueElement(std::string& out, const TCIMValue& element)
{
    if (element.IsNull()) {
        out += "<VALUE.NULL/>";
    } else if (TAccess::GetForm(element) == TAccess::kPath) {
        AppendPathElement(out, TAccess::GetPath(element));
    } else {
        out += "<VALUE>";
        AppendSimple(out, element);
        out += "</VALUE>";
    }
}

void AppendArray(std::string& out, const TCIMValue& value)
{
    const bool isOfPaths = value.GetType() == TType::kArrayReference;
    out += isOfPaths ? "<VALUE.REFARRAY>" : "<VALUE.ARRAY>";
    for (const TCIMValue& element : value.GetElements()) {
        AppendValueElement(out, element);
    }
    out += isOfPaths ? "</VALUE.REFARRAY>" : "</VALUE.ARRAY>";
}

void AppendNamespace(std::string& out, const TCIMReference& path)
{
    if (!path.GetHost().empty()) {
        out += "<NAMESPACEPATH><HOST>";
        TValueXml::AppendEscaped(out, path.GetHost());
        out += "</HOST>";
    }
    out += "<LOCALNAMESPACEPATH>";
    std::string_view rest = path.GetNamespaceName();
    // Each part of the name is an element of its own. Empty parts are left out.
    while (!rest.empty()) {
        const std::size_t end = std::min(rest.find('/'), rest.size());
        if (end > 0) {
            out += "<NAMESPACE";
            TValueXml::AppendAttribute(out, "NAME", rest.substr(0, end));
            out += "/>";
        }
        rest.remove_prefix(std::min(end + 1, rest.size()));
    }
    out += "</LOCALNAMESPACEPATH>";
    out += path.GetHost().empty() ? "" : "</NAMESPACEPATH>";
}

void AppendClassName(std::string& out, const TCIMReference& path)
{
    out += "<CLASSNAME";
    TValueXml::AppendAttribute(out, "NAME", path.GetClassName());
    out += "/>";
}

/// The value of the attribute VALUETYPE, which distinguishes only these three kinds.
const char* GetKeyKind(TType type)
{
    switch (type) {
    case TType::kBoolean:
        return "boolean";
    case TType::kString:
    case TType::kChar16:
    case TType::kDateTime:
        return "string";
    default:
        return "numeric";
    }
}

void AppendKeyBinding(std::string& out, const std::pair<std::string, TCIMValue>& binding)
{
    const auto& [name, value] = binding;
    // CIM-XML has no key binding for a null or an array.
    if (value.IsNull() || value.GetType().IsArray()) {
        return;
    }
    out += "<KEYBINDING";
    TValueXml::AppendAttribute(out, "NAME", name);
    out += '>';
    if (TAccess::GetForm(value) == TAccess::kPath) {
        AppendPathElement(out, TAccess::GetPath(value));
    } else {
        out += "<KEYVALUE";
        TValueXml::AppendAttribute(out, "VALUETYPE", GetKeyKind(value.GetType()));
        TValueXml::AppendAttribute(out, "TYPE", TValueText::GetTypeName(value.GetType()));
        out += '>';
        AppendSimple(out, value);
        out += "</KEYVALUE>";
    }
    out += "</KEYBINDING>";
}

/// A null without a type has to be written with some type.
const char* GetWrittenType(TType type)
{
    const char* const name = TValueText::GetTypeName(type);
    return *name != '\0' ? name : "string";
}

void AppendFlag(std::string& out, const char* name, bool value, bool usual)
{
    if (value != usual) {
        TValueXml::AppendAttribute(out, name, value ? "true" : "false");
    }
}

void AppendQualifiers(std::string& out, const std::vector<TObject::TQualifier>& qualifiers)
{
    for (const TObject::TQualifier& qualifier : qualifiers) {
        TValueXml::AppendQualifier(out, qualifier);
    }
}

void AppendOrigin(std::string& out, const std::string& classOrigin, bool propagated)
{
    if (!classOrigin.empty()) {
        TValueXml::AppendAttribute(out, "CLASSORIGIN", classOrigin);
    }
    AppendFlag(out, "PROPAGATED", propagated, false);
}

/// The type of a property or parameter. The name of its element already says whether it is a reference or an array.
void AppendTypeAttributes(std::string& out, TType type, const std::string& referenceClass, unsigned int arraySize)
{
    if (type.GetElementType() == TType::kReference) {
        if (!referenceClass.empty()) {
            TValueXml::AppendAttribute(out, "REFERENCECLASS", referenceClass);
        }
    } else {
        TValueXml::AppendAttribute(out, "TYPE", GetWrittenType(type));
    }
    if (arraySize > 0) {
        TValueXml::AppendAttribute(out, "ARRAYSIZE", std::to_string(arraySize));
    }
}

/// The element's name for the type, such as PROPERTY.ARRAY.
std::string GetKindName(const char* base, TType type)
{
    const bool isReference = type.GetElementType() == TType::kReference;
    return std::string(base) + (isReference ? (type.IsArray() ? ".REFARRAY" : ".REFERENCE") : (type.IsArray() ? ".ARRAY" : ""));
}

const TObject* AsObject(const TCIMValue& value)
{
    return TAccess::GetForm(value) == TAccess::kObject ? value.GetEmbeddedObject().get() : nullptr;
}

/// The embedded object, or the first one of an array. Null if there is other text too: the attribute EmbeddedObject would make a
/// reader take all of it for objects.
const TObject* FindObject(const TCIMValue& value)
{
    if (value.IsNull() || value.GetType() != TType::kArrayString) {
        return AsObject(value);
    }
    const TObject* object = nullptr;
    for (const TCIMValue& element : value.GetElements()) {
        if (TAccess::IsText(element) && !TAccess::GetText(element).empty()) {
            return nullptr;
        }
        object = object != nullptr ? object : AsObject(element);
    }
    return object;
}

void AppendParameter(std::string& out, const TObject::TParameter& parameter)
{
    const std::string element = GetKindName("PARAMETER", parameter.type);
    out.append(1, '<').append(element);
    TValueXml::AppendAttribute(out, "NAME", parameter.name);
    AppendTypeAttributes(out, parameter.type, parameter.referenceClass, parameter.arraySize);
    out += '>';
    AppendQualifiers(out, parameter.qualifiers);
    out.append("</").append(element).append(1, '>');
}

}  // namespace

void TValueXml::AppendValue(std::string& out, const TCIMValue& value)
{
    if (value.IsNull()) {
        return;
    }
    if (value.GetType().IsArray()) {
        AppendArray(out, value);
    } else {
        AppendValueElement(out, value);
    }
}

void TValueXml::AppendReference(std::string& out, const TCIMReference& path)
{
    // With a namespace the element is one of four: for a class or an instance, with or without a host.
    const bool isClass = path.GetKeyCount() == 0;
    const char* element = nullptr;
    if (!path.GetNamespaceName().empty()) {
        const bool hasHost = !path.GetHost().empty();
        element = isClass ? (hasHost ? "CLASSPATH" : "LOCALCLASSPATH") : (hasHost ? "INSTANCEPATH" : "LOCALINSTANCEPATH");
        out.append(1, '<').append(element).append(1, '>');
        AppendNamespace(out, path);
    }
    if (isClass) {
        AppendClassName(out, path);
    } else {
        AppendInstanceName(out, path);
    }
    if (element != nullptr) {
        out.append("</").append(element).append(1, '>');
    }
}

void TValueXml::AppendInstanceName(std::string& out, const TCIMReference& path)
{
    out += "<INSTANCENAME";
    AppendAttribute(out, "CLASSNAME", path.GetClassName());
    out += '>';
    path.EnumerateKeyBindings([&out](const std::pair<std::string, TCIMValue>& binding) {
        AppendKeyBinding(out, binding);
        return true;
    });
    out += "</INSTANCENAME>";
}

void TValueXml::AppendObject(std::string& out, const TEmbeddedObject& object)
{
    out += object.IsClass() ? "<CLASS" : "<INSTANCE";
    AppendAttribute(out, object.IsClass() ? "NAME" : "CLASSNAME", object.GetClassName());
    if (!object.GetSuperClassName().empty()) {
        AppendAttribute(out, "SUPERCLASS", object.GetSuperClassName());
    }
    out += '>';
    AppendQualifiers(out, object.GetQualifiers());
    for (const TObject::TProperty& property : object.GetProperties()) {
        AppendProperty(out, property);
    }
    for (const TObject::TMethod& method : object.GetMethods()) {
        AppendMethod(out, method);
    }
    out += object.IsClass() ? "</CLASS>" : "</INSTANCE>";
}

void TValueXml::AppendQualifier(std::string& out, const TEmbeddedObject::TQualifier& qualifier)
{
    using TDecl = ICIMQualifierDecl;
    out += "<QUALIFIER";
    AppendAttribute(out, "NAME", qualifier.name);
    AppendAttribute(out, "TYPE", GetWrittenType(qualifier.value.GetType()));
    AppendFlag(out, "PROPAGATED", qualifier.propagated, false);
    // The last argument is the default of DSP0201, which is not written.
    AppendFlag(out, "OVERRIDABLE", (qualifier.flavor & TDecl::kFlavorOverridable) != 0, true);
    AppendFlag(out, "TOSUBCLASS", (qualifier.flavor & TDecl::kFlavorToSubclass) != 0, true);
    AppendFlag(out, "TOINSTANCE", (qualifier.flavor & TDecl::kFlavorToInstance) != 0, false);
    AppendFlag(out, "TRANSLATABLE", (qualifier.flavor & TDecl::kFlavorTranslatable) != 0, false);
    out += '>';
    AppendValue(out, qualifier.value);
    out += "</QUALIFIER>";
}

void TValueXml::AppendProperty(std::string& out, const TEmbeddedObject::TProperty& property)
{
    const std::string element = GetKindName("PROPERTY", property.value.GetType());
    out.append(1, '<').append(element);
    AppendAttribute(out, "NAME", property.name);
    AppendTypeAttributes(out, property.value.GetType(), property.referenceClass, property.arraySize);
    AppendOrigin(out, property.classOrigin, property.propagated);
    if (const TObject* const object = FindObject(property.value)) {
        AppendAttribute(out, "EmbeddedObject", object->IsClass() ? "object" : "instance");
    }
    out += '>';
    AppendQualifiers(out, property.qualifiers);
    AppendValue(out, property.value);
    out.append("</").append(element).append(1, '>');
}

void TValueXml::AppendMethod(std::string& out, const TEmbeddedObject::TMethod& method)
{
    out += "<METHOD";
    AppendAttribute(out, "NAME", method.name);
    // A method without a result has no TYPE.
    if (method.type != TType::kNone) {
        AppendAttribute(out, "TYPE", TValueText::GetTypeName(method.type));
    }
    AppendOrigin(out, method.classOrigin, method.propagated);
    out += '>';
    AppendQualifiers(out, method.qualifiers);
    for (const TObject::TParameter& parameter : method.parameters) {
        AppendParameter(out, parameter);
    }
    out += "</METHOD>";
}

}  // namespace NORVZEL20
