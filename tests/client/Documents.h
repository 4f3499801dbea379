#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

// Pieces of inventories, for documents that are too small for a file of their own.

inline std::string Qualifier(const std::string& name)
{
    return "<QUALIFIER NAME=\"" + name + "\" TYPE=\"boolean\"><VALUE>TRUE</VALUE></QUALIFIER>";
}

inline const std::string kKey = Qualifier("Key");

inline std::string Declaration(const std::string& name, const std::string& type, const std::string& qualifiers = std::string())
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\">" + qualifiers + "</PROPERTY>";
}

inline std::string KeyProperty(const std::string& name)
{
    return Declaration(name, "string", kKey);
}

inline std::string Value(const std::string& name, const std::string& value, const std::string& type = "string")
{
    return "<PROPERTY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE>" + value + "</VALUE></PROPERTY>";
}

inline std::string ListDeclaration(const std::string& name, const std::string& type = "string",
                                   const std::string& qualifiers = std::string())
{
    return "<PROPERTY.ARRAY NAME=\"" + name + "\" TYPE=\"" + type + "\">" + qualifiers + "</PROPERTY.ARRAY>";
}

inline std::string List(const std::string& name, const std::vector<std::string>& values, const std::string& type = "string")
{
    std::string elements;
    for (const std::string& value : values) {
        elements += "<VALUE>" + value + "</VALUE>";
    }
    return "<PROPERTY.ARRAY NAME=\"" + name + "\" TYPE=\"" + type + "\"><VALUE.ARRAY>" + elements +
           "</VALUE.ARRAY></PROPERTY.ARRAY>";
}

inline std::string Class(const std::string& name, const std::string& super, const std::string& properties)
{
    return "<VALUE.OBJECT><CLASS NAME=\"" + name + "\"" + (super.empty() ? "" : " SUPERCLASS=\"" + super + "\"") + ">" +
           properties + "</CLASS></VALUE.OBJECT>\n";
}

inline std::string Instance(const std::string& cls, const std::string& properties)
{
    return "<VALUE.OBJECT><INSTANCE CLASSNAME=\"" + cls + "\">" + properties + "</INSTANCE></VALUE.OBJECT>\n";
}

/// The path of an instance with one text key.
inline std::string Path(const std::string& cls, const std::string& key, const std::string& value)
{
    return "<INSTANCENAME CLASSNAME=\"" + cls + "\"><KEYBINDING NAME=\"" + key + "\"><KEYVALUE>" + value +
           "</KEYVALUE></KEYBINDING></INSTANCENAME>";
}

/// The operating system that every comparison needs.
inline std::string System()
{
    return Class("KALMO_OperatingSystem", "", KeyProperty("Name") + Declaration("OSType", "uint16")) +
           Instance("KALMO_OperatingSystem", Value("Name", "host") + Value("OSType", "36", "uint16"));
}

/// A document. `ns` is the XML of its namespace, or empty for none.
inline std::string Document(const std::string& contents, const std::string& ns = std::string())
{
    return "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><DECLARATION><DECLGROUP>" + ns +
           "<QUALIFIER.DECLARATION NAME=\"Key\" TYPE=\"boolean\"/><QUALIFIER.DECLARATION NAME=\"Static\" TYPE=\"boolean\"/>"
           "<QUALIFIER.DECLARATION NAME=\"EmbeddedInstance\" TYPE=\"string\"/>\n" +
           contents + "</DECLGROUP></DECLARATION></CIM>\n";
}

}  // namespace NORVZEL20
