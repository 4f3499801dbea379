#include "client/rules/RulesFault.h"

#include <cstdlib>

#include "client/rules/TRulesDocument.h"
#include "client/text/DisplayText.h"

namespace NORVZEL20 {

namespace {

const std::string kLogPrefix = "Diff-XML Parser line ";

// What the plug-in's texts begin with, what a person is told instead (%c is the class, %t the rest of the text) and advised.
struct TWording {
    const char* begins;
    const char* told;
    const char* advice;
};

const TWording kWordings[] = {
    {"Unexpected element ", "element %t is not expected here",
     "a file is DifftoolSpec > class > includelist or excludelist > value"},
    {"Unknown TCIMDiffEngineSpec version", "DifftoolSpec has an attribute or a version that is not known",
     "its only attribute is version, at most \"1.0\""},
    {"Unknown parameter", "element class has an attribute that is not known", "its attributes are name, default and excludekeys"},
    {"Invalid default", "default is neither \"include\" nor \"exclude\"", "letter case counts"},
    {"Invalid property ", "class %c has no property %t", "the name counts as it stands between the tags, blanks included"},
};

const TWording kNoName = {"", "element class has no name", "give it the name of a class of the reference"};
const TWording kNoClass = {"", "class %c is not declared in the reference", "correct the name or remove the element"};
const TWording kOther = {"", "%t", "correct the file"};

bool EndsWith(const std::string& text, const std::string& end)
{
    return text.size() >= end.size() && text.compare(text.size() - end.size(), end.size(), end) == 0;
}

const TWording& FindWording(const std::string& text)
{
    for (const TWording& wording : kWordings) {
        if (text.compare(0, std::string(wording.begins).size(), wording.begins) == 0) {
            return wording;
        }
    }
    if (EndsWith(text, "has no name")) {
        return kNoName;
    }
    return EndsWith(text, " was not found in the schema") ? kNoClass : kOther;
}

std::string Replace(std::string text, const std::string& what, const std::string& by)
{
    const std::size_t at = text.find(what);
    return at == std::string::npos ? text : text.replace(at, what.size(), by);
}

// "Invalid property "x" specified on line 12" says the line twice.
std::string WithoutLine(const std::string& text, unsigned int line)
{
    const std::string end = " specified on line " + std::to_string(line);
    return EndsWith(text, end) ? text.substr(0, text.size() - end.size()) : text;
}

std::string ClassAt(const std::string& file, unsigned int line)
{
    const TRulesDocument document = TRulesDocument::Read(file);
    const TRulesDocument::TElement* element = document.FindByLine(line);
    return element == nullptr ? std::string() : element->className;
}

}  // namespace

std::string DescribeRulesFault(const std::string& file, const std::string& shownName, const std::vector<std::string>& log,
                               const TZELException& error)
{
    if (log.empty() || log.front().compare(0, kLogPrefix.size(), kLogPrefix) != 0) {
        return shownName + ": cannot be used as rules: " + error.what();
    }
    char* rest = nullptr;
    const unsigned int line = static_cast<unsigned int>(std::strtoul(log.front().c_str() + kLogPrefix.size(), &rest, 10));
    const std::string text = WithoutLine(rest + 1, line);
    const TWording& wording = FindWording(text);
    std::string told = Replace(wording.told, "%c", ClassAt(file, line));
    told = Replace(told, "%t", text.substr(std::string(wording.begins).size()));
    return shownName + ":" + std::to_string(line) + ": " + EscapeForDisplay(told) + "; " + wording.advice;
}

}  // namespace NORVZEL20
