#include "client/rules/RulesXml.h"

#include <boost/algorithm/string/join.hpp>

#include "embedded/value/TValueXml.h"

namespace NORVZEL20 {

std::string WriteRulesElement(const TRulesElement& element)
{
    std::string text = "  <class";
    TValueXml::AppendAttribute(text, "name", element.className);
    if (!element.byDefault.empty()) {
        TValueXml::AppendAttribute(text, "default", element.byDefault);
    }
    if (!element.excludedKeys.empty()) {
        TValueXml::AppendAttribute(text, "excludekeys", boost::algorithm::join(element.excludedKeys, " "));
    }
    const std::string lists = WriteRulesList("includelist", element.included) + WriteRulesList("excludelist", element.excluded);
    return text + (lists.empty() ? "/>\n" : ">\n" + lists + "  </class>\n");
}

std::string WriteRulesList(const std::string& name, const std::vector<std::string>& properties)
{
    std::string list;
    for (const std::string& property : properties) {
        list += "      <value>";
        TValueXml::AppendEscaped(list, property);
        list += "</value>\n";
    }
    return list.empty() ? list : "    <" + name + ">\n" + list + "    </" + name + ">\n";
}

std::string WriteRulesDocument(const std::string& elements)
{
    return "<DifftoolSpec version=\"1.0\">\n" + elements + kRulesDocumentEnd + "\n";
}

}  // namespace NORVZEL20
