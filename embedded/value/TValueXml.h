#pragma once

#include <string>
#include <string_view>

#include "embedded/value/TEmbeddedObject.h"
#include "host/Export.h"
#include "host/TCIMReference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Appends values as CIM-XML (DSP0201), without white space between elements.
///
/// The result is well-formed for every value: bytes that are not UTF-8 and characters that XML 1.0 does not allow become U+FFFD. A
/// carriage return is written as a character reference, because a reader would turn it into a line feed.
class CIMDELTA_INTERNAL_EXPORT TValueXml {
  public:
    TValueXml() = delete;

    /// Character data: & < > escaped, and CR.
    static void AppendEscaped(std::string& out, std::string_view text);
    /// ` NAME="text"`, with a blank in front. Quotes, tabs and line breaks are escaped too.
    static void AppendAttribute(std::string& out, std::string_view name, std::string_view text);

    /// VALUE, VALUE.ARRAY (with VALUE.NULL), VALUE.REFERENCE or VALUE.REFARRAY; nothing for null. An embedded object becomes
    /// escaped text in its VALUE.
    static void AppendValue(std::string& out, const TCIMValue& value);
    /// The contents of VALUE.REFERENCE: INSTANCEPATH, LOCALINSTANCEPATH or INSTANCENAME; without keys CLASSPATH, LOCALCLASSPATH or
    /// CLASSNAME. A host without a namespace is not written.
    static void AppendReference(std::string& out, const TCIMReference& path);
    /// INSTANCENAME with its KEYBINDINGs. Null keys are left out.
    static void AppendInstanceName(std::string& out, const TCIMReference& path);
    /// INSTANCE or CLASS.
    static void AppendObject(std::string& out, const TEmbeddedObject& object);

    /// QUALIFIER, with those attributes that differ from their defaults.
    static void AppendQualifier(std::string& out, const TEmbeddedObject::TQualifier& qualifier);
    /// PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE with qualifiers and value. The attribute EmbeddedObject marks a value that is
    /// an embedded object. An array that also has plain text is not marked; its reader needs the qualifier of the declaration.
    static void AppendProperty(std::string& out, const TEmbeddedObject::TProperty& property);
    /// METHOD with qualifiers and parameters.
    static void AppendMethod(std::string& out, const TEmbeddedObject::TMethod& method);
};

}  // namespace NORVZEL20
