#pragma once

#include <string>
#include <string_view>

#include "embedded/value/TEmbeddedObject.h"
#include "host/TCIMReference.h"
#include "host/TCIMValue.h"

namespace NORVZEL20 {

/// Values as CIM-XML (DSP0201), appended to a text, without white space between elements.
///
/// The result is well-formed for whatever a value holds: bytes that are no UTF-8 and characters that XML 1.0 cannot carry become
/// U+FFFD. A carriage return is written as a character reference, so that reading gives it back.
class TValueXml {
  public:
    TValueXml() = delete;

    /// Character data: & < > escaped, and CR.
    static void AppendEscaped(std::string& out, std::string_view text);
    /// ` NAME="text"` with a blank in front; text escaped with quotes, tabs and line ends too.
    static void AppendAttribute(std::string& out, std::string_view name, std::string_view text);

    /// VALUE, VALUE.ARRAY (with VALUE.NULL), VALUE.REFERENCE or VALUE.REFARRAY; nothing for null. Embedded objects become
    /// escaped text in their VALUE.
    static void AppendValue(std::string& out, const TCIMValue& value);
    /// What stands in VALUE.REFERENCE: INSTANCEPATH, LOCALINSTANCEPATH or INSTANCENAME; without keys CLASSPATH, LOCALCLASSPATH or
    /// CLASSNAME. A host without a namespace does not show.
    static void AppendReference(std::string& out, const TCIMReference& path);
    /// INSTANCENAME with its KEYBINDINGs; keys without value are left out.
    static void AppendInstanceName(std::string& out, const TCIMReference& path);
    /// INSTANCE or CLASS.
    static void AppendObject(std::string& out, const TEmbeddedObject& object);

    /// A whole QUALIFIER element, attributes that differ from their defaults alone.
    static void AppendQualifier(std::string& out, const TEmbeddedObject::TQualifier& qualifier);
    /// PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE with qualifiers and value. Embedded objects are marked, save in an array
    /// where plain text stands beside them: there a qualifier of the declaration has to tell.
    static void AppendProperty(std::string& out, const TEmbeddedObject::TProperty& property);
    /// METHOD with qualifiers and parameters.
    static void AppendMethod(std::string& out, const TEmbeddedObject::TMethod& method);
};

}  // namespace NORVZEL20
