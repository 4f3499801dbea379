#pragma once

#include <string>

namespace NORVZEL20 {

/// Why the plug-in refused a rules file, and the line.
struct TRulesFault {
    enum EKind {
        kMalformed,              ///< not well-formed XML; `text` is the parser's reason
        kWrongEncoding,          ///< the bytes are not text in UTF-8 or in an encoding that is read; `text` is the parser's reason
        kUnexpectedElement,      ///< `text` is the element
        kUnknownRootAttribute,   ///< an attribute of DifftoolSpec; `text` is its name
        kUnknownVersion,         ///< `text` is the version
        kUnknownClassAttribute,  ///< an attribute of class; `text` is its name
        kInvalidDefault,         ///< `text` is the value
        kNoClassName,
        kUnknownClass,
        kUnknownProperty,  ///< `text` is the property
        kSchemaFailed,     ///< the schema could not be read; `text` is its reason
    };

    EKind kind = kSchemaFailed;
    unsigned int line = 0;
    std::string className;  ///< the class of the element "class" in progress; empty outside one
    std::string text;

    /// One message for a person: `file:line: what is wrong; what to do`.
    std::string Describe(const std::string& file) const;

  private:
    std::string DescribeWithoutPlace() const;
};

}  // namespace NORVZEL20
