#pragma once

#include <string>
#include <vector>

namespace NORVZEL20 {

// The pieces of a rules file, each with its line ends.

/// What a class element says.
struct TRulesElement {
    std::string className;
    std::string byDefault;  ///< "include" or "exclude"; empty if the element is for keys alone
    std::vector<std::string> excludedKeys;
    std::vector<std::string> included;
    std::vector<std::string> excluded;
};

std::string WriteRulesElement(const TRulesElement& element);

/// A list of an element, "includelist" or "excludelist"; empty if there are no properties.
std::string WriteRulesList(const std::string& name, const std::vector<std::string>& properties);

/// The document around the elements, without the XML declaration.
std::string WriteRulesDocument(const std::string& elements);

/// What stands in front of the document in a file.
inline constexpr char kRulesDeclaration[] = "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n";

/// The last line of the document, without its end.
inline constexpr char kRulesDocumentEnd[] = "</DifftoolSpec>";

}  // namespace NORVZEL20
